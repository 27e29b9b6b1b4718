#include <algorithm>
#include <array>
#include <vector>

#include "selfcheck/case_groups.h"
#include "selfcheck/reference_series.h"
#include "stats/homogeneity_tests.h"

namespace ryn::selfcheck {

namespace {

using enum SeriesId;

struct HomogeneityCase {
    std::array<std::string_view, 3> numbers; ///< run test, Mann-Kendall, rank sum
    SeriesId series;
    std::array<std::string_view, 5> run;   ///< R, n1, n2, z, p
    std::array<std::string_view, 4> trend; ///< S, variance, z, p
    std::size_t first;                     ///< values of the first subsample
    std::array<std::string_view, 4> shift; ///< W, U, z, p
};

constexpr auto kCases = std::to_array<HomogeneityCase>({
    {{"T1a", "T1b", "T1c"},
     Nile,
     {"14", "30", "30", "-4.427059", "9.552665e-6"},
     {"-711", "24571", "-4.529465", "5.913316e-6"},
     28,
     {"1216", "810", "5.357454", "8.440284e-8"}},
    {{"T2a", "T2b", "T2c"},
     PortPirie,
     {"27", "29", "32", "-1.145825", "0.2518677"},
     {"-47", "31162.3333", "-0.2605811", "0.7944156"},
     32,
     {"1093", "565", "0.4791530", "0.6318298"}},
    {{"T3a", "T3b", "T3c"},
     Floyd,
     {"18", "19", "19", "-0.6578363", "0.5106434"},
     {"111", "6833.66667", "1.330656", "0.1833022"},
     19,
     {"382", "192", "0.04214636", "0.9663820"}},
});

void CompareRun(Comparisons& list, const HomogeneityCase& row, const ReferenceSeries& series) {
    const CaseLabel label{row.numbers[0], series.name, "run test", "R randtests 1.0.2"};
    const stats::RunTest test = stats::RunTestOf(series.values);
    Compare(list, label, "R", row.run[0], static_cast<double>(test.runs));
    Compare(list, label, "n1", row.run[1], static_cast<double>(test.above));
    Compare(list, label, "n2", row.run[2], static_cast<double>(test.below));
    Compare(list, label, "z", row.run[3], test.score.z);
    Compare(list, label, "p", row.run[4], test.score.level);
}

void CompareTrend(Comparisons& list, const HomogeneityCase& row, const ReferenceSeries& series) {
    const CaseLabel label{row.numbers[1], series.name, "Mann-Kendall",
                          "R Kendall 2.2.1 and trend 1.1.6"};
    const stats::TrendTest test = stats::TrendTestOf(series.values);
    Compare(list, label, "S", row.trend[0], static_cast<double>(test.s));
    Compare(list, label, "variance", row.trend[1], test.variance);
    Compare(list, label, "z", row.trend[2], test.score.z);
    Compare(list, label, "p", row.trend[3], test.score.level);
}

void CompareShift(Comparisons& list, const HomogeneityCase& row, const ReferenceSeries& series) {
    const CaseLabel label{row.numbers[2], series.name, "rank sum", "R 4.2.2: wilcox.test"};
    std::vector<int> samples(series.values.size(), 2);
    std::fill_n(samples.begin(), row.first, 1);
    const stats::ShiftTest test = stats::ShiftTestOf(series.values, samples);
    Compare(list, label, "W", row.shift[0], test.rankSum);
    Compare(list, label, "U", row.shift[1], test.u);
    Compare(list, label, "z", row.shift[2], test.score.z);
    Compare(list, label, "p", row.shift[3], test.score.level);
}

} // namespace

void CompareHomogeneityTests(Comparisons& list) {
    for (const HomogeneityCase& row : kCases) {
        const ReferenceSeries& series = SeriesOf(row.series);
        CompareRun(list, row, series);
        CompareTrend(list, row, series);
        CompareShift(list, row, series);
    }
}

} // namespace ryn::selfcheck
