#include "apps/cli/child_process.h"

#include <array>
#include <cerrno>
#include <csignal>
#include <fcntl.h>
#include <sys/prctl.h>
#include <sys/wait.h>
#include <unistd.h>
#include <utility>

namespace ryn::cli {

namespace {

constexpr int kCannotStart = 127; // what shells give

/// Holds all signals back while it lives. One that came to a child before exec would be taken by
/// the parent's handler there, and be lost: the child would never learn that it is to stop.
class AllSignalsHeld {
  public:
    AllSignalsHeld() {
        sigset_t all;
        ::sigfillset(&all);
        ::pthread_sigmask(SIG_SETMASK, &all, &before);
    }
    ~AllSignalsHeld() { Release(); }
    AllSignalsHeld(const AllSignalsHeld&) = delete;
    AllSignalsHeld& operator=(const AllSignalsHeld&) = delete;
    void Release() const { ::pthread_sigmask(SIG_SETMASK, &before, nullptr); }

  private:
    sigset_t before{};
};

/// In the child, between fork and exec: nothing here may allocate.
[[noreturn]] void Become(const char* program, char* const* arguments, int output, int errors,
                         pid_t parent, const AllSignalsHeld& held) {
    ::dup2(output, STDOUT_FILENO);
    ::dup2(errors, STDERR_FILENO);
    ::prctl(PR_SET_PDEATHSIG, SIGTERM);
    if (::getppid() != parent) // it died before that was set
        ::_exit(kCannotStart);
    for (const int signal : {SIGINT, SIGTERM, SIGHUP, SIGPIPE, SIGXFSZ})
        ::signal(signal, SIG_DFL);
    held.Release();
    ::execv(program, arguments);
    ::_exit(kCannotStart);
}

} // namespace

ChildProcess::~ChildProcess() {
    Stop();
    int exitCode = 0;
    if (IsRunning())
        Wait(0, &exitCode);
    Close();
}

ChildProcess::ChildProcess(ChildProcess&& other) noexcept
    : pid(std::exchange(other.pid, -1)),
      output(std::exchange(other.output, -1)),
      errors(std::exchange(other.errors, -1)) {}

ChildProcess& ChildProcess::operator=(ChildProcess&& other) noexcept {
    std::swap(pid, other.pid);
    std::swap(output, other.output);
    std::swap(errors, other.errors);
    return *this;
}

/// Gives the reason where there is no child.
int ChildProcess::Fork(const char* program, char* const* arguments, int writeOutput,
                       int writeErrors) {
    const pid_t parent = ::getpid();
    const AllSignalsHeld held;
    pid = ::fork();
    if (pid == 0)
        Become(program, arguments, writeOutput, writeErrors, parent, held);
    return pid < 0 ? errno : 0;
}

Status ChildProcess::Start(const std::string& program, const std::vector<std::string>& arguments) {
    std::vector<char*> pointers{const_cast<char*>(program.c_str())};
    for (const std::string& argument : arguments)
        pointers.push_back(const_cast<char*>(argument.c_str()));
    pointers.push_back(nullptr);
    std::array<int, 2> out{};
    std::array<int, 2> err{};
    if (::pipe2(out.data(), O_CLOEXEC) != 0)
        return Status::FromErrno(program, errno);
    if (::pipe2(err.data(), O_CLOEXEC) != 0) {
        const int reason = errno;
        ::close(out[0]);
        ::close(out[1]);
        return Status::FromErrno(program, reason);
    }
    const int reason = Fork(program.c_str(), pointers.data(), out[1], err[1]);
    ::close(out[1]);
    ::close(err[1]);
    output = out[0];
    errors = err[0];
    ::fcntl(output, F_SETFL, O_NONBLOCK);
    ::fcntl(errors, F_SETFL, O_NONBLOCK);
    if (pid > 0)
        return Status::Ok();
    Close();
    return Status::FromErrno(program, reason);
}

bool ChildProcess::Read(int* descriptor, std::string* text) {
    std::array<char, 4096> block{};
    while (*descriptor >= 0) {
        const ssize_t count = ::read(*descriptor, block.data(), block.size());
        if (count > 0) {
            text->append(block.data(), static_cast<std::size_t>(count));
            continue;
        }
        if (count < 0 && errno == EINTR)
            continue;
        if (count < 0 && errno == EAGAIN)
            return true;
        ::close(std::exchange(*descriptor, -1));
    }
    return false;
}

void ChildProcess::Stop() const {
    if (IsRunning())
        ::kill(pid, SIGTERM);
}

bool ChildProcess::HasEnded(int* exitCode) {
    return Wait(WNOHANG, exitCode);
}

bool ChildProcess::Wait(int options, int* exitCode) {
    int status = 0;
    pid_t ended = 0;
    do
        ended = ::waitpid(pid, &status, options);
    while (ended < 0 && errno == EINTR);
    if (ended == 0)
        return false;
    pid = -1;
    *exitCode = WIFSIGNALED(status) ? 128 + WTERMSIG(status) : WEXITSTATUS(status);
    return true;
}

void ChildProcess::Close() {
    for (int* const descriptor : {&output, &errors})
        if (*descriptor >= 0)
            ::close(std::exchange(*descriptor, -1));
}

} // namespace ryn::cli
