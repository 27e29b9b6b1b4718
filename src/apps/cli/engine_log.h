#pragma once

#include <filesystem>
#include <string>

#include "apps/cli/console.h"

namespace ryn::cli {

/// Tells the log of an engine that runs from now on from one of an earlier run.
class EngineLogWatch {
  public:
    EngineLogWatch() : start(std::filesystem::file_time_type::clock::now()) {}
    /// Whether the log was written since the object was made.
    bool HasSeen(const std::string& path) const;

  private:
    std::filesystem::file_time_type start;
};

/// The last error that a log tells, without its mark; empty where it tells none.
std::string LastErrorIn(const std::string& path);

/// The last lines of the engine's log, on standard error, or that there is none of this run.
void ShowEngineLog(const std::string& path, bool isOfThisRun, Console& console);

} // namespace ryn::cli
