#pragma once

#include <functional>
#include <string>
#include <utility>
#include <vector>

#include <CLI/App.hpp>

#include "apps/cli/console.h"

namespace ryn::cli {

/// One command of the program.
struct CommandEntry {
    std::string name;
    int helpTextId;
    /// Runs the command with the options that the command line filled; gives the exit code.
    std::function<int(Console&)> run;
};

/// The program's command line: its commands, and what runs the one that was named.
class CommandLine {
  public:
    CommandLine();

    /// Adds a command; its arguments and options are added to what this returns.
    CLI::App& Add(CommandEntry entry);
    /// Parses the arguments behind the program's name and runs the command. Help goes to standard
    /// output, a bad command line is one line on standard error and kExitInput.
    int Run(const std::vector<std::string>& arguments, Console& console);

  private:
    int ShowParseError(const CLI::ParseError& error, const std::vector<std::string>& arguments,
                       Console& console);
    std::string UnknownCommand(const std::vector<std::string>& arguments) const;

    CLI::App app;
    std::vector<std::pair<CLI::App*, CommandEntry>> commands;
};

} // namespace ryn::cli
