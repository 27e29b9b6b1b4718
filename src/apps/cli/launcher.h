#pragma once

#include <functional>
#include <optional>
#include <string>

#include "base/status.h"

namespace ryn::cli {

/// A variable of the environment; nothing where it is not set.
using Environment = std::function<std::optional<std::string>(const std::string& name)>;

/// The process's own.
Environment ProcessEnvironment();

/// Which of `parts` shares, from 1, this process is to run, by the launcher that started it: a
/// Slurm job array, mpirun (Open MPI, MPICH and those that speak as they do), srun, or GNU
/// parallel. A fault where no launcher gives a number, where it counts another number of processes
/// than `parts`, or its number lies outside; the fault names the variable.
///
/// Of launchers within each other the inner one counts: ranks of mpirun or srun within an array's
/// task or a command of parallel, unless there is only one rank. An array and parallel have to
/// agree. A batch script itself has no number but its array's.
///
/// Of a Slurm array the number within the array counts where the array is a whole one, whatever its
/// first number is. Tasks that are submitted again (--array=3) say nothing of the whole, so that
/// their numbers are taken as they stand, from 1: an array that begins at 0 is not to be
/// resubmitted in part.
Status PartOfLauncher(const Environment& environment, int parts, int* part);

} // namespace ryn::cli
