#pragma once

namespace ryn::cli {

/// What the program's exit tells.
enum ExitCode : int {
    kExitDone = 0,
    kExitInput = 1,    ///< the user's input is at fault: an argument, a file's content
    kExitAnalysis = 2, ///< the analysis failed
    kExitSystem = 3,   ///< the program could not do its work: disk, permission, memory
};

} // namespace ryn::cli
