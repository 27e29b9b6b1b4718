#pragma once

#include <string>
#include <string_view>

#include "base/atomic_file.h"

namespace ryn {

/// One of the engine's reports, written piece by piece as the analysis goes on and put in place of
/// the last run's at its end. A file that cannot be written is passed over.
class ReportFile {
  public:
    /// In a directory with its trailing separator; an empty one means no file.
    ReportFile(const std::string& directory, const std::string& name);

    /// Whether there is a file to write; a long text need not be made otherwise.
    bool IsWanted() const { return wanted; }
    void Write(std::string_view text);
    /// The reason why there is no new file; Ok also where none was wanted.
    Status Finish();

  private:
    AtomicFile file;
    Status opened;
    bool wanted;
};

} // namespace ryn
