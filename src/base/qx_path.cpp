#include "base/qx_path.h"

#include <filesystem>
#include <utility>

#include "base/path_parts.h"

namespace ryn {

CQxPath::CQxPath(std::string name) : fileName(std::move(name)) {}

void CQxPath::SetFileName(std::string name) {
    fileName = std::move(name);
}

std::string CQxPath::GetDirectoryName() const {
    return SplitPath(fileName).directory;
}

std::string CQxPath::GetFileNameRelativeTo(const std::string& baseDirectory) const {
    const std::filesystem::path path(fileName);
    if (fileName.empty() || baseDirectory.empty() || path.is_relative())
        return fileName;
    // As a directory name, so that the base itself is followed where it is a link.
    const std::filesystem::path base(FullPath(WithTrailingSeparator(baseDirectory)));
    const std::filesystem::path relative =
        std::filesystem::path(FullPath(fileName)).lexically_relative(base);
    return relative.empty() ? fileName : relative.string();
}

} // namespace ryn
