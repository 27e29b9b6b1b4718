#pragma once

#include <memory>
#include <mutex>
#include <set>
#include <string>
#include <unordered_map>

#include "base/path_parts.h"
#include "base/status.h"
#include "tsq/records.h"
#include "tsq/step_source.h"

namespace ryn {

/// The data files of this process that exist in memory alone, by their absolute path. For use by
/// any thread. A file that is being read stays until its reader is gone, also when it is removed or
/// replaced meanwhile.
class MemoryStore {
  public:
    using File = std::shared_ptr<const TsqContent>;

    static MemoryStore& Instance();

    void AddDirectory(const std::string& directory);
    /// Removes its files too when it was added no second time.
    void RemoveDirectory(const std::string& directory);
    /// True when files directly in the path's directory live in memory. The path is absolute.
    bool Covers(const std::string& path);
    /// The absolute path of a data file. One in memory is known by its text alone, without asking
    /// the disk for links on its way.
    std::string AbsolutePath(const std::string& path) {
        return Covers(path) ? path : FullPath(path);
    }

    Status Put(const std::string& path, TsqContent content);
    Status Put(const std::string& path, File file);
    /// Null when there is none.
    File Find(const std::string& path);
    bool Remove(const std::string& path);
    std::size_t SizeOf(const std::string& directory);

  private:
    std::mutex mutex;
    std::multiset<std::string, std::less<>> directories; // with a trailing separator
    std::unordered_map<std::string, File> files;
};

/// The numbers where they are, not copied.
std::unique_ptr<StepSource> SourceInMemory(MemoryStore::File file);

} // namespace ryn
