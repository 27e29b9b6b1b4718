#pragma once

#include <string>
#include <string_view>

#include <gtest/gtest.h>

#include "base/number_text.h"
#include "import/import.h"

namespace ryn::test {

/// A table imported from memory.
struct Imported {
    Status status;
    TableSamples samples;
    ImportReport report;

    explicit Imported(std::string_view text, const ImportOptions& options = {}) {
        MemorySource source("table.csv", text);
        status = ImportTable(source, options, "table", &samples, &report);
    }

    /// "2001-01-01 00:00:00 5; 2001-01-02 00:00:00 6.5"; seconds alone on a relative axis.
    std::string Samples() const {
        if (!status)
            return status.Text();
        std::string text;
        for (std::size_t i = 0; i < samples.Count(); ++i) {
            text += i > 0 ? "; " : "";
            text += samples.isRelative
                        ? ShortestText(static_cast<double>(samples.times[i]) / 1000.0)
                        : MomentText(samples.times[i]);
            for (const std::vector<float>& item : samples.values)
                text += " " + ShortestText(item[i]);
        }
        return text;
    }
    /// The same without the time of day where all are midnight.
    std::string Days() const {
        std::string text = Samples();
        for (std::size_t at = text.find(" 00:00:00"); at != std::string::npos;
             at = text.find(" 00:00:00"))
            text.erase(at, 9);
        return text;
    }
    std::string Report() const {
        std::string text;
        for (const std::string& line : ReportLines(report))
            text += line + "\n";
        return text;
    }
};

inline void ExpectContains(const std::string& text, const std::string& part) {
    EXPECT_NE(text.find(part), std::string::npos) << "no \"" << part << "\" in\n" << text;
}

} // namespace ryn::test
