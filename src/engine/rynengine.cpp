#include "engine/rynengine.h"

#include <exception>
#include <new>
#include <string>

#include "engine/engine_directory.h"
#include "engine/engine_run.h"
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

// The last line stands in the log whatever happened in between.
EngineStatus RunLogged(const KvfTree* tree, KvfHandle* output) {
    // First of all, so that whatever is wrong with the rest of the tree can be told.
    const std::string directory = EngineDirectory(tree);
    RunLog log(directory);
    log.Line(ProgramText());
    log.Line(NowText());
    const EngineStatus status = RunCaught(tree, output, directory, log);
    log.Line("finished with status " + std::to_string(static_cast<int>(status)));
    return status;
}

} // namespace

void RYNENGINE(const KvfHandle* input, KvfHandle* output, std::int32_t* status) noexcept {
    // Callers cannot catch: the module and its host meet in plain functions.
    auto reached = EngineStatus::SetUpFailed;
    try {
        reached = RunLogged(input == nullptr ? nullptr : input->get(), output);
    } catch (...) { // not even the log could be written
        reached = EngineStatus::SetUpFailed;
    }
    if (status != nullptr)
        *status = static_cast<std::int32_t>(reached);
}

} // namespace ryn
