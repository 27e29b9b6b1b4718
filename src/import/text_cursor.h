#pragma once

#include <string_view>

#include "import/table_text.h"

namespace ryn {

/// Walks a text from the left.
class TextCursor {
  public:
    explicit TextCursor(std::string_view whole) : text(whole) {}

    bool IsAtEnd() const { return text.empty(); }
    std::string_view Rest() const { return text; }
    char Peek() const { return text.empty() ? '\0' : text[0]; }
    void Skip(std::size_t count = 1) {
        text.remove_prefix(count < text.size() ? count : text.size());
    }
    bool Take(char c) {
        if (Peek() != c || text.empty())
            return false;
        text.remove_prefix(1);
        return true;
    }
    void SkipBlanks() {
        while (Peek() == ' ' || Peek() == '\t')
            Skip();
    }
    /// Takes up to `most` digits; *count is how many there were, and the value is 0 for none.
    int TakeNumber(int most, int* count) {
        int value = 0;
        for (*count = 0; *count < most && IsDigit(Peek()); ++*count) {
            value = value * 10 + (text[0] - '0');
            text.remove_prefix(1);
        }
        return value;
    }
    /// Takes letters; bytes of non-ASCII letters count as such.
    std::string_view TakeWord() {
        std::size_t size = 0;
        while (size < text.size() &&
               (IsLetter(text[size]) || static_cast<unsigned char>(text[size]) >= 0x80))
            ++size;
        const std::string_view word = text.substr(0, size);
        text.remove_prefix(size);
        return word;
    }

  private:
    std::string_view text;
};

} // namespace ryn
