#include "document/ryn_edit_doc.h"

#include <filesystem>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "support/recording_ports.h"
#include "support/temporary_directory.h"
#include "unit/results/sample_results.h"

namespace ryn {
namespace {

using test::RecordingPorts;
using test::TemporaryDirectory;
using ::testing::ElementsAre;
using ::testing::HasSubstr;
using ::testing::IsEmpty;

constexpr const char* kThreshold4 = "RynEditor { BasicInput { Threshold = 4.0 } }\n";

struct Opened {
    RecordingPorts ports;
    CRynEditDoc document;

    Opened() { document.UsePorts(ports); }
    double Threshold() { return document.GetGlobalKvf().BasicInput().Threshold; }
};

TEST(Document, IsUntitledAndUnmodifiedWhenNew) {
    const auto document = CRynEditDoc::RuntimeClass().create();
    auto* const analysis = dynamic_cast<CRynEditDoc*>(document.get());
    ASSERT_NE(analysis, nullptr);
    EXPECT_NE(analysis->OnNewDocument(), 0);
    EXPECT_EQ(analysis->GetPathName(), "");
    EXPECT_EQ(analysis->GetTitle(), "Untitled");
    EXPECT_FALSE(analysis->IsModified());
    EXPECT_TRUE(analysis->GetRuntimeClass().IsDerivedFrom(CK44SetupDoc::RuntimeClass()));
}

TEST(Document, OpensTheTwoSpellingsOfItsExtensionOnly) {
    const TemporaryDirectory directory;
    for (const char* name : {"a.ryn", "b.RYN"}) {
        Opened opened;
        EXPECT_NE(opened.document.OnOpenDocument(directory.Write(name, kThreshold4)), 0);
        EXPECT_EQ(opened.Threshold(), 4.0);
        EXPECT_TRUE(opened.document.WasReadWhole());
        EXPECT_FALSE(opened.document.IsModified());
    }
    for (const char* name : {"a.Ryn", "a.txt", "a", ".ryn"}) {
        Opened opened;
        EXPECT_EQ(opened.document.OnOpenDocument(directory.Write(name, kThreshold4)), 0) << name;
        EXPECT_THAT(opened.ports.messages, ElementsAre("Unsupported file format"));
    }
}

TEST(Document, FindsTheOtherSpellingOfAFile) {
    const TemporaryDirectory directory;
    directory.Write("a.RYN", kThreshold4);
    Opened opened;
    EXPECT_NE(opened.document.OnOpenDocument(directory.Path("a.ryn")), 0);
    EXPECT_EQ(opened.Threshold(), 4.0);
    EXPECT_EQ(opened.document.GetPathName(), directory.Path("a.RYN"));
}

TEST(Document, OpensWithDefaultsAndOneMessageWhenItsFileIsBroken) {
    const TemporaryDirectory directory;
    const std::string path = directory.Write("a.RYN", "RynEditor {\n  BasicInput\n");
    Opened opened;
    EXPECT_NE(opened.document.OnOpenDocument(path), 0);
    EXPECT_THAT(opened.ports.messages, ElementsAre(HasSubstr("a.RYN:")));
    EXPECT_EQ(opened.Threshold(), 0.0);
    EXPECT_FALSE(opened.document.WasReadWhole());
    EXPECT_EQ(opened.document.GetPathName(), path);

    opened.document.OnSaveDocument(path);
    EXPECT_TRUE(opened.document.TakeSaveError());
    EXPECT_EQ(directory.Read("a.RYN.broken"), "RynEditor {\n  BasicInput\n");
    EXPECT_THAT(directory.Read("a.RYN"), HasSubstr("ExtremeValueSection"));
}

TEST(Document, KeepsEveryBrokenFile) {
    const TemporaryDirectory directory;
    for (const char* content : {"{one", "{two"}) {
        Opened opened;
        opened.document.OnOpenDocument(directory.Write("a.RYN", content));
        opened.document.OnSaveDocument(directory.Path("a.RYN"));
        opened.document.OnSaveDocument(directory.Path("a.RYN"));
    }
    EXPECT_EQ(directory.Read("a.RYN.broken"), "{one");
    EXPECT_EQ(directory.Read("a.RYN.broken2"), "{two");
    EXPECT_EQ(directory.EntryCount(), 3U);
}

TEST(Document, KeepsTheFileBehindALinkAndLeavesWhatIsNoFileAlone) {
    const TemporaryDirectory directory;
    std::filesystem::create_symlink("data.RYN", directory.Root() / "link.RYN");
    directory.Write("data.RYN", "{broken");
    Opened linked;
    linked.document.OnOpenDocument(directory.Path("link.RYN"));
    linked.document.OnSaveDocument(directory.Path("link.RYN"));
    EXPECT_EQ(directory.Read("link.RYN.broken"), "{broken");
    EXPECT_THAT(directory.Read("data.RYN"), HasSubstr("ExtremeValueSection"));
    EXPECT_TRUE(std::filesystem::is_symlink(directory.Root() / "link.RYN"));

    std::filesystem::create_directory(directory.Root() / "folder.RYN");
    Opened folder;
    folder.document.OnOpenDocument(directory.Path("folder.RYN"));
    folder.document.OnSaveDocument(directory.Path("folder.RYN"));
    EXPECT_THAT(folder.document.TakeSaveError().Text(), HasSubstr("not a regular file"));
    EXPECT_TRUE(std::filesystem::is_directory(directory.Root() / "folder.RYN"));
}

TEST(Document, KeepsItsNamesThroughALinkedDirectory) {
    const TemporaryDirectory directory;
    std::filesystem::create_directories(directory.Root() / "real/deep");
    std::filesystem::create_directory_symlink("real/deep", directory.Root() / "link");
    directory.Write("real/deep/case.RYN",
                    "RynEditor { BasicInput { InputFileName = \"gauge.tsq0\" } }");
    for (int turn = 0; turn < 3; ++turn) {
        Opened opened;
        opened.document.OnOpenDocument(directory.Path("link/case.RYN"));
        opened.document.OnSaveDocument(directory.Path("link/case.RYN"));
        EXPECT_THAT(directory.Read("real/deep/case.RYN"),
                    HasSubstr("InputFileName = \"gauge.tsq0\""));
    }
}

TEST(Document, OfWhichACopyIsSavedStaysModified) {
    const TemporaryDirectory directory;
    Opened opened;
    opened.document.SetModifiedFlag(1);
    EXPECT_NE(opened.document.DoSave(directory.Path("copy.RYN"), 0), 0);
    EXPECT_TRUE(opened.document.IsModified());
    EXPECT_EQ(opened.document.GetTitle(), "Untitled");
}

TEST(Document, IsNotReadWholeWithoutItsTarget) {
    const TemporaryDirectory directory;
    Opened opened;
    EXPECT_NE(opened.document.OnOpenDocument(directory.Write("a.RYN", "Other { }\n")), 0);
    EXPECT_THAT(opened.ports.messages, IsEmpty());
    EXPECT_FALSE(opened.document.WasReadWhole());
    EXPECT_EQ(opened.document.GetGlobalKvf().Analysis().SplitDates.size(), 1U);
}

TEST(Document, SavesUnderItsOwnExtension) {
    const TemporaryDirectory directory;
    Opened opened;
    opened.document.SetModifiedFlag(1);
    EXPECT_NE(opened.document.OnSaveDocument(directory.Path("case.txt")), 0);
    EXPECT_TRUE(opened.document.TakeSaveError());
    EXPECT_EQ(opened.document.GetPathName(), directory.Path("case.RYN"));
    EXPECT_EQ(opened.document.GetTitle(), "case.RYN");
    EXPECT_FALSE(opened.document.IsModified());
    EXPECT_THAT(opened.ports.recentFiles, ElementsAre(directory.Path("case.RYN")));
    EXPECT_EQ(opened.ports.focusReleases, 1);
    EXPECT_EQ(directory.EntryCount(), 1U);
}

TEST(Document, LeavesNoStaleTwinOfTheOtherSpelling) {
    const TemporaryDirectory directory;
    Opened opened;
    opened.document.OnOpenDocument(directory.Write("case.ryn", kThreshold4));
    opened.document.OnSaveDocument(directory.Path("case.ryn"));
    EXPECT_TRUE(opened.document.TakeSaveError());
    EXPECT_FALSE(directory.Has("case.ryn"));
    EXPECT_THAT(directory.Read("case.RYN"), HasSubstr("Threshold = 4.0"));
}

TEST(Document, RefusesToSaveOverATwinThatIsAnotherFile) {
    const TemporaryDirectory directory;
    directory.Write("case.RYN", "Other { }\n");
    Opened opened;
    opened.document.OnOpenDocument(directory.Write("case.ryn", kThreshold4));
    EXPECT_NE(opened.document.OnSaveDocument(directory.Path("case.ryn")), 0);
    const Status error = opened.document.TakeSaveError();
    EXPECT_THAT(error.Text(), HasSubstr(directory.Path("case.ryn")));
    EXPECT_THAT(error.Text(), HasSubstr(directory.Path("case.RYN")));
    EXPECT_EQ(directory.Read("case.RYN"), "Other { }\n");
    EXPECT_EQ(directory.Read("case.ryn"), kThreshold4);
}

TEST(Document, ResolvesNamesAgainstItsOwnDirectory) {
    const TemporaryDirectory directory;
    std::filesystem::create_directory(directory.Root() / "sub dir");
    directory.Write("sub dir/case.RYN", "RynEditor { BasicInput { InputFileName = \"in.tsq0\" } }");
    std::filesystem::current_path(directory.Root());
    Opened opened;
    EXPECT_NE(opened.document.OnOpenDocument("sub dir/case.RYN"), 0);
    EXPECT_EQ(opened.document.GetGlobalKvf().BasicInput().InputFileName,
              directory.Path("sub dir/in.tsq0"));
    EXPECT_EQ(std::filesystem::current_path(), directory.Root() / "sub dir");
}

TEST(Document, WritesTheSameBytesTwice) {
    const TemporaryDirectory directory;
    Opened opened;
    opened.document.OnSaveDocument(directory.Path("case.RYN"));
    const std::string first = directory.Read("case.RYN");
    opened.document.OnOpenDocument(directory.Path("case.RYN"));
    opened.document.OnSaveDocument(directory.Path("case.RYN"));
    EXPECT_EQ(directory.Read("case.RYN"), first);
}

TEST(Document, TellsWhyASaveFailedAndStaysModified) {
    const TemporaryDirectory directory;
    Opened opened;
    opened.document.SetModifiedFlag(1);
    EXPECT_EQ(opened.document.DoSave(directory.Path("none/case.RYN")), 0);
    EXPECT_TRUE(opened.document.IsModified());
    EXPECT_EQ(opened.document.GetTitle(), "Untitled");
    EXPECT_THAT(opened.ports.messages, ElementsAre(HasSubstr("none/case.RYN")));
}

TEST(Document, AsksBeforeAModifiedOneIsClosed) {
    const TemporaryDirectory directory;
    Opened opened;
    EXPECT_NE(opened.document.SaveModified(), 0);
    EXPECT_THAT(opened.ports.questions, IsEmpty());
    opened.document.SetModifiedFlag(1);
    opened.ports.answer = Answer::Cancel;
    EXPECT_EQ(opened.document.SaveModified(), 0);
    opened.ports.answer = Answer::No;
    EXPECT_NE(opened.document.SaveModified(), 0);
    opened.ports.answer = Answer::Yes;
    EXPECT_EQ(opened.document.SaveModified(), 0); // no file was chosen
    opened.ports.chosenFile = directory.Path("chosen.ryn");
    EXPECT_NE(opened.document.SaveModified(), 0);
    EXPECT_TRUE(directory.Has("chosen.RYN"));
    EXPECT_THAT(opened.ports.questions.back(), HasSubstr("Untitled"));
}

TEST(Document, OpensAndSavesTheResultsThatItsParametersName) {
    const TemporaryDirectory directory;
    const std::string both = "RynEditor { DefineEVS { OutputFileName = \"a.res\" } }\n";
    directory.Write("a.RYN", both);
    directory.Write("a.res", std::string(test::kSampleOutput) + "Histogram { A = 1 }\n");
    std::string firstSave;
    for (int round = 0; round < 2; ++round) {
        Opened opened;
        opened.document.SetModifiedFlag(1);
        opened.document.OnOpenDocument(directory.Path("a.RYN"));
        EXPECT_TRUE(opened.document.Results().IsValid());
        EXPECT_TRUE(opened.document.ResultError());
        EXPECT_FALSE(opened.document.IsModified());
        EXPECT_EQ(test::OutputText(opened.document.Results()), test::kSampleOutput);
        opened.document.OnSaveDocument(directory.Path("a.RYN"));
        EXPECT_TRUE(opened.document.TakeSaveError());
        const std::string saved = directory.Read("a.res");
        EXPECT_EQ(saved, test::kSampleOutput + test::SettingsText(opened.document.Results()) +
                             "Histogram {\n    A = 1\n}\n");
        EXPECT_TRUE(firstSave.empty() || saved == firstSave);
        firstSave = saved;
    }
}

TEST(Document, OpensWithoutResultsInSilence) {
    const TemporaryDirectory directory;
    directory.Write("broken.res", std::string(test::kSampleOutput).substr(0, 900));
    for (const char* result : {"", "none.res", "broken.res", "."}) {
        directory.Write("a.RYN", std::string("RynEditor { DefineEVS { OutputFileName = \"") +
                                     result + "\" } }\n");
        const std::string before = directory.Read("broken.res");
        Opened opened;
        EXPECT_NE(opened.document.OnOpenDocument(directory.Path("a.RYN")), 0);
        EXPECT_FALSE(opened.document.Results().IsValid());
        EXPECT_THAT(opened.ports.messages, IsEmpty());
        EXPECT_EQ(opened.document.ResultError().IsOk(), std::string(result).empty());
        opened.document.OnSaveDocument(directory.Path("a.RYN")); // writes the parameter file alone
        EXPECT_EQ(directory.Read("broken.res"), before);
        EXPECT_FALSE(directory.Has("none.res"));
    }
}

TEST(Document, ThatIsOpenedAgainDropsTheResultsItHad) {
    const TemporaryDirectory directory;
    directory.Write("a.RYN", "RynEditor { DefineEVS { OutputFileName = \"a.res\" } }\n");
    directory.Write("a.res", std::string(test::kSampleOutput) + "Graphs { A = 1 }\n");
    directory.Write("b.RYN", "RynEditor { DefineEVS { OutputFileName = \"b.res\" } }\n");
    Opened opened;
    opened.document.OnOpenDocument(directory.Path("a.RYN"));
    opened.document.OnOpenDocument(directory.Path("b.RYN"));
    EXPECT_FALSE(opened.document.Results().IsValid());
    EXPECT_EQ(opened.document.Results().GraphsKvf, nullptr);
}

TEST(Document, NeverWritesResultsOverItsInputs) {
    const TemporaryDirectory directory;
    directory.Write("a.RYN", "RynEditor { DefineEVS { OutputFileName = \"a.res\" } }\n");
    directory.Write("a.res", test::kSampleOutput);
    Opened opened;
    opened.document.OnOpenDocument(directory.Path("a.RYN"));
    opened.document.GetGlobalKvf().DefineEVS().OutputFileName = directory.Path("a.RYN");
    opened.document.OnSaveDocument(directory.Path("a.RYN"));
    EXPECT_THAT(opened.document.TakeSaveError().Text(), HasSubstr("a.RYN"));
    EXPECT_THAT(directory.Read("a.RYN"), HasSubstr("DefineEVS"));
}

TEST(Document, TellsOfAResultFileThatCannotBeWritten) {
    const TemporaryDirectory directory;
    directory.Write("a.RYN", "RynEditor { DefineEVS { OutputFileName = \"a.res\" } }\n");
    directory.Write("a.res", test::kSampleOutput);
    Opened opened;
    opened.document.OnOpenDocument(directory.Path("a.RYN"));
    opened.document.GetGlobalKvf().DefineEVS().OutputFileName = directory.Path("none/a.res");
    opened.document.OnSaveDocument(directory.Path("a.RYN"));
    EXPECT_FALSE(opened.document.IsModified());
    EXPECT_THAT(opened.document.TakeSaveError().Text(), HasSubstr("none/a.res"));
    opened.document.GetGlobalKvf().DefineEVS().OutputFileName.clear(); // nowhere to write to
    opened.document.OnSaveDocument(directory.Path("a.RYN"));
    EXPECT_TRUE(opened.document.TakeSaveError());
}

TEST(Document, IsClosedByItsOwner) {
    auto document = std::make_unique<CRynEditDoc>();
    document->closeRequested = [&document](CDocument& /*closed*/) { document.reset(); };
    document->OnCloseDocument();
    EXPECT_EQ(document, nullptr);
}

} // namespace
} // namespace ryn
