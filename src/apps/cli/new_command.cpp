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
    // Assignments come after, so that one to a keyword that --grid fills counts.
    if (const int refused =
            Report(console, ApplyGridArguments(options.grid, callerDirectory, file.Path(),
                                               file.Root().GridInput())))
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
    AddTextOption(command, {"--grid", "FILE", kTextCliHelpGridFile}, &options->grid.grid);
    AddIntOption(command, {"--grid-item", "N", kTextCliHelpGridItem}, 1, &options->grid.item);
    AddTextOption(command, {"--x", "A:B:S", kTextCliHelpGridX}, &options->grid.x);
    AddTextOption(command, {"--y", "A:B:S", kTextCliHelpGridY}, &options->grid.y);
    AddTextOption(command, {"--time", "A:B", kTextCliHelpGridTime}, &options->grid.time);
    AddTextOption(command, {"--grid-out", "FILE", kTextCliHelpGridOutput}, &options->grid.output);
    AddConsentOption(command, &options->consent);
}

} // namespace ryn::cli
