#include "engine/run_log.h"

#include <array>
#include <ctime>
#include <filesystem>
#include <system_error>

#include "engine/plain_text.h"

namespace ryn {

RunLog::RunLog(const std::string& directory) {
    if (directory.empty())
        return;
    const std::string path = directory + "Ryn.log";
    std::error_code error;
    const auto existing = std::filesystem::status(path, error);
    // Opening a pipe would wait for its reader.
    if (std::filesystem::exists(existing) && !std::filesystem::is_regular_file(existing))
        return;
    // A new file, which needs a writable directory only: an old log must not pass for this run's.
    std::filesystem::remove(path, error);
    stream.reset(std::fopen(path.c_str(), "wb"));
}

void RunLog::Line(std::string_view text) {
    if (stream == nullptr)
        return;
    const std::string line = PlainText(text) + "\n";
    // A full disk loses the log and nothing else: results go another way.
    std::fwrite(line.data(), 1, line.size(), stream.get());
    std::fflush(stream.get());
}

void RunLog::Warning(const std::string& text) {
    warned = true;
    Line("warning: " + text);
}

void RunLog::Error(const std::string& text) {
    Line("error: " + text);
}

std::string ProgramText() {
    return "Ryn extreme value analysis, version " RYN_VERSION;
}

std::string NowText() {
    // Local time: users look for the run that they have just made.
    const std::time_t now = std::time(nullptr);
    std::tm fields{};
    if (localtime_r(&now, &fields) == nullptr)
        return "unknown date";
    std::array<char, 32> text{};
    return {text.data(), std::strftime(text.data(), text.size(), "%Y-%m-%d %H:%M:%S", &fields)};
}

} // namespace ryn
