#pragma once

#include <cstddef>
#include <optional>
#include <string>
#include <vector>

#include "import/civil_time.h"
#include "import/date_text.h"
#include "import/text_encoding.h"
#include "import/time_pattern.h"

namespace ryn {

/// What a column holds in the rows that were looked at.
enum class ColumnKind {
    Number,
    Time, ///< dates or times of day that are no plain numbers
    Text,
    Empty, ///< nothing but missing values so far
};

struct ColumnLayout {
    std::string name; ///< without its unit; empty where the table has none
    std::string unit; ///< empty where the table has none
    ColumnKind kind = ColumnKind::Text;
};

/// What one of the columns says about the time of its row.
enum class TimeRole {
    Date,
    Clock, ///< a time of day
    Year,
    Month,
    Day,
    DayOfYear,
    Hour,       ///< 0 to 24
    HourMinute, ///< 0 to 2400, the minutes in the last two digits
    Minute,
    Second,
    Zone,
    Elapsed, ///< a number of units since the origin
};

struct TimeColumn {
    std::size_t column = 0; ///< from 0
    TimeRole role = TimeRole::Date;
};

enum class TimeSource {
    Columns,      ///< each by its role
    Pattern,      ///< the texts of the columns, joined with blanks
    StartAndStep, ///< no column: every row is one step later
};

/// How a row's time is read.
struct TimeLayout {
    TimeSource source = TimeSource::Columns;
    std::vector<TimeColumn> columns;
    DateForm form = DateForm::YearMonthDay; ///< of the column with role Date
    std::vector<DateForm> rivals;           ///< other forms that the rows looked at fit as well
    std::optional<TimePattern> pattern;
    Millis elapsedUnit = 0;  ///< of role Elapsed
    Millis origin = 0;       ///< added to each time: where lengths of time count from
    bool isRelative = false; ///< lengths of time without an origin: no calendar
    TimeDefaults defaults;   ///< for parts that no column gives
    Millis start = 0;        ///< with source StartAndStep
    TimeStep step;
};

/// A numeric code that the table's own header announces.
struct AnnouncedCode {
    float value = 0.0F;
    long line = 0;
};

/// Everything that is needed to read a table's rows.
struct TableLayout {
    TextEncoding encoding = TextEncoding::Utf8;
    char delimiter = ',';
    char decimal = '.';
    bool isDecimalGiven = false; ///< by the user: it is not doubted
    std::vector<std::string> commentMarks;
    long nameLine = 0; ///< 0 where there is none
    long unitLine = 0;
    long dataLine = 1; ///< the first row
    std::vector<ColumnLayout> columns;
    TimeLayout time;
    std::vector<std::size_t> items;  ///< columns, from 0
    std::vector<std::size_t> months; ///< twelve columns of one item, a year's months on each row
    std::vector<AnnouncedCode> announced;
    std::vector<std::vector<std::string>> preview; ///< the first rows as fields
    std::vector<std::string> notes;                ///< what a user should know about the guesses
};

/// "3 \"discharge\"", or "3" for a column without a name.
std::string ColumnTitle(const TableLayout& layout, std::size_t column);

} // namespace ryn
