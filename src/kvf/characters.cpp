#include "kvf/characters.h"

#include <charconv>
#include <system_error>

namespace ryn {

namespace {

/// A range of first bytes: the range of the character's second byte and its length. The ranges of
/// well-formed sequences are table 3-7 of the Unicode standard.
struct Lead {
    unsigned char first, last;
    unsigned char secondFirst, secondLast;
    std::size_t length;
};

constexpr Lead kLeads[] = {
    {0xC2, 0xDF, 0x80, 0xBF, 2}, {0xE0, 0xE0, 0xA0, 0xBF, 3}, {0xE1, 0xEC, 0x80, 0xBF, 3},
    {0xED, 0xED, 0x80, 0x9F, 3}, {0xEE, 0xEF, 0x80, 0xBF, 3}, {0xF0, 0xF0, 0x90, 0xBF, 4},
    {0xF1, 0xF3, 0x80, 0xBF, 4}, {0xF4, 0xF4, 0x80, 0x8F, 4},
};

bool IsBetween(char byte, unsigned char first, unsigned char last) {
    return static_cast<unsigned char>(byte) >= first && static_cast<unsigned char>(byte) <= last;
}

bool FitsLead(std::string_view text, const Lead& lead) {
    if (text.size() < lead.length)
        return false;
    if (!IsBetween(text[1], lead.secondFirst, lead.secondLast))
        return false;
    for (std::size_t i = 2; i < lead.length; ++i)
        if (!IsBetween(text[i], 0x80, 0xBF))
            return false;
    return true;
}

} // namespace

std::size_t KvfUtf8Length(std::string_view text, std::size_t position) {
    if (static_cast<unsigned char>(text[position]) < 0x80)
        return 1; // nearly always
    text.remove_prefix(position);
    for (const Lead& lead : kLeads)
        if (IsBetween(text[0], lead.first, lead.last))
            return FitsLead(text, lead) ? lead.length : 0;
    return 0;
}

std::string KvfHexByte(char byte) {
    constexpr std::string_view kDigits = "0123456789ABCDEF";
    const auto value = static_cast<unsigned char>(byte);
    return {kDigits[value / 16], kDigits[value % 16]};
}

std::optional<char> KvfByteFromHex(std::string_view digits) {
    unsigned char value = 0;
    const char* const end = digits.data() + digits.size();
    const auto [stop, error] = std::from_chars(digits.data(), end, value, 16);
    if (digits.size() != 2 || stop != end || error != std::errc())
        return std::nullopt;
    return static_cast<char>(value);
}

} // namespace ryn
