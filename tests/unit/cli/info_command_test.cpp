#include <algorithm>
#include <limits>

#include "apps/cli/kvf_json.h"
#include "command_fixture.h"
#include "support/processor_time.h"

namespace ryn::cli {
namespace {

using testing::HasSubstr;
using InfoCommand = CommandTest;

std::string JsonOfText(std::string_view text) {
    const KvfHandle tree = kvfLoadText(text, "test");
    EXPECT_EQ(kvfPeekErrorGlb(), 0);
    return JsonOfTree(tree.get()).dump(-1, ' ', false, Json::error_handler_t::replace);
}

TEST(JsonOfTree, HasAValueForEachShapeOfKeyword) {
    EXPECT_EQ(JsonOfText("T {\nOne = 1\nNone =\nMany = 1, 2.5, true, \"x\"\n}"),
              R"({"T":{"One":1,"None":[],"Many":[1,2.5,true,"x"]}})");
    EXPECT_EQ(JsonOfText("T {\nF = 0.1f\nD = 3.0\nBad = nan\nFar = -inf\nP = file(\"a.tsq0\")\n}"),
              R"({"T":{"F":0.1,"D":3.0,"Bad":null,"Far":null,"P":"a.tsq0"}})");
}

TEST(JsonOfTree, GathersRepeatedNamesAtThePlaceOfTheFirst) {
    EXPECT_EQ(JsonOfText("T {\nA = 1\nB = 0\nA = 2\n}"), R"({"T":{"A":[1,2],"B":0}})");
    EXPECT_EQ(JsonOfText("T {\nA = 1, 2\nA = 3, 4\nA =\n}"), R"({"T":{"A":[[1,2],[3,4],[]]}})");
    EXPECT_EQ(JsonOfText("T { S { A = 1 } S { } }"), R"({"T":{"S":[{"A":1},{}]}})");
    EXPECT_EQ(JsonOfText("T { } U { } T { }"), R"({"T":[{},{}],"U":{}})");
}

TEST(JsonOfTree, TakesTimeInProportionToTheNumberOfMembers) {
    const auto secondsFor = [](int members) {
        const KvfHandle tree = kvfCreate();
        kvfAddTarget(tree.get(), "T");
        for (int i = 0; i < members; ++i)
            kvfPutParam(tree.get(), "K" + std::to_string(i), i);
        const double start = test::ProcessorSeconds();
        EXPECT_EQ(JsonOfTree(tree.get())["T"].size(), static_cast<std::size_t>(members));
        return test::ProcessorSeconds() - start;
    };
    secondsFor(200000); // the first pass pays for the memory
    // In quadratic time 200,000 members take a hundred times as long as 20,000.
    EXPECT_LT(secondsFor(200000), 40 * secondsFor(20000) + 0.1);
}

TEST_F(InfoCommand, ShowsTextThatIsNoUtf8) {
    const KvfHandle tree = kvfCreate();
    kvfAddTarget(tree.get(), "T");
    kvfPutParam(tree.get(), "Name", "H\xf6he\x1b");
    ASSERT_TRUE(kvfWrite(tree.get(), files.Path("a.res")));
    ASSERT_EQ(Run({"info", "a.res", "--json"}), 0) << err;
    EXPECT_EQ(Json()["T"]["Name"], "H\xef\xbf\xbdhe\x1b");
    ASSERT_EQ(Run({"info", "a.res"}), 0) << err;
    EXPECT_THAT(out, HasSubstr("\"H\xf6he\\x1b\""));
}

TEST_F(InfoCommand, KeepsListsOfValuesShortForPeople) {
    files.Write("a.res", "T { L = 1, 2, 3, 4, 5, 6, 7, 8, 9, 10 }");
    ASSERT_EQ(Run({"info", "a.res"}), 0);
    EXPECT_EQ(out, "T\n  L                              1, 2, 3, 4, 5, 6, 7, 8, ... (10 in all)\n");
}

TEST_F(InfoCommand, TellsTheExtentOfASeries) {
    const auto samples = test::SamplesOf(
        {{"1990-01-01", 3.25}, {"1990-01-01 06:00:30", 0.1}, {"1990-03-01", 7}, {"1990-03-02", 7}});
    ASSERT_TRUE(test::WriteDataFile(files.Path("s.tsq0"), samples, "Durchfluß", "m3/s"));
    ASSERT_EQ(Run({"info", "s.tsq0", "--json"}), 0) << err;
    // Without the blanks between the parts.
    out.erase(std::remove_if(out.begin(), out.end(), [](char c) { return c == ' ' || c == '\n'; }),
              out.end());
    EXPECT_EQ(out, R"({"axis":"non-equidistantcalendar","step":null,"count":4,"title":"gauge",)"
                   R"("first":"1990-01-01T00:00:00","last":"1990-03-02T00:00:00",)"
                   R"("longestGap":{"from":"1990-01-01T06:00:30","to":"1990-03-01T00:00:00",)"
                   R"("days":58.749652777777776},"items":[{"name":"Durchfluß","unit":"m3/s",)"
                   R"("values":4,"missing":0,"first":{"date":"1990-01-01T00:00:00","value":3.25},)"
                   R"("last":{"date":"1990-03-02T00:00:00","value":7.0},)"
                   R"("minimum":{"date":"1990-01-01T06:00:30","value":0.1},)"
                   R"("maximum":{"date":"1990-03-01T00:00:00","value":7.0}}]})");
    ASSERT_EQ(Run({"info", "s.tsq0"}), 0);
    EXPECT_EQ(out, "s.tsq0\n"
                   "title        gauge\n"
                   "time axis    non-equidistant, calendar\n"
                   "time steps   4\n"
                   "first        1990-01-01 00:00\n"
                   "last         1990-03-02 00:00\n"
                   "longest gap  58 d 17 h 59 min 30 s  (1990-01-01 06:00:30 - 1990-03-01 00:00)\n"
                   "\n"
                   "item 1: Durchfluß [m3/s]\n"
                   "values       4\n"
                   "first     3.25  1990-01-01 00:00\n"
                   "last         7  1990-03-02 00:00\n"
                   "smallest   0.1  1990-01-01 06:00:30\n"
                   "largest      7  1990-03-01 00:00\n");
}

TEST_F(InfoCommand, ShowsASeriesWithoutSteps) {
    ASSERT_TRUE(test::WriteDataFile(files.Path("s.tsq0"), {}));
    ASSERT_EQ(Run({"info", "s.tsq0", "--json"}), 0) << err;
    EXPECT_EQ(Json()["count"], 0);
    EXPECT_TRUE(Json()["first"].is_null());
    EXPECT_TRUE(Json()["longestGap"].is_null());
    EXPECT_TRUE(Json()["items"][0]["maximum"].is_null());
    EXPECT_EQ(Run({"info", "s.tsq0"}), 0);
}

TEST_F(InfoCommand, CountsMissingValuesOfAFileFromElsewhere) {
    const float nan = std::numeric_limits<float>::quiet_NaN();
    WriteYearly("s.tsq0", {5, nan, 7});
    ASSERT_EQ(Run({"info", "s.tsq0", "--json"}), 0) << err;
    const auto item = Json()["items"][0];
    EXPECT_EQ(item["values"], 2);
    EXPECT_EQ(item["missing"], 1);
    EXPECT_EQ(item["maximum"]["value"], 7.0);
}

TEST_F(InfoCommand, KnowsARegularAxisThatIsStoredTimeByTime) {
    struct Case {
        test::Samples samples;
        std::string axis;
        std::string step;
        std::string text;
    };
    const Case cases[] = {
        {test::SamplesOf({{"1990-01-01", 1}, {"1990-01-01 06:00", 2}, {"1990-01-01 12:00", 3}}),
         "equidistant calendar", "21600.0", "time axis   equidistant, calendar\n"},
        {test::SamplesOf({{"1990-01-01", 1}, {"1990-01-01 06:00", 2}, {"1990-01-01 12:00:01", 3}}),
         "non-equidistant calendar", "null", "time axis    non-equidistant, calendar\n"},
        {test::SamplesOf({{"1990-01-01", 1}, {"1990-01-02", 2}}), "non-equidistant calendar",
         "null", "time axis    non-equidistant, calendar\n"},
    };
    for (const Case& c : cases) {
        ASSERT_TRUE(test::WriteDataFile(files.Path("s.tsq0"), c.samples));
        ASSERT_EQ(Run({"info", "s.tsq0", "--json"}), 0) << err;
        EXPECT_EQ(Json()["axis"], c.axis);
        EXPECT_EQ(Json()["step"].dump(), c.step);
        ASSERT_EQ(Run({"info", "s.tsq0"}), 0);
        EXPECT_THAT(out, HasSubstr(c.text));
        EXPECT_EQ(out.find("\nstep        6 h\n") != std::string::npos, c.step != "null") << out;
    }
}

TEST_F(InfoCommand, WarnsOfStepsThatGoBackwards) {
    const auto samples =
        test::SamplesOf({{"1990-01-02", 1}, {"1990-01-03", 2}, {"1990-01-02 12:00", 3}});
    ASSERT_TRUE(test::WriteDataFile(files.Path("s.tsq0"), samples));
    ASSERT_EQ(Run({"info", "s.tsq0"}), 0);
    EXPECT_EQ(err, "ryn: warning: s.tsq0: 1 time steps do not lie after the one before them\n");
}

TEST_F(InfoCommand, RefusesCutFilesInOneLine) {
    WriteYearly("s.tsq0", {1, 2, 3, 4, 5, 6});
    const std::string whole = files.Read("s.tsq0");
    for (std::size_t length = 0; length < whole.size(); length += 7) {
        files.Write("cut.tsq0", whole.substr(0, length));
        const int code = Run({"info", "cut.tsq0"});
        EXPECT_LE(code, 1) << length;
        EXPECT_EQ(code == 1, !err.empty()) << length;
    }
}

} // namespace
} // namespace ryn::cli
