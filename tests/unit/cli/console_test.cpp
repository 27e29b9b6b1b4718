#include <cerrno>
#include <chrono>
#include <csignal>
#include <fcntl.h>
#include <ostream>
#include <unistd.h>

#include <gtest/gtest.h>

#include "apps/cli/console_ports.h"
#include "apps/cli/date_text.h"
#include "apps/cli/descriptor_output.h"
#include "apps/cli/nearest_names.h"
#include "apps/cli/plain_text.h"
#include "apps/cli/text_table.h"
#include "command_fixture.h"
#include "strings/language.h"

namespace ryn::cli {
namespace {

TEST(DescriptorOutput, RemembersWhyAWriteFailed) {
    const int full = ::open("/dev/full", O_WRONLY);
    DescriptorOutput buffer(full);
    std::ostream out(&buffer);
    out << "text" << std::flush;
    EXPECT_FALSE(out.good());
    EXPECT_EQ(buffer.Error(), ENOSPC);
    ::close(full);
}

TEST(DescriptorOutput, PassesOnMoreThanABufferWhole) {
    int ends[2];
    ASSERT_EQ(::pipe(ends), 0);
    std::string text;
    {
        DescriptorOutput buffer(ends[1]);
        std::ostream out(&buffer);
        for (int i = 0; i < 5000; ++i)
            out << "line " + std::to_string(i) + '\n';
        ::close(::dup(ends[0]));
        std::string part(60000, '\0'); // less than a pipe holds
        ASSERT_EQ(buffer.Error(), 0);
    }
    ::close(ends[1]);
    char block[4096];
    for (ssize_t got = 0; (got = ::read(ends[0], block, sizeof block)) > 0;)
        text.append(block, static_cast<std::size_t>(got));
    ::close(ends[0]);
    EXPECT_EQ(text.size(), 5000U * 6 + 10 + 90 * 2 + 900 * 3 + 4000 * 4);
    EXPECT_EQ(text.substr(text.size() - 10), "line 4999\n");
}

TEST(DescriptorOutput, TellsAReaderThatWentAwayFromAFullDisk) {
    std::signal(SIGPIPE, SIG_IGN);
    int ends[2];
    ASSERT_EQ(::pipe(ends), 0);
    ::close(ends[0]);
    DescriptorOutput buffer(ends[1]);
    std::ostream out(&buffer);
    out << "text" << std::flush;
    EXPECT_EQ(buffer.Error(), EPIPE);
    ::close(ends[1]);
}

TEST(PlainLine, DisarmsControlCharacters) {
    EXPECT_EQ(PlainLine("a\nb\tc\r\n"), "a b c");
    EXPECT_EQ(PlainLine("\x1b[2J\x7f"), "\\x1b[2J\\x7f");
    EXPECT_EQ(PlainLine("größe \xf6"), "größe \xf6");
}

TEST(DisplayWidth, CountsColumnsOfATerminal) {
    EXPECT_EQ(DisplayWidth("abc"), 3U);
    EXPECT_EQ(DisplayWidth("größe"), 5U);
    EXPECT_EQ(DisplayWidth("極値 a"), 6U);
    EXPECT_EQ(DisplayWidth("\xf6\xe6\x9e"), 3U);
    EXPECT_EQ(DisplayWidth(""), 0U);
}

TEST(TextTable, AlignsColumnsByTheirWidthOnATerminal) {
    TextTable table({Alignment::Left, Alignment::Right, Alignment::Left});
    table.AddRow({"極値", "1", "x"});
    table.AddRow({"a", "100"});
    std::ostringstream out;
    table.Print(out);
    EXPECT_EQ(out.str(), "極値    1  x\na     100\n");
}

TEST(NearestNames, AreSortedByDistance) {
    const std::vector<std::string> names = {"Threshold", "InterTime", "InterLevel", "InputItem"};
    EXPECT_EQ(NearestNames("treshold", names), (std::vector<std::string>{"Threshold"}));
    EXPECT_EQ(NearestNames("Inter", names), (std::vector<std::string>{"InterTime", "InterLevel"}));
    EXPECT_TRUE(NearestNames("xyz", names).empty());
    EXPECT_TRUE(NearestNames(std::string(1000000, 'x'), names).empty());
}

TEST(LengthForPeople, NamesTheUnitsThatCount) {
    EXPECT_EQ(LengthForPeople(COleDateTimeSpan(1.0 / 24)), "1 h");
    EXPECT_EQ(LengthForPeople(COleDateTimeSpan(31.25)), "31 d 6 h");
    EXPECT_EQ(LengthForPeople(COleDateTimeSpan(0, 0, 0, 59)), "59 s");
    EXPECT_EQ(LengthForPeople(COleDateTimeSpan(0.0)), "0 s");
}

TEST(ProgressLine, IsShownOnATerminalUntilAllIsDone) {
    std::istringstream in;
    const auto shown = [&in](bool isTerminal, std::chrono::milliseconds patience) {
        std::ostringstream out;
        std::ostringstream err;
        Console console{out, err, in, isTerminal};
        ProgressLine line(console, patience);
        for (const long long done : {0, 1, 50, 400, 800})
            line.ShowProgress(done, 800);
        return err.str();
    };
    using std::chrono::hours;
    using std::chrono::milliseconds;
    EXPECT_EQ(shown(true, milliseconds(0)), "\r0 %\r6 %\r50 %\r     \r");
    EXPECT_EQ(shown(true, hours(1)), "") << "the work was not long";
    EXPECT_EQ(shown(false, milliseconds(0)), "");
}

using Program = CommandTest;

TEST_F(Program, HelpsAtEveryLevelInBothLanguages) {
    for (const char* language : {"en", "ja"}) {
        ASSERT_EQ(Run({"--help", "--lang", language}), 0);
        for (const char* command :
             {"import", "export", "info", "new", "set", "check", "extract", "fit"}) {
            EXPECT_EQ(Run({command, "--help", "--lang", language}), 0) << command;
            EXPECT_EQ(err, "");
            EXPECT_THAT(out, testing::HasSubstr(std::string("ryn ") + command));
            EXPECT_THAT(out, testing::HasSubstr("--lang"));
            // An option without a text would be an id that the catalogue does not have.
            EXPECT_THAT(out, testing::Not(testing::ContainsRegex("--[a-z]+ *\n")));
        }
    }
}

TEST_F(Program, TakesItsLanguageFromTheEnvironment) {
    ::setenv("LC_ALL", "ja_JP.UTF-8", 1);
    EXPECT_EQ(Run({"check", "no.txt"}), 1);
    EXPECT_THAT(err, testing::HasSubstr("パラメータファイル"));
    SetLanguage(Language::English);
}

TEST_F(Program, LeavesTheCurrentDirectoryWhereItWas) {
    std::filesystem::create_directory(files.Path("down"));
    ASSERT_EQ(Run({"new", "down/case.ryn"}), 0);
    ASSERT_EQ(Run({"set", "down/case.ryn", "DefineEVS.Title=T"}), 0);
    EXPECT_EQ(std::filesystem::current_path(), files.Root());
}

} // namespace
} // namespace ryn::cli
