#include "apps/cli/child_process.h"

#include <array>
#include <cerrno>
#include <csignal>
#include <cstring>
#include <fcntl.h>
#include <sys/prctl.h>
#include <sys/wait.h>
#include <unistd.h>
#include <utility>

namespace ryn::cli {

namespace {

constexpr int kCannotStart = 127; // what shells give

/// "ryn: PROGRAM: REASON" on standard error.
void TellReason(const char* program, int error) {
    for (const char* const piece : {"ryn: ", program, ": ", ::strerrordesc_np(error), "\n"})
        if (::write(STDERR_FILENO, piece, std::strlen(piece)) < 0)
            return;
}

/// This process's handlers, which a signal that comes before exec would run, go. What is ignored
/// stays so, as under nohup; but SIGPIPE and SIGXFSZ are ignored by this program's own doing.
void ResetSignals(const sigset_t& mask) {
    for (const int signal : {SIGINT, SIGTERM, SIGHUP}) {
        struct sigaction found {};
        if (::sigaction(signal, nullptr, &found) == 0 && found.sa_handler != SIG_IGN)
            ::signal(signal, SIG_DFL);
    }
    for (const int signal : {SIGPIPE, SIGXFSZ})
        ::signal(signal, SIG_DFL);
    ::sigprocmask(SIG_SETMASK, &mask, nullptr);
}

/// What the child needs between fork and exec, where nothing may allocate.
struct Beginning {
    const char* program;
    char* const* arguments;
    int output;
    int errors;
    pid_t parent;
    sigset_t mask; ///< of signals, as the parent had it before it held them back
};

[[noreturn]] void Become(const Beginning& beginning) {
    ::dup2(beginning.output, STDOUT_FILENO);
    ::dup2(beginning.errors, STDERR_FILENO);
    ::prctl(PR_SET_PDEATHSIG, SIGTERM);
    if (::getppid() != beginning.parent) // it died before that was set
        ::_exit(kCannotStart);
    ResetSignals(beginning.mask);
    ::execv(beginning.program, beginning.arguments);
    TellReason(beginning.program, errno);
    ::_exit(kCannotStart);
}

/// Holds all signals back until the child has put away the handlers that it has from here: one that
/// asks it to stop would be lost in them.
pid_t Fork(Beginning& beginning) {
    sigset_t all;
    ::sigfillset(&all);
    ::pthread_sigmask(SIG_SETMASK, &all, &beginning.mask);
    const pid_t pid = ::fork();
    if (pid == 0)
        Become(beginning);
    const int reason = errno;
    ::pthread_sigmask(SIG_SETMASK, &beginning.mask, nullptr);
    errno = reason;
    return pid;
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
    // A caller may have left it ignored; then no child would tell how it ended.
    ::signal(SIGCHLD, SIG_DFL);
    Beginning beginning{program.c_str(), pointers.data(), out[1], err[1], ::getpid(), {}};
    pid = Fork(beginning);
    const int reason = errno;
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
    if (!IsRunning())
        return;
    ::kill(pid, SIGTERM);
    ::kill(pid, SIGCONT); // a suspended process takes no signal before
}

bool ChildProcess::HasEnded(int* exitCode) {
    return IsRunning() && Wait(WNOHANG, exitCode);
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
