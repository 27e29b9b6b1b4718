#include "tsq/memory_store.h"

#include <string_view>
#include <utility>

#include "base/path_parts.h"
#include "tsq/tsq.h"

namespace ryn {

namespace {

std::string_view DirectoryOf(std::string_view path) {
    return path.substr(0, path.rfind('/') + 1);
}

std::size_t BytesOf(const TsqContent& content) {
    std::size_t bytes = sizeof(TsqContent) + content.times.size() * sizeof(double);
    for (const auto& values : content.values)
        bytes += values.size() * sizeof(float);
    return bytes;
}

class MemorySource : public StepSource {
  public:
    explicit MemorySource(MemoryStore::File from) : file(std::move(from)) {}

    Status LoadTimes(std::size_t /*step*/, StepBlock<double>* block) override {
        block->numbers = file->times.data();
        block->size = file->times.size();
        return Status::Ok();
    }
    Status LoadValues(std::size_t item, std::size_t /*step*/, StepBlock<float>* block) override {
        block->numbers = file->values[item].data();
        block->size = static_cast<std::size_t>(file->header.axis.count);
        block->width = file->header.items[item].cells;
        return Status::Ok();
    }
    Status CountMissing(std::size_t /*item*/, std::size_t* missing) override {
        *missing = 0;
        return Status::Ok();
    }

  private:
    MemoryStore::File file;
};

} // namespace

MemoryStore& MemoryStore::Instance() {
    static MemoryStore store;
    return store;
}

void MemoryStore::AddDirectory(const std::string& directory) {
    const std::lock_guard lock(mutex);
    directories.insert(directory);
}

void MemoryStore::RemoveDirectory(const std::string& directory) {
    const std::lock_guard lock(mutex);
    if (const auto found = directories.find(directory); found != directories.end())
        directories.erase(found);
    if (!directories.contains(directory))
        std::erase_if(files,
                      [&](const auto& entry) { return DirectoryOf(entry.first) == directory; });
}

bool MemoryStore::Covers(const std::string& path) {
    const std::lock_guard lock(mutex);
    return !directories.empty() && directories.contains(DirectoryOf(path));
}

Status MemoryStore::Put(const std::string& path, TsqContent content) {
    return Put(path, std::make_shared<const TsqContent>(std::move(content)));
}

// The directory may have gone between making a file and closing it; a file that nobody would remove
// must not be left.
Status MemoryStore::Put(const std::string& path, File file) {
    const std::lock_guard lock(mutex);
    if (!directories.contains(DirectoryOf(path)))
        return Status::SystemFault(path + ": the directory in memory is gone");
    files[path].swap(file); // the old file is freed by the caller, outside the lock
    return Status::Ok();
}

MemoryStore::File MemoryStore::Find(const std::string& path) {
    const std::lock_guard lock(mutex);
    const auto found = files.find(path);
    return found != files.end() ? found->second : nullptr;
}

bool MemoryStore::Remove(const std::string& path) {
    const std::lock_guard lock(mutex);
    return files.erase(path) != 0;
}

std::size_t MemoryStore::SizeOf(const std::string& directory) {
    const std::lock_guard lock(mutex);
    std::size_t bytes = 0;
    for (const auto& [path, file] : files)
        if (DirectoryOf(path) == directory)
            bytes += BytesOf(*file);
    return bytes;
}

std::unique_ptr<StepSource> SourceInMemory(MemoryStore::File file) {
    return std::make_unique<MemorySource>(std::move(file));
}

TsqMemoryDirectory::TsqMemoryDirectory(const std::string& path)
    : directory(WithTrailingSeparator(FullPath(path))) {
    MemoryStore::Instance().AddDirectory(directory);
}

TsqMemoryDirectory::~TsqMemoryDirectory() {
    MemoryStore::Instance().RemoveDirectory(directory);
}

bool TsqMemoryDirectory::Remove(const std::string& path) {
    const std::string full = MemoryStore::Instance().AbsolutePath(path);
    return DirectoryOf(full) == directory && MemoryStore::Instance().Remove(full);
}

std::size_t TsqMemoryDirectory::Size() const {
    return MemoryStore::Instance().SizeOf(directory);
}

} // namespace ryn
