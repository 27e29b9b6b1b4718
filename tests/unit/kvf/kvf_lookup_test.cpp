#include <climits>
#include <string>

#include <gtest/gtest.h>
#include <rapidcheck/gtest.h>

#include "kvf/kvf.h"
#include "support/kvf_listing.h"

namespace ryn {
namespace {

using test::ListKvf;
using Lines = std::vector<std::string>;

/// What kvfGetParam gives for the only value of the only keyword; a marker when it finds nothing.
template <typename Type>
Type ReadBack(const std::string& value, Type otherwise) {
    const KvfHandle tree = kvfLoadText("T { K = " + value + " }", "case.ryn");
    Type result = otherwise;
    const int found = kvfGetParam(kvfTargetByNameNum(tree.get(), "T", 1), "K", &result, 1, 1);
    EXPECT_EQ(found != 0, !(result == otherwise)) << value;
    return result;
}

TEST(KvfLookup, WidensNumbersOnlyWhereNothingIsLost) {
    EXPECT_EQ(ReadBack("3", -1), 3);
    EXPECT_EQ(ReadBack("3.0", -1), -1);
    EXPECT_EQ(ReadBack("3.0f", -1), -1);
    EXPECT_EQ(ReadBack("true", -1), -1);
    EXPECT_EQ(ReadBack("3", -1.0F), 3.0F);
    EXPECT_EQ(ReadBack("16777216", -1.0F), 16777216.0F);
    EXPECT_EQ(ReadBack("16777217", -1.0F), -1.0F);
    EXPECT_EQ(ReadBack("2147483647", -1.0F), -1.0F);
    EXPECT_EQ(ReadBack("-2147483648", -1.0F), -2147483648.0F);
    EXPECT_EQ(ReadBack("0.1f", -1.0F), 0.1F);
    EXPECT_EQ(ReadBack("0.5", -1.0F), -1.0F);
    EXPECT_EQ(ReadBack("2147483647", -1.0), 2147483647.0);
    EXPECT_EQ(ReadBack("0.1f", -1.0), static_cast<double>(0.1F));
    EXPECT_EQ(ReadBack("0.1", -1.0), 0.1);
    EXPECT_EQ(ReadBack("\"3\"", -1.0), -1.0);
    EXPECT_EQ(ReadBack("true", false), true);
    EXPECT_EQ(ReadBack("1", false), false);
    const std::string none = "none";
    EXPECT_EQ(ReadBack("\"text\"", none), "text");
    EXPECT_EQ(ReadBack("file(\"name\")", none), "name");
    EXPECT_EQ(ReadBack("3", none), none);
}

TEST(KvfLookup, FindsRepeatedNamesByOccurrenceInFileOrder) {
    std::string text = "T {";
    for (int i = 1; i <= 40; ++i)
        text += " Item { N = " + std::to_string(i) + " }\nItem = " + std::to_string(-i) + ",7\n";
    const KvfHandle tree = kvfLoadText(text + "}\nT { Item = 99\n}", "case.ryn");
    const KvfSection* const target = kvfTargetByNameNum(tree.get(), "T", 1);
    for (int i = 1; i <= 40; ++i) {
        int section = 0;
        int keyword = 0;
        EXPECT_NE(kvfGetParam(kvfSectionByNameNum(target, "Item", i), "N", &section, 1, 1), 0);
        EXPECT_NE(kvfGetParam(target, "Item", &keyword, i, 1), 0);
        EXPECT_EQ(section, i);
        EXPECT_EQ(keyword, -i);
    }
    for (const int outside : {INT_MIN, -1, 0, 41, INT_MAX}) {
        EXPECT_EQ(kvfSectionByNameNum(target, "Item", outside), nullptr);
        EXPECT_EQ(kvfKeywordByNameNum(target, "Item", outside), nullptr);
        EXPECT_EQ(kvfParamByNum(kvfKeywordByNameNum(target, "Item", 1), outside), nullptr);
    }
    int value = 0;
    EXPECT_NE(kvfGetParam(kvfTargetByNameNum(tree.get(), "T", 2), "Item", &value, 1, 1), 0);
    EXPECT_EQ(value, 99);
    EXPECT_EQ(kvfSectionByNameNum(target, "item", 1), nullptr);
    EXPECT_EQ(kvfSectionByNameNum(target, "N", 1), nullptr);
}

RC_GTEST_PROP(KvfLookupProperty, AddsBetweenLookupsAreFound, ()) {
    const KvfHandle tree = kvfCreate();
    const KvfSection* const target = kvfAddTarget(tree.get(), "T");
    std::vector<std::vector<int>> expected(3);
    const auto names = *rc::gen::container<std::vector<int>>(60, rc::gen::inRange(0, 3));
    for (std::size_t i = 0; i < names.size(); ++i) {
        const auto name = static_cast<std::size_t>(names[i]);
        kvfPutParam(tree.get(), std::to_string(name), static_cast<int>(i));
        expected[name].push_back(static_cast<int>(i));
        int value = -1;
        const int count = static_cast<int>(expected[name].size());
        RC_ASSERT(kvfGetParam(target, std::to_string(name), &value, count, 1) != 0);
        RC_ASSERT(value == static_cast<int>(i));
        RC_ASSERT(kvfGetParam(target, std::to_string(name), &value, count + 1, 1) == 0);
        RC_ASSERT(kvfGetParam(target, std::to_string(name), &value, 1, 1) != 0);
        RC_ASSERT(value == expected[name].front());
    }
}

TEST(KvfLookup, ReadsAListWholeOrNotAtAll) {
    const KvfHandle tree =
        kvfLoadText("T { Date = 1990, 12, 31\nBad = 1, 2.0, 3\nNone =\n}", "case.ryn");
    const KvfSection* const target = kvfTargetByNameNum(tree.get(), "T", 1);
    int y = -1;
    int m = -1;
    int d = -1;
    int more = -1;
    EXPECT_EQ(kvfGetListParam(target, "Bad", 1, "iii", {&y, &m, &d}), 0);
    EXPECT_EQ(kvfGetListParam(target, "Date", 1, "iiii", {&y, &m, &d, &more}), 0);
    EXPECT_EQ(kvfGetListParam(target, "Date", 1, "idi", {&y, &m, &d}), 0);
    EXPECT_EQ(kvfGetListParam(target, "Date", 1, "ii", {&y, &m, &d}), 0);
    EXPECT_EQ(kvfGetListParam(target, "Date", 2, "iii", {&y, &m, &d}), 0);
    EXPECT_EQ(kvfGetListParam(target, "None", 1, "i", {&y}), 0);
    EXPECT_EQ(y, -1);
    EXPECT_NE(kvfGetListParam(target, "Date", 1, "iii", {&y, &m, &d}), 0);
    EXPECT_EQ(y * 10000 + m * 100 + d, 19901231);
    EXPECT_NE(kvfGetListParam(target, "Date", 1, "i", {&more}), 0);
    EXPECT_EQ(more, 1990);
    EXPECT_EQ(kvfGetNoParams(kvfKeywordByNameNum(target, "None", 1)), 0);
}

TEST(KvfLookup, NothingIsFoundOnANullHandle) {
    KvfHandle null;
    int number = 7;
    double real = 7;
    std::string text = "seven";
    EXPECT_EQ(kvfTargetByNameNum(nullptr, "T", 1), nullptr);
    EXPECT_EQ(kvfSectionByNameNum(nullptr, "S", 1), nullptr);
    EXPECT_EQ(kvfKeywordByNameNum(nullptr, "K", 1), nullptr);
    EXPECT_EQ(kvfParamByNum(nullptr, 1), nullptr);
    EXPECT_EQ(kvfGetNoParams(nullptr), 0);
    EXPECT_EQ(kvfIsBool(nullptr), 0);
    EXPECT_FALSE(kvfGetBool(nullptr));
    EXPECT_EQ(kvfGetParam(nullptr, "K", &number, 1, 1), 0);
    EXPECT_EQ(kvfGetParam(nullptr, "K", &real, 1, 1), 0);
    EXPECT_EQ(kvfGetParam(nullptr, "K", &text, 1, 1), 0);
    EXPECT_EQ(kvfGetParamFilename(nullptr, "K", &text, 1, 1), 0);
    EXPECT_EQ(kvfGetListParam(nullptr, "K", 1, "i", {&number}), 0);
    EXPECT_EQ(std::to_string(number) + std::to_string(real) + text, "77.000000seven");
    kvfAddTarget(nullptr, "T");
    kvfAddSection(nullptr, "S");
    kvfPutParam(nullptr, "K", 1);
    kvfPutParam(nullptr, "K", "text");
    kvfPutListParam(nullptr, "K", "i", {1});
    kvfAddInt(nullptr, 1);
    kvfEndSection(nullptr);
    kvfCopy(nullptr, nullptr);
    kvfClose(&null);
    kvfClose(nullptr);
    EXPECT_EQ(kvfText(nullptr), "");
}

TEST(KvfBuilder, EachAddGoesToTheInnermostOpenPart) {
    KvfHandle tree = kvfCreate();
    KvfTree* const t = tree.get();
    EXPECT_EQ(kvfAddSection(t, "NoTarget"), nullptr);
    kvfPutParam(t, "Lost", 1);
    kvfAddKeyword(t, "Lost");
    kvfAddInt(t, 1);
    kvfAddTarget(t, "A");
    kvfAddInt(t, 1); // no keyword is open
    kvfAddSection(t, "S");
    kvfAddKeyword(t, "List");
    kvfAddInt(t, 1);
    kvfAddBool(t, true);
    kvfEndSection(t);
    kvfAddFloat(t, 2.0F); // the keyword ended with its section
    kvfPutParam(t, "One", 1.0);
    kvfAddDouble(t, 2.0); // and this one is whole
    kvfPutListParam(t, "Bad", "ii", {1});
    kvfPutListParam(t, "Bad", "d", {1});
    kvfAddSection(t, "Open");
    kvfAddTarget(t, "B"); // closes A and what is open in it
    kvfPutParam(t, "Null", static_cast<const char*>(nullptr));
    kvfEndSection(t);
    kvfEndSection(t);
    kvfPutParam(t, "Lost", "after the end");
    EXPECT_EQ(kvfText(t), "A {\n    S {\n        List = 1, true\n    }\n    One = 1.0\n"
                          "    Open {\n    }\n}\nB {\n    Null = \"\"\n}\n");
    kvfClose(&tree);
    EXPECT_EQ(tree, nullptr);
}

TEST(KvfCopy, AppendsACopyOfItsOwnToAnotherTree) {
    KvfHandle source = kvfLoadText("G { A = 1, \"x\"\nS { F = file(\"y\") }\nA =\n}", "source.ryn");
    const KvfHandle destination = kvfCreate();
    KvfSection* const target = kvfAddTarget(destination.get(), "H");
    kvfPutParam(destination.get(), "A", 0);
    kvfEndSection(destination.get());
    kvfCopy(kvfTargetByNameNum(source.get(), "G", 1), target);
    kvfClose(&source);
    const Lines expected{"section H",      "keyword A of 1",
                         "int 0",          "keyword A of 2",
                         "int 1",          "text x",
                         "section S",      "keyword F of 1",
                         "file y",         "end",
                         "keyword A of 0", "end"};
    EXPECT_EQ(ListKvf(destination), expected);
    EXPECT_EQ(kvfGetNoParams(kvfKeywordByNameNum(target, "A", 2)), 2);
}

TEST(KvfCopy, CopiesASectionIntoItsOwnPartOnce) {
    const KvfHandle tree = kvfCreate();
    KvfSection* const target = kvfAddTarget(tree.get(), "T");
    kvfPutParam(tree.get(), "K", 1);
    KvfSection* const section = kvfAddSection(tree.get(), "S");
    kvfCopy(target, section);
    EXPECT_EQ(kvfText(tree.get()),
              "T {\n    K = 1\n    S {\n        K = 1\n        S {\n        }\n    }\n}\n");
    kvfCopy(section, section);
    EXPECT_EQ(kvfText(tree.get()),
              "T {\n    K = 1\n    S {\n        K = 1\n        S {\n        }\n"
              "        K = 1\n        S {\n        }\n    }\n}\n");
}

TEST(KvfCopy, LeavesAnOpenListAndHandlesToItsParametersGood) {
    const KvfHandle tree = kvfCreate();
    const KvfHandle source = kvfLoadText("G { A = 1, 2\n}", "source.ryn");
    KvfSection* const target = kvfAddTarget(tree.get(), "T");
    kvfAddKeyword(tree.get(), "Open");
    kvfAddInt(tree.get(), 10);
    const KvfParam* const first = kvfParamByNum(kvfKeywordByNameNum(target, "Open", 1), 1);
    kvfCopy(kvfTargetByNameNum(source.get(), "G", 1), target);
    kvfAddInt(tree.get(), 20);
    for (int i = 0; i < 1000; ++i)
        kvfPutParam(tree.get(), "More", i);
    EXPECT_EQ(kvfParamInt(*first), 10);
    const Lines lines = ListKvf(tree);
    const Lines head(lines.begin(), lines.begin() + 7);
    const Lines expected{
        "section T", "keyword Open of 2", "int 10", "int 20", "keyword A of 2", "int 1", "int 2"};
    EXPECT_EQ(head, expected);
}

} // namespace
} // namespace ryn
