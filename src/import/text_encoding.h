#pragma once

#include <optional>
#include <string>
#include <string_view>

namespace ryn {

enum class TextEncoding { Utf8, Windows1252, Utf16LittleEndian, Utf16BigEndian };

/// "UTF-8", "Windows-1252", ...: the name a report shows.
std::string EncodingName(TextEncoding encoding);
/// An encoding by a usual name in any case ("utf-8", "latin-1", "iso-8859-1", "cp1252", "utf-16le",
/// ...); nothing for an unknown one. Latin-1 is read as Windows-1252, which differs only where
/// Latin-1 has control characters.
std::optional<TextEncoding> EncodingOfName(std::string_view name);

/// The encoding that the first bytes of a text suggest: a byte order mark decides; else UTF-16
/// where every other byte is zero, Windows-1252 where the bytes are not valid UTF-8, UTF-8
/// otherwise. A sequence that the end of `start` cuts is not held against UTF-8.
TextEncoding GuessEncoding(std::string_view start);

/// Length of the byte order mark that `start` begins with, 0 when there is none.
std::size_t ByteOrderMarkSize(std::string_view start, TextEncoding encoding);

/// A text in UTF-8. Bytes that are not valid UTF-8 are taken as Windows-1252, and so is the whole
/// text when that is its encoding. UTF-16 has been converted when the text was read.
std::string ToUtf8(std::string_view text, TextEncoding encoding);

/// Converts UTF-16 in blocks. A unit or pair that a block cuts is kept for the next one.
class Utf16Decoder {
  public:
    explicit Utf16Decoder(TextEncoding encoding) : order(encoding) {}

    /// Appends the text of `bytes` as UTF-8. A lone surrogate becomes U+FFFD.
    void Decode(std::string_view bytes, std::string* text);

  private:
    void TakeUnit(unsigned unit, std::string* text);

    TextEncoding order;
    std::optional<unsigned char> oddByte;
    unsigned highSurrogate = 0;
};

} // namespace ryn
