#include "import/text_encoding.h"

#include <algorithm>
#include <array>
#include <cstdint>

#include "import/japanese_text.h"
#include "import/table_text.h"

namespace ryn {

namespace {

// Windows-1252 from 0x80 to 0x9F; the five bytes it leaves open are read as U+FFFD.
constexpr std::array<std::uint16_t, 32> kWindows1252 = {
    0x20AC, 0xFFFD, 0x201A, 0x0192, 0x201E, 0x2026, 0x2020, 0x2021, 0x02C6, 0x2030, 0x0160,
    0x2039, 0x0152, 0xFFFD, 0x017D, 0xFFFD, 0xFFFD, 0x2018, 0x2019, 0x201C, 0x201D, 0x2022,
    0x2013, 0x2014, 0x02DC, 0x2122, 0x0161, 0x203A, 0x0153, 0xFFFD, 0x017E, 0x0178};

unsigned Byte(char c) {
    return static_cast<unsigned char>(c);
}

/// Of a UTF-8 sequence by its first byte; 0 for a byte that begins none.
std::size_t SequenceLength(unsigned lead) {
    if (lead < 0x80)
        return 1;
    // 0xC0 and 0xC1 begin only overlong forms, which are no UTF-8.
    if (lead >= 0xC2 && lead < 0xE0)
        return 2;
    if (lead >= 0xE0 && lead < 0xF0)
        return 3;
    return lead >= 0xF0 && lead < 0xF5 ? 4 : 0;
}

enum class Tail { MustBeWhole, MayBeCut };

bool IsUtf8(std::string_view text, Tail tail) {
    for (std::size_t i = 0; i < text.size();) {
        const std::size_t length = SequenceLength(Byte(text[i]));
        if (length == 0)
            return false;
        for (std::size_t k = 1; k < length; ++k) {
            if (i + k == text.size())
                return tail == Tail::MayBeCut;
            if ((Byte(text[i + k]) & 0xC0) != 0x80)
                return false;
        }
        i += length;
    }
    return true;
}

/// True where nearly every other byte, starting with the first or second, is zero and the others
/// are not: ASCII text in UTF-16.
bool ZerosAtEveryOther(std::string_view text, std::size_t first) {
    std::size_t zeros = 0;
    std::size_t others = 0;
    const std::size_t pairs = std::min<std::size_t>(text.size(), 4096) / 2;
    for (std::size_t i = 0; i < pairs; ++i) {
        zeros += text[2 * i + first] == '\0' ? 1 : 0;
        others += text[2 * i + 1 - first] == '\0' ? 1 : 0;
    }
    return pairs >= 4 && others == 0 && zeros * 10 >= pairs * 9;
}

} // namespace

void AppendUtf8(unsigned code, std::string* text) {
    const auto put = [text](unsigned byte) { text->push_back(static_cast<char>(byte)); };
    if (code < 0x80) {
        put(code);
    } else if (code < 0x800) {
        put(0xC0 | (code >> 6));
        put(0x80 | (code & 0x3F));
    } else if (code < 0x10000) {
        put(0xE0 | (code >> 12));
        put(0x80 | ((code >> 6) & 0x3F));
        put(0x80 | (code & 0x3F));
    } else {
        put(0xF0 | (code >> 18));
        put(0x80 | ((code >> 12) & 0x3F));
        put(0x80 | ((code >> 6) & 0x3F));
        put(0x80 | (code & 0x3F));
    }
}

std::string EncodingName(TextEncoding encoding) {
    switch (encoding) {
    case TextEncoding::Utf8:
        return "UTF-8";
    case TextEncoding::Windows1252:
        return "Windows-1252";
    case TextEncoding::Utf16LittleEndian:
        return "UTF-16LE";
    case TextEncoding::Utf16BigEndian:
        return "UTF-16BE";
    case TextEncoding::ShiftJis:
        return "Shift_JIS";
    case TextEncoding::EucJp:
        return "EUC-JP";
    }
    return {};
}

std::optional<TextEncoding> EncodingOfName(std::string_view name) {
    std::string key = Lowercase(name);
    // People write utf8, UTF-8, utf_8; "Latin 1" and "latin-1".
    key.erase(std::remove_if(key.begin(), key.end(),
                             [](char c) { return c == '-' || c == '_' || c == ' '; }),
              key.end());
    if (key == "utf8" || key == "ascii" || key == "utf8sig")
        return TextEncoding::Utf8;
    for (const char* known : {"latin1", "iso88591", "iso885915", "windows1252", "cp1252", "ansi"})
        if (key == known)
            return TextEncoding::Windows1252;
    if (key == "utf16le" || key == "utf16")
        return TextEncoding::Utf16LittleEndian;
    for (const char* known : {"shiftjis", "sjis", "cp932", "mskanji", "windows31j"})
        if (key == known)
            return TextEncoding::ShiftJis;
    if (key == "eucjp")
        return TextEncoding::EucJp;
    if (key == "utf16be")
        return TextEncoding::Utf16BigEndian;
    return std::nullopt;
}

TextEncoding GuessEncoding(std::string_view start) {
    if (start.substr(0, 2) == "\xFF\xFE")
        return TextEncoding::Utf16LittleEndian;
    if (start.substr(0, 2) == "\xFE\xFF")
        return TextEncoding::Utf16BigEndian;
    // Spreadsheets and loggers forget the mark at times.
    if (ZerosAtEveryOther(start, 1))
        return TextEncoding::Utf16LittleEndian;
    if (ZerosAtEveryOther(start, 0))
        return TextEncoding::Utf16BigEndian;
    // Text in another encoding with an accent in it is hardly ever valid UTF-8 by chance.
    if (IsUtf8(start, Tail::MayBeCut))
        return TextEncoding::Utf8;
    if (LooksLikeEucJp(start))
        return TextEncoding::EucJp;
    return LooksLikeShiftJis(start) ? TextEncoding::ShiftJis : TextEncoding::Windows1252;
}

std::size_t ByteOrderMarkSize(std::string_view start, TextEncoding encoding) {
    switch (encoding) {
    case TextEncoding::Utf16LittleEndian:
        return start.substr(0, 2) == "\xFF\xFE" ? 2 : 0;
    case TextEncoding::Utf16BigEndian:
        return start.substr(0, 2) == "\xFE\xFF" ? 2 : 0;
    default:
        return start.substr(0, 3) == "\xEF\xBB\xBF" ? 3 : 0;
    }
}

std::string ToUtf8(std::string_view text, TextEncoding encoding) {
    if (encoding != TextEncoding::Windows1252 && IsUtf8(text, Tail::MustBeWhole))
        return std::string(text);
    std::string result;
    for (const char c : text) {
        const unsigned byte = Byte(c);
        // Above 0x9F the encoding is Latin-1, whose bytes are Unicode's first characters.
        AppendUtf8(byte >= 0x80 && byte < 0xA0 ? kWindows1252[byte - 0x80] : byte, &result);
    }
    return result;
}

} // namespace ryn
