#include "apps/cli/plain_text.h"

#include <array>
#include <cstdint>

namespace ryn::cli {

namespace {

bool IsControl(unsigned char c) {
    return c < 0x20 || c == 0x7f;
}

void AppendEscaped(std::string& line, unsigned char c) {
    constexpr std::string_view kDigits = "0123456789abcdef";
    line += "\\x";
    line += kDigits[c >> 4U];
    line += kDigits[c & 15U];
}

struct CodePoint {
    std::uint32_t value = 0;
    std::size_t length = 1;
};

/// The code point at the start of a text; a byte on its own where it is no valid sequence.
CodePoint FirstCodePoint(std::string_view text) {
    const auto byte = [text](std::size_t i) { return static_cast<unsigned char>(text[i]); };
    const unsigned char lead = byte(0);
    const std::size_t length = lead >= 0xf0 ? 4 : lead >= 0xe0 ? 3 : lead >= 0xc0 ? 2 : 1;
    if (length == 1 || text.size() < length)
        return {lead, 1};
    std::uint32_t value = lead & (0xffU >> (length + 1));
    for (std::size_t i = 1; i < length; ++i) {
        if ((byte(i) & 0xc0U) != 0x80U)
            return {lead, 1};
        value = value << 6U | (byte(i) & 0x3fU);
    }
    return {value, length};
}

bool IsWide(std::uint32_t codePoint) {
    struct Range {
        std::uint32_t first;
        std::uint32_t last;
    };
    constexpr std::array kWide = std::to_array<Range>({{0x1100, 0x115f},
                                                       {0x2e80, 0x303e},
                                                       {0x3041, 0xa4cf},
                                                       {0xac00, 0xd7a3},
                                                       {0xf900, 0xfaff},
                                                       {0xfe30, 0xfe6f},
                                                       {0xff01, 0xff60},
                                                       {0xffe0, 0xffe6},
                                                       {0x1f300, 0x1faff},
                                                       {0x20000, 0x3fffd}});
    for (const Range& range : kWide)
        if (codePoint >= range.first && codePoint <= range.last)
            return true;
    return false;
}

} // namespace

std::string PlainLine(std::string_view text) {
    while (!text.empty() && (text.back() == '\n' || text.back() == '\r'))
        text.remove_suffix(1);
    std::string line;
    line.reserve(text.size());
    for (const char c : text) {
        const auto byte = static_cast<unsigned char>(c);
        if (c == '\n' || c == '\r' || c == '\t')
            line += ' ';
        else if (IsControl(byte))
            AppendEscaped(line, byte);
        else
            line += c;
    }
    return line;
}

std::size_t DisplayWidth(std::string_view text) {
    std::size_t width = 0;
    while (!text.empty()) {
        const CodePoint next = FirstCodePoint(text);
        width += IsWide(next.value) ? 2 : 1;
        text.remove_prefix(next.length);
    }
    return width;
}

} // namespace ryn::cli
