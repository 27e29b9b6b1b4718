#include "import/comma_parts.h"

#include <algorithm>

#include "import/number_field.h"
#include "import/table_text.h"

namespace ryn {

namespace {

/// Names that are one fewer than the fields leave out the row names (which count from 1), or a
/// comma of the values was taken for a delimiter.
bool HasNameTooFew(const TableShape& shape, const RowRun& run) {
    if (run.first == 0 || shape.fieldCount < 3)
        return false;
    const HeadRow& header = shape.rows[run.first - 1];
    if (header.isComment || header.fields.size() + 1 != shape.fieldCount)
        return false;
    const bool isCounted =
        shape.kinds[0] == ColumnKind::Number && shape.rows[run.first].fields[0] == "1";
    return shape.kinds[0] == ColumnKind::Time ||
           (shape.kinds[0] == ColumnKind::Number && !isCounted);
}

/// Decimal points show that the comma is none.
bool AreWholeNumbers(const SampleRows& rows, std::size_t first) {
    for (const auto& fields : rows.All())
        for (std::size_t i = first; i < fields.size(); ++i)
            if (rows.Column(i).kind == ColumnKind::Number && !IsWholeNumber(fields[i]))
                return false;
    return true;
}

/// How the fields of a column that may be decimals are written.
struct DecimalLook {
    std::size_t rows = 0;
    std::size_t shortest = std::string_view::npos;
    std::size_t longest = 0;
    bool hasLeadingZero = false;  ///< "05": decimals are written so, whole numbers are not
    bool hasTrailingZero = false; ///< "50"

    void Add(std::string_view field) {
        ++rows;
        shortest = std::min(shortest, field.size());
        longest = std::max(longest, field.size());
        hasLeadingZero = hasLeadingZero || (field.size() > 1 && field[0] == '0');
        hasTrailingZero = hasTrailingZero || (field.size() > 1 && field.back() == '0');
    }
    /// Decimals have all the same length, or end in no zero. In so many rows one in ten would begin
    /// with a zero, unless they are whole numbers.
    bool MayBeDecimals() const {
        constexpr std::size_t kEnough = 50;
        if (rows == 0 || (shortest < longest && hasTrailingZero))
            return false;
        return longest == 1 || hasLeadingZero || rows < kEnough;
    }
};

/// Rows that are one field short: whole values, which are written without decimals.
bool HasShortRows(const TableShape& shape, const RowRun& run) {
    constexpr std::size_t kSeveral = 2; // the last line may be cut
    std::size_t count = 0;
    for (std::size_t i = run.first; i <= run.last; ++i) {
        const HeadRow& row = shape.rows[i];
        count += row.hasData && row.fields.size() + 1 == shape.fieldCount ? 1 : 0;
    }
    return count >= kSeveral;
}

/// Whether the column behind `whole` may hold its decimals.
bool MayHoldDecimals(const TableShape& shape, const RowRun& run, const SampleRows& rows,
                     std::size_t whole) {
    constexpr std::size_t kMostDecimals = 6;
    DecimalLook look;
    for (const auto& fields : rows.All()) {
        const std::string_view part = fields[whole + 1];
        if (IsMissingWord(fields[whole]) && IsMissingWord(part))
            continue;
        if (!IsWholeNumber(fields[whole]) || !IsDigits(part) || part.size() > kMostDecimals)
            return false;
        look.Add(part);
    }
    return look.MayBeDecimals() ||
           (look.rows > 0 && whole + 2 == shape.fieldCount && HasShortRows(shape, run));
}

bool IsPlainNumber(const TableLayout& layout, std::size_t column) {
    return column < layout.columns.size() && layout.columns[column].kind == ColumnKind::Number &&
           std::none_of(layout.time.columns.begin(), layout.time.columns.end(),
                        [column](const TimeColumn& time) { return time.column == column; });
}

Status PairFault(const TableShape& shape, const RowRun& run, std::size_t whole) {
    const HeadRow& row = shape.rows[run.first];
    const std::string text =
        row.fields.size() > whole + 1 ? row.fields[whole] + "," + row.fields[whole + 1] : row.text;
    return Status::InputFault("line " + std::to_string(row.line) + ": " + Quoted(text) +
                              " may be one number with a decimal comma, or columns " +
                              std::to_string(whole + 1) + " and " + std::to_string(whole + 2) +
                              "; write decimal points, or name the column with --item if they are "
                              "two");
}

} // namespace

bool IsWholeNumber(std::string_view field) {
    if (!field.empty() && (field[0] == '-' || field[0] == '+'))
        field.remove_prefix(1);
    return IsDigits(field);
}

Status CheckCommaPartsColumns(const TableShape& shape, const RowRun& run,
                              const ImportSettings& settings, const TableLayout& layout) {
    if (shape.delimiter != ',')
        return Status::Ok();
    const SampleRows rows(shape, run, layout.columns);
    if (HasNameTooFew(shape, run) && AreWholeNumbers(rows, 1))
        return Status::InputFault("line " + std::to_string(shape.rows[run.first].line) +
                                  " has a field more than the names above it: a decimal comma may "
                                  "part its numbers; write decimal points, or say --decimal . if "
                                  "they are whole numbers");
    if (layout.nameLine > 0 || !settings.itemColumns.empty() || layout.items.size() != 1)
        return Status::Ok();
    const std::size_t item = layout.items[0];
    // The whole part may be taken for a label, where it never changes.
    for (std::size_t whole = item > 0 ? item - 1 : 0; whole <= item; ++whole)
        if (IsPlainNumber(layout, whole) && IsPlainNumber(layout, whole + 1) &&
            MayHoldDecimals(shape, run, rows, whole))
            return PairFault(shape, run, whole);
    return Status::Ok();
}

} // namespace ryn
