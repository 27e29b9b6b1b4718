#pragma once

#include <iosfwd>
#include <string>
#include <vector>

namespace ryn::cli {

enum class Alignment { Left, Right };

/// Rows of cells printed with aligned columns, two blanks between them and none at the end of a
/// line. Cells are made harmless (PlainLine) on their way in.
class TextTable {
  public:
    explicit TextTable(std::vector<Alignment> columnAlignments);

    /// A row may be shorter than the table; its other cells are empty. Further cells are dropped.
    void AddRow(const std::vector<std::string>& cells);
    void Print(std::ostream& out) const;

  private:
    void PrintRow(std::ostream& out, const std::vector<std::string>& row) const;

    std::vector<Alignment> alignments;
    std::vector<std::size_t> widths;
    std::vector<std::vector<std::string>> rows;
};

} // namespace ryn::cli
