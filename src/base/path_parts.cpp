#include "base/path_parts.h"

#include <filesystem>
#include <system_error>

namespace ryn {

PathParts SplitPath(std::string_view path) {
    PathParts parts;
    const std::size_t slash = path.rfind('/');
    const std::size_t start = slash == std::string_view::npos ? 0 : slash + 1;
    parts.directory = std::string(path.substr(0, start));
    const std::string_view file = path.substr(start);
    const std::size_t point = file.rfind('.');
    const bool hasExtension = point != std::string_view::npos && point != 0 && file != "..";
    parts.name = std::string(file.substr(0, hasExtension ? point : file.size()));
    if (hasExtension)
        parts.extension = std::string(file.substr(point));
    return parts;
}

std::string FullPath(const std::string& name, const std::string& baseDirectory) {
    if (name.empty())
        return name;
    std::error_code error;
    const std::filesystem::path absolute =
        std::filesystem::absolute(std::filesystem::path(baseDirectory) / name, error);
    if (error)
        return name;
    const std::filesystem::path last = absolute.filename();
    const bool isDirectoryName = last.empty() || last == "." || last == "..";
    const std::filesystem::path directory = isDirectoryName ? absolute : absolute.parent_path();
    std::filesystem::path real = std::filesystem::weakly_canonical(directory, error);
    if (error) // a loop of links, or a directory that may not be searched
        return absolute.lexically_normal().string();
    return (isDirectoryName ? real : real / last).string();
}

std::string WithTrailingSeparator(std::string directory) {
    if (!directory.empty() && directory.back() != '/')
        directory.push_back('/');
    return directory;
}

} // namespace ryn
