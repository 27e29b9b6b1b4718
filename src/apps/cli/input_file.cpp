#include "apps/cli/input_file.h"

#include <cerrno>
#include <fcntl.h>
#include <filesystem>
#include <fstream>
#include <string_view>
#include <sys/stat.h>
#include <unistd.h>

#include "strings/catalogue.h"

namespace ryn::cli {

namespace {

bool IsUsersFault(int error) {
    return error == ENOENT || error == ENOTDIR || error == ELOOP || error == ENAMETOOLONG;
}

Status NotRegular(const std::string& path) {
    return Status::InputFault(FormatText(kTextCliNotRegular, path));
}

} // namespace

Status TestReadable(const std::string& path) {
    // Not blocking: a named pipe without a writer would hang the open.
    const int fd = ::open(path.c_str(), O_RDONLY | O_CLOEXEC | O_NONBLOCK);
    if (fd < 0) {
        const Status reason = Status::FromErrno(path, errno);
        return IsUsersFault(errno) ? Status::InputFault(reason.Text()) : reason;
    }
    struct stat info {};
    const bool regular = ::fstat(fd, &info) == 0 && S_ISREG(info.st_mode);
    ::close(fd);
    return regular ? Status::Ok() : NotRegular(path);
}

Status TestReplaceable(const std::string& path, Consent consent) {
    std::error_code error;
    const std::filesystem::file_status found = std::filesystem::status(path, error);
    if (!std::filesystem::exists(found))
        return Status::Ok();
    if (!std::filesystem::is_regular_file(found))
        return Status::SystemFault(NotRegular(path).Text());
    return consent == Consent::Given ? Status::Ok()
                                     : Status::InputFault(FormatText(kTextCliExists, path));
}

FileKind KindOfFile(const std::string& path) {
    std::ifstream file(path, std::ios::binary);
    std::string start(4, '\0');
    file.read(start.data(), static_cast<std::streamsize>(start.size()));
    const bool isClassic = start.compare(0, 3, "CDF") == 0;
    const bool isHdf = start == "\x89HDF";
    return isClassic || isHdf ? FileKind::DataFile : FileKind::ParameterTree;
}

} // namespace ryn::cli
