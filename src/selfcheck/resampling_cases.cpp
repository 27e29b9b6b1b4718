#include <array>
#include <limits>
#include <string>

#include "selfcheck/case_groups.h"
#include "selfcheck/named_combination.h"
#include "selfcheck/reference_series.h"
#include "selfcheck/sources.h"
#include "stats/fit.h"
#include "stats/jackknife.h"
#include "stats/monte_carlo.h"

namespace ryn::selfcheck {

namespace {

using enum SeriesId;

constexpr std::array<double, 3> kPeriods = {10, 50, 100}; // years
constexpr std::array<const char*, 3> kAverages = {"average x10", "average x50", "average x100"};
constexpr std::array<const char*, 3> kDeviations = {"deviation x10", "deviation x50",
                                                    "deviation x100"};

struct ResamplingCase {
    std::string_view number;
    SeriesId series;
    NamedCombination subject;
    std::array<std::string_view, 3> averages; ///< at kPeriods
    std::array<std::string_view, 3> deviations;
    std::string_view source;
};

// Seven significant digits.
constexpr auto kJackknife = std::to_array<ResamplingCase>({
    {"U1",
     PortPirie,
     Named("GUM/MOM"),
     {"4.295880", "4.607077", "4.738638"},
     {"0.05195984", "0.07959854", "0.09179181"},
     kProgram},
    {"U2",
     PortPirie,
     Named("GEV/LMOM"),
     {"4.306438", "4.590762", "4.701611"},
     {"0.05373043", "0.1041019", "0.1359985"},
     kLmom},
    {"U3",
     PortPirie,
     Named("GEV/ML"),
     {"4.301042", "4.582578", "4.692569"},
     {"0.05212351", "0.1027011", "0.1348014"},
     kOf30Digits},
    {"U4",
     Floyd,
     Named("LP3/MOM/LOG"),
     {"14458.16", "36402.36", "49719.70"},
     {"4052.440", "17687.02", "29897.42"},
     kProgram},
    {"U5",
     Fishkill,
     Named("P3/LMOM"),
     {"5294.953", "8760.553", "10281.35"},
     {"1159.446", "2742.643", "3499.667"},
     kProgram},
    {"U6",
     Rain40,
     Named("EXP1/MOM"),
     {"66.46100", "85.68281", "93.96119"},
     {"4.074667", "7.034589", "8.309357"},
     kExactFormula},
    {"U7",
     Rain40,
     Named("GP2/LMOM"),
     {"66.81543", "88.16572", "97.53020"},
     {"4.135211", "10.10355", "14.44248"},
     kLmom},
    {"U8",
     Rain40,
     Named("GP2/ML"),
     {"66.64625", "87.08050", "95.94092"},
     {"4.009340", "7.652107", "10.34916"},
     kProgram},
    {"U9",
     Rain40,
     Named("EXP1/ML"),
     {"66.46100", "85.68281", "93.96119"},
     {"4.074667", "7.034589", "8.309357"},
     kExactFormula},
});

struct MonteCarloCase {
    ResamplingCase values;
    std::string_view subject;
    stats::EventCount events;
};

constexpr std::string_view kSameGenerator = "an independent program with the same generator";

// Ten digits: each of the 1000 samples is drawn and fitted as there.
constexpr auto kMonteCarlo = std::to_array<MonteCarloCase>({
    {{"M1",
      PortPirie,
      Named("GUM/MOM"),
      {"4.290676114", "4.596758011", "4.726155761"},
      {"0.06358039684", "0.1018617126", "0.1184402655"},
      kSameGenerator},
     "Monte Carlo GUM/MOM",
     stats::EventCount::Poisson},
    {{"M2",
      Rain40,
      Named("EXP1/MOM"),
      {"66.29379321", "85.47787555", "93.74001011"},
      {"4.514084275", "7.294412706", "8.525401325"},
      kSameGenerator},
     "Monte Carlo EXP1/MOM",
     stats::EventCount::Poisson},
    {{"M3",
      Rain40,
      Named("EXP1/MOM"),
      {"66.49608148", "85.74337521", "94.03273342"},
      {"4.084014466", "7.050725827", "8.328418865"},
      kSameGenerator},
     "Monte Carlo EXP1/MOM, fixed count",
     stats::EventCount::Fixed},
});

void CompareQuantiles(Comparisons& list, const CaseLabel& label, const ResamplingCase& row,
                      const stats::ResampledQuantiles& found) {
    constexpr double kNaN = std::numeric_limits<double>::quiet_NaN();
    for (std::size_t i = 0; i < kPeriods.size(); ++i) {
        const bool isThere = i < found.atPeriods.size();
        Compare(list, label, kAverages[i], row.averages[i],
                isThere ? found.atPeriods[i].average : kNaN);
        Compare(list, label, kDeviations[i], row.deviations[i],
                isThere ? found.atPeriods[i].standardDeviation : kNaN);
    }
}

stats::ResampledQuantiles JackknifeOf(const ResamplingCase& row) {
    const ReferenceSeries& series = SeriesOf(row.series);
    const stats::FitInput input{series.values, series.frame};
    const stats::FitResult fit = stats::Fit(row.subject.combination, input);
    return fit ? stats::Jackknife(row.subject.combination, fit->distribution, input, {kPeriods})
               : stats::ResampledQuantiles{};
}

stats::ResampledQuantiles MonteCarloOf(const MonteCarloCase& row) {
    const ReferenceSeries& series = SeriesOf(row.values.series);
    const stats::Combination& combination = row.values.subject.combination;
    const stats::FitResult fit = stats::Fit(combination, {series.values, series.frame});
    stats::MonteCarloSettings settings;
    settings.events = row.events;
    return fit ? stats::MonteCarlo(
                     {combination, fit->distribution, series.values.size(), series.frame},
                     {kPeriods}, settings)
               : stats::ResampledQuantiles{};
}

} // namespace

void CompareResampling(Comparisons& list) {
    for (const ResamplingCase& row : kJackknife) {
        const CaseLabel label{row.number, SeriesOf(row.series).name, row.subject.name, row.source};
        CompareQuantiles(list, label, row, JackknifeOf(row));
    }
    for (const MonteCarloCase& row : kMonteCarlo) {
        const CaseLabel label{row.values.number, SeriesOf(row.values.series).name, row.subject,
                              row.values.source};
        CompareQuantiles(list, label, row.values, MonteCarloOf(row));
    }
}

} // namespace ryn::selfcheck
