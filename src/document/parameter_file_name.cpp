#include "document/parameter_file_name.h"

#include <filesystem>
#include <system_error>

#include "base/file_access.h"
#include "base/path_parts.h"

namespace ryn {

namespace {

constexpr const char* kUpper = ".RYN";
constexpr const char* kLower = ".ryn";

bool Exists(const std::string& path) {
    std::error_code error;
    return std::filesystem::exists(path, error);
}

Status Rename(const std::string& from, const std::string& to) {
    std::error_code error;
    std::filesystem::rename(from, to, error);
    return error
               ? Status::SystemFault(from + ": cannot be renamed to " + to + ": " + error.message())
               : Status::Ok();
}

} // namespace

bool IsParameterFileName(const std::string& path) {
    const std::string extension = SplitPath(path).extension;
    return extension == kUpper || extension == kLower;
}

std::string FindParameterFile(const std::string& path) {
    if (Exists(path))
        return path;
    const PathParts parts = SplitPath(path);
    const std::string other =
        parts.directory + parts.name + (parts.extension == kUpper ? kLower : kUpper);
    return Exists(other) ? other : path;
}

std::string SavedParameterFileName(const std::string& path, const std::string& extension) {
    const PathParts parts = SplitPath(path);
    return parts.directory + parts.name + "." + extension;
}

Status SettleSpelling(const std::string& openedName, const std::string& askedName,
                      const std::string& savedName) {
    const PathParts parts = SplitPath(savedName);
    const std::string lower = parts.directory + parts.name + kLower;
    if ((openedName != lower && askedName != lower) || !Exists(lower) ||
        IsSameFile(lower, savedName))
        return Status::Ok();
    if (Exists(savedName))
        return Status::SystemFault(savedName + ": not saved, since " + lower +
                                   " exists too and they are two files; remove one of them");
    return Rename(lower, savedName);
}

Status KeepBrokenFile(const std::string& path) {
    std::error_code error;
    if (!std::filesystem::is_regular_file(path, error)) // the save will say what it is
        return Status::Ok();
    std::string kept = path + ".broken";
    for (int number = 2; Exists(kept); ++number)
        kept = path + ".broken" + std::to_string(number);
    // A second name for the file, so that the first one is never without a file; a copy where the
    // name is a link or the file system has no second names.
    if (!std::filesystem::is_symlink(path, error)) {
        std::filesystem::create_hard_link(path, kept, error);
        if (!error)
            return Status::Ok();
    }
    std::filesystem::copy_file(path, kept, error);
    return error
               ? Status::SystemFault(path + ": cannot be kept as " + kept + ": " + error.message())
               : Status::Ok();
}

} // namespace ryn
