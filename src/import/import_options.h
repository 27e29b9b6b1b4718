#pragma once

#include <optional>
#include <string>
#include <vector>

#include "base/status.h"
#include "import/civil_time.h"
#include "import/date_text.h"
#include "import/text_encoding.h"
#include "import/time_pattern.h"

namespace ryn {

/// What a user says about a table; everything left open is found out from the table. The texts are
/// those of the command line's options.
struct ImportOptions {
    std::vector<std::string> timeColumns; ///< names or numbers from 1; several are joined
    std::vector<std::string>
        itemColumns;        ///< names or numbers from 1; empty: the first with numbers
    std::string unit;       ///< of every item
    std::string name;       ///< of the item; with several items a fault
    std::string delimiter;  ///< one character, or comma, semicolon, tab, bar, blank
    std::string decimal;    ///< "." or ","
    std::string comment;    ///< lines that begin so are passed over
    std::string encoding;   ///< "utf-8", "latin-1", "shift_jis", ...
    std::string timeFormat; ///< as for TimePattern, or excel, unix, decimal-year, year
    std::string start;      ///< with step the axis itself; alone, parts that the columns lack
    std::string step;       ///< as for ParseTimeStep
    std::vector<std::string>
        missing;        ///< codes and marks; "none" alone turns the search for codes off
    long skipLines = 0; ///< lines at the start that are no part of the table
    bool sort = false;  ///< rows may stand in any order
    std::string duplicates = "refuse"; ///< "refuse", "first", "last" or "max"
};

enum class DuplicateRule { Refuse, First, Last, Maximum };
enum class RowOrder { MustRise, Any };

/// Values that stand for a missing one.
struct MissingRules {
    std::vector<std::string> texts; ///< given codes; they also match a value's mark
    std::vector<float> numbers;     ///< the given codes that are numbers
    bool searchCodes = true;        ///< numeric codes are looked for: none were given
};

/// The options with their texts understood.
struct ImportSettings {
    std::optional<char> delimiter;
    std::optional<char> decimal;
    std::optional<TextEncoding> encoding;
    std::optional<DateForm> dateForm;
    std::optional<TimePattern> pattern;
    std::optional<Millis> start;
    std::optional<TimeStep> step;
    std::vector<std::string> timeColumns;
    std::vector<std::string> itemColumns;
    std::vector<std::string> commentMarks; ///< empty: the usual ones
    std::string unit;
    std::string name;
    MissingRules missing;
    long skipLines = 0;
    RowOrder order = RowOrder::MustRise;
    DuplicateRule duplicates = DuplicateRule::Refuse;
};

/// A fault names the option and what it may be.
Status ParseImportOptions(const ImportOptions& options, ImportSettings* settings);

} // namespace ryn
