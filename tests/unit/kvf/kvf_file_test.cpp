#include <clocale>
#include <csignal>
#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <sstream>
#include <string>
#include <sys/resource.h>
#include <sys/stat.h>

#include <gtest/gtest.h>

#include "kvf/kvf.h"
#include "support/kvf_listing.h"

namespace ryn {
namespace {

using test::KvfErrorText;
using test::ListKvf;
namespace fs = std::filesystem;

std::string ReadFile(const std::string& path) {
    std::ostringstream content;
    content << std::ifstream(path, std::ios::binary).rdbuf();
    return content.str();
}

/// A directory of its own for each test, and no error left from another one.
class KvfFile : public testing::Test {
  protected:
    KvfFile() {
        std::string pattern = (fs::temp_directory_path() / "kvf_test_XXXXXX").string();
        directory = ::mkdtemp(pattern.data());
        (void)kvfTakeWriteError();
    }
    ~KvfFile() override { fs::remove_all(directory); }

    std::string Path(const std::string& name) const { return (directory / name).string(); }
    std::string Put(const std::string& name, const std::string& content) const {
        std::ofstream(Path(name), std::ios::binary) << content;
        return Path(name);
    }
    std::ptrdiff_t CountFiles() const {
        return std::distance(fs::directory_iterator(directory), fs::directory_iterator());
    }

