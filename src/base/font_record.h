#pragma once

#include <cstdint>
#include <string>

namespace ryn {

/// A font as it is chosen, kept and given to a control. Result files keep height, face, family and
/// character set; the rest lives as long as the document.
struct FontRecord {
    /// The longest face name, in characters.
    static constexpr std::size_t kMaxFaceLength = 31;

    int height = 0; ///< pixels; negative: of the characters, positive: of the line; 0: the default
    int width = 0;
    int escapement = 0;  ///< tenths of a degree
    int orientation = 0; ///< tenths of a degree
    int weight = 0;      ///< 0 for whatever is usual, 400 normal, 700 bold
    bool italic = false;
    bool underline = false;
    bool strikeOut = false;
    std::uint8_t charSet = 0;
    std::uint8_t outPrecision = 0;
    std::uint8_t clipPrecision = 0;
    std::uint8_t quality = 0;
    std::uint8_t pitchAndFamily = 0;
    std::string faceName; ///< UTF-8

    bool operator==(const FontRecord&) const = default;
};

/// `name` cut to the characters that a face name can hold, never within one.
std::string FaceName(const std::string& name);

} // namespace ryn
