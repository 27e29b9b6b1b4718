#include "import/text_source.h"

#include <algorithm>
#include <cerrno>
#include <cstring>
#include <filesystem>
#include <system_error>

namespace ryn {

Status FileSource::Open(const std::string& path, std::unique_ptr<TextSource>* source) {
    // Asked before it is opened: the open of a named pipe without a writer would hang.
    std::error_code error;
    const std::filesystem::file_status status = std::filesystem::status(path, error);
    if (error)
        return Status::FromErrno(path, error.value());
    if (std::filesystem::is_directory(status))
        return Status::InputFault(path + ": is a directory, not a table");
    // A pipe cannot be read again for its rows once its head has been looked at.
    if (!std::filesystem::is_regular_file(status))
        return Status::InputFault(path + ": is no regular file; a table is read twice");
    auto opened = std::make_unique<FileSource>();
    opened->path = path;
    opened->file.reset(std::fopen(path.c_str(), "rbe"));
    if (!opened->file)
        return Status::FromErrno(path, errno);
    std::setvbuf(opened->file.get(), nullptr, _IONBF, 0); // readers ask for large blocks
    *source = std::move(opened);
    return Status::Ok();
}

Status FileSource::Read(char* buffer, std::size_t size, std::size_t* got) {
    *got = std::fread(buffer, 1, size, file.get());
    if (*got == 0 && std::ferror(file.get()) != 0)
        return Status::FromErrno(path, errno);
    return Status::Ok();
}

Status FileSource::Rewind() {
    if (std::fseek(file.get(), 0, SEEK_SET) != 0)
        return Status::FromErrno(path, errno);
    return Status::Ok();
}

Status MemorySource::Read(char* buffer, std::size_t size, std::size_t* got) {
    *got = std::min(size, text.size() - position);
    if (*got > 0)
        std::memcpy(buffer, text.data() + position, *got);
    position += *got;
    return Status::Ok();
}

Status MemorySource::Rewind() {
    position = 0;
    return Status::Ok();
}

} // namespace ryn
