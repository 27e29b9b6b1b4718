#include "base/file_access.h"

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
    // Not blocking: a named pipe without a writer would hang the open.
    const Descriptor file(::open(path.c_str(), O_RDONLY | O_CLOEXEC | O_NONBLOCK));
    return file.IsOpen() && !IsDirectory(file.Get());
}

Status EmptyFile(const std::string& path) {
    const Descriptor file(
        ::open(path.c_str(), O_WRONLY | O_CREAT | O_TRUNC | O_CLOEXEC | O_NONBLOCK, 0666));
    return file.IsOpen() ? Status::Ok() : Status::FromErrno(path, errno);
}

bool IsSameFile(const std::string& a, const std::string& b) {
    std::error_code error;
    return std::filesystem::equivalent(a, b, error) && !error;
}

Status ReadWholeFile(const std::string& path, std::size_t limit, std::string* content) {
    const Descriptor file(::open(path.c_str(), O_RDONLY | O_CLOEXEC));
    if (!file.IsOpen())
        return Status::FromErrno(path, errno);
    if (IsDirectory(file.Get()))
        return Status::FromErrno(path, EISDIR);
    std::string text;
    struct stat info {};
    if (::fstat(file.Get(), &info) == 0 && info.st_size > 0)
        text.reserve(std::min(static_cast<std::size_t>(info.st_size), limit) + 1);
    constexpr std::size_t kBlock = 1 << 20;
    for (;;) {
        const std::size_t before = text.size();
        text.resize(before + kBlock);
        const ssize_t got = ::read(file.Get(), text.data() + before, kBlock);
        if (got < 0 && errno == EINTR) {
            text.resize(before);
            continue;
        }
        if (got < 0)
            return Status::FromErrno(path, errno);
        text.resize(before + static_cast<std::size_t>(got));
        if (got == 0)
            break;
        if (text.size() > limit)
            return Status::InputFault(path + ": the file is larger than " + std::to_string(limit) +
                                      " bytes");
    }
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
