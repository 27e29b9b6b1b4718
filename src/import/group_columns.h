#pragma once

#include <string>
#include <string_view>
#include <unordered_map>
#include <vector>

#include "base/status.h"
#include "import/table_layout.h"

namespace ryn {

/// Watches the columns that may tell several series of one table apart: stations below each other,
/// parameters in turns. Taken as one series they would make a record that no gauge has.
class GroupColumns {
  public:
    /// The layout has to outlive it.
    explicit GroupColumns(const TableLayout& tableLayout);

    /// A row that gives a sample, in file order.
    void Add(long line, Millis moment, const std::vector<std::string_view>& fields);
    /// A fault that names the first line of the second series; none where the rows are one series.
    /// A column of quality flags makes none, and neither does one whose value is always the same or
    /// always another.
    Status Check(const std::string& source) const;

  private:
    /// What a column's heading says about it.
    enum class Naming {
        Group,   ///< a station, a site, a parameter
        Perhaps, ///< "id", "name"; or a text without a heading in front of the values
        None,
    };
    struct Group {
        std::string name;
        long line = 0; ///< of its first row
    };
    struct Column {
        std::size_t index = 0;
        Naming naming = Naming::None;
        long rows = 0;
        long runs = 0;
        long clashes = 0; ///< changes at which time does not rise
        bool isFull = false;
        std::size_t last = 0;      ///< the group of the row before
        std::vector<Group> groups; ///< as they occur first
        std::unordered_map<std::string, std::size_t> positions;
    };

    Naming NamingOf(std::size_t column) const;
    bool IsWatched(std::size_t column) const;
    void AddTo(Column* column, long line, bool rises, std::string_view field);
    bool TellsSeriesApart(const Column& column) const;

    const TableLayout& layout;
    std::vector<Column> columns;
    Millis previous = 0;
};

} // namespace ryn
