#pragma once

#include <optional>
#include <string>
#include <vector>

#include "import/table_layout.h"

namespace ryn {

/// The part of a date that a column's name announces ("Year", "jaar", "MM", "hr", "doy"); nothing
/// for another name. "mm" is Month; RolesOfNames tells it from minutes.
std::optional<TimeRole> RoleOfName(const std::string& name);

/// The role of each column by its name. A second "mm" is the minute, and so is "mm" beside "MM". A
/// role that occurs twice keeps its first column.
std::vector<std::optional<TimeRole>> RolesOfNames(const std::vector<ColumnLayout>& columns);

/// A name for minutes behind a column of hours, "mm" included.
bool IsMinuteName(const std::string& name);

/// True for the name of a column that holds a time, whatever its values ("date", "peak_tm").
bool IsTimeName(const std::string& name);

} // namespace ryn
