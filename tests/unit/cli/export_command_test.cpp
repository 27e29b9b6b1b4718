#include <bit>
#include <cmath>
#include <cstdint>

#include <gtest/gtest.h>
#include <rapidcheck/gtest.h>

#include "apps/cli/export_command.h"
#include "base/number_text.h"
#include "command_fixture.h"

namespace ryn::cli {
namespace {

using ExportCommand = CommandTest;

/// A data file of two items over three days.
void WriteTwoItems(const std::string& path) {
    TsqHeaderHandle header;
    tsqHeaderCreate(4, "two", "test", 1, 2, 1, &header);
    tsqSetEqCalendarAxis(header.get(), "2001-12-31", "06:00:00", kUnitHour, 0.0, 24.0, 0);
    tsqSetItemInfo(header.get(), tsqItemD(header.get(), 1), kItemTypeUndefined, "Level, \"raw\"",
                   UnitOfText("m"), kTsqDataTypeFloat);
    tsqSetItemInfo(header.get(), tsqItemD(header.get(), 2), kItemTypeUndefined, "Flow",
                   kUnitUndefined, kTsqDataTypeFloat);
    TsqFileHandle file;
    ASSERT_EQ(tsqFileCreate(path, header.get(), &file), 0);
    for (int step = 0; step < 3; ++step) {
        const float level = 0.1F * static_cast<float>(step + 1);
        const float flow = step == 1 ? std::nanf("") : 16777216.0F;
        tsqWriteItemTimeStep(header.get(), file.get(), 24.0 * step, &level);
        tsqWriteItemTimeStep(header.get(), file.get(), 24.0 * step, &flow);
    }
    ASSERT_EQ(tsqFileClose(header.get(), &file), 0);
}

TEST_F(ExportCommand, WritesAHeadingAndALineForEachStep) {
    WriteTwoItems(files.Path("s.tsq0"));
    ASSERT_EQ(Run({"export", "s.tsq0"}), 0) << err;
    EXPECT_EQ(out, "time,\"Level, \"\"raw\"\" [m]\",Flow\n"
                   "2001-12-31T06:00:00,0.1,16777216\n"
                   "2002-01-01T06:00:00,0.2,\n"
                   "2002-01-02T06:00:00,0.3,16777216\n");
    ASSERT_EQ(Run({"export", "s.tsq0", "--item", "2", "-o", "t.csv"}), 0) << err;
    EXPECT_EQ(out, "");
    EXPECT_EQ(files.Read("t.csv"), "time,Flow\n2001-12-31T06:00:00,16777216\n"
                                   "2002-01-01T06:00:00,\n2002-01-02T06:00:00,16777216\n");
}

TEST_F(ExportCommand, ReplacesATableOnlyWithConsent) {
    WriteYearly("s.tsq0", {1, 2});
    files.Write("t.csv", "mine");
    EXPECT_EQ(Run({"export", "s.tsq0", "-o", "t.csv"}), 1);
    EXPECT_EQ(files.Read("t.csv"), "mine");
    EXPECT_EQ(Run({"export", "s.tsq0", "-o", "t.csv", "--yes"}), 0);
    EXPECT_THAT(files.Read("t.csv"), testing::StartsWith("time,"));
    EXPECT_EQ(files.EntryCount(), 2U);
}

TEST_F(ExportCommand, StopsWhenNobodyReadsAnyMore) {
    WriteYearly("s.tsq0", std::vector<double>(5000, 1.0));
    std::ostringstream closed;
    closed.setstate(std::ios::badbit);
    std::istringstream input;
    Console console{closed, closed, input, false};
    EXPECT_EQ(RunExport({"s.tsq0", std::nullopt, std::nullopt, Consent::NotGiven}, console), 0);
}

RC_GTEST_FIXTURE_PROP(ExportCommand, EveryValueComesBackToTheBit,
                      (const std::vector<std::uint32_t>& bits)) {
    test::Samples samples;
    for (const std::uint32_t pattern : bits)
        if (const auto value = std::bit_cast<float>(pattern); std::isfinite(value))
            samples.push_back(
                {test::At("2000-01-01") + COleDateTimeSpan(static_cast<double>(samples.size())),
                 static_cast<double>(value), 0});
    RC_ASSERT(test::WriteDataFile(files.Path("s.tsq0"), samples));
    RC_ASSERT(Run({"export", "s.tsq0"}) == 0);
    std::istringstream lines(out);
    std::string line;
    std::getline(lines, line);
    for (const STSItem& sample : samples) {
        RC_ASSERT(static_cast<bool>(std::getline(lines, line)));
        const auto value = ParseFloat(line.substr(line.find(',') + 1));
        RC_ASSERT(value.has_value());
        RC_ASSERT(std::bit_cast<std::uint32_t>(*value) ==
                  std::bit_cast<std::uint32_t>(static_cast<float>(sample.value)));
    }
    RC_ASSERT(!std::getline(lines, line));
}

} // namespace
} // namespace ryn::cli