    fs::path directory;
};

KvfHandle SmallTree(int value) {
    KvfHandle tree = kvfCreate();
    kvfAddTarget(tree.get(), "T");
    kvfPutParam(tree.get(), "Value", value);
    kvfEndSection(tree.get());
    return tree;
}

TEST_F(KvfFile, WritesAParameterFileForPeopleToRead) {
    const KvfHandle tree = kvfCreate();
    KvfTree* const t = tree.get();
    kvfAddTarget(t, "RynEditor");
    kvfAddSection(t, "BasicInput");
    kvfPutParam(t, "SelectionMethod", 0);
    kvfPutParam(t, "InputFileName", "caf\xC3\xA9 \xE9\\x.tsq0");
    kvfPutParam(t, "Threshold", 12.5);
    kvfPutParam(t, "InterLevel", 3.0);
    kvfPutParam(t, "InterTimeSpecified", true);
    kvfPutListParam(t, "AmsStartDate", "iiiii", {1990, 1, 1, 0, 0});
    kvfEndSection(t);
    kvfAddSection(t, "Tsq2Input");
    kvfPutParamFilename(t, "Tsq2InputFile", "waves.tq0");
    kvfEndSection(t);
    kvfAddSection(t, "ExtremeValueSection");
    kvfAddKeyword(t, "ExtremeValues");
    for (int i = 0; i < 20; ++i)
        kvfAddFloat(t, 0.1F + static_cast<float>(i));
    kvfAddKeyword(t, "SampleNo");
    kvfEndSection(t);
    kvfEndSection(t);
    ASSERT_TRUE(kvfWrite(t, Path("case.RYN"), Durability::Unflushed));
    EXPECT_EQ(ReadFile(Path("case.RYN")), R"(RynEditor {
    BasicInput {
        SelectionMethod = 0
        InputFileName = "café \xE9\\x.tsq0"
        Threshold = 12.5
        InterLevel = 3.0
        InterTimeSpecified = true
        AmsStartDate = 1990, 1, 1, 0, 0
    }
    Tsq2Input {
        Tsq2InputFile = file("waves.tq0")
    }
    ExtremeValueSection {
        ExtremeValues = 0.1f, 1.1f, 2.1f, 3.1f, 4.1f, 5.1f, 6.1f, 7.1f, 8.1f, 9.1f, 10.1f, 11.1f,
            12.1f, 13.1f, 14.1f, 15.1f, 16.1f, 17.1f, 18.1f, 19.1f
        SampleNo =
    }
}
)");
    const KvfHandle back = kvfLoadFile(Path("case.RYN"), 1);
    EXPECT_EQ(ListKvf(back), ListKvf(tree));
    std::string name;
    const KvfSection* const input =
        kvfSectionByNameNum(kvfTargetByNameNum(back.get(), "RynEditor", 1), "BasicInput", 1);
    EXPECT_NE(kvfGetParam(input, "InputFileName", &name, 1, 1), 0);
    EXPECT_EQ(name, "caf\xC3\xA9 \xE9\\x.tsq0");
}

TEST_F(KvfFile, ReadsTheWorkedExampleOfTheFormatDocument) {
    const std::string document = ReadFile(RYN_SOURCE_DIR "/docs/formats/kvf.md");
    const std::size_t start = document.find("```\n# Annual") + 4;
    const std::string example = document.substr(start, document.find("```", start) - start);
    const KvfHandle tree = kvfLoadFile(Put("example.ryn", example), 1);
    ASSERT_TRUE(tree) << KvfErrorText();
    const std::string comment = example.substr(0, example.find('\n') + 1);
    // The document breaks one list early, to show that it may.
    std::string written = comment + kvfText(tree.get());
    written.replace(written.find("f, 3.0f"), 3, "f,\n            ");
    EXPECT_EQ(written, example);
}

TEST_F(KvfFile, AppendsTargetsBehindTheOldBytes) {
    const std::string crlf = Put("crlf.ryn", "Old {\r\n}\r\n");
    const std::string open = Put("open.ryn", "Old { K = 1 } # no line feed");
    const std::string empty = Put("empty.ryn", "");
    ASSERT_TRUE(kvfAppend(SmallTree(1).get(), crlf));
    ASSERT_TRUE(kvfAppend(SmallTree(1).get(), open));
    ASSERT_TRUE(kvfAppend(SmallTree(2).get(), open, Durability::Unflushed));
    ASSERT_TRUE(kvfAppend(SmallTree(3).get(), empty));
    EXPECT_EQ(ReadFile(crlf), "Old {\r\n}\r\nT {\n    Value = 1\n}\n");
    EXPECT_EQ(ReadFile(open), "Old { K = 1 } # no line feed\nT {\n    Value = 1\n}\n"
                              "T {\n    Value = 2\n}\n");
    EXPECT_EQ(ReadFile(empty), "T {\n    Value = 3\n}\n");
    const KvfHandle tree = kvfLoadFile(open, 0);
    int value = 0;
    EXPECT_NE(kvfGetParam(kvfTargetByNameNum(tree.get(), "T", 2), "Value", &value, 1, 1), 0);
    EXPECT_EQ(value, 2);
    EXPECT_EQ(CountFiles(), 3);
}

TEST_F(KvfFile, KeepsTheFirstWriteFailureUntilItIsTaken) {
    Put("file", "no directory");
    EXPECT_TRUE(kvfTakeWriteError());
    const Status first = kvfWrite(SmallTree(1).get(), Path("file/case.ryn"));
    const Status second = kvfAppend(SmallTree(1).get(), Path("missing.ryn"));
    EXPECT_EQ(first.Text(), Path("file/case.ryn") + ": Not a directory");
    EXPECT_EQ(second.Text(), Path("missing.ryn") + ": No such file or directory");
    EXPECT_TRUE(kvfWrite(SmallTree(1).get(), Path("good.ryn")));
    EXPECT_EQ(kvfTakeWriteError().Text(), first.Text());
    EXPECT_TRUE(kvfTakeWriteError());
    EXPECT_FALSE(fs::exists(Path("missing.ryn")));
}

TEST_F(KvfFile, LeavesWhatItCannotReplaceAsItIs) {
    fs::create_directory(Path("folder"));
    ASSERT_EQ(::mkfifo(Path("pipe").c_str(), 0600), 0);
    for (const std::string& path : {Path("folder"), std::string("/dev/full"), Path("pipe")}) {
        EXPECT_FALSE(kvfWrite(SmallTree(1).get(), path)) << path;
        EXPECT_FALSE(kvfAppend(SmallTree(1).get(), path)) << path;
        EXPECT_EQ(kvfTakeWriteError().Text().substr(0, path.size() + 2), path + ": ");
    }
    EXPECT_FALSE(kvfWrite(nullptr, Path("new.ryn")));
    EXPECT_EQ(CountFiles(), 2);
}

TEST_F(KvfFile, KeepsTheOldFileWhenTheDiskTakesNoMore) {
    const std::string path = Put("case.ryn", "Old {\n}\n");
    const KvfHandle tree = kvfCreate();
    kvfAddTarget(tree.get(), "T");
    kvfPutParam(tree.get(), "Long", std::string_view(std::string(100000, 'x')));
    rlimit before{};
    ASSERT_EQ(::getrlimit(RLIMIT_FSIZE, &before), 0);
    const auto handler = std::signal(SIGXFSZ, SIG_IGN);
    const rlimit small{8192, before.rlim_max};
    ASSERT_EQ(::setrlimit(RLIMIT_FSIZE, &small), 0);
    const Status written = kvfWrite(tree.get(), path);
    const Status appended = kvfAppend(tree.get(), path);
    ::setrlimit(RLIMIT_FSIZE, &before);
    std::signal(SIGXFSZ, handler);
    EXPECT_EQ(written.Text(), path + ": File too large");
    EXPECT_EQ(appended.Text(), path + ": File too large");
    EXPECT_EQ(ReadFile(path), "Old {\n}\n");
    EXPECT_EQ(CountFiles(), 1);
}

TEST_F(KvfFile, RefusesToWriteATreeDeeperThanItReads) {
    const KvfHandle tree = kvfCreate();
    kvfAddTarget(tree.get(), "T");
    for (int level = 2; level <= 200; ++level)
        kvfAddSection(tree.get(), "S");
    EXPECT_TRUE(kvfWrite(tree.get(), Path("deep.ryn")));
    EXPECT_TRUE(kvfLoadFile(Path("deep.ryn"), 0)) << KvfErrorText();
    for (int level = 201; level <= 10000; ++level)
        kvfAddSection(tree.get(), "S");
    EXPECT_EQ(kvfWrite(tree.get(), Path("deeper.ryn")).Text(),
              Path("deeper.ryn") + ": 10000 levels of blocks are more than the format's 200");
    EXPECT_EQ(CountFiles(), 1);
    const KvfHandle copy = kvfCreate();
    kvfCopy(kvfTargetByNameNum(tree.get(), "T", 1), kvfAddTarget(copy.get(), "T"));
    EXPECT_EQ(ListKvf(copy), ListKvf(tree));
}

TEST_F(KvfFile, TellsWhyAFileCouldNotBeReadAndHoldsTheErrorUntilItIsTaken) {
    ASSERT_EQ(::mkfifo(Path("pipe").c_str(), 0600), 0);
    const struct {
        std::string path;
        const char* reason;
    } cases[] = {
        {Path("missing.ryn"), "No such file or directory"},
        {directory.string(), "Is a directory"},
        {Path("pipe"), "not a regular file"},
        {"/dev/zero", "not a regular file"},
        {Path("pipe/case.ryn"), "Not a directory"},
        {"", "No such file or directory"},
    };
    for (const auto& c : cases) {
        EXPECT_FALSE(kvfLoadFile(c.path, 1));
        EXPECT_NE(kvfPeekErrorGlb(), 0);
        EXPECT_NE(kvfGetErrorGlb(), 0);
        EXPECT_EQ(kvfPeekErrorGlb(), 0);
        int line = -1;
        int column = -1;
        std::string text;
        kvfGetSyntaxErr(nullptr, &line, &column, &text);
        EXPECT_EQ(line, 0);
        EXPECT_EQ(column, 0);
        EXPECT_EQ(text, c.path + ": " + c.reason);
    }
}

TEST_F(KvfFile, ASuccessfulLoadClearsTheError) {
    const std::string bad = Put("bad.ryn", "A {\n    K =\n");
    EXPECT_FALSE(kvfLoadFile(bad, 1));
    int line = 0;
    int column = 0;
    kvfGetSyntaxErr(nullptr, &line, &column, nullptr);
    EXPECT_EQ(line, 3);
    EXPECT_EQ(column, 1);
    EXPECT_EQ(KvfErrorText().substr(0, bad.size() + 5), bad + ":3:1:");
    EXPECT_NE(kvfPeekErrorGlb(), 0);
    EXPECT_TRUE(kvfLoadFile(Put("good.ryn", "A {\n}\n"), 1));
    EXPECT_EQ(kvfGetErrorGlb(), 0);
    EXPECT_EQ(KvfErrorText(), "");
}

TEST_F(KvfFile, RefusesAFileOverTheSizeLimitBeforeReadingItAll) {
    const std::string path = Put("huge.ryn", "");
    fs::resize_file(path, (std::uintmax_t{256} << 20) + 1); // sparse
    EXPECT_FALSE(kvfLoadFile(path, 1));
    EXPECT_EQ(KvfErrorText(), path + ": the file is larger than 256 MiB");
}

TEST_F(KvfFile, HasADecimalPointInEveryLocale) {
    const std::string before = std::setlocale(LC_ALL, nullptr);
    const char* found = nullptr;
    for (const char* name : {"de_DE.UTF-8", "de_DE.utf8", "fr_FR.UTF-8", "de_DE"})
        found = found != nullptr ? found : std::setlocale(LC_ALL, name);
    if (found == nullptr)
        GTEST_SKIP() << "no locale with a decimal comma is installed";
    const KvfHandle tree = kvfLoadText("T { K = 1234567.5, 0.25f }", "case.ryn");
    const std::string text = kvfText(tree.get());
    std::setlocale(LC_ALL, before.c_str());
    EXPECT_EQ(text, "T {\n    K = 1234567.5, 0.25f\n}\n");
}

} // namespace
} // namespace ryn
