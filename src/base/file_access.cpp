#include "base/file_access.h"

#include <algorithm>
#include <cerrno>
#include <fcntl.h>
#include <filesystem>
#include <sys/stat.h>
#include <system_error>
#include <unistd.h>

namespace ryn {

namespace {

/// A file descriptor that closes itself.
class Descriptor {
  public:
    explicit Descriptor(int number) : fd(number) {}
    ~Descriptor() {
        if (fd >= 0)
            ::close(fd);
    }
    Descriptor(const Descriptor&) = delete;
    Descriptor& operator=(const Descriptor&) = delete;
    int Get() const { return fd; }
    bool IsOpen() const { return fd >= 0; }

  private:
    int fd;
};

bool IsDirectory(int fd) {
    struct stat info {};
    return ::fstat(fd, &info) == 0 && S_ISDIR(info.st_mode);
}

} // namespace

bool CanOpenForReading(const std::string& path) {
    if (path.find('\0') != std::string::npos) // the system would see another, shorter name
        return false;
    // Not blocking: a named pipe without a writer would hang the open.
    const Descriptor file(::open(path.c_str(), O_RDONLY | O_CLOEXEC | O_NONBLOCK));
    return file.IsOpen() && !IsDirectory(file.Get());
}

Status EmptyFile(const std::string& path) {
    if (path.find('\0') != std::string::npos)
        return Status::FromErrno(path, EINVAL);
    const Descriptor file(
        ::open(path.c_str(), O_WRONLY | O_CREAT | O_TRUNC | O_CLOEXEC | O_NONBLOCK, 0666));
    return file.IsOpen() ? Status::Ok() : Status::FromErrno(path, errno);
}

bool IsSameFile(const std::string& a, const std::string& b) {
    std::error_code error;
    return std::filesystem::equivalent(a, b, error) && !error;
}

Status ReadWholeFile(const std::string& path, std::size_t limit, std::string* content) {
    // Not blocking, as a named pipe without a writer would: it reads as an empty file.
    const Descriptor file(::open(path.c_str(), O_RDONLY | O_CLOEXEC | O_NONBLOCK));
    if (!file.IsOpen())
        return Status::FromErrno(path, errno);
    struct stat info {};
    if (::fstat(file.Get(), &info) != 0)
        return Status::FromErrno(path, errno);
    if (S_ISDIR(info.st_mode))
        return Status::FromErrno(path, EISDIR);
    // One byte more than the file has, to see its end; a file that tells no size grows from there.
    std::string text(std::min(static_cast<std::size_t>(info.st_size), limit) + 1, '\0');
    std::size_t used = 0;
    for (;;) {
        const ssize_t got = ::read(file.Get(), text.data() + used, text.size() - used);
        if (got < 0 && errno == EINTR)
            continue;
        if (got < 0)
            return Status::FromErrno(path, errno);
        if (got == 0)
            break;
        used += static_cast<std::size_t>(got);
        if (used > limit)
            return Status::InputFault(path + ": the file is larger than " + std::to_string(limit) +
                                      " bytes");
        if (used == text.size())
            text.resize(std::max<std::size_t>(2 * used, 4096));
    }
    text.resize(used);
    *content = std::move(text);
    return Status::Ok();
}

CurrentDirectoryScope::CurrentDirectoryScope(const std::string& directory) {
    std::error_code error;
    previous = std::filesystem::current_path(error).string();
    (void)SetCurrentDirectory(directory);
}

CurrentDirectoryScope::~CurrentDirectoryScope() {
    (void)SetCurrentDirectory(previous);
}

Status SetCurrentDirectory(const std::string& directory) {
    if (directory.empty())
        return Status::Ok();
    std::error_code error;
    std::filesystem::current_path(directory, error);
    return error ? Status::SystemFault(directory + ": " + error.message()) : Status::Ok();
}

} // namespace ryn
