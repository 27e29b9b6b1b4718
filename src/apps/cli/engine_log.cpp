#include "apps/cli/engine_log.h"

#include <algorithm>
#include <chrono>
#include <cstddef>
#include <ostream>
#include <sstream>
#include <system_error>
#include <vector>

#include "apps/cli/plain_text.h"
#include "base/file_access.h"
#include "strings/catalogue.h"

namespace ryn::cli {

bool EngineLogWatch::HasSeen(const std::string& path) const {
    // File systems keep times to two seconds at worst.
    constexpr std::chrono::seconds kCoarsest(2);
    std::error_code error;
    const auto written = std::filesystem::last_write_time(path, error);
    return !error && written >= start - kCoarsest;
}

// The log of a long list of combinations tells at its end what went wrong.
void ShowEngineLog(const std::string& path, bool isOfThisRun, Console& console) {
    constexpr std::size_t kLinesShown = 20;
    constexpr std::size_t kLargestLog = 64U << 20U;
    std::string text;
    if (!isOfThisRun || !ReadWholeFile(path, kLargestLog, &text)) {
        ShowError(console, FormatText(kTextCliNoLog, path));
        return;
    }
    std::vector<std::string> lines;
    std::istringstream stream(text);
    for (std::string line; std::getline(stream, line);)
        lines.push_back(PlainLine(line));
    ShowError(console, FormatText(kTextCliRunFailed, path));
    const std::size_t first = lines.size() - std::min(lines.size(), kLinesShown);
    for (std::size_t i = first; i < lines.size(); ++i)
        console.err << "  " << lines[i] << '\n';
}

} // namespace ryn::cli
