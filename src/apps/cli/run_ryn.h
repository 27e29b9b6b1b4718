#pragma once

#include <string>
#include <vector>

#include "apps/cli/console.h"

namespace ryn::cli {

/// The program: runs the command that the arguments (without the program's name) ask for, in the
/// language of --lang or else of the environment, and gives the exit code. The process's current
/// directory is afterwards what it was. No exception comes out.
int RunRyn(const std::vector<std::string>& arguments, Console& console);

} // namespace ryn::cli
