#include "import/bad_rows.h"

namespace ryn {

void BadRows::Add(long line, const std::string& fault) {
    if (rows.count == 0)
        first = "line " + std::to_string(line) + ": " + fault;
    rows.Add(line);
}

Status BadRows::AsFault(const std::string& source) const {
    std::string text = source + ": " + first;
    if (rows.count > 1)
        text += " (" + std::to_string(rows.count) + " rows cannot be read: lines " +
                LineList(rows.firstLines, rows.count) + ")";
    return Status::InputFault(text);
}

} // namespace ryn
