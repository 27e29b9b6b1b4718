#pragma once

#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "apps/cli/settings.h"

namespace ryn::cli {

/// Reads a value by the member's type and stores it. False, with the member as it was, when the
/// text is none. Relative file names count from `callerDirectory`.
bool SetValue(const Setting& setting, std::string_view text, const std::string& callerDirectory);

/// What a member takes, for an error's text.
std::string ExpectedValue(const Setting& setting);

/// The member's value as SetValue takes it.
std::string ValueText(const Setting& setting);

/// "2,10,100" as numbers, all finite; nothing when one is none. An empty text is an empty list.
std::optional<std::vector<double>> ParseNumberList(std::string_view text);

/// `name` as seen from `directory`, absolute; an empty name stays empty.
std::string AbsoluteName(const std::string& name, const std::string& directory);

} // namespace ryn::cli
