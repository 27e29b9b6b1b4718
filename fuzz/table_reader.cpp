#include <cmath>
#include <cstddef>
#include <cstdint>
#include <cstdlib>
#include <string>
#include <string_view>

#include "import/import.h"

namespace {

/// Options by the bits of the input's first byte, so that the rows behind the guesses are reached.
ryn::ImportOptions OptionsOf(std::uint8_t bits) {
    ryn::ImportOptions options;
    options.sort = (bits & 1) != 0;
    options.duplicates = (bits & 2) != 0 ? "max" : "refuse";
    if ((bits & 4) != 0)
        options.start = "1990-01-01";
    if ((bits & 12) == 12)
        options.step = "1mo";
    if ((bits & 16) != 0)
        options.timeFormat = "%d.%m.%y";
    if ((bits & 32) != 0)
        options.missing = {"", "-9", "e"};
    if ((bits & 64) != 0)
        options.itemColumns = {"2", "3"};
    return options;
}

void Require(bool condition) {
    if (!condition)
        std::abort();
}

} // namespace

/// A table either gives samples in rising order with finite values, or one line that names it.
extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    if (size == 0)
        return 0;
    ryn::MemorySource source("input",
                             std::string_view(reinterpret_cast<const char*>(data + 1), size - 1));
    ryn::TableSamples samples;
    ryn::ImportReport report;
    const ryn::Status status =
        ryn::ImportTable(source, OptionsOf(data[0]), "input", &samples, &report);
    Require(!ryn::ReportLines(report).empty());
    if (!status) {
        Require(!status.Text().empty() && status.Text().find('\n') == std::string::npos);
        return 0;
    }
    Require(samples.Count() > 0 && samples.values.size() == report.items.size());
    for (std::size_t i = 0; i < samples.Count(); ++i) {
        Require(i == 0 || samples.times[i] > samples.times[i - 1]);
        for (const auto& item : samples.values)
            Require(std::isfinite(item[i]));
    }
    return 0;
}
