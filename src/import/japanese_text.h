#pragma once

#include <string_view>

namespace ryn {

/// Whether bytes are valid in an encoding and hold Japanese characters in common use. The same
/// bytes are valid in others too, so that rare characters and single ones, which accents and
/// typographic quotes of Windows-1252 look like, prove nothing. The end may cut a character.
bool LooksLikeShiftJis(std::string_view text);
bool LooksLikeEucJp(std::string_view text);

} // namespace ryn
