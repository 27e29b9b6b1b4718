#pragma once

#include <string>
#include <string_view>
#include <vector>

namespace ryn::cli {

/// The names that a mistyped one was probably meant to be, nearest first, at most `most`. Distance
/// is the number of characters to change, put in or take out, without regard to case; a name that
/// contains the whole of what was typed counts as near. Nothing when no name is near.
std::vector<std::string> NearestNames(std::string_view typed, const std::vector<std::string>& names,
                                      std::size_t most = 3);

/// "a, b, c".
std::string JoinNames(const std::vector<std::string>& names);

} // namespace ryn::cli
