#include "apps/cli/self_check_command.h"

#include <algorithm>
#include <memory>
#include <ostream>

#include "apps/cli/command_options.h"
#include "apps/cli/json_output.h"
#include "apps/cli/text_table.h"
#include "base/number_text.h"
#include "selfcheck/reference_series.h"
#include "selfcheck/self_check.h"
#include "strings/catalogue.h"

namespace ryn::cli {

namespace {

using selfcheck::Comparison;
using selfcheck::Comparisons;

std::string TextOf(int id) {
    return std::string(Text(id));
}

std::ptrdiff_t CountAgreeing(const Comparisons& comparisons) {
    return std::count_if(comparisons.begin(), comparisons.end(),
                         [](const Comparison& comparison) { return comparison.agrees; });
}

void PrintSeries(std::ostream& out) {
    TextTable table({Alignment::Left, Alignment::Right, Alignment::Left});
    table.AddRow({TextOf(kTextCliCheckSeries), "n"});
    for (const selfcheck::ReferenceSeries& series : selfcheck::AllSeries())
        table.AddRow({std::string(series.name), std::to_string(series.values.size()),
                      std::string(series.description)});
    table.Print(out);
}

void PrintComparisons(std::ostream& out, const Comparisons& comparisons) {
    constexpr auto kLeft = Alignment::Left;
    constexpr auto kRight = Alignment::Right;
    TextTable table({kLeft, kLeft, kLeft, kLeft, kRight, kRight, kLeft, kLeft});
    table.AddRow({TextOf(kTextCliCheckNumber), TextOf(kTextCliCheckSeries),
                  TextOf(kTextCliCheckSubject), TextOf(kTextCliCheckQuantity),
                  TextOf(kTextCliCheckExpected), TextOf(kTextCliCheckFound), "",
                  TextOf(kTextCliCheckSource)});
    for (const Comparison& comparison : comparisons) {
        const selfcheck::CaseLabel& label = comparison.label;
        table.AddRow({std::string(label.number), std::string(label.series),
                      std::string(label.subject), comparison.quantity,
                      std::string(comparison.expected), selfcheck::FoundText(comparison),
                      TextOf(comparison.agrees ? kTextCliCheckAgrees : kTextCliCheckDiffers),
                      std::string(label.source)});
    }
    table.Print(out);
}

/// Numbers that there are none of are null, as everywhere.
Json JsonOfComparison(const Comparison& comparison) {
    const selfcheck::CaseLabel& label = comparison.label;
    const std::optional<double> expected = ParseDouble(comparison.expected);
    return {
        {"number", label.number},
        {"series", label.series},
        {"subject", label.subject},
        {"quantity", comparison.quantity},
        {"expected", expected ? JsonOf(*expected) : Json(nullptr)},
        {"tolerance", expected ? JsonOf(selfcheck::Tolerance(comparison.expected)) : Json(nullptr)},
        {"found", JsonOf(comparison.found)},
        {"agrees", comparison.agrees},
        {"source", label.source}};
}

Json JsonOfSelfCheck(const Comparisons& comparisons) {
    Json series = Json::array();
    for (const selfcheck::ReferenceSeries& one : selfcheck::AllSeries())
        series.push_back(
            {{"name", one.name}, {"n", one.values.size()}, {"description", one.description}});
    Json values = Json::array();
    for (const Comparison& comparison : comparisons)
        values.push_back(JsonOfComparison(comparison));
    return {{"values", comparisons.size()},
            {"agreeing", CountAgreeing(comparisons)},
            {"series", std::move(series)},
            {"comparisons", std::move(values)}};
}

} // namespace

int ShowSelfCheck(const Comparisons& comparisons, const SelfCheckOptions& options,
                  Console& console) {
    const std::ptrdiff_t agreeing = CountAgreeing(comparisons);
    const auto count = static_cast<std::ptrdiff_t>(comparisons.size());
    if (options.form == OutputForm::Json) {
        PrintJson(console, JsonOfSelfCheck(comparisons));
    } else {
        PrintSeries(console.out);
        console.out << '\n';
        PrintComparisons(console.out, comparisons);
        console.out << '\n'
                    << Text(kTextCliCheckTolerance) << '\n'
                    << FormatText(kTextCliCheckSummary, agreeing, count) << '\n';
    }
    if (agreeing == count)
        return kExitDone;
    ShowError(console, FormatText(kTextCliCheckDiffer, count - agreeing, count));
    return kExitAnalysis;
}

void AddSelfCheckCommand(CommandLine& line) {
    auto options = std::make_shared<SelfCheckOptions>();
    CLI::App& command =
        line.Add({"selfcheck", kTextCliHelpSelfCheck, [options](Console& console) {
                      return ShowSelfCheck(selfcheck::RunSelfCheck(), *options, console);
                  }});
    AddJsonOption(command, &options->form);
}

} // namespace ryn::cli
