#pragma once

#include <cstddef>
#include <optional>
#include <string_view>

namespace ryn::cli {

/// Bytes as users write them: "800M", "2G", "1.5G", "4096"; K, M, G and T are powers of 1024, with
/// or without "B" or "iB" behind them, in any case. Nothing for anything else, for less than one
/// byte, and for more than 2^60.
std::optional<std::size_t> ParseSize(std::string_view text);

} // namespace ryn::cli
