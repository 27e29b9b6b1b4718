#pragma once

#include <csignal>
#include <string>

namespace ryn {

/// Remembers, while it lives, the name of a temporary file that a signal is to take away. Marks
/// are kept in a table of fixed size that a signal handler can read; a file that finds no room
/// there, or whose name is longer than the system takes, is made without.
class TemporaryMark {
  public:
    TemporaryMark() = default;
    ~TemporaryMark() { Clear(); }
    TemporaryMark(const TemporaryMark&) = delete;
    TemporaryMark& operator=(const TemporaryMark&) = delete;

    /// In place of what was marked before. The name may be relative; the mark is not.
    void Set(const std::string& path);
    void Clear();

  private:
    int slot = -1;
};

/// Lets SIGINT, SIGTERM and SIGHUP remove the marked files before they end the process as ever. A
/// signal that the process ignores stays ignored.
void RemoveTemporariesOnSignals();

/// Holds these signals back from the calling thread while it lives, so that none comes between
/// making a file and marking it.
class SignalsHeld {
  public:
    SignalsHeld();
    ~SignalsHeld();
    SignalsHeld(const SignalsHeld&) = delete;
    SignalsHeld& operator=(const SignalsHeld&) = delete;

  private:
    sigset_t before{};
};

} // namespace ryn
