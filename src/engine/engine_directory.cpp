#include "engine/engine_directory.h"

#include <cstddef>

#include "base/path_parts.h"

namespace ryn {

std::string EngineDirectory(const KvfTree* tree) {
    constexpr std::size_t kLongest = 4096;
    const KvfSection* const target = kvfTargetByNameNum(tree, "RynEditor", 1);
    const KvfSection* const section = kvfSectionByNameNum(target, "DefineEVS", 1);
    std::string name;
    kvfGetParam(section, "OutputFileName", &name, 1, 1);
    // What follows a zero byte would be cut off by the system, and files written elsewhere.
    if (name.size() > kLongest || name.find('\0') != std::string::npos)
        return {};
    // Absolute from here on, since the current directory belongs to the process and may move.
    return SplitPath(FullPath(name)).directory;
}

} // namespace ryn
