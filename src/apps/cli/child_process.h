#pragma once

#include <functional>
#include <string>
#include <sys/types.h>
#include <vector>

#include "base/status.h"

namespace ryn::cli {

/// A child process whose standard output and standard error are read through pipes. It is stopped
/// (SIGTERM) when its parent dies, and when the object goes while it runs.
class ChildProcess {
  public:
    ChildProcess() = default;
    ~ChildProcess();
    ChildProcess(ChildProcess&& other) noexcept;
    ChildProcess& operator=(ChildProcess&& other) noexcept;

    /// `arguments` without the program's name. A program that is not there ends with 127 and its
    /// reason on Errors(). Called by a thread that outlives the child, which takes that thread's
    /// end for the parent's.
    Status Start(const std::string& program, const std::vector<std::string>& arguments);

    bool IsRunning() const { return pid > 0; }
    int Output() const { return output; }
    int Errors() const { return errors; }
    /// Reads what there is at Output() or Errors() without waiting and appends it; false at its
    /// end.
    bool ReadOutput(std::string* text) { return Read(&output, text); }
    bool ReadErrors(std::string* text) { return Read(&errors, text); }
    void Stop() const;
    /// Whether it has ended, after which IsRunning is false: with the exit code, or 128 and the
    /// signal that ended it. What it wrote last can still be read.
    bool HasEnded(int* exitCode);

  private:
    static bool Read(int* descriptor, std::string* text);
    void Close();
    /// `options` as waitpid takes them.
    bool Wait(int options, int* exitCode);

    pid_t pid = -1;
    int output = -1; // read ends; -1 at their end
    int errors = -1;
};

} // namespace ryn::cli
