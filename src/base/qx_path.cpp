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
    const std::filesystem::path base(FullPath(baseDirectory));
    const std::filesystem::path relative = path.lexically_normal().lexically_relative(base);
    return relative.empty() ? fileName : relative.string();
}

} // namespace ryn
