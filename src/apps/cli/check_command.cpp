#include "apps/cli/check_command.h"

#include <memory>
#include <ostream>

#include "apps/cli/case_file.h"
#include "apps/cli/command_options.h"
#include "apps/cli/finding_lines.h"
#include "apps/cli/grid_case.h"
#include "apps/cli/json_output.h"
#include "apps/cli/plain_text.h"
#include "strings/catalogue.h"

namespace ryn::cli {

namespace {

Json JsonOfFindings(const CMessageList& findings) {
    Json list = Json::array();
    for (const CMessage& finding : findings)
        list.push_back({{"page", finding.page}, {"text", FindingText(finding)}});
    return list;
}

/// A batch over a grid brings a series file of its own to each point.
void DropFindingsOnInput(CMessageList& findings) {
    const std::string_view text = Text(kTextInputFileMissing);
    std::erase_if(findings, [&](const CMessage& finding) { return finding.text == text; });
}

Status TestGrid(CaseFile& file) {
    Status tested = TestGridSettings(file);
    return tested ? TestGridPlan(file) : tested;
}

} // namespace

int RunCheck(const CheckOptions& options, Console& console) {
    CaseFile file(console, Consent::NotGiven);
    if (const int refused = file.Open(options.file))
        return refused;
    CMessageList findings;
    file.Root().Check(findings, 1);
    if (file.Root().GridInput().UseTsq2Input) {
        DropFindingsOnInput(findings);
        if (const Status grid = TestGrid(file); !grid)
            return Report(console, grid);
    }
    if (options.form == OutputForm::Json)
        PrintJson(console, JsonOfFindings(findings));
    else
        PrintFindings(findings, file.Document(), console.out);
    if (options.form == OutputForm::Text && findings.empty())
        console.out << FormatText(kTextCliNoFindings, PlainLine(file.ShownName())) << '\n';
    return findings.empty() ? kExitDone : kExitInput;
}

void AddCheckCommand(CommandLine& line) {
    auto options = std::make_shared<CheckOptions>();
    CLI::App& command = line.Add({"check", kTextCliHelpCheck, [options](Console& console) {
                                      return RunCheck(*options, console);
                                  }});
    AddCaseFileArgument(command, &options->file);
    AddJsonOption(command, &options->form);
}

} // namespace ryn::cli
