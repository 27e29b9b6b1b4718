#include "apps/cli/part_jobs.h"

#include <algorithm>
#include <cstring>
#include <poll.h>

#include "apps/cli/child_process.h"
#include "apps/cli/exit_code.h"
#include "strings/catalogue.h"

namespace ryn::cli {

namespace {

/// One part's process and what is known of it.
struct Job {
    int part = 0;
    int starts = 0;
    ChildProcess process;
    std::string errors;
};

/// A process that was killed, as for want of memory, could not say so itself.
std::string EndBySignalText(int signal) {
    const char* const name = ::sigdescr_np(signal);
    return FormatText(kTextCliGridPartKilled, signal, std::string(name != nullptr ? name : "?"));
}

/// All parts, from the first start to the last end.
class Supervisor {
  public:
    explicit Supervisor(const PartJobs& wanted) : jobs(wanted) {}

    PartJobsEnd Run() {
        for (int part = 1; part <= jobs.parts && end.part == 0; ++part) {
            running.emplace_back();
            running.back().part = part;
            Start(running.back());
        }
        while (!running.empty()) {
            StopIfAsked();
            Await();
            for (Job& job : running)
                Read(job);
            std::erase_if(running, [](const Job& job) { return !job.process.IsRunning(); });
        }
        return std::move(end);
    }

  private:
    void Start(Job& job) {
        ++job.starts;
        job.errors.clear();
        job.process = ChildProcess();
        const Status started = job.process.Start(jobs.program, jobs.argumentsOf(job.part));
        if (!started)
            Fail(job, kExitSystem, started.Text());
    }

    void Fail(const Job& job, int exitCode, const std::string& errors) {
        if (end.part != 0 || end.wasStopped)
            return; // the first failure is the reason of the others
        end.part = job.part;
        end.exitCode = exitCode;
        end.errors = errors;
        StopAll();
    }

    void StopIfAsked() {
        if (end.wasStopped || end.part != 0 || !jobs.isStopped || !jobs.isStopped())
            return;
        end.wasStopped = true;
        StopAll();
    }

    void StopAll() {
        for (const Job& job : running)
            job.process.Stop();
    }

    /// Until a part writes or ends, or it is time to ask whether to stop.
    void Await() {
        constexpr int kMilliseconds = 100;
        constexpr int kWhileOneEnds = 2; // its pipes are closed some time before it has ended
        int timeout = kMilliseconds;
        std::vector<pollfd> watched;
        for (const Job& job : running) {
            const auto before = watched.size();
            for (const int descriptor : {job.process.Output(), job.process.Errors()})
                if (descriptor >= 0)
                    watched.push_back({descriptor, POLLIN, 0});
            if (watched.size() == before)
                timeout = kWhileOneEnds;
        }
        ::poll(watched.data(), watched.size(), timeout);
    }

    void Read(Job& job) {
        int exitCode = 0;
        // Asked first, so that what it wrote before its end is read below.
        const bool hasEnded = job.process.HasEnded(&exitCode);
        std::string text;
        job.process.ReadOutput(&text);
        job.process.ReadErrors(&job.errors);
        if (!text.empty() && jobs.noteProgress)
            jobs.noteProgress();
        constexpr std::size_t kKept = 16384;
        if (job.errors.size() > kKept)
            job.errors.erase(0, job.errors.size() - kKept);
        if (hasEnded && exitCode != kExitDone)
            TakeFailure(job, exitCode);
    }

    void TakeFailure(Job& job, int exitCode) {
        constexpr int kSignals = 128;
        constexpr int kFirstOfSystem = 126; // cannot be started, or ended by a signal
        const bool died = exitCode == kExitSystem || exitCode >= kFirstOfSystem;
        // A signal to the whole process group may have ended the part: then this one has it too.
        StopIfAsked();
        if (died && job.starts < 2 && end.part == 0 && !end.wasStopped)
            return Start(job);
        if (exitCode > kSignals)
            job.errors += "ryn: " + EndBySignalText(exitCode - kSignals) + '\n';
        Fail(job, died ? kExitSystem : exitCode, job.errors);
    }

    const PartJobs& jobs;
    std::vector<Job> running;
    PartJobsEnd end;
};

} // namespace

PartJobsEnd RunPartJobs(const PartJobs& jobs) {
    return Supervisor(jobs).Run();
}

} // namespace ryn::cli
