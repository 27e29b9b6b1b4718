#pragma once

#include <optional>
#include <string>
#include <string_view>

namespace ryn {

enum class TextEncoding {
    Utf8,
    Windows1252,
    Utf16LittleEndian,
    Utf16BigEndian,
    ShiftJis, ///< with the characters that Windows adds (code page 932)
    EucJp,
};

/// "UTF-8", "Windows-1252", ...: the name a report shows.
std::string EncodingName(TextEncoding encoding);
/// An encoding by a usual name in any case ("utf-8", "latin-1", "iso-8859-1", "cp1252", "utf-16le",
/// "shift_jis", "cp932", "euc-jp", ...); nothing for an unknown one. Latin-1 is read as
/// Windows-1252, which differs only where Latin-1 has control characters.
std::optional<TextEncoding> EncodingOfName(std::string_view name);

/// The encoding that the first bytes of a text suggest: a byte order mark decides; else UTF-16
/// where every other byte is zero, UTF-8 where the bytes are valid UTF-8; EUC-JP or Shift_JIS where
/// they are valid so and make Japanese words, Windows-1252 otherwise. A sequence that the end of
/// `start` cuts is not held against UTF-8.
TextEncoding GuessEncoding(std::string_view start);

/// Length of the byte order mark that `start` begins with, 0 when there is none.
std::size_t ByteOrderMarkSize(std::string_view start, TextEncoding encoding);

/// A text in UTF-8. Bytes that are not valid UTF-8 are taken as Windows-1252, and so is the whole
/// text when that is its encoding. Encodings with a decoder have been converted when the
/// text was read.
std::string ToUtf8(std::string_view text, TextEncoding encoding);

/// Appends a character by its number.
void AppendUtf8(unsigned code, std::string* text);

} // namespace ryn
