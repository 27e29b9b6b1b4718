#include "run/run_command.h"

#include <filesystem>
#include <memory>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "support/recording_ports.h"
#include "support/sample_series.h"
#include "support/temporary_directory.h"
#include "unit/results/sample_results.h"

namespace ryn {
namespace {

using test::kSampleOutput;
using test::OutputText;
using test::RecordingPorts;
using test::SettingsText;
using test::TemporaryDirectory;
using ::testing::ElementsAre;
using ::testing::HasSubstr;
using ::testing::IsEmpty;

constexpr const char* kFindings = "Computation can not start because of error(s) in input data.";
constexpr const char* kUnwritable = "Can not create output file";
constexpr const char* kCompleted = "Computation completed successfully.";
constexpr const char* kFailed =
    "Errors occured during computation. Do you want to view the log file ?";

/// What the engine's double is told, and what it saw.
struct EngineDouble {
    std::int32_t status = 0;
    int calls = 0;
    std::int32_t statusBefore = -1;
    std::string input;
    std::string directory;
    bool resultsWereThere = false;
    const CRynEditDoc* document = nullptr;
} engineDouble;

void CallDouble(const KvfHandle* input, KvfHandle* output, std::int32_t* status) {
    ++engineDouble.calls;
    engineDouble.statusBefore = *status;
    engineDouble.input = kvfText(input->get());
    engineDouble.directory = std::filesystem::current_path();
    engineDouble.resultsWereThere =
        const_cast<CRynEditDoc*>(engineDouble.document)->Results().IsValid();
    *output = kvfLoadText(kSampleOutput, "engine");
    *status = engineDouble.status;
}

/// An analysis of a series of five years, with its result file.
struct Case {
    TemporaryDirectory directory;
    RecordingPorts ports;
    CRynEditDoc document;

