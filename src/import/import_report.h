#pragma once

#include <optional>
#include <string>
#include <vector>

#include "import/table_layout.h"

namespace ryn {

/// Why rows were left out.
enum class DropReason {
    MissingValue,   ///< an item's value is missing
    IncompleteDate, ///< the date lacks its month
    EmptyRow,       ///< nothing but delimiters
    Divider,        ///< a line without letters and digits, or a merge mark
    RepeatedHeader, ///< the line of names again
    Footer,         ///< text behind the last row
    Duplicate,      ///< merged with another row of the same time, as asked
};

/// Rows that were left out for one reason.
struct DroppedRows {
    static constexpr std::size_t kMostLines = 10;

    DropReason reason = DropReason::MissingValue;
    long count = 0;
    std::vector<long> firstLines; ///< at most kMostLines

    void Add(long line);
};

/// Something that occurred in place of a value, or behind one.
struct OccurredText {
    std::string text; ///< empty for an empty field
    long count = 0;
    std::string origin; ///< why it was taken so; empty where it needs no reason
};

struct ImportedItem {
    std::string column; ///< its title in the table
    std::string name;
    std::string unit;     ///< empty where none is known
    std::string itemType; ///< as it is stored
};

/// What an import found out and did. The command prints it; a dialog can show it field by field.
struct ImportReport {
    std::string source;
    std::string form;   ///< "table", "DONAR DIF file", "netCDF file"
    TableLayout layout; ///< of a table
    std::vector<ImportedItem> items;
    std::vector<std::string> otherItems; ///< titles of columns that could be chosen as well
    std::vector<OccurredText> missing;   ///< codes and words for missing values
    std::vector<OccurredText> marks;     ///< quality marks behind values that were taken
    long rowsRead = 0;
    long samples = 0; ///< written
    std::vector<DroppedRows> dropped;
    bool isRelative = false;
    Millis first = 0;
    Millis last = 0;
    std::optional<Millis> equalStep; ///< of an equidistant axis
    std::vector<std::string> notes;

    DroppedRows& Dropped(DropReason reason);
};

/// The report as lines for a terminal, without line ends.
std::vector<std::string> ReportLines(const ImportReport& report);

/// "12, 13, 17 and 4 more": `lines` are the first of `count`.
std::string LineList(const std::vector<long>& lines, long count);

} // namespace ryn
