#include "import/hash_fields.h"

#include <algorithm>

#include "import/field_split.h"
#include "import/table_text.h"

namespace ryn {

namespace {

bool IsValueLike(std::string_view field) {
    return IsHashField(field) || std::any_of(field.begin(), field.end(), IsDigit);
}

} // namespace

bool IsHashField(std::string_view field) {
    constexpr std::size_t kFewest = 3; // one or two stand in front of comments and numbers
    return field.size() >= kFewest && field.find_first_not_of('#') == std::string_view::npos;
}

bool IsRowWithHashes(std::string_view line, char delimiter) {
    line = Trimmed(line);
    if (line.empty() || line[0] != '#') // nearly every line ends here
        return false;
    FieldList list;
    list.SplitUnquoted(line, delimiter);
    const auto& fields = list.All();
    if (fields.size() < 2 || !IsHashField(fields[0]))
        return false;
    // Blanks part the words of a comment as well.
    return delimiter == kBlanks ? std::all_of(fields.begin(), fields.end(), IsValueLike) &&
                                      line.find_first_not_of("# \t") != std::string_view::npos
                                : std::any_of(fields.begin() + 1, fields.end(), IsValueLike);
}

} // namespace ryn
