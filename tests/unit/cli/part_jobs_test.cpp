#include "apps/cli/part_jobs.h"

#include <chrono>
#include <csignal>
#include <filesystem>
#include <fstream>
#include <map>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "apps/cli/launcher.h"
#include "support/temporary_directory.h"

namespace ryn::cli {
namespace {

using testing::HasSubstr;

/// Parts that run a shell script with the part's number, in a directory of their own.
struct ScriptedJobs {
    test::TemporaryDirectory directory;
    PartJobs jobs;

    explicit ScriptedJobs(const std::string& script) {
        jobs.program = "/bin/sh";
        jobs.parts = 3;
        const std::string before = "cd " + directory.Root().string() + "; echo $$ > pid$1; ";
        jobs.argumentsOf = [before, script](int part) {
            return std::vector<std::string>{"-c", before + script, "part", std::to_string(part)};
        };
    }
    /// Whether the process that a part was, or is, still runs.
    bool IsRunning(int part) const {
        std::ifstream file(directory.Path("pid" + std::to_string(part)));
        pid_t pid = 0;
        return (file >> pid) && ::kill(pid, 0) == 0;
    }
};

TEST(PartJobs, RunAllPartsAndTellWhenOneWrites) {
    ScriptedJobs run("echo made; touch done$1");
    int calls = 0;
    run.jobs.noteProgress = [&calls] { ++calls; };
    const PartJobsEnd end = RunPartJobs(run.jobs);
    EXPECT_EQ(end.exitCode, 0);
    EXPECT_GE(calls, 1);
    for (const int part : {1, 2, 3})
        EXPECT_TRUE(run.directory.Has("done" + std::to_string(part)));
}

TEST(PartJobs, StartAPartThatDiedOnceMore) {
    ScriptedJobs killed("test $1 != 2 || test -e again || { touch again; kill -9 $$; }");
    EXPECT_EQ(RunPartJobs(killed.jobs).exitCode, 0);
    ScriptedJobs failed("test $1 != 2 || test -e again || { touch again; exit 3; }");
    EXPECT_EQ(RunPartJobs(failed.jobs).exitCode, 0);
    ScriptedJobs twice("test $1 != 2 || { echo no room >&2; exit 3; }");
    const PartJobsEnd end = RunPartJobs(twice.jobs);
    EXPECT_EQ(end.exitCode, 3);
    EXPECT_EQ(end.part, 2);
    EXPECT_EQ(end.errors, "no room\n");
}

TEST(PartJobs, StopTheOthersWhenOneFailsForGood) {
    ScriptedJobs run("test $1 = 3 && { echo x >> starts; echo bad case >&2; exit 1; }; sleep 60");
    const auto start = std::chrono::steady_clock::now();
    const PartJobsEnd end = RunPartJobs(run.jobs);
    EXPECT_LT(std::chrono::steady_clock::now() - start, std::chrono::seconds(30));
    EXPECT_EQ(end.exitCode, 1);
    EXPECT_EQ(end.part, 3);
    EXPECT_THAT(end.errors, HasSubstr("bad case"));
    EXPECT_EQ(run.directory.Read("starts"), "x\n"); // it would fail again
    EXPECT_FALSE(run.IsRunning(1));
}

TEST(PartJobs, LeaveNoProcessWhenTheyAreStopped) {
    ScriptedJobs run("exec sleep 60");
    int calls = 0;
    run.jobs.isStopped = [&] {
        return ++calls > 3 && run.directory.Has("pid1") && run.directory.Has("pid3");
    };
    const PartJobsEnd end = RunPartJobs(run.jobs);
    EXPECT_TRUE(end.wasStopped);
    for (const int part : {1, 2, 3})
        EXPECT_FALSE(run.IsRunning(part));
}

TEST(PartJobs, TellThatAProgramCannotBeStarted) {
    PartJobs jobs;
    jobs.program = "/nonexistent/program";
    jobs.argumentsOf = [](int) { return std::vector<std::string>(); };
    EXPECT_EQ(RunPartJobs(jobs).exitCode, 3);
}

/// The part that an environment makes of one of `parts`; 0 where it is refused.
int PartIn(const std::map<std::string, std::string>& variables, int parts) {
    int part = 0;
    const Environment environment = [&](const std::string& name) -> std::optional<std::string> {
        const auto found = variables.find(name);
        return found != variables.end() ? std::optional(found->second) : std::nullopt;
    };
    const Status status = PartOfLauncher(environment, parts, &part);
    EXPECT_EQ(status ? 0 : 1, part == 0 ? 1 : 0) << status.Text();
    return part;
}

TEST(Launcher, GivesAProcessItsNumber) {
    EXPECT_EQ(PartIn({{"OMPI_COMM_WORLD_RANK", "0"}, {"OMPI_COMM_WORLD_SIZE", "2"}}, 2), 1);
    EXPECT_EQ(PartIn({{"PMI_RANK", "3"}, {"PMI_SIZE", "4"}}, 4), 4);
    EXPECT_EQ(PartIn({{"PARALLEL_SEQ", "3"}}, 4), 3);
    EXPECT_EQ(PartIn({{"SLURM_PROCID", "1"}, {"SLURM_NTASKS", "2"}}, 2), 2);
    const auto array = [](const char* id, const char* first, const char* step, const char* count) {
        return std::map<std::string, std::string>{
            {"SLURM_ARRAY_TASK_ID", id},     {"SLURM_ARRAY_TASK_MIN", first},
            {"SLURM_ARRAY_TASK_STEP", step}, {"SLURM_ARRAY_TASK_COUNT", count},
            {"SLURM_PROCID", "0"},           {"SLURM_NTASKS", "1"}};
    };
    EXPECT_EQ(PartIn(array("1", "1", "1", "4"), 4), 1);
    EXPECT_EQ(PartIn(array("0", "0", "1", "4"), 4), 1);
    EXPECT_EQ(PartIn(array("14", "10", "2", "4"), 4), 3);
    EXPECT_EQ(PartIn(array("3", "3", "1", "1"), 4), 3); // submitted again, alone
    EXPECT_EQ(PartIn(array("0", "0", "1", "1"), 1), 1);
}

TEST(Launcher, IsRefusedWhereItsNumberDoesNotFit) {
    EXPECT_EQ(PartIn({}, 2), 0);
    EXPECT_EQ(PartIn({{"OMPI_COMM_WORLD_RANK", "0"}, {"OMPI_COMM_WORLD_SIZE", "3"}}, 2), 0);
    EXPECT_EQ(PartIn({{"PARALLEL_SEQ", "5"}}, 4), 0);
    EXPECT_EQ(PartIn({{"PARALLEL_SEQ", "one"}}, 4), 0);
    EXPECT_EQ(PartIn({{"SLURM_ARRAY_TASK_ID", "0"}, {"SLURM_ARRAY_TASK_COUNT", "1"}}, 4), 0);
    EXPECT_EQ(PartIn({{"SLURM_PROCID", "0"}, {"SLURM_NTASKS", "1"}}, 4), 0);
}

} // namespace
} // namespace ryn::cli
