#include "apps/cli/check_command.h"

#include <memory>
#include <ostream>

#include "apps/cli/case_file.h"
#include "apps/cli/command_options.h"
#include "apps/cli/finding_lines.h"
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

} // namespace

int RunCheck(const CheckOptions& options, Console& console) {
    CaseFile file(console, Consent::NotGiven);
    if (const int refused = file.Open(options.file))
        return refused;
    CMessageList findings;
    file.Root().Check(findings, 1);
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
