#include <algorithm>
#include <array>
#include <cmath>
#include <vector>

#include "selfcheck/case_groups.h"
#include "selfcheck/reference_series.h"
#include "selfcheck/sources.h"
#include "stats/plotting_position.h"
#include "stats/sample_statistics.h"

namespace ryn::selfcheck {

namespace {

using enum SeriesId;

constexpr std::string_view kStatistics =
    "R EnvStats 3.1.0 (skewness, kurtosis) and lmom 3.2 (L-moments); an independent program";
constexpr std::array<const char*, 12> kQuantities = {
    "mean", "variance", "skewness", "kurtosis", "b0", "b1", "b2", "b3", "l1", "l2", "t3", "t4"};

struct StatisticsCase {
    std::string_view number;
    SeriesId series;
    std::array<std::string_view, 12> values;
};

constexpr auto kCases = std::to_array<StatisticsCase>({
    {"S1",
     PortPirie,
     {"3.980615", "0.05784649", "0.7279791", "3.407240", "3.980615", "2.057630", "1.397278",
      "1.061264", "3.980615", "0.1346442", "0.1374331", "0.1328312"}},
    {"S2",
     Floyd,
     {"6771.103", "1.36789e8", "4.742450", "28.7825", "6771.103", "5417.412", "4692.035",
      "4217.464", "6771.103", "4063.721", "0.5952284", "0.4493620"}},
    {"S3",
     Fishkill,
     {"2775.000", "3913557", "2.220253", "7.986548", "2775.000", "1858.768", "1460.254", "1228.231",
      "2775.000", "942.5362", "0.4073191", "0.3047450"}},
    {"S4",
     Rain40,
     {"51.94318", "148.8211", "1.660970", "5.094483", "51.94318", "29.04609", "20.78795",
      "16.41577", "51.94318", "6.148996", "0.3893879", "0.2092633"}},
});

struct LogarithmCase {
    std::string_view number;
    SeriesId series;
    std::string_view mean, deviation, skewness; ///< of the logarithms to base 10
};

constexpr auto kLogarithms = std::to_array<LogarithmCase>({
    {"B1", Fishkill, "3.3684", "0.2456", "0.7300"},
    {"B2", Floyd, "3.5553", "0.4642", "0.3566"},
});

struct PositionCase {
    stats::PlottingMethod method;
    std::string_view name;
    std::string_view first, fifth; ///< exceedance probability of the largest and the fifth largest
};

constexpr auto kPositions = std::to_array<PositionCase>({
    {stats::PlottingMethod::Weibull, "Weibull position", "0.04000000", "0.2000000"},
    {stats::PlottingMethod::Hazen, "Hazen position", "0.02083333", "0.1875000"},
    {stats::PlottingMethod::Gringorten, "Gringorten position", "0.02321725", "0.1890547"},
    {stats::PlottingMethod::Blom, "Blom position", "0.02577320", "0.1907216"},
    {stats::PlottingMethod::Cunnane, "Cunnane position", "0.02479339", "0.1900826"},
});

void CompareStatistics(Comparisons& list, const StatisticsCase& row) {
    const ReferenceSeries& series = SeriesOf(row.series);
    const CaseLabel label{row.number, series.name, "sample statistics", kStatistics};
    const stats::SampleStatistics s = stats::SampleStatisticsOf(series.values);
    const std::array<double, 12> found = {
        s.mean,        s.variance,    s.skewness, s.kurtosis, s.weighted.b0, s.weighted.b1,
        s.weighted.b2, s.weighted.b3, s.l1,       s.l2,       s.lSkewness,   s.lKurtosis};
    for (std::size_t i = 0; i < found.size(); ++i)
        Compare(list, label, kQuantities[i], row.values[i], found[i]);
}

void CompareLogarithms(Comparisons& list, const LogarithmCase& row) {
    const ReferenceSeries& series = SeriesOf(row.series);
    const CaseLabel label{row.number, series.name, "log10 of the values", kBulletin};
    std::vector<double> logarithms(series.values.begin(), series.values.end());
    std::transform(logarithms.begin(), logarithms.end(), logarithms.begin(),
                   [](double x) { return std::log10(x); });
    const stats::SampleStatistics found = stats::SampleStatisticsOf(logarithms);
    Compare(list, label, "mean", row.mean, found.mean);
    Compare(list, label, "deviation", row.deviation, std::sqrt(found.variance));
    Compare(list, label, "skewness", row.skewness, found.skewness);
}

void ComparePositions(Comparisons& list, const PositionCase& row) {
    const ReferenceSeries& series = SeriesOf(Fishkill);
    const CaseLabel label{"Q1", series.name, row.name, "the formula"};
    const std::size_t count = series.values.size();
    Compare(list, label, "rank 1", row.first, stats::PlottingPosition(row.method, 1, count));
    Compare(list, label, "rank 5", row.fifth, stats::PlottingPosition(row.method, 5, count));
}

} // namespace

void CompareSampleStatistics(Comparisons& list) {
    for (const StatisticsCase& row : kCases)
        CompareStatistics(list, row);
    for (const LogarithmCase& row : kLogarithms)
        CompareLogarithms(list, row);
    for (const PositionCase& row : kPositions)
        ComparePositions(list, row);
}

} // namespace ryn::selfcheck
