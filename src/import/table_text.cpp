#include "import/table_text.h"

#include <algorithm>

#include "import/text_encoding.h"

namespace ryn {

namespace {

constexpr std::string_view kNoBreakSpace = "\xC2\xA0";

bool IsBlankAt(std::string_view text, std::size_t position) {
    const char c = text[position];
    return c == ' ' || c == '\t' || c == '\n' || c == '\r';
}

bool StartsWithRepeated(std::string_view line, char c) {
    constexpr std::size_t kMergeMark = 7;
    return line.size() >= kMergeMark && line.find_first_not_of(c) >= kMergeMark;
}

/// Whether one of the words between bars passes a test.
template <typename Test>
bool AnyWord(std::string_view list, const Test& test) {
    while (!list.empty()) {
        const std::size_t end = std::min(list.find('|'), list.size());
        if (test(list.substr(0, end)))
            return true;
        list.remove_prefix(std::min(end + 1, list.size()));
    }
    return false;
}

} // namespace

std::string_view Trimmed(std::string_view text) {
    for (bool again = true; again && !text.empty();) {
        again = true;
        if (IsBlankAt(text, 0))
            text.remove_prefix(1);
        else if (text.substr(0, 2) == kNoBreakSpace)
            text.remove_prefix(2);
        else if (IsBlankAt(text, text.size() - 1))
            text.remove_suffix(1);
        else if (text.size() >= 2 && text.substr(text.size() - 2) == kNoBreakSpace)
            text.remove_suffix(2);
        else
            again = false;
    }
    return text;
}

std::string Lowercase(std::string_view text) {
    std::string lower(text);
    for (char& c : lower)
        c = c >= 'A' && c <= 'Z' ? static_cast<char>(c - 'A' + 'a') : c;
    return lower;
}

bool IsDigit(char c) {
    return c >= '0' && c <= '9';
}

bool IsLetter(char c) {
    return (c >= 'a' && c <= 'z') || (c >= 'A' && c <= 'Z');
}

bool IsDigits(std::string_view text) {
    return !text.empty() && std::all_of(text.begin(), text.end(), IsDigit);
}

std::vector<std::string> Words(std::string_view text) {
    std::vector<std::string> words;
    std::string word;
    // The blank at the end closes the last word.
    for (const char c : Lowercase(text) + " ") {
        if (IsLetter(c) || static_cast<unsigned char>(c) >= 0x80) {
            word += c;
        } else if (!word.empty()) {
            words.push_back(word);
            word.clear();
        }
    }
    return words;
}

bool IsOneOf(std::string_view text, std::string_view list) {
    const std::string lower = Lowercase(text);
    return AnyWord(list, [&lower](std::string_view word) { return word == lower; });
}

bool StartsWithOneOf(std::string_view lower, std::string_view list) {
    return AnyWord(list,
                   [lower](std::string_view word) { return lower.substr(0, word.size()) == word; });
}

std::size_t FindOneOf(std::string_view lower, std::string_view list) {
    std::size_t first = std::string_view::npos;
    AnyWord(list, [lower, &first](std::string_view word) {
        first = std::min(first, lower.find(word));
        return false; // all of them
    });
    return first;
}

bool IsSeparatorLine(std::string_view line, char delimiter) {
    // An unresolved merge leaves its marks as lines of their own.
    line = Trimmed(line);
    for (const char mark : {'<', '=', '>', '|'})
        if (StartsWithRepeated(line, mark))
            return true;
    const bool onlyMarks = std::none_of(line.begin(), line.end(), [](char c) {
        return IsDigit(c) || IsLetter(c) || static_cast<unsigned char>(c) >= 0x80 || c == '"';
    });
    const bool divided = delimiter != ' ' && line.find(delimiter) != std::string_view::npos;
    // Stars and fields between delimiters may be missing values, and two dashes too.
    return line.size() >= 3 && onlyMarks && !divided && line.find('*') == std::string_view::npos;
}

std::string ShownText(std::string_view text) {
    constexpr std::size_t kShown = 60;
    // Texts of the table come in its own encoding; messages are UTF-8.
    std::string shown = ToUtf8(text.substr(0, 4 * kShown), TextEncoding::Utf8);
    for (char& c : shown)
        c = static_cast<unsigned char>(c) < 0x20 ? ' ' : c;
    if (shown.size() <= kShown)
        return shown;
    std::size_t end = kShown;
    while ((static_cast<unsigned char>(shown[end]) & 0xC0U) == 0x80U) // not within a character
        --end;
    return shown.substr(0, end) + "...";
}

std::string Quoted(std::string_view text) {
    return "\"" + ShownText(text) + "\"";
}

} // namespace ryn
