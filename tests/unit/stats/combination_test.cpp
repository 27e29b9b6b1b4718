#include "stats/combination.h"

#include <gtest/gtest.h>

#include <string>

namespace ryn::stats {
namespace {

std::string Methods(int distribution, SeriesKind kind) {
    std::string offered;
    for (int method = 0; method < 3; ++method) {
        Combination c;
        c.distribution = static_cast<DistributionType>(distribution);
        c.method = static_cast<EstimationMethod>(method);
        switch (OfferOf(c, kind)) {
        case Offer::DistributionNotOffered:
            return "-";
        case Offer::Offered:
            offered += " " + std::to_string(method);
            break;
        case Offer::MethodNotOffered:
            offered += " .";
            break;
        }
    }
    return offered.substr(1);
}

struct Line {
    const char* annualMaximum;
    const char* partialDuration;
};

// By the numbers of the setup file, GEV to TGUM; methods 0 moments, 1 likelihood, 2 L-moments.
TEST(Combinations, AreOfferedAsTheDialogsHaveThem) {
    const Line lines[] = {{"0 1 2", "-"},     {"0 1 2", "-"},     {"0 . 2", "0 1 2"},
                          {"0 . .", "-"},     {"0 . 2", "0 1 2"}, {"0 . 2", "0 1 2"},
                          {"0 . 2", "0 . 2"}, {"0 1 2", "0 1 2"}, {"-", "0 1 2"},
                          {". 1 .", "-"},     {"-", ". 1 ."}};
    int number = 0;
    for (const Line& line : lines) {
        EXPECT_EQ(Methods(number, SeriesKind::AnnualMaximum), line.annualMaximum) << number;
        EXPECT_EQ(Methods(number, SeriesKind::PartialDuration), line.partialDuration) << number;
        ++number;
    }
}

TEST(Combinations, OutsideTheNumbersAreNotOffered) {
    for (const int number : {-1, 11, 1000}) {
        EXPECT_EQ(Methods(number, SeriesKind::AnnualMaximum), "-");
        Combination c;
        c.method = static_cast<EstimationMethod>(number);
        EXPECT_EQ(OfferOf(c, SeriesKind::AnnualMaximum), Offer::MethodNotOffered);
        c.distribution = static_cast<DistributionType>(number);
        EXPECT_TRUE(EstimatedSymbols(c, SeriesKind::AnnualMaximum).empty());
    }
}

std::string Symbols(DistributionType distribution, EstimationMethod method, LocationType location,
                    SeriesKind kind) {
    Combination c;
    c.distribution = distribution;
    c.method = method;
    c.location = location;
    std::string text;
    for (const auto symbol : EstimatedSymbols(c, kind)) {
        text += (text.empty() ? "" : " ") + std::string(symbol);
    }
    return text;
}

TEST(EstimatedSymbols, FollowFamilyMethodLocationAndKind) {
    using enum DistributionType;
    using enum EstimationMethod;
    using enum LocationType;
    const auto ams = SeriesKind::AnnualMaximum;
    const auto pds = SeriesKind::PartialDuration;
    EXPECT_EQ(Symbols(Gev, MaximumLikelihood, Fixed, ams), "xi alpha kappa");
    EXPECT_EQ(Symbols(DistributionType::Gumbel, Moments, Fixed, ams), "xi alpha");
    EXPECT_EQ(Symbols(Frechet, Moments, Estimated, ams), "alpha kappa");
    EXPECT_EQ(Symbols(SquareRootExponential, MaximumLikelihood, Estimated, ams), "a b");
    EXPECT_EQ(Symbols(TruncatedGumbel, MaximumLikelihood, Fixed, pds), "xi alpha");
    for (const auto family : {Weibull, DistributionType::GeneralisedPareto, GammaPearson3}) {
        EXPECT_EQ(Symbols(family, EstimationMethod::LMoments, Fixed, ams), "xi alpha kappa");
        EXPECT_EQ(Symbols(family, EstimationMethod::LMoments, Fixed, pds), "alpha kappa");
        EXPECT_EQ(Symbols(family, EstimationMethod::LMoments, Estimated, pds), "xi alpha kappa");
        EXPECT_EQ(Symbols(family, MaximumLikelihood, Estimated, pds), "alpha kappa");
    }
    EXPECT_EQ(Symbols(LogPearson3, Moments, Fixed, pds), "xi alpha kappa");
    EXPECT_EQ(Symbols(LogNormal, Moments, Fixed, ams), "mu sigma");
    EXPECT_EQ(Symbols(LogNormal, Moments, Estimated, ams), "xi mu sigma");
    EXPECT_EQ(Symbols(LogNormal, MaximumLikelihood, Estimated, pds), "xi mu sigma");
    EXPECT_EQ(Symbols(LogNormal, EstimationMethod::LMoments, Estimated, pds), "mu sigma");
    EXPECT_EQ(Symbols(DistributionType::Exponential, Moments, Estimated, pds), "xi alpha");
    EXPECT_EQ(Symbols(DistributionType::Exponential, MaximumLikelihood, Estimated, pds), "alpha");
}

TEST(MinimumCount, IsFiveForTheParametersThereAre) {
    Combination c;
    EXPECT_EQ(MinimumCount(c, SeriesKind::AnnualMaximum), 5U);
    c.distribution = DistributionType::Exponential;
    EXPECT_EQ(MinimumCount(c, SeriesKind::PartialDuration), 5U);
}

} // namespace
} // namespace ryn::stats
