#include "engine/rynengine.h"

#include <exception>
#include <filesystem>
#include <new>
#include <string>
#include <string_view>
#include <system_error>

#include "engine/engine_directory.h"
#include "engine/engine_run.h"
#include "engine/goodness_report.h"
#include "engine/quantile_report.h"
#include "engine/run_log.h"

namespace ryn {

namespace {

// Every other series would fare the same: a status that ends a batch.
EngineStatus RunCaught(const KvfTree* tree, KvfHandle* output, const std::string& directory,
                       RunLog& log) {
    try {
        return EngineRun(directory, log).Execute(tree, output);
    } catch (const std::bad_alloc&) {
        log.Error("out of memory");
    } catch (const std::exception& fault) {
        log.Error(std::string("unexpected fault: ") + fault.what());
    }
    return EngineStatus::SetUpFailed;
}

// An earlier run's reports must not pass for this one's, whatever happens before they are written.
void RemoveReports(const std::string& directory) {
    if (directory.empty())
        return;
    for (const std::string_view name : {kGoodnessReportName, kQuantileReportName}) {
        const std::filesystem::path path = directory + std::string(name);
        std::error_code error;
        if (std::filesystem::is_regular_file(path, error))
            std::filesystem::remove(path, error);
    }
}

// Without a directory nothing is written. The last line stands in the log whatever happened in
// between.
EngineStatus RunLogged(const KvfTree* tree, KvfHandle* output, const std::string& directory) {
    RunLog log(directory);
    RemoveReports(directory);
    log.Line(ProgramText());
    log.Line(NowText());
    const EngineStatus status = RunCaught(tree, output, directory, log);
    log.Line("finished with status " + std::to_string(static_cast<int>(status)));
    return status;
}

enum class EngineFiles { Written, Omitted };

// Callers cannot catch: the module and its host meet in plain functions.
void Run(const KvfHandle* input, KvfHandle* output, std::int32_t* status,
         EngineFiles files) noexcept {
    auto reached = EngineStatus::SetUpFailed;
    try {
        const KvfTree* const tree = input == nullptr ? nullptr : input->get();
        // First of all, so that whatever is wrong with the rest of the tree can be told.
        reached = RunLogged(tree, output,
                            files == EngineFiles::Written ? EngineDirectory(tree) : std::string());
    } catch (...) { // not even the log could be written
        reached = EngineStatus::SetUpFailed;
    }
    if (status != nullptr)
        *status = static_cast<std::int32_t>(reached);
}

} // namespace

void RYNENGINE(const KvfHandle* input, KvfHandle* output, std::int32_t* status) noexcept {
    Run(input, output, status, EngineFiles::Written);
}

void RynEngineWithoutFiles(const KvfHandle* input, KvfHandle* output,
                           std::int32_t* status) noexcept {
    Run(input, output, status, EngineFiles::Omitted);
}

} // namespace ryn