    Case() {
        engineDouble = {};
        engineDouble.document = &document;
        document.UsePorts(ports);
        CDefineEVSKvf& series = document.GetGlobalKvf().DefineEVS();
        series.InputFileName = directory.Path("series.tsq0");
        series.InputItem = 1;
        series.OutputFileName = directory.Path("a.res");
        EXPECT_TRUE(
            test::WriteDataFile(series.InputFileName, test::Daily("1990-05-01", {3, 4, 5, 6, 7})));
        document.OnSaveDocument(directory.Path("a.ryn"));
    }
    RunOutcome Run(std::int32_t engineStatus = 0) {
        ports.messages.clear();
        ports.questions.clear();
        engineDouble.status = engineStatus;
        return RunAnalysis(document, CallDouble);
    }
    COutputSettings& Results() { return document.Results(); }
};

TEST(RunCommand, TakesTheResultsOfEveryStatusButOneAndThree) {
    for (const std::int32_t status : {0, 2, 4, -1}) {
        Case run;
        run.document.GetGlobalKvf().Analysis().RunTest = true; // saved before the engine reads
        EXPECT_EQ(run.Run(status).end, RunEnd::Succeeded);
        EXPECT_THAT(run.ports.messages, ElementsAre(kCompleted));
        EXPECT_TRUE(run.Results().IsValid());
        EXPECT_EQ(run.directory.Read("a.res"), kSampleOutput + SettingsText(run.Results()));
        EXPECT_FALSE(run.document.IsModified());
        EXPECT_EQ(engineDouble.statusBefore, 0);
        EXPECT_EQ(engineDouble.input, run.directory.Read("a.RYN"));
        EXPECT_THAT(engineDouble.input, HasSubstr("RunTest = true"));
    }
}

TEST(RunCommand, OffersTheLogOfAFailedRun) {
    for (const std::int32_t status : {1, 3}) {
        Case run;
        ASSERT_EQ(run.Run().end, RunEnd::Succeeded);
        const std::string earlier = run.directory.Read("a.res");
        const RunOutcome outcome = run.Run(status);
        EXPECT_EQ(outcome.end, RunEnd::EngineFailed);
        EXPECT_EQ(outcome.engineStatus, status);
        EXPECT_EQ(outcome.logFile, run.directory.Path("Ryn.log"));
        EXPECT_THAT(run.ports.questions, ElementsAre(kFailed));
        EXPECT_THAT(run.ports.messages, IsEmpty());
        EXPECT_THAT(run.ports.viewedFiles, IsEmpty()); // the answer was No
        EXPECT_FALSE(run.Results().IsValid());
        // The save before the engine wrote the earlier results back.
        EXPECT_EQ(run.directory.Read("a.res"), earlier);
        run.ports.answer = Answer::Yes;
        run.Run(status);
        EXPECT_THAT(run.ports.viewedFiles, ElementsAre(run.directory.Path("Ryn.log")));
        EXPECT_EQ(run.directory.Read("a.res"), ""); // nothing was left to write back
    }
}

TEST(RunCommand, StopsAtFindingsBeforeAnythingHappens) {
    Case run;
    ASSERT_EQ(run.Run().end, RunEnd::Succeeded);
    const std::string parameters = run.directory.Read("a.RYN");
    const std::string results = run.directory.Read("a.res");
    CGlobalKvf& root = run.document.GetGlobalKvf();
    root.Analysis().EvaluatedReturnPeriods = {0.5};
    EXPECT_EQ(run.Run().end, RunEnd::Findings);
    root.Analysis().EvaluatedReturnPeriods.clear();
    root.DefineEVS().OutputFileName.clear(); // a finding, not a file that cannot be created
    EXPECT_EQ(run.Run().end, RunEnd::Findings);
    EXPECT_THAT(run.ports.messages, ElementsAre(kFindings));
    EXPECT_EQ(run.directory.Read("a.RYN"), parameters);
    EXPECT_EQ(run.directory.Read("a.res"), results);
    EXPECT_TRUE(run.Results().IsValid());
    EXPECT_EQ(engineDouble.calls, 1);
}

TEST(RunCommand, DoesNotCheckTheBasicInput) {
    Case run;
    run.document.GetGlobalKvf().BasicInput().InputFileName = run.directory.Path("none.tsq0");
    EXPECT_EQ(run.Run().end, RunEnd::Succeeded);
}

TEST(RunCommand, StopsWhereTheResultFileCannotBeWritten) {
    Case run;
    ASSERT_EQ(run.Run().end, RunEnd::Succeeded);
    const std::string parameters = run.directory.Read("a.RYN");
    const std::string series = run.directory.Read("series.tsq0");
    for (const char* name : {"no/such/a.res", "a.RYN", "series.tsq0", "."}) {
        run.document.GetGlobalKvf().DefineEVS().OutputFileName = run.directory.Path(name);
        const RunOutcome outcome = run.Run();
        EXPECT_EQ(outcome.end, RunEnd::OutputUnwritable) << name;
        EXPECT_THAT(outcome.reason.Text(), HasSubstr(run.directory.Path("")));
        EXPECT_THAT(run.ports.messages, ElementsAre(kUnwritable));
    }
    EXPECT_TRUE(run.Results().IsValid());
    EXPECT_EQ(run.directory.Read("a.RYN"), parameters);
    EXPECT_EQ(run.directory.Read("series.tsq0"), series);
}

TEST(RunCommand, StopsWhenTheAnalysisCannotBeSaved) {
    Case run;
    ASSERT_EQ(run.Run().end, RunEnd::Succeeded);
    std::filesystem::remove(run.directory.Path("a.RYN"));
    std::filesystem::create_directory(run.directory.Path("a.RYN")); // no regular file
    const RunOutcome outcome = run.Run();
    EXPECT_EQ(outcome.end, RunEnd::SaveFailed);
    EXPECT_THAT(run.ports.messages, ElementsAre(HasSubstr("a.RYN")));
    EXPECT_TRUE(run.Results().IsValid());
    EXPECT_EQ(run.directory.Read("a.res"), kSampleOutput + SettingsText(run.Results()));
    EXPECT_EQ(engineDouble.calls, 1);
}

TEST(RunCommand, AsksAnUnsavedAnalysisForItsName) {
    Case saved;
    CRynEditDoc document;
    document.UsePorts(saved.ports);
    engineDouble.document = &document;
    CDefineEVSKvf& series = document.GetGlobalKvf().DefineEVS();
    series.InputFileName = saved.directory.Path("series.tsq0");
    series.OutputFileName = saved.directory.Path("b.res");
    saved.ports.chosenFile = saved.directory.Path("b.txt");
    EXPECT_EQ(RunAnalysis(document, CallDouble).end, RunEnd::Succeeded);
    EXPECT_EQ(document.GetPathName(), saved.directory.Path("b.RYN"));
    EXPECT_EQ(engineDouble.input, saved.directory.Read("b.RYN"));
}

TEST(RunCommand, WithoutASavedFileFailsAndTheEngineIsNotCalled) {
    Case saved;
    CRynEditDoc document;
    document.UsePorts(saved.ports);
    CDefineEVSKvf& series = document.GetGlobalKvf().DefineEVS();
    series.InputFileName = saved.directory.Path("series.tsq0");
    series.OutputFileName = saved.directory.Path("b.res");
    const RunOutcome outcome = RunAnalysis(document, CallDouble); // the dialog is cancelled
    EXPECT_EQ(outcome.end, RunEnd::EngineFailed);
    EXPECT_EQ(outcome.engineStatus, 1);
    EXPECT_FALSE(outcome.reason);
    EXPECT_EQ(saved.ports.messages.size(), 1U);
    EXPECT_THAT(saved.ports.questions, ElementsAre(kFailed));
    EXPECT_EQ(engineDouble.calls, 0);
}

TEST(RunCommand, TheEngineWorksInTheParameterFilesDirectoryOnAnEmptyModel) {
    Case run;
    ASSERT_EQ(run.Run().end, RunEnd::Succeeded);
    std::filesystem::current_path("/");
    ASSERT_EQ(run.Run().end, RunEnd::Succeeded);
    EXPECT_EQ(engineDouble.directory, run.directory.Root());
    EXPECT_EQ(std::filesystem::current_path(), "/");
    EXPECT_FALSE(engineDouble.resultsWereThere);
}

TEST(RunCommand, KeptPlotsWaitForTheNextSave) {
    Case run;
    run.Results().GraphsKvf = test::TreeOf("Graphs { Width = 2 }");
    run.Results().HistogramKvf = test::TreeOf("Histogram { Width = 3 }");
    run.Results().PlottingPos.Precision = 9;
    ASSERT_EQ(run.Run().end, RunEnd::Succeeded);
    const std::string afterRun = run.directory.Read("a.res");
    EXPECT_EQ(afterRun, kSampleOutput + SettingsText(run.Results()));
    EXPECT_THAT(afterRun, HasSubstr("Precision = 9"));
    for (int save = 0; save < 2; ++save) {
        run.document.OnSaveDocument(run.directory.Path("a.ryn"));
        EXPECT_EQ(run.directory.Read("a.res"),
                  afterRun + "Graphs {\n    Width = 2\n}\nHistogram {\n    Width = 3\n}\n");
    }
}

TEST(RunCommand, ShowsThatItIsBusyFromFirstToLast) {
    Case run;
    run.Run(1);
    EXPECT_EQ(run.ports.busy, 0); // as often ended as begun
    EXPECT_GE(run.ports.busyRestores, 3);
}

} // namespace
} // namespace ryn
