#include "apps/cli/launcher.h"

#include <algorithm>
#include <array>
#include <cstdint>
#include <cstdlib>

#include "base/number_text.h"
#include "strings/catalogue.h"

namespace ryn::cli {

namespace {

/// A launcher that counts its processes from a first number on.
struct Launcher {
    const char* number;
    const char* count; ///< how many processes it started; null where it does not tell
    int first;
};

// In this order: an array's task may itself start something under mpirun or srun, which then knows
// better; a shell under parallel may be a task of an array.
constexpr std::array kLaunchers = {
    Launcher{"OMPI_COMM_WORLD_RANK", "OMPI_COMM_WORLD_SIZE", 0},
    Launcher{"PMI_RANK", "PMI_SIZE", 0},
    Launcher{"PARALLEL_SEQ", nullptr, 1},
};

Status ReadNumber(const Environment& environment, const char* name, int* number) {
    const std::string text = environment(name).value_or("");
    const std::optional<int> read = ParseInt(text);
    if (!read)
        return Status::InputFault(FormatText(kTextCliLauncherNoNumber, name, text));
    *number = *read;
    return Status::Ok();
}

/// 64 bits: a variable may hold any number, from which the first one is still taken away.
Status Take(const char* name, std::int64_t number, int parts, int* part) {
    if (number < 1 || number > parts)
        return Status::InputFault(FormatText(kTextCliLauncherOutside, name, number, parts));
    *part = static_cast<int>(number);
    return Status::Ok();
}

Status TakeRank(const Environment& environment, const Launcher& launcher, int parts, int* part) {
    int number = 0;
    if (Status read = ReadNumber(environment, launcher.number, &number); !read)
        return read;
    int count = parts;
    if (launcher.count != nullptr && environment(launcher.count))
        if (Status read = ReadNumber(environment, launcher.count, &count); !read)
            return read;
    if (count != parts)
        return Status::InputFault(FormatText(kTextCliLauncherCount, launcher.count, count, parts));
    return Take(launcher.number, std::int64_t{number} - launcher.first + 1, parts, part);
}

Status TakeArrayTask(const Environment& environment, int parts, int* part) {
    constexpr const char* kId = "SLURM_ARRAY_TASK_ID";
    int id = 0;
    int count = 0;
    if (Status read = ReadNumber(environment, kId, &id); !read)
        return read;
    if (environment("SLURM_ARRAY_TASK_COUNT"))
        if (Status read = ReadNumber(environment, "SLURM_ARRAY_TASK_COUNT", &count); !read)
            return read;
    if (count != parts || parts == 1)
        return Take(kId, parts == 1 ? 1 : id, parts, part);
    int first = 0;
    int step = 1;
    if (Status read = ReadNumber(environment, "SLURM_ARRAY_TASK_MIN", &first); !read)
        return read;
    if (environment("SLURM_ARRAY_TASK_STEP"))
        if (Status read = ReadNumber(environment, "SLURM_ARRAY_TASK_STEP", &step); !read)
            return read;
    return Take(kId, (std::int64_t{id} - first) / std::max(step, 1) + 1, parts, part);
}

/// A process alone is no share: srun and mpirun set their variables for one process too, such as an
/// array's task that runs the program under them.
bool StartedOneOnly(const Environment& environment, const Launcher& launcher) {
    return launcher.count != nullptr && environment(launcher.count) == "1";
}

} // namespace

Environment ProcessEnvironment() {
    return [](const std::string& name) -> std::optional<std::string> {
        const char* const value = std::getenv(name.c_str());
        return value != nullptr ? std::optional<std::string>(value) : std::nullopt;
    };
}

Status PartOfLauncher(const Environment& environment, int parts, int* part) {
    for (const Launcher& launcher : kLaunchers)
        if (environment(launcher.number) && (parts == 1 || !StartedOneOnly(environment, launcher)))
            return TakeRank(environment, launcher, parts, part);
    if (environment("SLURM_ARRAY_TASK_ID"))
        return TakeArrayTask(environment, parts, part);
    // Set in every job, so that it counts only where srun started as many processes.
    if (environment("SLURM_PROCID"))
        return TakeRank(environment, {"SLURM_PROCID", "SLURM_NTASKS", 0}, parts, part);
    for (const Launcher& launcher : kLaunchers) // tells what does not fit
        if (environment(launcher.number))
            return TakeRank(environment, launcher, parts, part);
    return Status::InputFault(FormatText(kTextCliLauncherNone, parts));
}

} // namespace ryn::cli
