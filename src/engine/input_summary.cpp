#include "engine/input_summary.h"

#include <algorithm>
#include <array>

#include "base/number_text.h"
#include "engine/plain_text.h"
#include "engine/report_text.h"
#include "stats/monte_carlo.h"

namespace ryn {

namespace {

using stats::SeriesKind;

// Names come from data files of any origin.
std::string SeriesLine(const EngineInput& input) {
    const std::string name = PlainName(input.labels.itemName);
    const std::string unit = PlainName(input.labels.unit);
    return "Series: " + (name.empty() ? "(no name)" : name) +
           (unit.empty() ? "" : " [" + unit + "]") + ", " + std::to_string(input.values.size()) +
           " values";
}

// A rate comes from a count over a record length and has more digits than meaning.
std::string RateText(double rate) {
    constexpr double kFewest = 0.01; // with fewer, four decimals leave no digits
    return rate < kFewest ? SixDigits(rate) : FixedText(rate, 4);
}

std::string KindLine(const EngineInput& input) {
    if (input.frame.kind == SeriesKind::AnnualMaximum)
        return "Kind: annual maxima";
    return "Kind: partial durations, threshold " + ShortestText(input.threshold) +
           UnitSuffix(input) + ", " + RateText(input.averageNumber) + " events a year";
}

// Whether T counts events or annual maxima moves a quantile by much at short periods.
std::string PeriodsLine(const EngineInput& input) {
    constexpr std::size_t kMostShown = 30; // a line that can still be read
    std::string line = "Return periods in years: ";
    const std::size_t shown = std::min(input.periods.size(), kMostShown);
    for (std::size_t i = 0; i < shown; ++i)
        line += (i == 0 ? "" : ", ") + PeriodText(input.periods[i]);
    if (input.periods.empty())
        line += "none";
    if (shown < input.periods.size())
        line += " and " + std::to_string(input.periods.size() - shown) + " more";
    if (input.frame.kind == SeriesKind::PartialDuration)
        line += input.meaning == stats::PeriodMeaning::OfEvent ? " (of an event)"
                                                               : " (of the annual maximum)";
    return line;
}

// With what somebody needs who wants the same numbers from another program.
std::string UncertaintyLine(UncertaintyMethod method, std::size_t count) {
    const stats::MonteCarloSettings settings;
    switch (method) {
    case UncertaintyMethod::MonteCarlo:
        return "Uncertainty: Monte Carlo (parametric bootstrap), " +
               std::to_string(settings.samples) + " samples, seed " + std::to_string(settings.seed);
    case UncertaintyMethod::Jackknife:
        return "Uncertainty: jackknife, each of " + std::to_string(count) +
               " values left out in turn";
    case UncertaintyMethod::None:
        break;
    }
    return "Uncertainty: not computed, since Tsq2Input/UncertaintyCal is false";
}

struct DistributionName {
    std::string_view name;
    bool hasFreeLocation; // the location is fixed or estimated, by method, kind and option
};

// In the order of the setup file's numbers.
constexpr std::array<DistributionName, 11> kDistributionNames = {{
    {"generalised extreme value", false},
    {"Gumbel", false},
    {"Weibull", true},
    {"Frechet", false},
    {"generalised Pareto", true},
    {"gamma/Pearson type 3", true},
    {"log-Pearson type 3", false},
    {"log-normal", true},
    {"exponential", true},
    {"square-root exponential", false},
    {"truncated Gumbel", false},
}};

constexpr std::array<std::string_view, 3> kMethodNames = {
    "the method of moments", "maximum likelihood", "the method of L-moments"};
constexpr std::array<std::string_view, 4> kLogNormalNames = {
    "bias correction of skewness I", "bias correction of skewness II",
    "lower bound quantile method I", "lower bound quantile method II"};

// What was done and not what the option says, which some methods and kinds of series overrule.
std::string LocationText(const stats::Combination& combination, SeriesKind kind) {
    if (stats::EffectiveLocation(combination, kind) == stats::LocationType::Estimated)
        return ", location estimated";
    return kind == SeriesKind::PartialDuration ? ", location fixed at the threshold"
                                               : ", location fixed at 0";
}

/// The options of one family by moments; empty for all others.
std::string OptionText(const stats::Combination& combination, SeriesKind kind) {
    using stats::DistributionType;
    if (combination.method != stats::EstimationMethod::Moments)
        return {};
    switch (combination.distribution) {
    case DistributionType::Gumbel:
        return combination.sampleCorrection ? ", with sample size correction" : "";
    case DistributionType::LogPearson3:
        return combination.logPearson == stats::LogPearsonType::LogSpace ? ", in log space"
                                                                         : ", in real space";
    case DistributionType::LogNormal:
        if (stats::EffectiveLocation(combination, kind) == stats::LocationType::Fixed)
            return {};
        return ", " +
               std::string(kLogNormalNames.at(static_cast<std::size_t>(combination.logNormal)));
    default:
        return {};
    }
}

} // namespace

Sentences SummaryLines(const EngineInput& input) {
    return {SeriesLine(input),
            KindLine(input),
            PeriodsLine(input),
            UncertaintyLine(input.uncertainty, input.values.size()),
            "Plotting positions: " + std::string(NameOf(input.plotting)),
            "Combinations: " + std::to_string(input.combinations.size())};
}

std::string LabelOf(const NamedCombination& combination, std::size_t index) {
    return combination.name.empty() ? "combination " + std::to_string(index + 1)
                                    : PlainName(combination.name);
}

std::string DescriptionOf(const stats::Combination& combination, stats::SeriesKind kind) {
    const auto& [name, hasFreeLocation] =
        kDistributionNames.at(static_cast<std::size_t>(combination.distribution));
    return std::string(name) + " distribution" +
           (hasFreeLocation ? LocationText(combination, kind) : "") + ", by " +
           std::string(kMethodNames.at(static_cast<std::size_t>(combination.method))) +
           OptionText(combination, kind);
}

std::string_view NameOf(stats::PlottingMethod method) {
    constexpr std::array<std::string_view, 5> kNames = {"Weibull", "Hazen", "Gringorten", "Blom",
                                                        "Cunnane"};
    return kNames.at(static_cast<std::size_t>(method));
}

std::string UnitSuffix(const EngineInput& input) {
    return input.labels.unit.empty() ? "" : " " + PlainName(input.labels.unit);
}

} // namespace ryn
