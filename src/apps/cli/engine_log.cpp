#include "apps/cli/engine_log.h"

#include <algorithm>
#include <chrono>
#include <cstddef>
#include <ostream>
#include <sstream>
#include <string_view>
#include <system_error>
#include <vector>

#include "apps/cli/plain_text.h"
#include "base/file_access.h"
#include "strings/catalogue.h"

namespace ryn::cli {

namespace {

/// Nothing where the log cannot be read.
std::vector<std::string> LinesOf(const std::string& path) {
    constexpr std::size_t kLargestLog = 64U << 20U;
    std::string text;
    std::vector<std::string> lines;
    if (!ReadWholeFile(path, kLargestLog, &text))
        return lines;
    std::istringstream stream(text);
    for (std::string line; std::getline(stream, line);)
        lines.push_back(PlainLine(line));
    return lines;
}

} // namespace

bool EngineLogWatch::HasSeen(const std::string& path) const {
    // File systems keep times to two seconds at worst.
    constexpr std::chrono::seconds kCoarsest(2);
    std::error_code error;
    const auto written = std::filesystem::last_write_time(path, error);
    return !error && written >= start - kCoarsest;
}

std::string LastErrorIn(const std::string& path) {
    constexpr std::string_view kMark = "error: ";
    const std::vector<std::string> lines = LinesOf(path);
    const auto found = std::find_if(lines.rbegin(), lines.rend(), [kMark](const std::string& line) {
        return line.compare(0, kMark.size(), kMark) == 0;
    });
    return found != lines.rend() ? found->substr(kMark.size()) : std::string();
}

// The log of a long list of combinations tells at its end what went wrong.
void ShowEngineLog(const std::string& path, bool isOfThisRun, Console& console) {
    constexpr std::size_t kLinesShown = 20;
    const std::vector<std::string> lines = isOfThisRun ? LinesOf(path) : std::vector<std::string>();
    if (lines.empty()) {
        ShowError(console, FormatText(kTextCliNoLog, path));
        return;
    }
    ShowError(console, FormatText(kTextCliRunFailed, path));
    const std::size_t first = lines.size() - std::min(lines.size(), kLinesShown);
    for (std::size_t i = first; i < lines.size(); ++i)
        console.err << "  " << lines[i] << '\n';
}

} // namespace ryn::cli
