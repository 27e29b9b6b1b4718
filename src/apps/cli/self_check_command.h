#pragma once

#include "apps/cli/command_line.h"
#include "apps/cli/console.h"
#include "selfcheck/comparison.h"

namespace ryn::cli {

/// `ryn selfcheck`: published values, computed anew on this machine.
struct SelfCheckOptions {
    OutputForm form = OutputForm::Text;
};

/// Shows comparisons, with the series that they are of. kExitAnalysis when a value differs.
int ShowSelfCheck(const selfcheck::Comparisons& comparisons, const SelfCheckOptions& options,
                  Console& console);
void AddSelfCheckCommand(CommandLine& line);

} // namespace ryn::cli
