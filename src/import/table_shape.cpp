#include "import/table_shape.h"

#include <algorithm>
#include <map>

#include "import/clock_text.h"
#include "import/field_split.h"
#include "import/hash_fields.h"
#include "import/number_field.h"
#include "import/table_text.h"

namespace ryn {

namespace {

// A field's kind is decided by most rows, not by all: a faulty row is named when it is read.
constexpr double kMost = 0.8;
// How far an open quote is followed in the head before it is taken for a plain character, and how
// many characters may be looked at again for that in the whole head.
constexpr std::size_t kMostJoinedLines = 20;
constexpr std::size_t kMostJoinedBytes = std::size_t{1} << 24;

/// In any of the forms that have a sign in them; dates in digits alone are numbers here, which a
/// column's rows together tell apart.
bool LooksLikeTime(std::string_view field) {
    constexpr std::size_t kLongestTime = 40;
    constexpr DateForm kForms[] = {DateForm::YearMonthDay, DateForm::DayMonthYear,
                                   DateForm::MonthDayYear, DateForm::ShortYearMonthDay,
                                   DateForm::Compact,      DateForm::YearMonth,
                                   DateForm::Duration};
    if (field.size() > kLongestTime || std::none_of(field.begin(), field.end(), IsDigit))
        return false;
    for (const DateForm form : kForms) {
        TimeParts parts;
        if (ParseDate(field, form, &parts) != TimeResult::Bad)
            return true;
    }
    TimeParts parts;
    return field.find(':') != std::string_view::npos && ParseClock(field, &parts);
}

/// Splits the lines of a head into rows.
class HeadSplitter {
  public:
    HeadSplitter(const TableHead& tableHead, char fieldDelimiter,
                 const std::vector<std::string>& commentMarks)
        : head(tableHead),
          delimiter(fieldDelimiter),
          marks(commentMarks) {}

    std::vector<HeadRow> Split() {
        std::vector<HeadRow> rows;
        for (std::size_t i = 0; i < head.lines.size();) {
            HeadRow row;
            i += SplitLine(i, &row);
            rows.push_back(std::move(row));
        }
        return rows;
    }

  private:
    /// Splits the line at `index`, joined with those after it while a quote is open. Returns how
    /// many lines it took.
    std::size_t SplitLine(std::size_t index, HeadRow* row) {
        const TableHead::Line& line = head.lines[index];
        row->line = line.number;
        row->text = line.text;
        const std::size_t mark = CommentMarkSize(line.text, marks);
        row->isComment = mark > 0 && !IsRowWithHashes(line.text, delimiter);
        row->isDivider = !row->isComment && IsSeparatorLine(line.text, delimiter);
        std::size_t used = 1;
        const std::size_t cut = row->isComment ? mark : 0;
        bool isClosed = list.Split(std::string_view(row->text).substr(cut), delimiter);
        while (!isClosed && !row->isComment && used < kMostJoinedLines &&
               index + used < head.lines.size() && looked < kMostJoinedBytes) {
            row->text += "\n" + head.lines[index + used++].text;
            looked += row->text.size();
            isClosed = list.Split(row->text, delimiter);
        }
        if (!isClosed) {
            // In a preamble an inch sign, in a row a fault that reading will name.
            used = 1;
            row->text = line.text;
            list.SplitUnquoted(std::string_view(row->text).substr(cut), delimiter);
        }
        row->fields.assign(list.All().begin(), list.All().end());
        return used;
    }

