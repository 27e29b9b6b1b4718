#include "apps/cli/launcher.h"

#include <array>
#include <cstdlib>

#include "base/number_text.h"
#include "strings/catalogue.h"

namespace ryn::cli {

namespace {

constexpr const char* kArrayTask = "SLURM_ARRAY_TASK_ID";
constexpr const char* kSequence = "PARALLEL_SEQ";

/// Processes started together, each with its rank from 0.
struct Group {
    const char* sign; ///< set where this launcher started the process
    const char* rank;
    const char* size; ///< null where it does not tell
};

// The innermost first: mpirun starts its helpers by srun, whose numbers the ranks then inherit.
// SLURM_PROCID and SLURM_NTASKS stand in a batch script as well, of which there is only one; the
// count of a step's tasks does not.
constexpr std::array kGroups = {
    Group{"OMPI_COMM_WORLD_RANK", "OMPI_COMM_WORLD_RANK", "OMPI_COMM_WORLD_SIZE"},
    Group{"PMI_RANK", "PMI_RANK", "PMI_SIZE"},
    Group{"SLURM_STEP_NUM_TASKS", "SLURM_PROCID", "SLURM_STEP_NUM_TASKS"},
    Group{"PMIX_RANK", "PMIX_RANK", nullptr},
};

const Group* GroupIn(const Environment& environment) {
    for (const Group& group : kGroups)
        if (environment(group.sign))
            return &group;
    return nullptr;
}

Status ReadNumber(const Environment& environment, const char* name, int* number) {
    const std::string text = environment(name).value_or("");
    const std::optional<int> read = ParseInt(text);
    if (!read)
        return Status::InputFault(FormatText(kTextCliLauncherNoNumber, name, text));
    *number = *read;
    return Status::Ok();
}

/// Leaves the number as it is where the variable is not set.
Status ReadIfSet(const Environment& environment, const char* name, int* number) {
    return environment(name) ? ReadNumber(environment, name, number) : Status::Ok();
}

Status Take(const char* name, long long number, int parts, int* part) {
    if (number < 1 || number > parts)
        return Status::InputFault(FormatText(kTextCliLauncherOutside, name, number, parts));
    *part = static_cast<int>(number);
    return Status::Ok();
}

Status OtherCount(const char* name, int count, int parts) {
    return Status::InputFault(FormatText(kTextCliLauncherCount, name, count, parts));
}

Status TakeRank(const Environment& environment, const Group& group, int parts, int* part) {
    int rank = 0;
    int size = parts;
    Status read = ReadNumber(environment, group.rank, &rank);
    if (read && group.size != nullptr)
        read = ReadIfSet(environment, group.size, &size);
    if (!read)
        return read;
    if (size != parts)
        return OtherCount(group.size, size, parts);
    return Take(group.rank, rank + 1LL, parts, part);
}

struct ArrayTask {
    int id = 0;
    int count = 0; ///< of tasks; 0 where Slurm does not tell
    int first = 1;
    int step = 1;
};

Status ReadArrayTask(const Environment& environment, ArrayTask* task) {
    Status read = ReadNumber(environment, kArrayTask, &task->id);
    if (read)
        read = ReadIfSet(environment, "SLURM_ARRAY_TASK_COUNT", &task->count);
    if (read)
        read = ReadIfSet(environment, "SLURM_ARRAY_TASK_MIN", &task->first);
    if (read)
        read = ReadIfSet(environment, "SLURM_ARRAY_TASK_STEP", &task->step);
    return read;
}

/// Only an array of all parts tells where its numbers begin: tasks submitted again are an array of
/// their own, whose first number is that of one of them.
Status TakeArrayTask(const Environment& environment, int parts, int* part) {
    ArrayTask task;
    if (Status read = ReadArrayTask(environment, &task); !read)
        return read;
    if (task.count > parts)
        return OtherCount("SLURM_ARRAY_TASK_COUNT", task.count, parts);
    if (task.count == parts) {
        const long long place = static_cast<long long>(task.id) - task.first;
        const bool isOnStep = task.step > 0 && place % task.step == 0;
        return Take(kArrayTask, isOnStep ? place / task.step + 1 : 0, parts, part);
    }
    return Take(kArrayTask, task.id, parts, part)
               ? Status::Ok()
               : Status::InputFault(
                     FormatText(kTextCliLauncherLoneTask, kArrayTask, task.id, parts));
}

Status TakeSequence(const Environment& environment, int parts, int* part) {
    int number = 0;
    const Status read = ReadNumber(environment, kSequence, &number);
    return read ? Take(kSequence, number, parts, part) : read;
}

/// An array's task and a command of GNU parallel at once: which of the two lies within the other is
/// not to be seen, since jobs inherit the variables of the shell that submitted them.
Status TakeAgreed(const Environment& environment, int parts, int* part) {
    int task = 0;
    int sequence = 0;
    Status taken = TakeArrayTask(environment, parts, &task);
    if (taken)
        taken = TakeSequence(environment, parts, &sequence);
    if (taken && task != sequence)
        return Status::InputFault(
            FormatText(kTextCliLauncherDisagree, kArrayTask, task, kSequence, sequence));
    if (taken)
        *part = task;
    return taken;
}

bool IsAlone(const Environment& environment, const Group& group) {
    return group.size != nullptr && environment(group.size) == "1";
}

} // namespace

Environment ProcessEnvironment() {
    return [](const std::string& name) -> std::optional<std::string> {
        const char* const value = std::getenv(name.c_str());
        return value != nullptr ? std::optional<std::string>(value) : std::nullopt;
    };
}

Status PartOfLauncher(const Environment& environment, int parts, int* part) {
    const bool isTask = environment(kArrayTask).has_value();
    const bool isInSequence = environment(kSequence).has_value();
    const Group* const group = GroupIn(environment);
    // "srun ryn ..." in an array's task, or under parallel, is a group of one.
    if (group != nullptr && !((isTask || isInSequence) && IsAlone(environment, *group)))
        return TakeRank(environment, *group, parts, part);
    if (isTask && isInSequence)
        return TakeAgreed(environment, parts, part);
    if (isTask)
        return TakeArrayTask(environment, parts, part);
    if (isInSequence)
        return TakeSequence(environment, parts, part);
    return Status::InputFault(FormatText(kTextCliLauncherNone, parts));
}

} // namespace ryn::cli
