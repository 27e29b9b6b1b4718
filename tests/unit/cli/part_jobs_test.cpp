#include "apps/cli/part_jobs.h"

#include <chrono>
#include <csignal>
#include <filesystem>
#include <fstream>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "base/stop_signals.h"
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
    const PartJobsEnd end = RunPartJobs(jobs);
    EXPECT_EQ(end.exitCode, 3);
    EXPECT_EQ(end.errors, "ryn: /nonexistent/program: No such file or directory\n");
}

/// Gives a signal a disposition while it lives.
class Disposition {
  public:
    Disposition(int of, void (*handler)(int)) : signal(of), before(::signal(of, handler)) {}
    ~Disposition() { ::signal(signal, before); }
    Disposition(const Disposition&) = delete;
    Disposition& operator=(const Disposition&) = delete;

  private:
    int signal;
    void (*before)(int);
};

// A stop that comes between a part's fork and its exec must not be lost in the handlers that the
// part has from this process until then.
TEST(PartJobs, StopPartsThatHaveOnlyJustBeenStarted) {
    const StopSignals signals;
    for (int i = 0; i < 20; ++i) {
        ScriptedJobs run("exec sleep 20");
        run.jobs.isStopped = [] { return true; };
        const auto start = std::chrono::steady_clock::now();
        EXPECT_TRUE(RunPartJobs(run.jobs).wasStopped);
        ASSERT_LT(std::chrono::steady_clock::now() - start, std::chrono::seconds(10));
    }
}

// A signal to the whole process group ends a part before the request to stop has been seen.
TEST(PartJobs, StartNoPartAgainWhenAllAreToStop) {
    ScriptedJobs run("touch over; kill -9 $$");
    run.jobs.parts = 1;
    int starts = 0;
    run.jobs.argumentsOf = [&, before = run.jobs.argumentsOf](int part) {
        ++starts;
        return before(part);
    };
    run.jobs.isStopped = [&] { return run.directory.Has("over"); };
    EXPECT_TRUE(RunPartJobs(run.jobs).wasStopped);
    EXPECT_EQ(starts, 1);
}

TEST(PartJobs, StopAPartThatIsSuspended) {
    ScriptedJobs run("touch there; kill -STOP $$; exec sleep 20");
    run.jobs.parts = 1;
    run.jobs.isStopped = [&] { return run.directory.Has("there"); };
    const auto start = std::chrono::steady_clock::now();
    EXPECT_TRUE(RunPartJobs(run.jobs).wasStopped);
    EXPECT_LT(std::chrono::steady_clock::now() - start, std::chrono::seconds(10));
}

TEST(PartJobs, TellBySignalsNameWhatEndedAPart) {
    ScriptedJobs run("echo halfway >&2; kill -9 $$");
    run.jobs.parts = 1;
    const PartJobsEnd end = RunPartJobs(run.jobs);
    EXPECT_EQ(end.exitCode, 3);
    EXPECT_EQ(end.errors, "halfway\nryn: ended by signal 9 (Killed)\n");
}

TEST(PartJobs, KeepASignalIgnoredThatTheirParentIgnores) {
    const Disposition nohup(SIGHUP, SIG_IGN);
    ScriptedJobs run("kill -HUP $$; touch done$1");
    EXPECT_EQ(RunPartJobs(run.jobs).exitCode, 0);
    EXPECT_TRUE(run.directory.Has("done1"));
}

TEST(PartJobs, SeeHowPartsEndWhereTheCallerIgnoresTheEndOfChildren) {
    const Disposition ignored(SIGCHLD, SIG_IGN);
    ScriptedJobs run("exit 1");
    EXPECT_EQ(RunPartJobs(run.jobs).exitCode, 1);
}

} // namespace
} // namespace ryn::cli