    const TableHead& head;
    char delimiter;
    const std::vector<std::string>& marks;
    FieldList list;
    std::size_t looked = 0; ///< characters of joined lines
};

/// How much a field of a kind speaks for a delimiter: numbers that are not quite ones less.
double Weight(FieldKind kind) {
    switch (kind) {
    case FieldKind::Text:
        return 0.0;
    case FieldKind::Marked:
    case FieldKind::Grouped:
        return 0.5;
    default:
        return 1.0;
    }
}

/// Share of a row's fields that are understood; 0 for a row without any number or time.
double Explained(const HeadRow& row, char decimal) {
    double understood = 0.0;
    bool hasData = false;
    for (const std::string& field : row.fields) {
        const FieldKind kind = KindOfField(field, decimal);
        hasData = hasData || kind == FieldKind::Number || kind == FieldKind::Grouped ||
                  kind == FieldKind::Time;
        understood += Weight(kind);
    }
    return hasData ? understood / static_cast<double>(row.fields.size()) : 0.0;
}

/// The first line that is no comment; null when there is none.
const HeadRow* FirstLine(const TableShape& shape) {
    const auto at = std::find_if(shape.rows.begin(), shape.rows.end(), [](const HeadRow& row) {
        return !row.isComment && !row.isDivider;
    });
    return at == shape.rows.end() ? nullptr : &*at;
}

/// Whole numbers with one comma between in all rows, under a title without a comma.
bool IsColumnOfDecimalCommas(const TableShape& shape) {
    const HeadRow* first = FirstLine(shape);
    if (shape.delimiter != ',' || first == nullptr || first->fields.size() != 1)
        return false;
    return std::all_of(shape.rows.begin(), shape.rows.end(), [](const HeadRow& row) {
        std::string_view whole = row.fields[0];
        if (!whole.empty() && (whole[0] == '-' || whole[0] == '+'))
            whole.remove_prefix(1);
        return row.fields.size() != 2 || (IsDigits(whole) && IsDigits(row.fields[1]));
    });
}

/// How far a number of fields is to be believed. One field needs no delimiter, so that a table with
/// one goes before it: "1871,1120" is a year and a value rather than a decimal comma.
double Belief(const TableShape& shape, std::size_t fieldCount) {
    if (fieldCount == 1)
        return 0.9;
    if (fieldCount == 2 && IsColumnOfDecimalCommas(shape))
        return 0.8;
    // As many titles as fields: "time value" above "2001-01-01T10:00 -1,5" has no comma.
    const HeadRow* first = FirstLine(shape);
    const bool hasTitles = first != nullptr && first->fields.size() == fieldCount &&
                           Explained(*first, shape.decimal) == 0.0;
    return hasTitles ? 1.1 : 1.0;
}

/// The number of fields that explains most, and how much it does.
double WeighFieldCounts(const TableShape& shape, std::size_t* fieldCount) {
    std::map<std::size_t, double> weights;
    for (const HeadRow& row : shape.rows)
        if (!row.isComment && !row.isDivider)
            weights[row.fields.size()] += Explained(row, shape.decimal);
    double best = 0.0;
    for (const auto& [count, weight] : weights) {
        const double believed = weight * Belief(shape, count);
        if (believed > best) {
            best = believed;
            *fieldCount = count;
        }
    }
    return best;
}

/// What most rows hold that hold anything.
ColumnKind KindOfColumn(const std::vector<const HeadRow*>& rows, std::size_t column, char decimal) {
    std::map<FieldKind, double> counts;
    for (const HeadRow* row : rows)
        counts[KindOfField(row->fields[column], decimal)] += 1.0;
    const double present = static_cast<double>(rows.size()) - counts[FieldKind::Missing];
    if (present == 0.0)
        return ColumnKind::Empty;
    const double plain = counts[FieldKind::Number] + counts[FieldKind::Grouped];
    if (plain > 0.0 && plain + counts[FieldKind::Marked] >= kMost * present)
        return ColumnKind::Number;
    return counts[FieldKind::Time] >= kMost * present ? ColumnKind::Time : ColumnKind::Text;
}

/// The kinds of the columns by the last quarter of the rows of that size, which a header with
/// numbers in it does not reach; where a column is empty there, by more of them.
std::vector<ColumnKind> KindsOfColumns(const TableShape& shape) {
    std::vector<const HeadRow*> rows;
    for (const HeadRow& row : shape.rows)
        if (row.hasData && row.fields.size() == shape.fieldCount)
            rows.push_back(&row);
    std::reverse(rows.begin(), rows.end());
    // Fewer rows than this say too little about a column.
    constexpr std::size_t kEnough = 5;
    std::vector<ColumnKind> kinds(shape.fieldCount, ColumnKind::Empty);
    for (const unsigned part : {4U, 2U, 1U}) {
        const std::size_t count = std::min(rows.size(), std::max(kEnough, rows.size() / part));
        const std::vector<const HeadRow*> last(rows.begin(),
                                               rows.begin() + static_cast<std::ptrdiff_t>(count));
        for (std::size_t column = 0; column < shape.fieldCount; ++column)
            if (kinds[column] == ColumnKind::Empty)
                kinds[column] = KindOfColumn(last, column, shape.decimal);
    }
    return kinds;
}

std::vector<std::string> CommentMarks(const ImportSettings& settings, char delimiter) {
    if (!settings.commentMarks.empty())
        return settings.commentMarks;
    std::vector<std::string> marks = {"#", "%", "//", "!"};
    if (delimiter != ';')
        marks.emplace_back(";");
    return marks;
}

enum class FieldMatch { Yes, No, Free };

/// Columns of text or nothing fit any field, and a missing value fits any column.
FieldMatch MatchField(ColumnKind kind, std::string_view field, char decimal) {
    if (kind == ColumnKind::Text || kind == ColumnKind::Empty)
        return FieldMatch::Free;
    const FieldKind found = KindOfField(field, decimal);
    if (found == FieldKind::Missing)
        return FieldMatch::Free;
    const bool fits = kind == ColumnKind::Time
                          ? found == FieldKind::Time
                          : found == FieldKind::Number || found == FieldKind::Marked ||
                                found == FieldKind::Grouped;
    return fits ? FieldMatch::Yes : FieldMatch::No;
}

struct Matches {
    std::size_t yes = 0;
    std::size_t no = 0;
};

Matches MatchRow(const TableShape& shape, const HeadRow& row) {
    Matches matches;
    for (std::size_t i = 0; i < shape.fieldCount && i < row.fields.size(); ++i) {
        const FieldMatch match = MatchField(shape.kinds[i], row.fields[i], shape.decimal);
        matches.yes += match == FieldMatch::Yes ? 1 : 0;
        matches.no += match == FieldMatch::No ? 1 : 0;
    }
    return matches;
}

/// A row but for a fault: as many fields as the others, at least half of them right; or nothing in
/// any of them.
bool IsFaultyRow(const TableShape& shape, const HeadRow& row) {
    if (row.fields.size() != shape.fieldCount)
        return false;
    if (std::all_of(row.fields.begin(), row.fields.end(),
                    [](const auto& field) { return IsMissingWord(field) || IsHashField(field); }))
        return true;
    const Matches matches = MatchRow(shape, row);
    return matches.yes > 0 && matches.yes >= matches.no;
}

} // namespace

FieldKind KindOfField(std::string_view field, char decimal) {
    switch (ReadNumber(field, decimal).kind) {
    case NumberKind::Missing:
        return FieldKind::Missing;
    case NumberKind::Marked:
        return FieldKind::Marked;
    case NumberKind::Grouped:
        return FieldKind::Grouped;
    case NumberKind::NoNumber:
        return LooksLikeTime(field) ? FieldKind::Time : FieldKind::Text;
    default:
        return FieldKind::Number;
    }
}

std::size_t CommentMarkSize(std::string_view line, const std::vector<std::string>& marks) {
    const std::size_t blanks = line.find_first_not_of(" \t");
    if (blanks == std::string_view::npos)
        return 0;
    line.remove_prefix(blanks);
    for (const std::string& mark : marks) {
        if (line.substr(0, mark.size()) != mark)
            continue;
        // "##" and "###" too.
        std::size_t size = mark.size();
        while (size < line.size() && line[size] == mark.back())
            ++size;
        return blanks + size;
    }
    return 0;
}

std::optional<TableShape> FindShape(const TableHead& head, const ImportSettings& settings) {
    // Where several explain as much, the earlier one holds.
    const std::string delimiters =
        settings.delimiter ? std::string(1, *settings.delimiter) : std::string("\t;|, ");
    const std::string decimals =
        settings.decimal ? std::string(1, *settings.decimal) : std::string(".,");
    std::optional<TableShape> best;
    double bestWeight = 0.0;
    for (const char delimiter : delimiters) {
        TableShape shape;
        shape.delimiter = delimiter;
        shape.commentMarks = CommentMarks(settings, delimiter);
        shape.rows = HeadSplitter(head, delimiter, shape.commentMarks).Split();
        for (const char decimal : decimals) {
            shape.decimal = decimal;
            const double weight = WeighFieldCounts(shape, &shape.fieldCount);
            // A few rows more are chance: a tab that somebody typed as a blank.
            if (weight > bestWeight * 1.05) {
                bestWeight = weight;
                best = shape;
            }
        }
    }
    if (!best)
        return best;
    for (HeadRow& row : best->rows)
        row.hasData = !row.isComment && !row.isDivider && Explained(row, best->decimal) > 0.0;
    best->kinds = KindsOfColumns(*best);
    return best;
}

bool HasKindsOfColumns(const TableShape& shape, const HeadRow& row) {
    if (row.fields.size() != shape.fieldCount)
        return false;
    const Matches matches = MatchRow(shape, row);
    return matches.yes > 0 && matches.no == 0;
}

std::vector<RowRun> FindRuns(const TableShape& shape, const RowTest& isRow) {
    std::vector<RowRun> runs;
    bool isOpen = false;
    std::string header;
    for (std::size_t i = 0; i < shape.rows.size(); ++i) {
        const HeadRow& row = shape.rows[i];
        if (row.isComment || row.isDivider)
            continue;
        if (isRow(row)) {
            if (!isOpen)
                runs.push_back({i, i, 0});
            isOpen = true;
            runs.back().last = i;
            ++runs.back().count;
        } else if (isOpen) {
            isOpen = IsFaultyRow(shape, row) || (!header.empty() && row.text == header);
        } else {
            header = row.text;
        }
    }
    return runs;
}

} // namespace ryn
