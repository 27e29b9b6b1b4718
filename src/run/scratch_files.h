#pragma once

#include <memory>
#include <string>
#include <utility>

#include "tsq/tsq.h"

namespace ryn {

/// Where a batch keeps the series of its points while it runs: in files of the temporary directory
/// or, under the same operations, in memory.
class ScratchFiles {
  public:
    /// In the directory of the environment's TMPDIR or, where that names none, in
    /// `otherDirectory`.
    static ScratchFiles OnDisk(const std::string& otherDirectory);
    /// In a new directory there, which goes with the object: for one of several processes.
    static ScratchFiles InOwnDirectory(const std::string& otherDirectory);
    static ScratchFiles InMemory(const std::string& otherDirectory);

    ~ScratchFiles();
    ScratchFiles(ScratchFiles&& other) = default;
    ScratchFiles(const ScratchFiles&) = delete;
    ScratchFiles& operator=(const ScratchFiles&) = delete;

    /// A name that no file has, made of "RYNTsq0_<point>_" and letters drawn at random; absolute,
    /// without extension.
    std::string NewName(int point) const;
    /// A file that is not there is no fault.
    void Remove(const std::string& path);

  private:
    explicit ScratchFiles(std::string where) : directory(std::move(where)) {}

    std::string directory; // with its trailing separator
    std::unique_ptr<TsqMemoryDirectory> memory;
    std::string ownDirectory;
};

} // namespace ryn
