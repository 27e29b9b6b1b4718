#pragma once

#include <optional>
#include <string_view>

#include "kvf/kvf.h"
#include "kvf/scanner.h"

namespace ryn {

/// Reads a text into an empty tree; docs/formats/kvf.md. After an error the tree holds what stood
/// before it.
std::optional<KvfSyntaxError> KvfReadText(std::string_view text, KvfTree* tree);

} // namespace ryn
