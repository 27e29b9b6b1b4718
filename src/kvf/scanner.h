#pragma once

#include <cstddef>
#include <optional>
#include <string>
#include <string_view>

namespace ryn {

/// Where a text breaks the rules; line and column count from 1, columns in characters.
struct KvfSyntaxError {
    int line = 0;
    int column = 0;
    std::string text; ///< what was expected and what was found, without the place
};

/// A place in a text that moves forward over tokens and remembers the first error. Functions that
/// return bool return false after an error.
class KvfScanner {
  public:
    /// `content` has to outlive the scanner. A byte order mark is passed over.
    explicit KvfScanner(std::string_view content);

    /// Looks at the whole text for bytes that may stand nowhere in it. To be called first.
    bool CheckBytes();

    bool AtEnd() const { return position == text.size(); }
    bool At(char c) const { return !AtEnd() && text[position] == c; }
    bool AtLineEnd() const { return AtEnd() || At('\n') || At('\r'); }
    int Line() const { return line; }

    void SkipBlanks();
    /// Skips comments too.
    void SkipBlanksAndLines();
    /// Moves over this character if it is the next one.
    bool Take(char c);
    /// Moves over an identifier; empty when there is none.
    std::string_view TakeIdentifier();
    /// What stands here up to the next blank, line end or punctuation; does not move.
    std::string_view Word() const;
    void Skip(std::string_view word) { position += word.size(); }
    /// Moves over a string from its opening quote.
    bool ReadString(std::string* value);

    /// Records the error of this place: "expected WHAT, found ...". Returns false.
    bool Expected(const std::string& what);
    const std::optional<KvfSyntaxError>& Error() const { return error; }

  private:
    bool ReadEscape(std::string* value);
    std::string Found() const;
    bool Fail(const std::string& what, const std::string& found);
    /// For errors alone: it counts from the start of the line, which can be the whole file.
    std::size_t ColumnOf(std::size_t place) const;

    std::string_view text;
    std::size_t position = 0;
    std::size_t lineStart = 0;
    int line = 1;
    std::optional<KvfSyntaxError> error;
};

/// A token in quotes for a message, cut where it is long.
std::string KvfQuoteToken(std::string_view token);

} // namespace ryn
