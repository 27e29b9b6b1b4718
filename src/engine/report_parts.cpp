#include "engine/report_parts.h"

#include "engine/input_summary.h"
#include "engine/plain_text.h"
#include "engine/report_text.h"
#include "engine/shape_note.h"

namespace ryn {

namespace {

constexpr std::string_view kReadingNotes =
    "\"-\" stands for a number that does not exist. xi is a location or lower bound, alpha a "
    "scale\n"
    "and kappa a shape, whose sign and tail are told with each fit (log-normal: mu and sigma of "
    "the\nlogarithms; square-root exponential: exp(-a) is the probability of 0, b a scale).\n";

// No date: two runs over the same tree give the same report.
std::string Title(std::string_view subject, const EngineInput& input) {
    std::string text;
    AppendHeading(text, subject, '=');
    text.erase(0, 1); // no blank line before the first
    for (const std::string* const line : {&input.labels.title, &input.labels.subtitle})
        if (!line->empty())
            text += PlainName(*line) + "\n";
    return text + "\n";
}

// The given ones too: an exceedance without its threshold is no level.
void AppendParameters(std::string& text, const stats::FittedModel& model) {
    for (const stats::Parameter& parameter : stats::Parameters(model.distribution))
        AppendValue(text, std::string(parameter.symbol) + (parameter.estimated ? "" : " (given)"),
                    SixDigits(parameter.value));
    if (const std::string note = ShapeNote(model.distribution); !note.empty())
        text += "  " + note + "\n";
}

} // namespace

std::string ReportHead(std::string_view subject, const EngineInput& input) {
    std::string text = Title(subject, input);
    for (const std::string& line : SummaryLines(input))
        text += line + "\n";
    return text + "\n" + std::string(kReadingNotes);
}

// Without the summary of the set-up, of which only parts may have been read.
std::string ReportOfFailure(std::string_view subject, const EngineInput& input,
                            const Sentences& faults) {
    std::string text = Title(subject, input) + "The series could not be analysed:\n";
    for (const std::string& fault : faults)
        text += "  " + PlainText(fault) + "\n";
    return text;
}

std::string CombinationHead(const EngineInput& input, std::size_t index,
                            const CombinationResults& results) {
    const NamedCombination& combination = input.combinations[index];
    std::string text;
    AppendHeading(text, std::to_string(index + 1) + ". " + LabelOf(combination, index), '-');
    text += DescriptionOf(combination.combination, input.frame.kind) + "\n\n";
    if (!results.fit) {
        const stats::FitFailure& failure = results.fit.Failure();
        return text + "Could not be fitted: " + stats::FailureText(failure) + ".\n";
    }
    AppendParameters(text, *results.fit);
    for (const stats::FitWarning& warning : results.fit->warnings)
        text += "  Warning: " + stats::WarningText(warning) + ".\n";
    return text;
}

} // namespace ryn
