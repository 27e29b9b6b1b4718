#include "apps/cli/new_command.h"

#include <memory>

#include "apps/cli/case_file.h"
#include "apps/cli/command_options.h"
#include "base/path_parts.h"
#include "strings/catalogue.h"

namespace ryn::cli {

int RunNew(const NewOptions& options, Console& console) {
    const std::string callerDirectory = FullPath(".");
    CaseFile file(console, options.consent);
    if (const int refused = file.New(options.file))
        return refused;
    if (const int refused =
            Report(console, ApplyArguments(file.Root(), options.arguments, callerDirectory)))
        return refused;
    return file.Save();
}

void AddNewCommand(CommandLine& line) {
    auto options = std::make_shared<NewOptions>();
    CLI::App& command = line.Add({"new", kTextCliHelpNew, [options](Console& console) {
                                      return RunNew(*options, console);
                                  }});
    AddCaseFileArgument(command, &options->file);
    AddCaseArguments(command, &options->arguments);
    AddConsentOption(command, &options->consent);
}

} // namespace ryn::cli
