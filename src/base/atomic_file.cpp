#include "base/atomic_file.h"

#include <cerrno>
#include <cstdlib>
#include <fcntl.h>
#include <filesystem>
#include <sys/stat.h>
#include <unistd.h>

#include "base/path_parts.h"

namespace ryn {

namespace {

/// Follows links, also one whose file does not exist yet, at most 40 deep as the system does.
Status ResolveLinks(std::string* path) {
    std::filesystem::path current(*path);
    for (int depth = 0; depth < 40; ++depth) {
        std::error_code error;
        if (!std::filesystem::is_symlink(current, error)) {
            *path = current.string();
            return Status::Ok();
        }
        const std::filesystem::path next = std::filesystem::read_symlink(current, error);
        if (error)
            return Status::SystemFault(current.string() + ": " + error.message());
        current = next.is_absolute() ? next : current.parent_path() / next;
    }
    return Status::FromErrno(*path, ELOOP);
}

mode_t NewFileMode() {
    const mode_t mask = ::umask(0);
    ::umask(mask);
    return static_cast<mode_t>(0666) & ~mask;
}

Status FlushDirectory(const std::string& directory) {
    const int fd = ::open(directory.empty() ? "." : directory.c_str(), O_RDONLY | O_CLOEXEC);
    if (fd < 0)
        return Status::Ok(); // a directory that may be written but not read cannot be flushed
    ::fsync(fd);             // some file systems refuse this for directories; the data are safe
    ::close(fd);
    return Status::Ok();
}

} // namespace

AtomicFile::~AtomicFile() {
    Discard();
}

Status AtomicFile::Open(const std::string& path) {
    Discard();
    std::string resolved = path;
    if (Status status = ResolveLinks(&resolved); !status)
        return status;
    mode_t mode = NewFileMode();
    struct stat info {};
    if (::stat(resolved.c_str(), &info) == 0) {
        if (!S_ISREG(info.st_mode))
            return Status::SystemFault(path + ": not a regular file");
        if (::access(resolved.c_str(), W_OK) != 0)
            return Status::FromErrno(path, errno); // renaming would pass over a write protection
        mode = info.st_mode & 07777;
    }
    const PathParts parts = SplitPath(resolved);
    // The name is cut so that the temporary one stays below the system's 255 bytes.
    std::string name =
        parts.directory + "." + (parts.name + parts.extension).substr(0, 200) + ".XXXXXX";
    const int fd = ::mkostemp(name.data(), O_CLOEXEC);
    if (fd < 0)
        return Status::FromErrno(path, errno);
    temporary = name;
    target = resolved;
    writeError = 0;
    ::fchmod(fd, mode);
    stream.reset(::fdopen(fd, "wb"));
    if (!stream) {
        const int error = errno;
        ::close(fd);
        Discard();
        return Status::FromErrno(path, error);
    }
    return Status::Ok();
}

void AtomicFile::Write(std::string_view bytes) {
    if (!stream || writeError != 0 || bytes.empty())
        return;
    if (std::fwrite(bytes.data(), 1, bytes.size(), stream.get()) != bytes.size())
        writeError = errno;
}

Status AtomicFile::Commit(Durability durability) {
    if (!stream)
        return Status::SystemFault("no file is open");
    if (writeError == 0 && std::fflush(stream.get()) != 0)
        writeError = errno;
    if (writeError == 0 && durability == Durability::Flushed &&
        ::fsync(::fileno(stream.get())) != 0)
        writeError = errno;
    std::FILE* const raw = stream.release();
    if (std::fclose(raw) != 0 && writeError == 0)
        writeError = errno;
    if (writeError == 0 && std::rename(temporary.c_str(), target.c_str()) != 0)
        writeError = errno;
    if (writeError != 0) {
        const std::string name = target;
        const int error = writeError;
        Discard();
        return Status::FromErrno(name, error);
    }
    temporary.clear();
    return durability == Durability::Flushed ? FlushDirectory(SplitPath(target).directory)
                                             : Status::Ok();
}

void AtomicFile::Discard() {
    stream.reset();
    if (!temporary.empty())
        ::unlink(temporary.c_str());
    temporary.clear();
}

Status WriteFileAtomically(const std::string& path, std::string_view content,
                           Durability durability) {
    AtomicFile file;
    if (Status status = file.Open(path); !status)
        return status;
    file.Write(content);
    return file.Commit(durability);
}

} // namespace ryn
