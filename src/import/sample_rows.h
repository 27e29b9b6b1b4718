#pragma once

#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "base/status.h"
#include "import/table_layout.h"
#include "import/table_shape.h"

namespace ryn {

/// Rows of a table's head with the columns they have, for questions about single columns. The shape
/// and the columns have to outlive it. Every row has all fields.
class SampleRows {
  public:
    SampleRows(const TableShape& shape, const RowRun& run,
               const std::vector<ColumnLayout>& columnLayouts);

    std::size_t Count() const { return rows.size(); }
    const std::vector<std::vector<std::string_view>>& All() const { return rows; }
    const std::vector<ColumnLayout>& Columns() const { return columns; }
    const ColumnLayout& Column(std::size_t index) const { return columns[index]; }
    std::size_t ColumnCount() const { return columns.size(); }
    char Decimal() const { return decimal; }
    /// Of the row at a position in All().
    long LineOf(std::size_t row) const { return lines[row]; }

    /// Whether a column has so many digits in every row, and nothing else, or is empty there.
    bool HasDigitsOnly(std::size_t column, std::size_t size) const;

  private:
    std::vector<std::vector<std::string_view>> rows;
    std::vector<long> lines;
    const std::vector<ColumnLayout>& columns;
    char decimal;
};

/// The column that a user means by a name or a number from 1; nothing for none.
std::optional<std::size_t> FindColumn(const std::vector<ColumnLayout>& columns,
                                      const std::string& nameOrNumber);
/// A fault that names the option and lists the columns.
Status NoSuchColumn(const std::string& option, const std::string& name, const TableLayout& layout);

} // namespace ryn
