#pragma once

#include <functional>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "import/import_options.h"
#include "import/table_head.h"
#include "import/table_layout.h"

namespace ryn {

/// One line of the head, split; or the lines of a field with line breaks, as one.
struct HeadRow {
    long line = 0;
    bool isComment = false; ///< the fields are those behind the comment mark
    bool isDivider = false; ///< no row and no text: "======"
    bool hasData = false;   ///< at least one number or time
    std::string text;
    std::vector<std::string> fields;

    std::vector<std::string_view> Views() const { return {fields.begin(), fields.end()}; }
};

/// The grid that a table's head makes under its most convincing delimiter.
struct TableShape {
    char delimiter = ',';
    char decimal = '.';
    std::vector<std::string> commentMarks;
    std::size_t fieldCount = 0;    ///< of most rows
    std::vector<ColumnKind> kinds; ///< of its columns, by the last of the rows
    std::vector<HeadRow> rows;
};

/// Consecutive rows that belong together: positions in TableShape::rows, both ends included.
struct RowRun {
    std::size_t first = 0;
    std::size_t last = 0;
    std::size_t count = 0; ///< rows that conform
};

/// What a single field is. Numbers with a mark behind are Number where `marks` counts them so.
enum class FieldKind { Missing, Number, Marked, Grouped, Time, Text };
FieldKind KindOfField(std::string_view field, char decimal);

/// Splits the head under each delimiter and decimal sign that the settings leave open and takes the
/// pair that explains most fields as numbers and times. Nothing when no row has any.
std::optional<TableShape> FindShape(const TableHead& head, const ImportSettings& settings);

/// The start of a comment in a line, or 0 when the line is none.
std::size_t CommentMarkSize(std::string_view line, const std::vector<std::string>& marks);

using RowTest = std::function<bool(const HeadRow&)>;
/// A row of the right size whose fields are what their columns hold.
bool HasKindsOfColumns(const TableShape& shape, const HeadRow& row);
/// The runs of rows that pass the test, in order. Comments and dividers do not end a run, and
/// neither does a row that is one but for a fault in a field (reading will name it), nor a repeated
/// header.
std::vector<RowRun> FindRuns(const TableShape& shape, const RowTest& isRow);

} // namespace ryn
