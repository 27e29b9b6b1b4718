#include "apps/cli/set_command.h"

#include <memory>

#include "apps/cli/case_file.h"
#include "apps/cli/command_options.h"
#include "base/path_parts.h"
#include "strings/catalogue.h"

namespace ryn::cli {

int RunSet(const SetOptions& options, Console& console) {
    if (options.arguments.AreEmpty())
        return Report(console, Status::InputFault(std::string(Text(kTextCliNothingToSet))));
    const std::string callerDirectory = FullPath("."); // before opening moves it
    CaseFile file(console, options.consent);
    if (const int refused = file.Open(options.file))
        return refused;
    if (const int refused =
            Report(console, ApplyArguments(file.Root(), options.arguments, callerDirectory)))
        return refused;
    return file.Save();
}

void AddSetCommand(CommandLine& line) {
    auto options = std::make_shared<SetOptions>();
    CLI::App& command = line.Add({"set", kTextCliHelpSet, [options](Console& console) {
                                      return RunSet(*options, console);
                                  }});
    AddCaseFileArgument(command, &options->file);
    AddCaseArguments(command, &options->arguments);
    AddConsentOption(command, &options->consent);
}

} // namespace ryn::cli
