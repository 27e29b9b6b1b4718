#include "base/atomic_file.h"

#include <cerrno>
#include <cstdlib>
#include <fcntl.h>
#include <filesystem>
#include <random>
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

/// Makes a new file ".NAME.XXXXXX" beside the target, by the process's mask of permissions.
int MakeBeside(const PathParts& parts, std::string* name) {
    constexpr std::string_view kLetters = "abcdefghijklmnopqrstuvwxyz0123456789";
    std::random_device random;
    for (int attempt = 0; attempt < 100; ++attempt) {
        // The name is cut so that the temporary one stays below the system's 255 bytes.
        *name = parts.directory + "." + (parts.name + parts.extension).substr(0, 200) + ".";
        for (int i = 0; i < 6; ++i)
            name->push_back(kLetters[random() % kLetters.size()]);
        const int fd = ::open(name->c_str(), O_RDWR | O_CREAT | O_EXCL | O_CLOEXEC, 0666);
        if (fd >= 0 || errno != EEXIST)
            return fd;
    }
    return -1;
}

/// Makes a rename last. A directory that may be written but not read cannot be flushed, and some
/// file systems refuse it; the data are safe either way.
void FlushDirectory(const std::string& directory) {
    const int fd = ::open(directory.empty() ? "." : directory.c_str(), O_RDONLY | O_CLOEXEC);
    if (fd < 0)
        return;
    ::fsync(fd);
    ::close(fd);
}

} // namespace

AtomicFile::~AtomicFile() {
    Discard();
}

Status AtomicFile::Open(const std::string& path) {
    Discard();
    if (path.empty())
        return Status::FromErrno("\"\"", ENOENT);
    if (path.find('\0') != std::string::npos) // the system would see another, shorter name
        return Status::FromErrno(path, EINVAL);
    std::string resolved = path;
    if (Status status = ResolveLinks(&resolved); !status)
        return status;
    struct stat info {};
    const bool replaces = ::stat(resolved.c_str(), &info) == 0;
    if (replaces && !S_ISREG(info.st_mode))
        return Status::SystemFault(path + ": not a regular file");
    if (replaces && ::access(resolved.c_str(), W_OK) != 0)
        return Status::FromErrno(path, errno); // renaming would pass over a write protection
    const int fd = MakeTemporary(resolved);
    if (fd < 0)
        return Status::FromErrno(path, errno);
    target = resolved;
    writeError = 0;
    if (replaces)
        ::fchmod(fd, info.st_mode & 07777);
    stream.reset(::fdopen(fd, "wb"));
    if (!stream) {
        const int error = errno;
        ::close(fd);
        Discard();
        return Status::FromErrno(path, error);
    }
    return Status::Ok();
}

int AtomicFile::MakeTemporary(const std::string& besideThis) {
    const SignalsHeld held;
    std::string name;
    const int fd = MakeBeside(SplitPath(besideThis), &name);
    if (fd < 0)
        return fd;
    temporary = name;
    mark.Set(name);
    return fd;
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
    mark.Clear();
    if (durability == Durability::Flushed)
        FlushDirectory(SplitPath(target).directory);
    return Status::Ok();
}

void AtomicFile::Discard() {
    stream.reset();
    if (!temporary.empty())
        ::unlink(temporary.c_str());
    temporary.clear();
    mark.Clear();
}

Status TestAtomicWrite(const std::string& path) {
    AtomicFile file;
    return file.Open(path);
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
