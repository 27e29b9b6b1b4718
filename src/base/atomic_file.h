#pragma once

#include <cstdio>
#include <memory>
#include <string>
#include <string_view>

#include "base/status.h"
#include "base/temporary_mark.h"

namespace ryn {

/// Whether a finished file is flushed to the disk before it takes its name.
enum class Durability {
    Flushed,   ///< a save that a person asked for: survives a power cut
    Unflushed, ///< files that the next step overwrites
};

/// A file that is written beside its target and renamed over it when it is complete, so that a
/// reader, or a kill at any moment, sees the old file or the new one. A link is followed to its
/// file. A target that exists and is no regular file is refused. An existing target's permissions
/// are kept.
///
/// Without Commit the destructor removes what was written, and so does a signal once
/// RemoveTemporariesOnSignals was called. A kill leaves a hidden file ".NAME.XXXXXX" beside the
/// target.
class AtomicFile {
  public:
    AtomicFile() = default;
    ~AtomicFile();
    AtomicFile(const AtomicFile&) = delete;
    AtomicFile& operator=(const AtomicFile&) = delete;

    Status Open(const std::string& target);
    /// The name of the file being written, for a library that opens it by itself. Empty when
    /// closed.
    const std::string& TemporaryName() const { return temporary; }
    /// Appends; buffered. An error is remembered and reported by Commit.
    void Write(std::string_view bytes);
    /// Closes, flushes as asked, and renames over the target. On failure the target is as it was
    /// and the temporary file is gone.
    Status Commit(Durability durability);

  private:
    struct CloseStream {
        void operator()(std::FILE* file) const { std::fclose(file); }
    };

    /// The descriptor, or -1 with errno.
    int MakeTemporary(const std::string& besideThis);
    void Discard();

    std::string target;    // after following links
    std::string temporary; // beside it
    TemporaryMark mark;    // of the temporary file
    std::unique_ptr<std::FILE, CloseStream> stream;
    int writeError = 0;
};

/// Whether a file could be written in this way: it is a regular one or does not exist, and another
/// can be made beside it. Leaves everything as it is.
Status TestAtomicWrite(const std::string& path);

/// Writes a whole file through AtomicFile.
Status WriteFileAtomically(const std::string& path, std::string_view content,
                           Durability durability);

} // namespace ryn
