#include "import/field_split.h"

#include <cstring>

#include "import/table_text.h"

namespace ryn {

namespace {

bool IsBlank(char c) {
    return c == ' ' || c == '\t';
}

bool Divides(char c, char delimiter) {
    return delimiter == kBlanks ? IsBlank(c) : c == delimiter;
}

/// A tab is no blank where it is the delimiter.
std::size_t SkipBlanks(std::string_view record, std::size_t position, char delimiter) {
    while (position < record.size() && IsBlank(record[position]) && record[position] != delimiter)
        ++position;
    return position;
}

/// Walks a record that has quotes, and gathers its fields with the quotes undone.
class QuotedRecord {
  public:
    QuotedRecord(std::string_view text, char fieldDelimiter, std::string* unquoted)
        : record(text),
          delimiter(fieldDelimiter),
          storage(unquoted) {}

    /// Appends the next field to the storage; false when its quote does not close.
    bool TakeField() {
        if (delimiter != kBlanks)
            position = SkipBlanks(record, position, delimiter);
        // A quote within a field is a plain character: 5" pipes, minutes of arc.
        if (position < record.size() && record[position] == '"' && !TakeQuoted())
            return false;
        // Also behind a closing quote: "abc"def is one field.
        while (position < record.size() && !Divides(record[position], delimiter))
            storage->push_back(record[position++]);
        return true;
    }
    bool IsAtEnd() const { return position >= record.size(); }
    void SkipDelimiter() {
        ++position;
        while (delimiter == kBlanks && !IsAtEnd() && IsBlank(record[position]))
            ++position;
    }
    void SkipLeadingBlanks() {
        while (delimiter == kBlanks && !IsAtEnd() && IsBlank(record[position]))
            ++position;
    }

  private:
    bool TakeQuoted() {
        for (++position; position < record.size(); ++position) {
            if (record[position] != '"') {
                storage->push_back(record[position]);
            } else if (position + 1 < record.size() && record[position + 1] == '"') {
                storage->push_back('"');
                ++position;
            } else {
                ++position;
                return true;
            }
        }
        return false;
    }

    std::string_view record;
    char delimiter;
    std::string* storage;
    std::size_t position = 0;
};

} // namespace

bool FieldList::Split(std::string_view record, char delimiter) {
    fields.clear();
    // Most rows have no quotes; their fields are views into the row, and nothing is copied.
    if (!record.empty() && std::memchr(record.data(), '"', record.size()) != nullptr)
        return SplitQuoted(record, delimiter);
    SplitUnquoted(record, delimiter);
    return true;
}

void FieldList::SplitUnquoted(std::string_view record, char delimiter) {
    fields.clear();
    if (delimiter == kBlanks)
        SplitAtBlanks(record);
    else
        SplitPlain(record, delimiter);
}

void FieldList::SplitPlain(std::string_view record, char delimiter) {
    for (std::size_t start = 0;;) {
        const std::size_t end = record.find(delimiter, start);
        // Fixed-width exports pad their fields.
        fields.push_back(Trimmed(record.substr(start, end - start)));
        if (end == std::string_view::npos)
            return;
        start = end + 1;
    }
}

void FieldList::SplitAtBlanks(std::string_view record) {
    constexpr std::string_view kBlankCharacters = " \t";
    std::size_t start = record.find_first_not_of(kBlankCharacters);
    while (start != std::string_view::npos) {
        const std::size_t end = record.find_first_of(kBlankCharacters, start);
        fields.push_back(record.substr(start, end - start));
        start = record.find_first_not_of(kBlankCharacters, end);
    }
}

bool FieldList::SplitQuoted(std::string_view record, char delimiter) {
    storage.clear();
    storage.reserve(record.size()); // never moves: undoing quotes only shortens
    QuotedRecord walk(record, delimiter, &storage);
    walk.SkipLeadingBlanks();
    while (true) {
        const std::size_t start = storage.size();
        if (!walk.TakeField())
            return false;
        fields.push_back(Trimmed(std::string_view(storage).substr(start)));
        if (walk.IsAtEnd())
            return true;
        walk.SkipDelimiter();
        // Blanks at the end of a line are no empty field; a comma there is one.
        if (walk.IsAtEnd() && delimiter == kBlanks)
            return true;
    }
}

std::string DelimiterName(char delimiter) {
    switch (delimiter) {
    case ',':
        return "comma";
    case ';':
        return "semicolon";
    case '\t':
        return "tab";
    case '|':
        return "bar";
    case kBlanks:
        return "blanks";
    default:
        return std::string("\"") + delimiter + "\"";
    }
}

} // namespace ryn
