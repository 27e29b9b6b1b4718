#pragma once

#include <functional>
#include <string>
#include <vector>

namespace ryn::cli {

/// Processes that share a work between them, all at once.
struct PartJobs {
    std::string program;
    int parts = 1;
    /// The arguments of a part's process, from 1.
    std::function<std::vector<std::string>(int part)> argumentsOf;
    /// Called when a part has written to its standard output, whose text is dropped.
    std::function<void()> noteProgress;
    /// Asked several times a second; true stops all parts.
    std::function<bool()> isStopped;
};

/// How the processes ended.
struct PartJobsEnd {
    int exitCode = 0; ///< of the part that failed; 0 when all did their work
    int part = 0;     ///< the one that failed; 0 for none
    bool wasStopped = false;
    std::string errors; ///< what the part that failed wrote on its standard error last, and
                        ///< the signal where one ended it
};

/// Runs the parts to their end. One that died, by a signal or with kExitSystem, is started a second
/// time; one that failed otherwise would fail again. When a part has failed for good, and when all
/// are to stop, the others are stopped; all have ended when this returns.
PartJobsEnd RunPartJobs(const PartJobs& jobs);

} // namespace ryn::cli
