#pragma once

#include <cstddef>
#include <optional>
#include <string>
#include <string_view>

/// Characters as the text format sees them; nothing here looks at the process's locale.
namespace ryn {

/// ASCII letters and "_".
constexpr bool KvfIsLetter(char c) {
    return (c >= 'a' && c <= 'z') || (c >= 'A' && c <= 'Z') || c == '_';
}

constexpr bool KvfIsDigit(char c) {
    return c >= '0' && c <= '9';
}

constexpr bool KvfIsLetterOrDigit(char c) {
    return KvfIsLetter(c) || KvfIsDigit(c);
}

/// Codes 0 to 31 and 127.
constexpr bool KvfIsControl(char c) {
    return (c >= 0 && c < ' ') || c == '\x7F';
}

/// The length in bytes, 1 to 4, of the UTF-8 character that starts at `position`, which is inside
/// the text; 0 when there is none. Overlong forms, surrogates and codes above U+10FFFF are none.
std::size_t KvfUtf8Length(std::string_view text, std::size_t position);

/// Two hexadecimal digits, written in capitals and read in either case.
std::string KvfHexByte(char byte);
std::optional<char> KvfByteFromHex(std::string_view digits);

} // namespace ryn
