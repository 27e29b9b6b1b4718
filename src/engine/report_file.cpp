#include "engine/report_file.h"

namespace ryn {

ReportFile::ReportFile(const std::string& directory, const std::string& name)
    : wanted(!directory.empty()) {
    if (wanted)
        opened = file.Open(directory + name);
}

void ReportFile::Write(std::string_view text) {
    if (wanted && opened) // the reason is told once, at the end
        file.Write(text);
}

Status ReportFile::Finish() {
    if (!wanted || !opened)
        return opened;
    // The next run overwrites it: nothing that a power cut may not take.
    return file.Commit(Durability::Unflushed);
}

} // namespace ryn
