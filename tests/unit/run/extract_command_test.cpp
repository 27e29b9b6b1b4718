#include "run/extract_command.h"

#include <filesystem>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "strings/text_id.h"
#include "support/recording_ports.h"
#include "support/sample_series.h"
#include "support/temporary_directory.h"

namespace ryn {
namespace {

using test::RecordingPorts;
using test::SamplesOf;
using test::TemporaryDirectory;
using test::WriteDataFile;
using ::testing::HasSubstr;

struct Case {
    TemporaryDirectory directory;
    RecordingPorts ports;
    CGlobalKvf root;

    Case() {
        root.Values().UsePorts(ports);
        CBasicInputKvf& basic = root.BasicInput();
        basic.InputFileName = directory.Path("in.tsq0");
        basic.OutputFileName = directory.Path("out.tsq0");
        basic.InputItem = 1;
        EXPECT_TRUE(
            WriteDataFile(basic.InputFileName, SamplesOf({{"1990-05-01", 3}, {"1991-05-01", 4}})));
    }
    ExtractionResult Run() { return ExtractSeriesOf(root); }
};

TEST(ExtractCommand, WritesTheSeriesAndFreesTheSamples) {
    Case run;
    const ExtractionResult result = run.Run();
    ASSERT_TRUE(result.status) << result.status.Text();
    EXPECT_EQ(result.report.selected, 2);
    CTsqValues series;
    ASSERT_TRUE(series.ReadSummary(run.directory.Path("out.tsq0"), 0));
    EXPECT_EQ(series.maximum.value, 4.0);
    EXPECT_EQ(run.root.Values().samples.capacity(), 0U);
}

TEST(ExtractCommand, RefusesMissingNamesAndUnreadableInput) {
    Case run;
    run.root.BasicInput().OutputFileName.clear();
    EXPECT_EQ(run.Run().messageId, kTextExtractionNameMissing);
    run.root.BasicInput().OutputFileName = run.directory.Write("out.tsq0", "old");
    run.root.BasicInput().InputFileName = run.directory.Path("none.tsq0");
    EXPECT_EQ(run.Run().messageId, kTextExtractionInputUnreadable);
    EXPECT_EQ(run.Run().status.Kind(), Fault::Input);
    EXPECT_EQ(run.directory.Read("out.tsq0"), "old");
}

TEST(ExtractCommand, KeepsTheOldSeriesWhenTheInputIsBad) {
    Case run;
    run.directory.Write("out.tsq0", "old");
    run.root.BasicInput().InputItem = 2;
    EXPECT_THAT(run.Run().status.Text(), HasSubstr("there is no item 2"));
    run.root.BasicInput().InputItem = 1;
    run.root.BasicInput().AmsStartDate = COleDateTime();
    EXPECT_EQ(run.Run().messageId, kTextInvalidYearStart);
    run.root.BasicInput().AmsStartDate = COleDateTime(1990, 1, 1, 0, 0, 0);
    run.root.BasicInput().InputFileName = run.directory.Write("bad.tsq0", "CDF\1 no more");
    EXPECT_THAT(run.Run().status.Text(), HasSubstr("bad.tsq0"));
    EXPECT_EQ(run.directory.Read("out.tsq0"), "old");
}

TEST(ExtractCommand, RefusesToReplaceItsOwnInput) {
    Case run;
    const std::string before = run.directory.Read("in.tsq0");
    std::filesystem::create_symlink("in.tsq0", run.directory.Root() / "out.tsq0");
    EXPECT_EQ(run.Run().messageId, kTextExtractionOverInput);
    EXPECT_EQ(run.directory.Read("in.tsq0"), before);
}

TEST(ExtractCommand, ReportsAnOutputThatCannotBeWritten) {
    Case run;
    run.root.BasicInput().OutputFileName = run.directory.Path("none/out.tsq0");
    EXPECT_EQ(run.Run().messageId, kTextExtractionOutputUnwritable);
    EXPECT_EQ(run.Run().status.Kind(), Fault::System);
    run.root.BasicInput().OutputFileName = "/dev/full";
    EXPECT_THAT(run.Run().status.Text(), HasSubstr("/dev/full"));
    EXPECT_EQ(run.Run().status.Kind(), Fault::System);
}

} // namespace
} // namespace ryn
