#include "apps/cli/run_ryn.h"

#include <exception>
#include <new>
#include <string_view>

#include "apps/cli/check_command.h"
#include "apps/cli/command_line.h"
#include "apps/cli/export_command.h"
#include "apps/cli/extract_command.h"
#include "apps/cli/fit_command.h"
#include "apps/cli/grid_command.h"
#include "apps/cli/import_command.h"
#include "apps/cli/info_command.h"
#include "apps/cli/new_command.h"
#include "apps/cli/run_command.h"
#include "apps/cli/self_check_command.h"
#include "apps/cli/set_command.h"
#include "apps/cli/show_command.h"
#include "base/file_access.h"
#include "strings/catalogue.h"
#include "strings/language.h"

namespace ryn::cli {

namespace {

/// Looked up before the command line is made, whose help has a language.
Language LanguageOf(const std::vector<std::string>& arguments) {
    constexpr std::string_view kOption = "--lang";
    for (std::size_t i = 0; i < arguments.size(); ++i) {
        const std::string& argument = arguments[i];
        if (argument == kOption && i + 1 < arguments.size())
            return LanguageOfLocale(arguments[i + 1]);
        if (argument.rfind("--lang=", 0) == 0)
            return LanguageOfLocale(std::string_view(argument).substr(kOption.size() + 1));
    }
    return LanguageOfEnvironment();
}

int RunCommand(const std::vector<std::string>& arguments, Console& console) {
    CommandLine line;
    AddImportCommand(line);
    AddExportCommand(line);
    AddInfoCommand(line);
    AddNewCommand(line);
    AddSetCommand(line);
    AddCheckCommand(line);
    AddExtractCommand(line);
    AddRunCommand(line);
    AddShowCommand(line);
    AddGridCommand(line);
    AddFitCommand(line);
    AddSelfCheckCommand(line);
    return line.Run(arguments, console);
}

} // namespace

int RunRyn(const std::vector<std::string>& arguments, Console& console) {
    try {
        SetLanguage(LanguageOf(arguments));
        const CurrentDirectoryScope keepDirectory("");
        return RunCommand(arguments, console);
    } catch (const std::bad_alloc&) {
        ShowError(console, Text(kTextCliOutOfMemory));
    } catch (const std::exception& error) {
        ShowError(console, FormatText(kTextCliUnexpected, std::string(error.what())));
    }
    return kExitSystem;
}

} // namespace ryn::cli
