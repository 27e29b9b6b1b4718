#include "apps/cli/self_check_command.h"

#include "command_fixture.h"
#include "selfcheck/self_check.h"
#include "strings/language.h"

namespace ryn::cli {
namespace {

using testing::EndsWith;
using testing::HasSubstr;
using SelfCheckCommand = CommandTest;

selfcheck::Comparisons OneRightAndOneWrong() {
    selfcheck::Comparisons list;
    selfcheck::Compare(list, {"A2", "portpirie", "GEV/ML", "a book"}, "xi", "3.874750", 3.8747503);
    selfcheck::Compare(list, {"A2", "portpirie", "GEV/ML", "a book"}, "ln L", "4.34", 4.346);
    return list;
}

struct Shown {
    int code;
    std::string out;
    std::string err;
};

Shown Show(const selfcheck::Comparisons& comparisons, OutputForm form) {
    std::ostringstream out;
    std::ostringstream err;
    std::istringstream in;
    Console console{out, err, in, false};
    const int code = ShowSelfCheck(comparisons, {form}, console);
    return {code, out.str(), err.str()};
}

TEST_F(SelfCheckCommand, MeetsEveryPublishedValue) {
    ASSERT_EQ(Run({"selfcheck"}), 0) << err;
    EXPECT_EQ(err, "");
    const std::string count = std::to_string(selfcheck::RunSelfCheck().size());
    EXPECT_THAT(out, EndsWith("\n" + count + " of " + count + " values agree\n"));
    EXPECT_THAT(out, testing::Not(HasSubstr("DIFFERS")));
    ASSERT_EQ(Run({"selfcheck", "--json"}), 0);
    EXPECT_EQ(Json()["values"], Json()["agreeing"]);
    EXPECT_EQ(Json()["comparisons"].size(), Json()["values"]);
    EXPECT_EQ(Json()["series"][0]["n"], 65);
}

TEST_F(SelfCheckCommand, TellsWhatDiffersAndExitsWithTwo) {
    const Shown shown = Show(OneRightAndOneWrong(), OutputForm::Text);
    EXPECT_EQ(shown.code, 2);
    EXPECT_THAT(
        shown.out,
        EndsWith("\n"
                 "number  series     subject  quantity  expected     found           source\n"
                 "A2      portpirie  GEV/ML   xi        3.874750  3.874750  ok       a book\n"
                 "A2      portpirie  GEV/ML   ln L          4.34      4.35  DIFFERS  a book\n"
                 "\n"
                 "A value agrees when it is within half a unit of the last digit expected.\n"
                 "1 of 2 values agree\n"));
    EXPECT_EQ(shown.err, "ryn: 1 of 2 values differ from what was published\n");
}

TEST_F(SelfCheckCommand, TellsTheSameAsJson) {
    const Shown shown = Show(OneRightAndOneWrong(), OutputForm::Json);
    EXPECT_EQ(shown.code, 2);
    const auto json = nlohmann::ordered_json::parse(shown.out);
    EXPECT_EQ(json["agreeing"], 1);
    const auto second = json["comparisons"][1];
    EXPECT_EQ(second["number"], "A2");
    EXPECT_EQ(second["quantity"], "ln L");
    EXPECT_EQ(second["expected"], 4.34);
    EXPECT_EQ(second["found"], 4.346);
    EXPECT_NEAR(second["tolerance"], 0.005, 1e-8);
    EXPECT_EQ(second["agrees"], false);
    EXPECT_EQ(second["source"], "a book");
}

TEST_F(SelfCheckCommand, SpeaksJapaneseWithTheSameNumbers) {
    ASSERT_EQ(Run({"selfcheck", "--lang", "ja"}), 0) << err;
    EXPECT_THAT(out, HasSubstr("公表値"));
    EXPECT_THAT(out, HasSubstr("3.874750"));
    SetLanguage(Language::English);
}

} // namespace
} // namespace ryn::cli
