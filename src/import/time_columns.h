#pragma once

#include <vector>

#include "base/status.h"
#include "import/import_options.h"
#include "import/table_layout.h"
#include "import/table_shape.h"

namespace ryn {

/// Rows of a table's head with the columns they have, for questions about single columns.
class SampleRows {
  public:
    SampleRows(const TableShape& shape, const RowRun& run,
               const std::vector<ColumnLayout>& columns);

    std::size_t Count() const { return rows.size(); }
    const std::vector<std::vector<std::string_view>>& All() const { return rows; }
    const ColumnLayout& Column(std::size_t index) const { return columns[index]; }
    std::size_t ColumnCount() const { return columns.size(); }
    char Decimal() const { return decimal; }

  private:
    std::vector<std::vector<std::string_view>> rows;
    const std::vector<ColumnLayout>& columns;
    char decimal;
};

/// Finds the columns that say when a row was measured, and how to read them; notes what the user
/// should know. A fault says what to give. The layout's columns are set already.
Status FindTime(const SampleRows& rows, const ImportSettings& settings, TableLayout* layout);

/// The column that a user means by a name or a number from 1; nothing for none.
std::optional<std::size_t> FindColumn(const std::vector<ColumnLayout>& columns,
                                      const std::string& nameOrNumber);
/// A fault that names the option and lists the columns.
Status NoSuchColumn(const std::string& option, const std::string& name, const TableLayout& layout);

} // namespace ryn
