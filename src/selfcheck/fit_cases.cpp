#include <array>
#include <cmath>
#include <limits>
#include <span>
#include <string>

#include "selfcheck/case_groups.h"
#include "selfcheck/fit_case.h"
#include "selfcheck/named_combination.h"
#include "selfcheck/reference_series.h"
#include "selfcheck/sources.h"
#include "stats/fit.h"
#include "stats/return_period.h"

namespace ryn::selfcheck {

namespace {

using enum SeriesId;

constexpr double kNaN = std::numeric_limits<double>::quiet_NaN();
constexpr std::array<double, 3> kPeriods = {10, 50, 100}; // years

/// A result that the literature gives; where it has none, the text is empty.
struct LiteratureCase {
    std::string_view number;
    SeriesId series;
    NamedCombination subject;
    std::array<std::string_view, 3> parameters;
    std::string_view logLikelihood;
};

// The shape is minus the book's xi.
constexpr auto kLiterature = std::to_array<LiteratureCase>({
    {"C1", PortPirie, Named("GEV/ML"), {"3.87", "0.198", "0.050"}, "4.34"},
    {"C2", Rain30, Named("GP2/ML"), {"7.44", "-0.184"}, ""},
});

/// Return periods of the annual maximum, to ten and seven digits.
struct AnnualPeriodCase {
    std::string_view number;
    NamedCombination subject;
    std::array<std::string_view, 3> quantiles;
};

constexpr std::array<std::string_view, 3> kExceedances = {"0.1149387444", "0.02203931707",
                                                          "0.01096400275"};
constexpr auto kAnnualPeriods = std::to_array<AnnualPeriodCase>({
    {"Y2", Named("EXP1/MOM"), {"65.83735", "85.56237", "93.90123"}},
    {"Y3", Named("GP2/LMOM"), {"65.93133", "88.02546", "98.01794"}},
});

std::string AtPeriod(const std::string& symbol, std::size_t i) {
    return symbol + std::to_string(static_cast<int>(kPeriods[i]));
}

stats::FitResult FitOf(SeriesId id, const stats::Combination& combination) {
    const ReferenceSeries& series = SeriesOf(id);
    return stats::Fit(combination, {series.values, series.frame});
}

// The symbols are known without a fit, and so is the number of lines.
void CompareParameters(Comparisons& list, const CaseLabel& label, const stats::FitResult& fit,
                       const stats::SymbolList& symbols,
                       const std::array<std::string_view, 3>& expected) {
    for (std::size_t i = 0; i < symbols.size(); ++i) {
        const bool isThere =
            fit && i < fit->parameters.size() && fit->parameters[i].symbol == symbols[i];
        Compare(list, label, std::string(symbols[i]), expected[i],
                isThere ? fit->parameters[i].value : kNaN);
    }
}

void CompareQuantiles(Comparisons& list, const CaseLabel& label, const stats::FitResult& fit,
                      const stats::SeriesFrame& frame, stats::PeriodMeaning meaning,
                      const std::array<std::string_view, 3>& expected) {
    for (std::size_t i = 0; i < kPeriods.size(); ++i)
        Compare(list, label, AtPeriod("x", i), expected[i],
                fit ? stats::QuantileOfPeriod(fit->distribution, kPeriods[i], frame, meaning)
                    : kNaN);
}

void CompareTable(Comparisons& list, std::span<const FitCase> cases) {
    for (const FitCase& row : cases) {
        const ReferenceSeries& series = SeriesOf(row.series);
        const CaseLabel label{row.number, series.name, row.subject.name, row.source};
        const stats::FitResult fit = FitOf(row.series, row.subject.combination);
        CompareParameters(list, label, fit,
                          stats::EstimatedSymbols(row.subject.combination, series.frame.kind),
                          row.parameters);
        CompareQuantiles(list, label, fit, series.frame, stats::PeriodMeaning::OfEvent,
                         row.quantiles);
        // Only a fit that stands can be without likelihood.
        if (fit || row.logLikelihood != "none")
            Compare(list, label, "ln L", row.logLikelihood, fit ? fit->logLikelihood : kNaN);
    }
}

void CompareLiterature(Comparisons& list) {
    for (const LiteratureCase& row : kLiterature) {
        const ReferenceSeries& series = SeriesOf(row.series);
        const CaseLabel label{row.number, series.name, row.subject.name, kColes};
        const stats::FitResult fit = FitOf(row.series, row.subject.combination);
        CompareParameters(list, label, fit,
                          stats::EstimatedSymbols(row.subject.combination, series.frame.kind),
                          row.parameters);
        if (!row.logLikelihood.empty())
            Compare(list, label, "ln L", row.logLikelihood, fit ? fit->logLikelihood : kNaN);
    }
}

void CompareAnnualPeriods(Comparisons& list) {
    using stats::PeriodMeaning;
    const ReferenceSeries& series = SeriesOf(Rain40);
    const CaseLabel exceedance{"Y1", series.name, "annual maximum", kProgram};
    for (std::size_t i = 0; i < kPeriods.size(); ++i)
        Compare(
            list, exceedance, AtPeriod("e", i), kExceedances[i],
            stats::ExceedanceOfPeriod(kPeriods[i], series.frame, PeriodMeaning::OfAnnualMaximum));
    for (const AnnualPeriodCase& row : kAnnualPeriods)
        CompareQuantiles(list, {row.number, series.name, row.subject.name, kProgram},
                         FitOf(Rain40, row.subject.combination), series.frame,
                         PeriodMeaning::OfAnnualMaximum, row.quantiles);
}

} // namespace

void CompareFits(Comparisons& list) {
    CompareTable(list, AnnualMaximumFits());
    CompareTable(list, PartialDurationFits());
    CompareAnnualPeriods(list);
    CompareLiterature(list);
}

} // namespace ryn::selfcheck
