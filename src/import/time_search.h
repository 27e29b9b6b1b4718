#pragma once

#include <algorithm>
#include <optional>
#include <vector>

#include "base/status.h"
#include "import/sample_rows.h"
#include "import/table_layout.h"

namespace ryn {

/// How well rows read under a layout.
struct TimeFit {
    double ok = 0.0;
    double incomplete = 0.0;
    double bad = 0.0;
    double withClock = 0.0;
    double withoutRise = 0.0; ///< rows that are not later than the one before

    double Total() const { return ok + incomplete + bad; }
    /// Nearly all rows have a time, or a date that lacks its day, and half of them are whole. A row
    /// with a fault does not make it none: reading names it.
    bool IsGood() const {
        const bool isNearlyAll = bad <= 0.1 * Total() || (bad <= 1.0 && ok >= 3.0);
        return ok > 0.0 && ok >= 0.5 * Total() && isNearlyAll;
    }
    /// And the times rise from row to row.
    bool Rises() const { return IsGood() && withoutRise <= 0.02 * Total(); }
};

TimeFit FitTime(const SampleRows& rows, const TimeLayout& time);

/// A layout of one column with dates.
TimeLayout DateLayout(std::size_t column, DateForm form);

/// What the search for time columns may look at.
struct TimeSearch {
    const SampleRows& rows;
    std::vector<std::size_t> columns; ///< those that may be taken
    bool hasStart = false;            ///< a date stands in for parts that no column gives

    bool Contains(std::size_t column) const {
        return std::find(columns.begin(), columns.end(), column) != columns.end();
    }
    /// True when nearly all rows have something that fits the role.
    bool IsUsable(std::size_t column, TimeRole role) const;
};

/// A column of whole dates (and clock times). False when there is none.
bool FindDateColumn(const TimeSearch& search, TimeLayout* time);

/// The column of times of day that goes with the dates of the layout, where these have none; notes
/// one that is empty too often. A fault for one that cannot be read.
Status FindClockColumn(const TimeSearch& search, TableLayout* layout);

/// A column of zone names ("EST", "EDT") beside the time.
void FindZoneColumn(const TimeSearch& search, TimeLayout* time);

/// What FindPartColumns came to.
enum class PartsResult {
    Found,
    None,
    NoMonth, ///< year and day, but no month between them
};

/// Year, month, day and so on in columns of their own, told by their names.
PartsResult FindPartColumns(const TimeSearch& search, TimeLayout* time);

/// Year, month and day (and hour, minute, second) side by side without names, told by their values.
bool FindUnnamedParts(const TimeSearch& search, TimeLayout* time);

/// "1999/00", "1999-2000": a year and the one after it.
bool IsHydrologicalYear(std::string_view field);
/// The first column of years such as "1999/00", which are no months; several rows have to tell.
std::optional<std::size_t> FindHydrologicalYears(const TimeSearch& search);

/// A column of months, years, decimal years, or lengths of time.
bool FindOtherTime(const TimeSearch& search, TimeLayout* time);

} // namespace ryn
