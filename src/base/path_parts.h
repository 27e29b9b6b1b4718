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

/// The absolute form of a name, taken against the current directory, "." and ".." resolved without
/// looking at the disk; of any length. An empty name stays empty.
std::string FullPath(const std::string& name);

/// A directory with its trailing separator; empty stays empty.
std::string WithTrailingSeparator(std::string directory);

} // namespace ryn
