#pragma once

#include <string>

#include "base/status.h"
#include "import/import_report.h"

namespace ryn {

/// The rows of a table that cannot be read: the first one's fault in full, and the lines of the
/// first few, so that a user sees at once whether it is one slip or the wrong column.
class BadRows {
  public:
    void Add(long line, const std::string& fault);
    bool IsEmpty() const { return rows.count == 0; }
    std::string Text() const;
    /// The same behind the table's name.
    Status AsFault(const std::string& source) const;

  private:
    std::string first;
    DroppedRows rows;
};

} // namespace ryn
