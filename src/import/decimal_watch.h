#pragma once

#include <optional>
#include <string>
#include <string_view>

#include "base/status.h"
#include "import/table_layout.h"

namespace ryn {

/// Watches a table's values for a sign that may part thousands as well as decimals. A comma is in
/// doubt where every number with one reads as thousands ("1,224"); a point, which decimals mostly
/// have, only where whole numbers of hundreds stand beside those ("377", "1.131"). A value that is
/// written as thousands are not ("0.754", "1.5", "1131") ends the watch, and so does the user's own
/// word. The whole table is watched: its first rows may all be below a thousand.
class DecimalWatch {
  public:
    /// The layout has to outlive it.
    explicit DecimalWatch(const TableLayout& tableLayout)
        : layout(tableLayout),
          isSettled(tableLayout.isDecimalGiven) {}

    /// A number as it is written, without a mark behind it.
    void Look(long line, std::size_t column, std::string_view number) {
        // Most whole numbers tell nothing more; this runs for each value.
        const bool isKnown =
            hundreds && number.size() <= 3 && number.find(layout.decimal) == std::string_view::npos;
        if (!isSettled && !isKnown)
            LookCloser(line, column, number);
    }
    /// A fault that names the first value in doubt.
    Status Verdict() const;

  private:
    struct Place {
        long line = 0;
        std::size_t column = 0;
        std::string number;
    };
    void LookCloser(long line, std::size_t column, std::string_view number);
    void LookAtWhole(long line, std::size_t column, std::string_view digits);

    const TableLayout& layout;
    bool isSettled;
    std::optional<Place> inDoubt;
    std::optional<Place> hundreds;
};

} // namespace ryn
