#include "import/bad_rows.h"

namespace ryn {

void BadRows::Add(long line, const std::string& fault) {
    if (rows.count == 0)
        first = "line " + std::to_string(line) + ": " + fault;
    rows.Add(line);
}

std::string BadRows::Text() const {
    if (rows.count <= 1)
        return first;
    return first + " (" + std::to_string(rows.count) + " rows cannot be read: lines " +
           LineList(rows.firstLines, rows.count) + ")";
}

Status BadRows::AsFault(const std::string& source) const {
    return Status::InputFault(source + ": " + Text());
}

} // namespace ryn
