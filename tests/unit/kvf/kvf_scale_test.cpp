#include <algorithm>
#include <string>

#include <gtest/gtest.h>

#include "kvf/kvf.h"
#include "support/processor_time.h"

namespace ryn {
namespace {

/// Two names in turn, which would make a walk over the siblings for each occurrence quadratic.
std::string SiblingsText(int count) {
    std::string text = "T {\n";
    for (int i = 0; i < count; ++i)
        text += (i % 2 == 0 ? "    Even = " : "    Odd = ") + std::to_string(i) + "\n";
    return text + "}\n";
}

/// Looks every sibling up by name and occurrence; true when each holds its number.
bool FindAll(const KvfTree* tree, int count) {
    const KvfSection* const target = kvfTargetByNameNum(tree, "T", 1);
    for (int i = 0; i < count; ++i) {
        int value = -1;
        if (kvfGetParam(target, i % 2 == 0 ? "Even" : "Odd", &value, i / 2 + 1, 1) == 0 ||
            value != i)
            return false;
    }
    return true;
}

double SecondsToReadAndFind(const std::string& text, int count) {
    const double start = test::ProcessorSeconds();
    const KvfHandle tree = kvfLoadText(text, "siblings.ryn");
    EXPECT_TRUE(FindAll(tree.get(), count));
    return test::ProcessorSeconds() - start;
}

TEST(KvfScale, ReadsAndFindsAMillionSiblingsInProportionalTime) {
    const std::string tenth = SiblingsText(100'000);
    const std::string whole = SiblingsText(1'000'000);
    // The shorter of two, since another process may take the processor away.
    const double small =
        std::min(SecondsToReadAndFind(tenth, 100'000), SecondsToReadAndFind(tenth, 100'000));
    const double large = SecondsToReadAndFind(whole, 1'000'000);
    // In proportion it is 10; a walk for each occurrence makes it 100 and more.
    EXPECT_LT(large, 40 * small);
}

TEST(KvfScale, ReadsAMillionTextsOnOneLineInProportionalTime) {
    std::string text = "T { K = \"\"";
    for (int i = 1; i < 1'000'000; ++i) // quadratic, this takes many minutes
        text += ",\"\"";
    const KvfHandle tree = kvfLoadText(text + " }", "line.ryn");
    const KvfSection* const target = kvfTargetByNameNum(tree.get(), "T", 1);
    EXPECT_EQ(kvfGetNoParams(kvfKeywordByNameNum(target, "K", 1)), 1'000'000);
}

TEST(KvfScale, FindsSectionsThatAreAddedBetweenLookupsInProportionalTime) {
    const KvfHandle tree = kvfCreate();
    const KvfSection* const target = kvfAddTarget(tree.get(), "T");
    constexpr int kCount = 100'000; // quadratic, this takes minutes
    int found = 0;
    for (int i = 1; i <= kCount; ++i) {
        const KvfSection* const added = kvfAddSection(tree.get(), "Item");
        kvfEndSection(tree.get());
        found += kvfSectionByNameNum(target, "Item", i) == added ? 1 : 0;
    }
    EXPECT_EQ(found, kCount);
}

TEST(KvfScale, ManyNamesOfTheirOwnAreWrittenReadAndFound) {
    constexpr int kCount = 300'000;
    const KvfHandle tree = kvfCreate();
    kvfAddTarget(tree.get(), "T");
    for (int i = 0; i < kCount; ++i)
        kvfPutParam(tree.get(), "Item" + std::to_string(i), 0.5 * i);
    const KvfHandle back = kvfLoadText(kvfText(tree.get()), "names.ryn");
    const KvfSection* const target = kvfTargetByNameNum(back.get(), "T", 1);
    int found = 0;
    for (int i = 0; i < kCount; ++i) {
        double value = -1.0;
        kvfGetParam(target, "Item" + std::to_string(i), &value, 1, 1);
        found += value == 0.5 * i ? 1 : 0;
    }
    EXPECT_EQ(found, kCount);
}

} // namespace
} // namespace ryn
