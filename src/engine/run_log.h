#pragma once

#include <cstdio>
#include <memory>
#include <string>
#include <string_view>

namespace ryn {

/// The engine's log, "Ryn.log": plain text, one statement a line. Each line reaches the file when
/// it is written, so that the file tells how far a run came that ended early.
class RunLog {
  public:
    /// Begins the file anew in a directory (with its trailing separator). Without one, and where
    /// the file cannot be written or is no regular file, all lines are dropped.
    explicit RunLog(const std::string& directory);

    /// Whatever the text holds, it stays one line. Never throws but for want of memory.
    void Line(std::string_view text);
    /// "warning: TEXT"
    void Warning(const std::string& text);
    /// "error: TEXT"
    void Error(const std::string& text);
    /// A line that is told otherwise counts as a warning too.
    void NoteWarning() { warned = true; }
    bool HasWarnings() const { return warned; }

  private:
    struct CloseStream {
        void operator()(std::FILE* file) const { std::fclose(file); }
    };

    std::unique_ptr<std::FILE, CloseStream> stream;
    bool warned = false;
};

/// The first line of each log: the program's name and version.
std::string ProgramText();

/// Local date and time, the one line that differs between two runs.
std::string NowText();

} // namespace ryn
