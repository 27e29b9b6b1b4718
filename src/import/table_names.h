#pragma once

#include "import/table_layout.h"
#include "import/table_shape.h"

namespace ryn {

/// Finds the names and units of the columns in the lines above the first row (position `firstRow`
/// of the shape's rows): the nearest line, or block of lines, with as many fields as the rows have.
/// A line of column types is passed over; a line of units gives the units; names with a unit behind
/// are parted. Sets columns, nameLine and unitLine. Kinds are the shape's.
void FindNames(const TableShape& shape, std::size_t firstRow, TableLayout* layout);

/// What the free text above the table says: codes for missing values, and the unit where no
/// column gives one.
void ReadPreamble(const TableShape& shape, std::size_t firstRow, TableLayout* layout);

} // namespace ryn
