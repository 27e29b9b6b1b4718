#include "apps/cli/text_table.h"

#include <algorithm>
#include <ostream>

#include "apps/cli/plain_text.h"

namespace ryn::cli {

TextTable::TextTable(std::vector<Alignment> columnAlignments)
    : alignments(std::move(columnAlignments)),
      widths(alignments.size(), 0) {}

void TextTable::AddRow(const std::vector<std::string>& cells) {
    std::vector<std::string> row(alignments.size());
    for (std::size_t i = 0; i < std::min(row.size(), cells.size()); ++i) {
        row[i] = PlainLine(cells[i]);
        widths[i] = std::max(widths[i], DisplayWidth(row[i]));
    }
    rows.push_back(std::move(row));
}

void TextTable::Print(std::ostream& out) const {
    for (const std::vector<std::string>& row : rows)
        PrintRow(out, row);
}

void TextTable::PrintRow(std::ostream& out, const std::vector<std::string>& row) const {
    std::string line;
    for (std::size_t i = 0; i < row.size(); ++i) {
        const std::string padding(widths[i] - DisplayWidth(row[i]), ' ');
        if (i > 0)
            line += "  ";
        line += alignments[i] == Alignment::Right ? padding + row[i] : row[i] + padding;
    }
    line.erase(line.find_last_not_of(' ') + 1);
    out << line << '\n';
}

} // namespace ryn::cli
