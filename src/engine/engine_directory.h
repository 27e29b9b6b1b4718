#pragma once

#include <string>

#include "kvf/kvf.h"

namespace ryn {

/// Where the engine puts its log and reports: the directory of the result file that
/// DefineEVS/OutputFileName names, made absolute against the current directory, with its trailing
/// separator. Empty, which means no files, where no file is named or the name can be none (a zero
/// byte, or longer than a system takes).
std::string EngineDirectory(const KvfTree* tree);

} // namespace ryn
