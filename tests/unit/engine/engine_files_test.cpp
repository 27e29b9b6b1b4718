#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <sys/stat.h>

#include <clocale>

#include "unit/engine/engine_case.h"

namespace ryn::test {
namespace {

using ::testing::HasSubstr;
using ::testing::Not;

/// A log without its line of date and time.
std::string WithoutDate(const std::string& log) {
    const std::size_t first = log.find('\n') + 1;
    return log.substr(0, first) + log.substr(log.find('\n', first) + 1);
}

TEST(EngineLog, TellsTheSetUpAndEachCombination) {
    const EngineRunOf run({"rain40", {"EXP1/MOM", "GEV/MOM", "GP3/LMOM"}, 1});
    EXPECT_EQ(run.status, 2);
    EXPECT_EQ(
        WithoutDate(run.Log()),
        "Ryn extreme value analysis, version 0.1.0\n"
        "Series: Water level [m], 44 values\n"
        "Kind: partial durations, threshold 40 m, 0.9167 events a year\n"
        "Return periods in years: 10, 50, 100 (of an event)\n"
        "Uncertainty: jackknife, each of 44 values left out in turn\n"
        "Plotting positions: Cunnane\n"
        "Combinations: 3\n"
        "EXP1/MOM: ok\n"
        "GEV/MOM: failed: distribution is not offered for a partial duration series (C01)\n"
        "GP3/LMOM: ok\n"
        "warning: GP3/LMOM: 1 value(s) lie outside the range of the fitted distribution (W1)\n"
        "finished with status 2\n");
}

TEST(EngineLog, SaysWhenNoCombinationCouldBeFitted) {
    const EngineRunOf run({"rain40", {"GEV/MOM", "GUM/MOM"}});
    EXPECT_EQ(run.status, 1);
    EXPECT_EQ(run.Target(), nullptr);
    EXPECT_THAT(run.Log(), HasSubstr("error: none of the combinations could be fitted\n"));
    EXPECT_THAT(run.File("Rynout2.txt"), HasSubstr("Could not be fitted: distribution"));
}

TEST(EngineFiles, AreTheSameInEveryRunAndLocaleButForTheDate) {
    const EngineRunOf first({"portpirie", {"GEV/LMOM", "GUM/MOM"}});
    const std::string previous = std::setlocale(LC_ALL, nullptr);
    ASSERT_NE(std::setlocale(LC_ALL, "de_DE.UTF-8"), nullptr);
    const EngineRunOf second({"portpirie", {"GEV/LMOM", "GUM/MOM"}});
    std::setlocale(LC_ALL, previous.c_str());
    EXPECT_EQ(WithoutDate(first.Log()), WithoutDate(second.Log()));
    EXPECT_EQ(first.File("Rynout1.txt"), second.File("Rynout1.txt"));
    EXPECT_EQ(first.File("Rynout2.txt"), second.File("Rynout2.txt"));
    EXPECT_EQ(kvfText(first.output.get()), kvfText(second.output.get()));
}

TEST(GoodnessReport, ShowsWhatEachMeasureIsMadeOf) {
    const std::string report = EngineRunOf({"portpirie", {"GEV/LMOM"}}).File("Rynout1.txt");
    for (const char* line :
         {"A title\nA subtitle\n", "  L-skewness                       0.137433\n",
          "Hosking's sign", "were fitted to the same values",
          "Values, bounds and quantiles are in m", "\n1. GEV/LMOM\n",
          "generalised extreme value distribution, by the method of L-moments",
          "  kappa                           0.0512120\n",
          " lower bound    upper bound       observed       expected   contribution\n",
          "              1           -inf        3.69137              6        5.90909 ",
          "  Degrees of freedom                      7\n",
          "  SLSC                            0.0156744\n",
          "  Log-likelihood                    4.29495\n",
          "  Akaike's criterion               -2.58991\n",
          "           rank          place              x              p           F(x)  quant",
          "             19        3.57000     0.00920245      0.0148458        3.54640 "})
        EXPECT_THAT(report, HasSubstr(line));
}

TEST(QuantileReport, TellsMethodProbabilitiesAndBounds) {
    const std::string report = EngineRunOf({"rain40", {"EXP1/MOM"}, 1}).File("Rynout2.txt");
    for (const char* line :
         {"(n-1) (bar - est)", "a peak above the threshold\nexceeds the T-year event",
          "exponential distribution, location fixed at the threshold, by the method of moments",
          "  xi (given)                        40.0000\n",
          "             10       0.109091        66.4610        66.4610",
          "\nResamples that could not be fitted: 0 of 44\n"})
        EXPECT_THAT(report, HasSubstr(line));
}

TEST(QuantileReport, KeepsItsColumnsForPeriodsOfManyDigits) {
    EngineCase thirds{"rain40", {"EXP1/MOM"}};
    thirds.periods = {10.0 / 3, 1e7 / 3, 2.5};
    const std::string report = EngineRunOf(thirds).File("Rynout2.txt");
    const std::size_t head = report.find("              T              e");
    ASSERT_NE(head, std::string::npos);
    const std::size_t width = report.find('\n', head) - head;
    for (const char* period :
         {"\n        3.33333  ", "\n        3333333  ", "\n            2.5  "}) {
        const std::size_t row = report.find(period, head);
        ASSERT_NE(row, std::string::npos) << period;
        EXPECT_EQ(report.find('\n', row + 1) - row - 1, width) << period;
    }
}

TEST(EngineLog, GivesARateOfFewEventsItsDigits) {
    const EngineRunOf run({"rain40", {"EXP1/MOM"}, 1, 4, {1e6}}, "AvgAnNum = 0.9",
                          "AvgAnNum = 0.00002#");
    EXPECT_THAT(run.Log(), HasSubstr(", 2.00000e-05 events a year\n"));
}

TEST(GoodnessReport, SaysWhyALikelihoodDoesNotExist) {
    const EngineRunOf run({"rain40", {"WEI2/LMOM"}}, "ExtremeValues = 44.5", "ExtremeValues = 40");
    EXPECT_THAT(run.File("Rynout1.txt"),
                HasSubstr("the density is 0 or infinite at 1 value(s), such as peaks at"));
    EXPECT_THAT(EngineRunOf({"rain40", {"WEI2/LMOM"}}).File("Rynout1.txt"),
                Not(HasSubstr("does not exist:")));
}

// Two signs are in use for one shape, and the bound of a negative alpha is easily overlooked.
TEST(QuantileReport, TellsWhatEachShapeMeans) {
    const std::string maxima =
        EngineRunOf(
            {"portpirie", {"GEV/LMOM", "WEI/MOM", "FRE/MOM", "P3/MOM", "LP3/MOM/LOG", "LN2/MOM"}})
            .File("Rynout2.txt");
    for (const char* line :
         {"  kappa has Hosking's sign (shape in Coles (2001): -0.0512120): upper bound at 7.84",
          "here lighter, no upper bound\n", "x^-kappa (a GEV of shape -0.04546",
          "2/sqrt(kappa): no upper bound\n", "  of the logarithms, alpha has the sign"})
        EXPECT_THAT(maxima, HasSubstr(line));
    EXPECT_THAT(EngineRunOf({"rain40", {"GP2/LMOM"}}).File("Rynout2.txt"),
                HasSubstr(": heavy tail, no upper bound\n"));
}

TEST(QuantileReport, HasPercentileIntervalsOfMonteCarloAlone) {
    const std::string table =
        "           T          lower       estimate          upper      resamples\n";
    const std::string drawn = EngineRunOf({"rain40", {"GP2/LMOM"}}).File("Rynout2.txt");
    EXPECT_THAT(drawn, HasSubstr(table));
    EXPECT_THAT(EngineRunOf({"rain40", {"GP2/LMOM"}, 1}).File("Rynout2.txt"),
                Not(HasSubstr(table)));
}

// With 0.92 events a year a period of 1.2 years is that of nearly every event: samples of few
// events have none so frequent.
TEST(QuantileReport, CountsTheResamplesBehindEachPeriod) {
    EngineCase shortPeriod{"rain40", {"EXP1/MOM"}};
    shortPeriod.periods = {1.2, 100};
    const std::string report = EngineRunOf(shortPeriod).File("Rynout2.txt");
    const std::size_t table = report.find("resamples\n            1.2 ");
    ASSERT_NE(table, std::string::npos) << report;
    const auto countAtEnd = [&report](std::size_t line) {
        const std::size_t end = report.find('\n', line);
        return std::stoi(report.substr(report.rfind(' ', end), end));
    };
    const std::size_t first = report.find('\n', table) + 1;
    EXPECT_GT(countAtEnd(first), 600);
    EXPECT_LT(countAtEnd(first), 950);
    EXPECT_EQ(countAtEnd(report.find('\n', first) + 1), 1000);
    EXPECT_THAT(report, HasSubstr("could not be fitted: 0 of 1000\n"));
}

TEST(EngineFiles, HoldNothingThatWasNotAskedFor) {
    const EngineRunOf run({}, "SLSCTest = true", "SLSCTest = false");
    EXPECT_THAT(run.File("Rynout1.txt"), Not(HasSubstr("SLSC")));
}

TEST(EngineFiles, DoNotKeepAnEarlierRunsReports) {
    const TemporaryDirectory directory;
    KvfHandle output = kvfCreate();
    std::int32_t status = -1;
    const KvfHandle good = TreeOf({}, directory.Root().string());
    RYNENGINE(&good, &output, &status);
    ASSERT_EQ(status, 0);
    std::string text = kvfText(good.get());
    const KvfHandle broken = kvfLoadText(text.replace(text.find("4.03f"), 5, "nan"), "edited");
    RYNENGINE(&broken, &output, &status);
    EXPECT_EQ(status, 1);
    for (const char* name : {"Rynout1.txt", "Rynout2.txt"})
        EXPECT_THAT(directory.Read(name),
                    HasSubstr("The series could not be analysed:\n  value 1 of the series is nan"));
}

// A pipe would hang the run until somebody reads it.
TEST(EngineFiles, ArePassedOverWhereTheyCannotBeWritten) {
    const TemporaryDirectory directory;
    ASSERT_EQ(::mkfifo(directory.Path("Ryn.log").c_str(), 0600), 0);
    std::filesystem::create_directory(directory.Path("Rynout1.txt"));
    const KvfHandle tree = TreeOf({}, directory.Root().string());
    KvfHandle output = kvfCreate();
    std::int32_t status = -1;
    RYNENGINE(&tree, &output, &status);
    EXPECT_EQ(status, 0);
    EXPECT_TRUE(directory.Has("Rynout2.txt"));
    std::filesystem::remove(directory.Path("Ryn.log"));
    RYNENGINE(&tree, &output, &status);
    EXPECT_EQ(status, 0);
    EXPECT_THAT(directory.Read("Ryn.log"), HasSubstr("Rynout1.txt was not written: "));
    const EngineRunOf nowhere({}, "case.res", "no-such-directory/case.res");
    EXPECT_EQ(nowhere.status, 0);
    EXPECT_EQ(nowhere.directory.EntryCount(), 0U);
}

TEST(EngineFiles, LieInTheResultFilesDirectoryAgainstTheCurrentOne) {
    const EngineRunOf named({}, "case.res", "case\\x00/case.res"); // a zero byte cuts names off
    EXPECT_EQ(named.status, 0);
    EXPECT_EQ(named.directory.EntryCount(), 0U);
    const TemporaryDirectory directory;
    std::filesystem::create_directory(directory.Path("results"));
    std::filesystem::current_path(directory.Root());
    const KvfHandle tree = TreeOf({}, "results");
    KvfHandle output = kvfCreate();
    std::int32_t status = -1;
    RYNENGINE(&tree, &output, &status);
    EXPECT_TRUE(directory.Has("results/Ryn.log"));
    EXPECT_TRUE(directory.Has("results/Rynout1.txt"));
}

} // namespace
} // namespace ryn::test
