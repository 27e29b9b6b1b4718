#include "apps/cli/command_line.h"

#include <algorithm>
#include <ostream>

#include <CLI/Config.hpp>
#include <CLI/Formatter.hpp>

#include "apps/cli/command_options.h"
#include "apps/cli/nearest_names.h"
#include "apps/cli/parse_error_text.h"
#include "strings/catalogue.h"

namespace ryn::cli {

namespace {

std::string TextOf(int id) {
    return std::string(Text(id));
}

} // namespace

CommandLine::CommandLine() : app(TextOf(kTextCliHelpProgram), "ryn") {
    const auto formatter = std::make_shared<CLI::Formatter>();
    formatter->label("Usage", TextOf(kTextCliLabelUsage));
    formatter->label("OPTIONS", TextOf(kTextCliLabelOptions));
    formatter->label("SUBCOMMAND", TextOf(kTextCliLabelCommand));
    formatter->label("Positionals", TextOf(kTextCliLabelArguments));
    formatter->label("REQUIRED", "");
    formatter->column_width(34);
    app.formatter(formatter);
    app.option_defaults()->group(TextOf(kTextCliLabelOptions));
    app.set_help_flag("-h,--help", TextOf(kTextCliHelpHelp));
    app.set_version_flag("--version", "ryn " RYN_VERSION, TextOf(kTextCliHelpVersion));
    app.require_subcommand(1);
    AddLanguageOption(app);
}

CLI::App& CommandLine::Add(CommandEntry entry) {
    CLI::App* const command = app.add_subcommand(entry.name, TextOf(entry.helpTextId));
    command->set_help_flag("-h,--help", TextOf(kTextCliHelpHelp));
    command->group(TextOf(kTextCliLabelCommands));
    AddLanguageOption(*command);
    commands.emplace_back(command, std::move(entry));
    return *command;
}

int CommandLine::Run(const std::vector<std::string>& arguments, Console& console) {
    try {
        app.parse(std::vector<std::string>(arguments.rbegin(), arguments.rend()));
    } catch (const CLI::ParseError& error) {
        return ShowParseError(error, arguments, console);
    }
    for (const auto& [command, entry] : commands)
        if (command->parsed())
            return entry.run(console);
    return kExitInput;
}

int CommandLine::ShowParseError(const CLI::ParseError& error,
                                const std::vector<std::string>& arguments, Console& console) {
    if (error.get_exit_code() == 0) { // asked for help or for the version
        app.exit(error, console.out, console.err);
        return kExitDone;
    }
    const std::vector<CLI::App*> chosen = app.get_subcommands();
    const CLI::App& command = chosen.empty() ? app : *chosen.front();
    if (chosen.empty() && (arguments.empty() || arguments.front().rfind('-', 0) != 0))
        ShowError(console, UnknownCommand(arguments));
    else if (chosen.empty() && app.remaining().empty()) // options of the program alone
        ShowError(console, UnknownCommand({}));
    else
        ShowError(console, FormatText(kTextCliBadCommandLine, ParseErrorText(error, command),
                                      chosen.empty() ? "" : command.get_name() + " "));
    return kExitInput;
}

std::string CommandLine::UnknownCommand(const std::vector<std::string>& arguments) const {
    std::vector<std::string> names;
    for (const auto& [command, entry] : commands)
        names.push_back(entry.name);
    if (arguments.empty())
        return FormatText(kTextCliNoCommand, JoinNames(names));
    const std::vector<std::string> nearest = NearestNames(arguments.front(), names);
    return FormatText(kTextCliUnknownCommand, arguments.front()) +
           (nearest.empty() ? "" : FormatText(kTextCliNearest, JoinNames(nearest)));
}

} // namespace ryn::cli
