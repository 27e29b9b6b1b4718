#pragma once

#include <string>

#include <CLI/App.hpp>

namespace ryn::cli {

/// Why a command line could not be parsed, in the user's language and with the argument that is at
/// fault. `command` is the command that was named, else the program.
std::string ParseErrorText(const CLI::ParseError& error, const CLI::App& command);

} // namespace ryn::cli
