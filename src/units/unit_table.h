#pragma once

#include <span>
#include <string_view>

/// The table of units with a fixed code. Codes are stored in files: a row may be added, but none
/// changed or taken away. docs/decisions/data-files-unit-codes.md tells how they were chosen.
namespace ryn {

struct UnitRow {
    int code;
    /// As UDUNITS reads it; what a file's `units` says.
    std::string_view text;
    /// The same unit in other writings, parted by "|".
    std::string_view aliases;
};

/// Ascending by code.
std::span<const UnitRow> UnitTable();

/// The row of a code; null for a code that the table does not hold.
const UnitRow* FindUnitRow(int code);

/// Codes from here on belong to texts outside the table, for the life of the process.
inline constexpr int kFirstInternedUnit = 100000;

} // namespace ryn
