#pragma once

#include <optional>
#include <string_view>

#include "kvf/tree.h"

namespace ryn {

/// What a value without quotes means.
struct KvfWord {
    std::optional<KvfParam> value;
    /// For a word in the form of a number, what its type takes; without a value, it is beyond that.
    /// Empty for a word that is no number.
    std::string_view range;
};

/// Reads a number, true, false, inf or nan by its form; docs/formats/kvf.md.
KvfWord KvfReadWord(std::string_view word);

} // namespace ryn
