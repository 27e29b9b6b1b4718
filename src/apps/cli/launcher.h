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
/// Of a Slurm array the number within the array counts where the array is a whole one, whatever its
/// first number is. A task that is submitted alone (--array=3) says nothing of the whole, so that
/// its number is taken as it stands, from 1. mpirun with one process only says nothing where there
/// are more parts and another launcher gives a number.
Status PartOfLauncher(const Environment& environment, int parts, int* part);

} // namespace ryn::cli
