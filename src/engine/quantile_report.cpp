#include "engine/quantile_report.h"

#include <cstddef>

#include "base/number_text.h"
#include "engine/plain_text.h"
#include "engine/report_parts.h"
#include "engine/report_text.h"

namespace ryn {

namespace {

// The two methods give their names to different things: the jackknife's average is corrected for
// bias, that of Monte Carlo shows it.
std::string_view MethodNotes(UncertaintyMethod method) {
    switch (method) {
    case UncertaintyMethod::MonteCarlo:
        return "average, bias and deviation: mean of the quantiles of samples drawn from the "
               "fitted\n"
               "distribution and fitted in the same way, its difference from the estimate, and "
               "their\n"
               "standard deviation. They take the distribution as the right one.\n";
    case UncertaintyMethod::Jackknife:
        return "average, bias and deviation: the jackknife estimate n est - (n-1) bar, the bias\n"
               "(n-1) (bar - est) and the standard error, bar being the mean of the n quantiles "
               "with\n"
               "one value left out and est the estimate.\n";
    case UncertaintyMethod::None:
        break;
    }
    return "No averages and deviations were asked for.\n";
}

// As it was given, but for one with so many digits (a third of a year) that it would push the rest
// of its row out of the columns.
std::string PeriodCell(double years) {
    constexpr std::size_t kLongest = 13;
    const std::string text = PeriodText(years);
    return text.size() <= kLongest ? text : SixDigits(years);
}

// The bounds are symmetric and thus too narrow above for a heavy tail, which the head says; the
// deviation is what the pages show.
void AppendQuantile(std::string& text, double period, double exceedance,
                    const stats::ResampledQuantile& quantile) {
    constexpr double kNormal95 = 1.96; // half width of the central 95 % in standard deviations
    const double margin = kNormal95 * quantile.standardDeviation;
    AppendRow(text, {PeriodCell(period), SixDigits(exceedance), SixDigits(quantile.estimate),
                     SixDigits(quantile.average), SixDigits(quantile.bias),
                     SixDigits(quantile.standardDeviation), SixDigits(quantile.estimate - margin),
                     SixDigits(quantile.estimate + margin)});
}

// A heavy tail's resamples reach much further up than down, which no symmetric bounds show. How
// many they are differs by period: where samples of few events drop out, the rest are the larger
// ones.
void AppendPercentiles(std::string& text, const std::vector<double>& periods,
                       const std::vector<stats::ResampledQuantile>& quantiles) {
    text += "\nPercentile intervals: 95 % of the resampled quantiles lie between the bounds;\n"
            "resamples are those that have the event\n";
    AppendRow(text, {"T", "lower", "estimate", "upper", "resamples"});
    for (std::size_t i = 0; i < periods.size(); ++i)
        AppendRow(text, {PeriodCell(periods[i]), SixDigits(quantiles[i].lower),
                         SixDigits(quantiles[i].estimate), SixDigits(quantiles[i].upper),
                         std::to_string(quantiles[i].used)});
}

// Many failures make the deviation that of the milder samples.
void AppendResamples(std::string& text, UncertaintyMethod method,
                     const stats::ResampledQuantiles& quantiles) {
    if (method == UncertaintyMethod::None)
        return;
    text += "\nResamples that could not be fitted: " + std::to_string(quantiles.Failed()) + " of " +
            std::to_string(quantiles.asked) + "\n";
}

} // namespace

std::string QuantileReportHead(const EngineInput& input) {
    const std::string unit = PlainName(input.labels.unit);
    // For partial durations e is not 1/T, which readers of annual maxima expect.
    return ReportHead(kQuantileReportSubject, input) + "Events are in " +
           (unit.empty() ? "the series' unit" : unit) + ", T in years; e is the probability that " +
           (input.frame.kind == stats::SeriesKind::AnnualMaximum ? "the maximum of a year"
                                                                 : "a peak above the threshold") +
           "\nexceeds the T-year event.\n\n" + std::string(MethodNotes(input.uncertainty)) +
           (input.uncertainty == UncertaintyMethod::None
                ? ""
                : "lower and upper: estimate -+ 1.96 deviations, some 95 % where estimates are "
                  "normal;\nthose of a heavy tail are skewed, so that upper is too low.\n");
}

std::string QuantileReportOf(const EngineInput& input, std::size_t index,
                             const SeriesResults& series, const CombinationResults& results) {
    std::string text = CombinationHead(input, index, results);
    if (!results.fit) // the head says why
        return text;
    text += '\n';
    AppendRow(text, {"T", "e", "estimate", "average", "bias", "deviation", "lower", "upper"});
    for (std::size_t i = 0; i < input.periods.size(); ++i)
        AppendQuantile(text, input.periods[i], series.exceedances[i],
                       results.quantiles.atPeriods[i]);
    if (input.uncertainty == UncertaintyMethod::MonteCarlo && !input.periods.empty())
        AppendPercentiles(text, input.periods, results.quantiles.atPeriods);
    AppendResamples(text, input.uncertainty, results.quantiles);
    return text;
}

} // namespace ryn
