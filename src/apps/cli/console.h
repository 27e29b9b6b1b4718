#pragma once

#include <iosfwd>
#include <string>
#include <string_view>

#include "apps/cli/exit_code.h"
#include "base/status.h"

namespace ryn::cli {

/// Where a command reads and writes: the process's streams, or a test's. The streams outlive it.
struct Console {
    std::ostream& out; ///< results
    std::ostream& err; ///< errors, warnings, notes and progress
    std::istream& in;
    bool errIsTerminal = false; ///< progress is shown only there
};

/// Whether a command that would replace a file, or a question, has the user's consent (--yes).
enum class Consent { NotGiven, Given };

/// How a command shows its results.
enum class OutputForm { Text, Json };

/// One line "ryn: TEXT" on standard error.
void ShowError(Console& console, std::string_view text);
/// One line "ryn: warning: TEXT" on standard error.
void ShowWarning(Console& console, std::string_view text);
/// One line "ryn: note: TEXT" on standard error: what a command took for granted.
void ShowNote(Console& console, std::string_view text);

/// Shows a failure and gives the exit code that it stands for; kExitDone, and nothing shown, for
/// Ok.
int Report(Console& console, const Status& status);

} // namespace ryn::cli
