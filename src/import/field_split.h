#pragma once

#include <string>
#include <string_view>
#include <vector>

namespace ryn {

/// Stands for a delimiter of runs of blanks and tabs.
inline constexpr char kBlanks = ' ';

/// The fields of one record, trimmed. The views point into the record's text, or into storage of
/// this object where quotes had to be undone; valid until the next Split.
class FieldList {
  public:
    /// Splits a record at its delimiters. A field that begins with a double quote runs to the
    /// closing one, whatever stands between; a doubled quote is one quote. False when a quote is
    /// still open at the end of the text.
    bool Split(std::string_view record, char delimiter);
    /// The same with quotes as plain characters.
    void SplitUnquoted(std::string_view record, char delimiter);

    std::size_t Size() const { return fields.size(); }
    std::string_view operator[](std::size_t index) const { return fields[index]; }
    const std::vector<std::string_view>& All() const { return fields; }

  private:
    void SplitPlain(std::string_view record, char delimiter);
    void SplitAtBlanks(std::string_view record);
    bool SplitQuoted(std::string_view record, char delimiter);

    std::vector<std::string_view> fields;
    std::string storage;
};

/// The name of a delimiter for people: "comma", "tab", "blanks", "\"~\"".
std::string DelimiterName(char delimiter);

} // namespace ryn
