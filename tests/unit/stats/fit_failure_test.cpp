#include "stats/fit.h"

#include "unit/stats/named_combinations.h"
#include "unit/stats/reference_files.h"

#include <gtest/gtest.h>

#include <cmath>
#include <limits>
#include <string>
#include <vector>

namespace ryn::stats {
namespace {

using testing::FrameOf;
using testing::Named;
using testing::ReferenceSeries;

const SeriesFrame kAnnual{};
const std::vector<double> kNegative = {-5, -4, -3, -2, -1};

// "CODE text" of the failure, or the empty text of a success.
std::string Failing(const std::string& name, const std::vector<double>& values,
                    const SeriesFrame& frame) {
    const FitResult fit = Fit(Named(name), {values, frame});
    return fit ? "" : FailureCode(fit.Failure()) + " " + FailureText(fit.Failure());
}

TEST(Fit, RefusesWhatTheKindOfSeriesDoesNotOffer) {
    const auto annual = ReferenceSeries("portpirie");
    const auto peaks = ReferenceSeries("rain40");
    for (const char* name : {"GEV/MOM", "GUM/MOM", "FRE/MOM", "FRE/ML", "SQE/ML"}) {
        EXPECT_EQ(Failing(name, peaks, FrameOf("rain40")),
                  "C01 distribution is not offered for a partial duration series");
    }
    for (const char* name : {"EXP1/MOM", "EXP2/LMOM", "TGUM/ML"}) {
        EXPECT_EQ(Failing(name, annual, kAnnual),
                  "C01 distribution is not offered for an annual maximum series");
    }
}

TEST(Fit, RefusesAllEqualButOneWhateverTheRounding) {
    for (const std::size_t count : {5U, 6U, 7U, 20U}) {
        std::vector<double> values(count, 5.0);
        values.back() = 6.0;
        for (const char* name : {"GP/LMOM", "GEV/LMOM"})
            EXPECT_EQ(Failing(name, values, kAnnual).substr(0, 3), "C08") << name << count;
    }
}

TEST(Fit, RefusesWhatTheDistributionDoesNotOffer) {
    const std::string text = "C02 estimation method is not offered for this distribution";
    const auto annual = ReferenceSeries("portpirie");
    const auto peaks = ReferenceSeries("rain40");
    for (const char* name :
         {"FRE/ML", "FRE/LMOM", "WEI/ML", "GP/ML", "P3/ML", "LP3/ML", "SQE/MOM"}) {
        EXPECT_EQ(Failing(name, annual, kAnnual), text);
    }
    for (const char* name : {"LP3/ML", "TGUM/MOM", "TGUM/LMOM"}) {
        EXPECT_EQ(Failing(name, peaks, FrameOf("rain40")), text);
    }
}

TEST(Fit, NeedsFiveValues) {
    const std::string four = "C03 too few values: 4, at least 5 are needed";
    EXPECT_EQ(Failing("GEV/LMOM", {1, 2, 3, 5}, kAnnual), four);
    EXPECT_EQ(Failing("GUM/MOM", {1, 2, 3, 5}, kAnnual), four);
    EXPECT_EQ(Failing("EXP1/ML", {1, 2, 3, 5}, {SeriesKind::PartialDuration, 0, 1}), four);
    EXPECT_EQ(Failing("GEV/LMOM", {}, kAnnual), "C03 too few values: 0, at least 5 are needed");
    EXPECT_EQ(Failing("GEV/LMOM", {1, 2, 3, 5, 9}, kAnnual), "");
}

TEST(Fit, RefusesASampleWithoutSpread) {
    const std::vector<double> equal(10, 7.3);
    EXPECT_EQ(Failing("GUM/MOM", equal, kAnnual), "C14 parameters are not valid");
    EXPECT_EQ(Failing("GUM/LMOM", equal, kAnnual), "C14 parameters are not valid");
    EXPECT_EQ(Failing("GEV/MOM", equal, kAnnual).substr(0, 4), "C06 ");
    EXPECT_EQ(Failing("GP/MOM", equal, kAnnual).substr(0, 4), "C06 ");
    EXPECT_EQ(Failing("GEV/LMOM", equal, kAnnual).substr(0, 4), "C08 ");
    EXPECT_EQ(Failing("GP/LMOM", equal, kAnnual).substr(0, 4), "C08 ");
    const SeriesFrame peaks{SeriesKind::PartialDuration, 5, 1};
    for (const char* name : {"WEI", "FRE", "P3", "LP3", "LN2"}) {
        for (const char* method : {"/MOM", "/LMOM"}) {
            EXPECT_NE(Failing(std::string(name) + method, equal, kAnnual), "") << name << method;
        }
    }
    for (const char* name :
         {"WEI2/MOM", "WEI2/LMOM", "GAM/MOM", "GAM/LMOM", "LN2/MOM", "LN2/LMOM"}) {
        EXPECT_NE(Failing(name, equal, peaks), "") << name;
    }
}

// Values 1 to 9 and an outlier: `skewed` to the right, turned left for right to the left.
const std::vector<double> kRight = {1, 2, 3, 4, 5, 6, 7, 8, 9, 40};
const std::vector<double> kLeft = {-40, -9, -8, -7, -6, -5, -4, -3, -2, -1};

std::vector<double> Shifted(std::vector<double> values, double shift) {
    for (double& x : values) {
        x += shift;
    }
    return values;
}

TEST(Fit, RefusesValuesThatHaveNoLogarithm) {
    const std::string text = "C04 all values must be greater than 0";
    const auto withZero = Shifted(kRight, -1);
    for (const char* name :
         {"FRE/MOM", "LP3/MOM/LOG", "LP3/MOM/REAL", "LP3/LMOM", "LN2/MOM", "LN3/MOM/LBQI"}) {
        EXPECT_EQ(Failing(name, withZero, kAnnual), text) << name;
    }
    const SeriesFrame peaks{SeriesKind::PartialDuration, -5, 1};
    for (const char* name : {"LP3/MOM/LOG", "LP3/LMOM", "LN3/MOM/LBQI"}) {
        EXPECT_EQ(Failing(name, withZero, peaks), text) << name;
    }
    // Elsewhere 0 is a value like any other, or outside the support.
    for (const char* name : {"P3/MOM", "LN3/MOM/BI", "LN3/MOM/LBQII", "LN2/LMOM"}) {
        EXPECT_EQ(Failing(name, withZero, kAnnual), "") << name;
    }
    EXPECT_EQ(Failing("LN2/MOM", withZero, peaks), "");
}

TEST(Fit, RefusesSkewnessThatTheDistributionCannotHave) {
    const std::string left = "C06 sample skewness -2.861 is outside the range of the distribution";
    EXPECT_EQ(Failing("WEI/MOM", kLeft, kAnnual), left);
    EXPECT_EQ(Failing("WEI/LMOM", kLeft, kAnnual),
              "C08 sample L-moments are outside the range of the distribution (L-Cv -0.569, "
              "L-skewness -0.621)");
    for (const char* name : {"LN3/MOM/BI", "LN3/MOM/BII"}) {
        EXPECT_EQ(Failing(name, kLeft, kAnnual).substr(0, 4), "C07 ") << name;
    }
    EXPECT_EQ(Failing("LN3/MOM/BI", kLeft, kAnnual), "C07 sample skewness -2.861 must be positive");
    // mu_3 so close to the least that mu_2 allows that alpha lies below -1000.
    EXPECT_EQ(Failing("LP3/MOM/REAL", {1e-9, 100, 100, 100, 100, 100}, kAnnual).substr(0, 4),
              "C06 ");
}

TEST(Fit, RefusesBoundsThatTheOrderStatisticsDoNotGive) {
    EXPECT_EQ(Failing("LN3/MOM/LBQII", Shifted(kLeft, 50), kAnnual),
              "C09 lower bound cannot be estimated: largest + smallest - 2 x median is not "
              "positive");
    EXPECT_EQ(Failing("LN3/MOM/LBQII", {1, 1, 1, 1, 2, 3}, kAnnual),
              "C10 estimated lower bound 1.000 is not below the smallest value 1.000");
    EXPECT_EQ(Failing("LN3/MOM/LBQI", {10, 50, 50, 50, 60}, kAnnual).substr(0, 4), "C10 ");
    // Smallest and largest already lie symmetric about the geometric mean on the linear scale.
    EXPECT_EQ(Failing("LN3/MOM/LBQI", {5, 5, 5, 5, 5}, kAnnual), "C12 no convergence");
}

TEST(Fit, HoldsTheNewFamiliesAgainstTheSample) {
    const auto floyd = ReferenceSeries("floyd");
    for (const char* name : {"LN3/MOM/BII", "P3/MOM"}) {
        EXPECT_EQ(Failing(name, floyd, kAnnual),
                  "C13 more than a quarter of the values lie outside the range of the fitted "
                  "distribution");
    }
    FitScratch scratch;
    const auto p3 = EstimateParameters(Named("P3/MOM"), {floyd, kAnnual}, scratch);
    EXPECT_NEAR(Support(p3->distribution).lower, 1838.76, 0.005);
    const auto ln3 = EstimateParameters(Named("LN3/MOM/BII"), {floyd, kAnnual}, scratch);
    EXPECT_NEAR(Support(ln3->distribution).lower, 3212.44, 0.005);
}

TEST(Fit, WarnsOfASkewnessCorrectionBeyondItsCalibration) {
    const auto warnings = [](const std::string& name, const std::vector<double>& values) {
        const FitResult fit = Fit(Named(name), {values, kAnnual});
        std::string codes;
        for (const FitWarning& warning : fit ? fit->warnings : WarningList{}) {
            codes += WarningCode(warning);
        }
        return codes;
    };
    EXPECT_EQ(warnings("LN3/MOM/BII", {2, 3, 4, 5, 6, 8, 11}), "W2") << "7 values";
    EXPECT_EQ(warnings("LN3/MOM/BI", {2, 3, 4, 5, 6, 8, 11}), "");
    EXPECT_EQ(warnings("LN3/MOM/BII", ReferenceSeries("portpirie")), "");
    FitScratch scratch;
    const auto floyd = ReferenceSeries("floyd");
    EXPECT_EQ(EstimateParameters(Named("LN3/MOM/BII"), {floyd, kAnnual}, scratch)->warnings.size(),
              1U);
}

TEST(Fit, RefusesExceedancesThatAverageNothing) {
    const auto peaks = ReferenceSeries("rain40");
    const SeriesFrame high{SeriesKind::PartialDuration, 60, 1};
    for (const char* name : {"GP2/MOM", "GP2/LMOM", "EXP1/MOM", "EXP1/ML", "EXP1/LMOM", "WEI2/MOM",
                             "WEI2/LMOM", "GAM/MOM", "GAM/LMOM", "LN2/MOM", "LN2/LMOM"}) {
        EXPECT_EQ(Failing(name, peaks, high), "C15 mean exceedance is not positive");
    }
    const SeriesFrame none{SeriesKind::PartialDuration, std::nan(""), 1};
    EXPECT_EQ(Failing("GP2/MOM", peaks, none), "C15 mean exceedance is not positive");
}

// A threshold just below the mean leaves an L-Cv above 1, which no positive variable has.
TEST(Fit, RefusesLMomentsThatTheDistributionCannotHave) {
    const SeriesFrame frame{SeriesKind::PartialDuration, 2.5, 1};
    for (const char* name : {"GP2/LMOM", "WEI2/LMOM", "GAM/LMOM", "LN2/LMOM"}) {
        EXPECT_EQ(Failing(name, {1, 2, 3, 4, 5}, frame),
                  "C08 sample L-moments are outside the range of the distribution (L-Cv 2.000, "
                  "L-skewness 0.000)");
    }
    EXPECT_EQ(Failing("LN2/LMOM", kNegative, kAnnual).substr(0, 4), "C08 ");
}

// xi = mean - s lies above the lower 40 % of a sample with two levels.
TEST(Fit, RefusesAnEstimateThatLeavesAQuarterOfTheValuesOutside) {
    const SeriesFrame frame{SeriesKind::PartialDuration, 0, 1};
    EXPECT_EQ(Failing("EXP2/MOM", {1, 1, 1, 1, 10, 10, 10, 10, 10, 10}, frame),
              "C13 more than a quarter of the values lie outside the range of the fitted "
              "distribution");
    FitScratch scratch;
    const std::vector<double> values = {1, 1, 1, 1, 10, 10, 10, 10, 10, 10};
    EXPECT_TRUE(EstimateParameters(Named("EXP2/MOM"), {values, frame}, scratch))
        << "resampling keeps such an estimate";
}

TEST(Fit, WarnsOfValuesOutsideTheSupport) {
    const auto values = ReferenceSeries("portpirie");
    const FitResult fit = Fit(Named("GP/MOM"), {values, kAnnual});
    ASSERT_TRUE(fit);
    ASSERT_EQ(fit->warnings.size(), 1U);
    EXPECT_EQ(WarningCode(fit->warnings[0]) + " " + WarningText(fit->warnings[0]),
              "W1 4 value(s) lie outside the range of the fitted distribution");
    EXPECT_TRUE(std::isnan(fit->logLikelihood));
}

// Series are stored with seven digits, thresholds with sixteen.
TEST(Fit, CountsAPeakThatRoundingLeftBelowTheThresholdAsEqualToIt) {
    const SeriesFrame frame{SeriesKind::PartialDuration, 40.1, 1};
    const double stored = std::nextafter(40.1F, 0.0F);
    ASSERT_LT(stored, 40.1);
    const std::vector<double> rounded = {stored, 41, 45, 47, 52, 60};
    const FitResult fit = Fit(Named("GP2/LMOM"), {rounded, frame});
    ASSERT_TRUE(fit);
    EXPECT_TRUE(fit->warnings.empty());
    EXPECT_TRUE(std::isfinite(fit->logLikelihood));
    const std::vector<double> lower = {40.0998, 41, 45, 47, 52, 60};
    const FitResult warned = Fit(Named("GP2/LMOM"), {lower, frame});
    ASSERT_TRUE(warned);
    EXPECT_EQ(warned->warnings.size(), 1U);
}

TEST(Fit, RefusesValuesThatAreNotFinite) {
    const double odd[] = {std::numeric_limits<double>::quiet_NaN(),
                          std::numeric_limits<double>::infinity(),
                          -std::numeric_limits<double>::infinity()};
    for (const double value : odd) {
        auto annual = ReferenceSeries("portpirie");
        annual[7] = value;
        for (const char* name :
             {"GEV/MOM",      "GEV/LMOM", "GUM/MOM",     "GUM/MOM corr", "GUM/LMOM",
              "GP/MOM",       "GP/LMOM",  "WEI/MOM",     "WEI/LMOM",     "FRE/MOM",
              "P3/MOM",       "P3/LMOM",  "LP3/MOM/LOG", "LP3/MOM/REAL", "LP3/LMOM",
              "LN2/MOM",      "LN2/LMOM", "LN3/MOM/BI",  "LN3/MOM/BII",  "LN3/MOM/LBQI",
              "LN3/MOM/LBQII"}) {
            EXPECT_NE(Failing(name, annual, kAnnual), "") << name << " with " << value;
        }
        auto peaks = ReferenceSeries("rain40");
        peaks[7] = value;
        for (const char* name :
             {"GP2/MOM", "GP3/MOM", "GP2/LMOM", "GP3/LMOM", "EXP1/ML", "EXP2/MOM", "EXP2/LMOM",
              "WEI2/MOM", "WEI3/MOM", "WEI2/LMOM", "GAM/MOM", "GAM/LMOM", "LN2/MOM", "LN2/LMOM"}) {
            EXPECT_NE(Failing(name, peaks, FrameOf("rain40")), "") << name << " with " << value;
        }
    }
}

// Values so large that their squares overflow.
TEST(Fit, SurvivesValuesAtTheEndOfTheNumbers) {
    const std::vector<double> huge = {1e308, -1e308, 5e307, 1e307, -3e307, 1e300};
    for (const char* name :
         {"GEV/MOM", "GEV/LMOM", "GUM/MOM", "GUM/LMOM", "GP/MOM", "GP/LMOM", "WEI/MOM", "WEI/LMOM",
          "P3/MOM", "P3/LMOM", "LN2/LMOM", "LN3/MOM/BI", "LN3/MOM/BII", "LN3/MOM/LBQII"}) {
        const FitResult fit = Fit(Named(name), {huge, kAnnual});
        if (fit) {
            for (const Parameter& parameter : fit->parameters) {
                EXPECT_TRUE(std::isfinite(parameter.value)) << name;
            }
        } else {
            EXPECT_FALSE(FailureText(fit.Failure()).empty()) << name;
        }
    }
}

TEST(FailureText, NamesEveryFaultWithItsNumbers) {
    const struct {
        FitFailure failure;
        const char* text;
    } rows[] = {
        {{FitFault::ValuesNotPositive}, "C04 all values must be greater than 0"},
        {{FitFault::ValuesAtThreshold}, "C05 too many values equal the threshold"},
        {{FitFault::SkewnessOutOfRange, {-2.5, 0}},
         "C06 sample skewness -2.500 is outside the range of the distribution"},
        {{FitFault::SkewnessNotPositive, {-0.1234, 0}},
         "C07 sample skewness -0.123 must be positive"},
        {{FitFault::LowerBoundUndefined},
         "C09 lower bound cannot be estimated: largest + smallest - 2 x median is not positive"},
        {{FitFault::LowerBoundTooHigh, {12.3456, 11}},
         "C10 estimated lower bound 12.346 is not below the smallest value 11.000"},
        {{FitFault::NoInteriorMaximum},
         "C11 the likelihood has no maximum inside the parameter range"},
        {{FitFault::NoConvergence}, "C12 no convergence"},
    };
    for (const auto& row : rows) {
        EXPECT_EQ(FailureCode(row.failure) + " " + FailureText(row.failure), row.text);
    }
    const FitFailure extreme{FitFault::SkewnessOutOfRange, {-1.7e308, 0}};
    EXPECT_GT(FailureText(extreme).size(), 309U);
}

} // namespace
} // namespace ryn::stats
