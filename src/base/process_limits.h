#pragma once

#include <cstddef>

namespace ryn {

/// How many files the process may have open at one time; at least 1.
int LimitOfOpenFiles();

/// How many bytes the process may use: the least of the machine's memory, its control group's
/// limit and the process's own limits. At least 64 MiB.
std::size_t UsableMemory();

} // namespace ryn
