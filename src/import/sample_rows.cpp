#include "import/sample_rows.h"

#include <algorithm>

#include "base/number_text.h"
#include "import/table_text.h"
#include "import/unit_text.h"

namespace ryn {

SampleRows::SampleRows(const TableShape& shape, const RowRun& run,
                       const std::vector<ColumnLayout>& columnLayouts)
    : columns(columnLayouts),
      decimal(shape.decimal) {
    for (std::size_t i = run.first; i <= run.last && i < shape.rows.size(); ++i) {
        const HeadRow& row = shape.rows[i];
        // Rows of another size, empty ones and headers within say nothing about single columns.
        if (!row.hasData || row.fields.size() != shape.fieldCount)
            continue;
        rows.push_back(row.Views());
        lines.push_back(row.line);
    }
}

bool SampleRows::HasDigitsOnly(std::size_t column, std::size_t size) const {
    return std::all_of(rows.begin(), rows.end(), [column, size](const auto& fields) {
        return fields[column].empty() ||
               (IsDigits(fields[column]) && fields[column].size() == size);
    });
}

std::optional<std::size_t> FindColumn(const std::vector<ColumnLayout>& columns,
                                      const std::string& nameOrNumber) {
    const std::string wanted(Trimmed(nameOrNumber));
    const std::optional<int> number = IsDigits(wanted) ? ParseInt(wanted) : std::nullopt;
    // A number goes before a name: a column named "2" is rare, and its number names it as well.
    if (number && *number >= 1 && static_cast<std::size_t>(*number) <= columns.size())
        return static_cast<std::size_t>(*number) - 1;
    std::string withoutUnit;
    std::string unit;
    SplitNameAndUnit(wanted, &withoutUnit, &unit);
    // As written first: names may differ in case alone ("MM" and "mm").
    for (std::size_t i = 0; i < columns.size(); ++i)
        if (!wanted.empty() && columns[i].name == wanted)
            return i;
    for (std::size_t i = 0; i < columns.size(); ++i) {
        const std::string name = Lowercase(columns[i].name);
        if (!name.empty() && (name == Lowercase(wanted) || name == Lowercase(withoutUnit)))
            return i;
    }
    return std::nullopt;
}

Status NoSuchColumn(const std::string& option, const std::string& name, const TableLayout& layout) {
    // One readable line, whatever the table.
    constexpr std::size_t kMostListed = 30;
    std::string list;
    for (std::size_t i = 0; i < layout.columns.size() && i < kMostListed; ++i)
        list += (i > 0 ? ", " : "") + ColumnTitle(layout, i);
    return Status::InputFault(option + " " + Quoted(name) + ": no such column; there are " + list);
}

std::string ColumnTitle(const TableLayout& layout, std::size_t column) {
    std::string number = std::to_string(column + 1);
    if (column >= layout.columns.size() || layout.columns[column].name.empty())
        return number;
    return number + " " + Quoted(layout.columns[column].name);
}

} // namespace ryn
