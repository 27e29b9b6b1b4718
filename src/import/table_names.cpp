#include "import/table_names.h"

#include <algorithm>
#include <optional>

#include "import/number_field.h"
#include "import/table_text.h"
#include "import/time_names.h"
#include "import/unit_text.h"

namespace ryn {

namespace {

using Fields = std::vector<std::string>;

/// "5s", "15s", "20d": the line of column types of an RDB table.
bool IsTypeLine(const Fields& fields) {
    return std::all_of(fields.begin(), fields.end(), [](const std::string& field) {
        return field.size() >= 2 && IsLetter(field.back()) &&
               IsDigits(std::string_view(field).substr(0, field.size() - 1));
    });
}

std::string WithoutBrackets(std::string_view text) {
    text = Trimmed(text);
    if (text.size() >= 2 &&
        ((text[0] == '[' && text.back() == ']') || (text[0] == '(' && text.back() == ')')))
        text = text.substr(1, text.size() - 2);
    return std::string(Trimmed(text));
}

/// Units, or something in brackets, above half of the columns of numbers at least; and no title of
/// a date ("date,h" are names).
bool IsUnitLine(const TableShape& shape, const Fields& fields) {
    std::size_t units = 0;
    std::size_t others = 0;
    for (std::size_t i = 0; i < fields.size(); ++i) {
        const std::string text = WithoutBrackets(fields[i]);
        if (IsTimeName(text) && !RoleOfName(text))
            return false;
        if (text.empty() || text == "-" || shape.kinds[i] != ColumnKind::Number)
            continue;
        const bool isBracketed = text.size() != fields[i].size();
        (isBracketed || LooksLikeUnit(text) ? units : others) += 1;
    }
    return units > 0 && units >= others;
}

/// Under the delimiter of blanks, the unit behind a name is a field of its own: "Q", "[m3/s]".
void JoinBracketFields(Fields* fields) {
    for (std::size_t i = 1; i < fields->size();) {
        const char first = (*fields)[i].empty() ? '\0' : (*fields)[i][0];
        if (first == '[' || first == '(') {
            (*fields)[i - 1] += " " + (*fields)[i];
            fields->erase(fields->begin() + static_cast<std::ptrdiff_t>(i));
        } else {
            ++i;
        }
    }
}

/// A line's fields spread over the columns; empty when it is no line of titles. One field less than
/// the rows have means that the first column has no title (row names), or that a date and a time
/// share one: in both cases the last columns match.
Fields AsTitles(const TableShape& shape, const HeadRow& row) {
    Fields fields = row.fields;
    if (shape.delimiter == ' ')
        JoinBracketFields(&fields);
    const std::size_t count = shape.fieldCount;
    if (fields.size() == count + 1 && fields.back().empty())
        fields.pop_back();
    if (fields.size() + 1 == count && !row.isComment) {
        const bool lastIsEmpty = shape.kinds.back() == ColumnKind::Empty;
        fields.insert(lastIsEmpty ? fields.end() : fields.begin(), std::string());
    }
    return fields.size() == count ? fields : Fields();
}

/// Words above the columns, and no row or line of a preamble that happens to have as many fields.
bool HasTitles(const TableShape& shape, const HeadRow& row, const Fields& titles) {
    if (titles.empty() || row.isDivider)
        return false;
    std::size_t texts = 0;
    for (const std::string& title : titles) {
        const FieldKind kind = KindOfField(title, shape.decimal);
        texts += kind == FieldKind::Text || kind == FieldKind::Marked ||
                         (kind == FieldKind::Missing && !title.empty())
                     ? 1
                     : 0;
        if (kind == FieldKind::Time && title.size() >= 8)
            return false; // a date: data, or a preamble's line
        // "Unit: m3/s" in a table of two columns is a line of the preamble.
        if (!title.empty() && title.back() == ':')
            return false;
    }
    return texts > 0 || (titles[0].empty() && titles.size() > 1);
}

struct TitleLine {
    long line = 0;
    Fields fields;
};

/// The lines directly above the rows that have a field for each column, nearest first.
std::vector<TitleLine> LinesOfTitles(const TableShape& shape, std::size_t firstRow) {
    constexpr std::size_t kMostLines = 4;
    std::vector<TitleLine> lines;
    for (std::size_t i = firstRow; i-- > 0 && lines.size() < kMostLines;) {
        const HeadRow& row = shape.rows[i];
        const bool isBlankComment =
            row.isComment && std::all_of(row.fields.begin(), row.fields.end(),
                                         [](const std::string& field) { return field.empty(); });
        if (row.isDivider || isBlankComment)
            continue;
        Fields titles = AsTitles(shape, row);
        if (!titles.empty() && IsTypeLine(titles))
            continue;
        if (!HasTitles(shape, row, titles))
            break;
        lines.push_back({row.line, std::move(titles)});
    }
    return lines;
}

/// A name that is only a number ("0" of a data frame's column) says nothing.
bool SaysNothing(std::string_view name) {
    return name.find_first_not_of("0123456789. ") == std::string_view::npos;
}

void SetColumn(const std::string& title, ColumnLayout* column) {
    SplitNameAndUnit(title, &column->name, &column->unit);
    if (SaysNothing(column->name))
        column->name.clear();
}

/// Where a line speaks of missing values; npos when it does not.
std::size_t MentionOfMissing(const std::string& line) {
    // In the languages of the headers seen; stems, since they are inflected.
    return FindOneOf(
        Lowercase(line),
        "missing|no data|nodata|no_data|no-data|inval|not available|fillvalue|"
        "fill value|fill_value|undefined|fehlwert|lücke|luecke|ontbrek|manquant|lacune|"
        "mancant|faltant|mangler|saknas");
}

/// Numbers that no gauge measures: negative, or made of nines, or huge.
bool IsCodeLike(float value, std::string_view text) {
    std::string digits;
    for (const char c : text)
        if (IsDigit(c))
            digits += c;
    while (!digits.empty() && digits.back() == '0')
        digits.pop_back();
    const bool nines = digits.size() >= 3 && digits.find_first_not_of('9') == std::string::npos;
    return value < 0.0F || nines || value >= 1e19F;
}

/// The code-like number of a line that stands nearest to the mention of missing values, also
/// against a word ("RINVAL-777.0").
std::optional<float> CodeNear(const std::string& text, std::size_t mention) {
    std::optional<float> nearest;
    std::size_t least = std::string::npos;
    constexpr std::string_view kNumberSigns = "+-.0123456789eE";
    for (std::size_t i = 0; i < text.size();) {
        if (!IsDigit(text[i]) && text[i] != '-') {
            ++i;
            continue;
        }
        const std::size_t end = std::min(text.find_first_not_of(kNumberSigns, i), text.size());
        std::string_view number = std::string_view(text).substr(i, end - i);
        while (!number.empty() && !IsDigit(number.back()))
            number.remove_suffix(1);
        const NumberField field = ReadNumber(number, '.');
        const std::size_t distance = i > mention ? i - mention : mention - i;
        if (field.kind == NumberKind::Value && IsCodeLike(field.value, number) &&
            distance < least) {
            least = distance;
            nearest = field.value;
        }
        i = end;
    }
    return nearest;
}

/// A code that was announced twice counts once.
void FindCode(const HeadRow& row, std::vector<AnnouncedCode>* codes) {
    const std::size_t mention = MentionOfMissing(row.text);
    if (mention == std::string::npos)
        return;
    const std::optional<float> code = CodeNear(row.text, mention);
    if (code && std::none_of(codes->begin(), codes->end(),
                             [&code](const AnnouncedCode& known) { return known.value == *code; }))
        codes->push_back({*code, row.line});
}

/// The unit of a preamble's "Einheit: m3/s", "Unit;mm", "EHD;I;cm".
std::string UnitOfPreamble(const HeadRow& row) {
    const std::size_t cut = row.text.find_first_of(":;=,\t");
    if (cut == std::string::npos)
        return {};
    const std::vector<std::string> words = Words(std::string_view(row.text).substr(0, cut));
    if (words.empty() ||
        !IsOneOf(
            words.back(),
            "unit|units|einheit|parametereinheit|eenheid|unit\xC3\xA9|unidad|unit\xC3\xA0|enhet"))
        return {};
    std::string_view rest = std::string_view(row.text).substr(cut + 1);
    while (!rest.empty() &&
           std::string_view(" \t;,:=\"").find(rest.back()) != std::string_view::npos)
        rest.remove_suffix(1);
    while (!rest.empty() && std::string_view(" \t;,:=\"").find(rest[0]) != std::string_view::npos)
        rest.remove_prefix(1);
    const std::string unit = WithoutBrackets(rest);
    return LooksLikeUnit(unit) ? unit : std::string();
}

} // namespace

void FindNames(const TableShape& shape, std::size_t firstRow, TableLayout* layout) {
    layout->nameLine = 0;
    layout->unitLine = 0;
    layout->columns.assign(shape.fieldCount, {});
    for (std::size_t i = 0; i < shape.fieldCount; ++i)
        layout->columns[i].kind = shape.kinds[i];
    std::vector<TitleLine> lines = LinesOfTitles(shape, firstRow);
    if (lines.empty())
        return;
    // The names stand above a line of units; without one they are the nearest line.
    const auto unitLine = std::find_if(lines.begin(), lines.end(), [&shape](const TitleLine& line) {
        return IsUnitLine(shape, line.fields);
    });
    const bool hasUnits =
        unitLine != lines.end() && lines.size() > 1 && unitLine + 1 != lines.end();
    const TitleLine& names = hasUnits ? *(unitLine + 1) : lines.front();
    layout->nameLine = names.line;
    for (std::size_t i = 0; i < shape.fieldCount; ++i)
        SetColumn(names.fields[i], &layout->columns[i]);
    if (!hasUnits)
        return;
    layout->unitLine = unitLine->line;
    for (std::size_t i = 0; i < shape.fieldCount; ++i)
        if (layout->columns[i].unit.empty())
            layout->columns[i].unit = WithoutBrackets(unitLine->fields[i]);
}

void ReadPreamble(const TableShape& shape, std::size_t firstRow, TableLayout* layout) {
    for (std::size_t i = 0; i < firstRow; ++i) {
        const HeadRow& row = shape.rows[i];
        FindCode(row, &layout->announced);
        const std::string unit = UnitOfPreamble(row);
        if (unit.empty())
            continue;
        for (ColumnLayout& column : layout->columns)
            if (column.unit.empty() && column.kind == ColumnKind::Number)
                column.unit = unit;
    }
}

} // namespace ryn
