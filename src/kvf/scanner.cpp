#include "kvf/scanner.h"

#include <algorithm>

#include "kvf/characters.h"

namespace ryn {

namespace {

constexpr std::string_view kByteOrderMark = "\xEF\xBB\xBF";
constexpr std::string_view kBlanks = " \t\r"; // CheckBytes lets CR stand before LF only
constexpr std::string_view kWordEnds = " \t\r\n,{}()=#\"";
constexpr std::size_t kLongestToken = 40;

std::size_t EndOrSize(std::size_t found, std::string_view text) {
    return found == std::string_view::npos ? text.size() : found;
}

std::optional<char> Unescaped(char letter) {
    switch (letter) {
    case '"':
    case '\\':
        return letter;
    case 'n':
        return '\n';
    case 'r':
        return '\r';
    case 't':
        return '\t';
    default:
        return std::nullopt;
    }
}

bool IsForbidden(std::string_view text, std::size_t at) {
    const char c = text[at];
    if (c == '\t' || c == '\n' || (c == '\r' && text.substr(at + 1, 1) == "\n"))
        return false;
    return KvfIsControl(c) || KvfUtf8Length(text, at) == 0;
}

} // namespace

std::string KvfQuoteToken(std::string_view token) {
    std::size_t length = 0;
    for (std::size_t i = 0; i < kLongestToken && length < token.size(); ++i)
        length += std::max<std::size_t>(KvfUtf8Length(token, length), 1);
    const bool isCut = length < token.size();
    return "\"" + std::string(token.substr(0, length)) + (isCut ? "...\"" : "\"");
}

KvfScanner::KvfScanner(std::string_view content) : text(content) {
    if (text.substr(0, kByteOrderMark.size()) == kByteOrderMark)
        text.remove_prefix(kByteOrderMark.size());
}

bool KvfScanner::CheckBytes() {
    for (std::size_t i = 0; i < text.size(); i += KvfUtf8Length(text, i)) {
        if (!IsForbidden(text, i))
            continue;
        const std::string_view before = text.substr(0, i);
        line = 1 + static_cast<int>(std::count(before.begin(), before.end(), '\n'));
        lineStart = before.rfind('\n') + 1; // npos + 1 is 0
        position = i;
        return Fail("UTF-8 text without control characters", "the byte 0x" + KvfHexByte(text[i]));
    }
    return true;
}

void KvfScanner::SkipBlanks() {
    position = EndOrSize(text.find_first_not_of(kBlanks, position), text);
}

void KvfScanner::SkipBlanksAndLines() {
    for (;;) {
        SkipBlanks();
        if (At('#'))
            position = EndOrSize(text.find('\n', position), text);
        if (!Take('\n'))
            return;
        ++line;
        lineStart = position;
    }
}

bool KvfScanner::Take(char c) {
    if (!At(c))
        return false;
    ++position;
    return true;
}

std::string_view KvfScanner::TakeIdentifier() {
    const std::size_t start = position;
    if (!AtEnd() && KvfIsLetter(text[position]))
        while (!AtEnd() && KvfIsLetterOrDigit(text[position]))
            ++position;
    return text.substr(start, position - start);
}

std::string_view KvfScanner::Word() const {
    const std::size_t end = EndOrSize(text.find_first_of(kWordEnds, position), text);
    return text.substr(position, end - position);
}

bool KvfScanner::ReadString(std::string* value) {
    const std::size_t opening = position;
    value->clear();
    Take('"');
    for (;;) {
        const std::size_t plainEnd = EndOrSize(text.find_first_of("\"\\\r\n", position), text);
        value->append(text.substr(position, plainEnd - position));
        position = plainEnd;
        if (Take('"'))
            return true;
        if (AtLineEnd())
            return Expected("a closing quote for the text that begins in column " +
                            std::to_string(ColumnOf(opening)));
        if (!ReadEscape(value))
            return false;
    }
}

bool KvfScanner::ReadEscape(std::string* value) {
    const std::string_view escape = text.substr(position, 2);
    if (escape == "\\x") {
        const std::optional<char> byte = KvfByteFromHex(text.substr(position + 2, 2));
        if (!byte)
            return Fail("two hexadecimal digits after \\x",
                        KvfQuoteToken(text.substr(position, 4)));
        *value += *byte;
        position += 4;
        return true;
    }
    const std::optional<char> plain = Unescaped(escape.back());
    if (!plain || escape.size() < 2)
        return Fail("one of the escapes \\\" \\\\ \\n \\r \\t \\xHH (a backslash itself is \\\\)",
                    KvfQuoteToken(escape));
    *value += *plain;
    position += 2;
    return true;
}

bool KvfScanner::Expected(const std::string& what) {
    return Fail(what, Found());
}

std::string KvfScanner::Found() const {
    if (AtEnd())
        return "the end of the file";
    if (AtLineEnd())
        return "the end of the line";
    if (At('"'))
        return "a quoted text";
    const std::string_view word = Word();
    return KvfQuoteToken(word.empty() ? text.substr(position, 1) : word);
}

bool KvfScanner::Fail(const std::string& what, const std::string& found) {
    error = KvfSyntaxError{line, static_cast<int>(ColumnOf(position)),
                           "expected " + what + ", found " + found};
    return false;
}

std::size_t KvfScanner::ColumnOf(std::size_t place) const {
    const std::string_view before = text.substr(lineStart, place - lineStart);
    const auto isFirstByte = [](char c) { return (static_cast<unsigned char>(c) & 0xC0) != 0x80; };
    return 1 + static_cast<std::size_t>(std::count_if(before.begin(), before.end(), isFirstByte));
}

} // namespace ryn
