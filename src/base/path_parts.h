#pragma once

#include <string>
#include <string_view>

namespace ryn {

/// The parts of a file name. Put together in this order they are the name again.
struct PathParts {
    std::string directory; ///< with its trailing separator; empty when the name has none
    std::string name;      ///< without directory and extension
    std::string extension; ///< with its point; empty when there is none. ".ryn" alone is a name
};

PathParts SplitPath(std::string_view path);

/// The absolute form of a name, taken against `baseDirectory` or, where that is empty, the current
/// directory; of any length. Links on the way are followed, as far as the directories exist, so
/// that
/// ".." leads where the system leads; a link that the name itself is stays. An empty name stays
/// empty.
std::string FullPath(const std::string& name, const std::string& baseDirectory = {});

/// A directory with its trailing separator; empty stays empty.
std::string WithTrailingSeparator(std::string directory);

} // namespace ryn
