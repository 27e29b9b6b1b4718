#pragma once

#include <string_view>

#include "import/bad_rows.h"
#include "import/decimal_watch.h"
#include "import/import_options.h"
#include "import/import_report.h"
#include "import/number_field.h"
#include "import/table_layout.h"

namespace ryn {

/// Ordered by what they mean for a row with several items.
enum class ValueResult { Taken, Missing, Bad };

/// Reads the items' fields of a table's rows; counts missing words, given codes and quality marks
/// in the report, and collects what is no value. All arguments have to outlive it.
class ItemValues {
  public:
    ItemValues(const TableLayout& tableLayout, const MissingRules& missingRules,
               ImportReport* importReport, BadRows* badRows);

    /// *value is set when it is Taken.
    ValueResult Read(long line, std::size_t column, std::string_view field, float* value);
    /// Whether the user says that an empty field is a missing value ("--missing \"\""): then a row
    /// that ends too early and a blank line are as well.
    bool IsEmptyGiven() const { return emptyIsGiven; }
    ValueResult CountMissing(std::string_view text);
    /// A fault where the values read leave open what their decimal sign is.
    Status DecimalVerdict() const { return decimals.Verdict(); }

  private:
    bool IsGiven(const NumberField& number, std::string_view field) const;
    bool IsGivenText(std::string_view text) const;
    ValueResult Refuse(long line, std::size_t column, std::string_view field, NumberKind kind);

    const TableLayout& layout;
    const MissingRules& missing;
    ImportReport* report;
    BadRows* bad;
    DecimalWatch decimals;
    bool emptyIsGiven;
};

} // namespace ryn
