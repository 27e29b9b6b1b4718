#include "apps/cli/show_command.h"

#include <memory>
#include <optional>
#include <ostream>
#include <sstream>

#include "apps/cli/case_file.h"
#include "apps/cli/command_options.h"
#include "apps/cli/plain_text.h"
#include "strings/catalogue.h"

namespace ryn::cli {

namespace {

/// The text of a page; nothing for a number that is no text page.
std::optional<std::string> PageText(const COutputSettings& results, int page) {
    CQxTextOcxPlot control;
    switch (page) {
    case 12:
        results.Independence.FillText(control);
        break;
    case 14:
        results.SampleStats.FillText(control);
        break;
    default:
        return std::nullopt;
    }
    return control.GetText();
}

int ReportNoResults(const CaseFile& file, const Status& reason, Console& console) {
    return Report(console,
                  Status::InputFault(
                      reason ? FormatText(kTextCliNoResults, file.ShownName())
                             : FormatText(kTextCliNoResultFile, file.ShownName(), reason.Text())));
}

} // namespace

int RunShow(const ShowOptions& options, Console& console) {
    CaseFile file(console, Consent::NotGiven);
    if (const int refused = file.Open(options.file))
        return refused;
    const std::optional<std::string> text = PageText(file.Document().Results(), options.page);
    if (!text)
        return Report(console, Status::InputFault(FormatText(kTextCliNoSuchPage, options.page)));
    if (!file.Document().Results().IsValid())
        return ReportNoResults(file, file.Document().ResultError(), console);
    std::istringstream lines(*text);
    for (std::string line; std::getline(lines, line);)
        console.out << PlainLine(line) << '\n';
    return kExitDone;
}

void AddShowCommand(CommandLine& line) {
    auto options = std::make_shared<ShowOptions>();
    CLI::App& command = line.Add({"show", kTextCliHelpShow, [options](Console& console) {
                                      return RunShow(*options, console);
                                  }});
    AddCaseFileArgument(command, &options->file);
    command.add_option("--page", options->page, std::string(Text(kTextCliHelpPage)))
        ->type_name("N")
        ->required();
}

} // namespace ryn::cli
