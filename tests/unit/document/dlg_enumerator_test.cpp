#include "document/dlg_enumerator.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "strings/language.h"

namespace ryn {
namespace {

using ::testing::ElementsAre;

TEST(Pages, StandInTheOrderOfTheTree) {
    std::vector<std::uint32_t> order;
    for (const PageEntry& entry : PageTable())
        order.push_back(entry.page);
    EXPECT_THAT(order, ElementsAre(1, 2, 3, 5, 4, 10, 11, 12, 13, 14, 15, 16, 17, 18));
}

TEST(Pages, HaveTextClassAndHelp) {
    struct Row {
        std::uint32_t page;
        const char* title;
        const char* className;
        int help;
    };
    const CDlgEnumerator pages;
    for (const Row& row : std::initializer_list<Row>{
             {2, "Extract Extreme Value Series", "CBasicForm", 135026},
             {3, "Define Extreme Value Series", "CDefineEVSForm", 135028},
             {4, "Analysis", "CMiscForm", 135025},
             {5, "Probability Distribution and Estimation Method", "CProbabilityForm", 135024},
             {11, "Extreme value series and plotting position", "CTableView", 135033},
             {12, "Independence and homogenity tests", "CTextView", 135034},
             {13, "Goodness-of-fit statistics", "CTableView2", 135035},
             {14, "Sample statistics and estimated parameters", "CTextView2", 135036},
             {15, "Estimated quantiles and standard errors", "CTableView3", 135037},
             {16, "Histogram and frequency function", "CTableView4", 135040},
             {17, "Frequency plot", "CGraphicalView", 135038},
             {18, "Probability plot", "CGraphicalView2", 135039}}) {
        std::string topic = "before";
        std::string address = "before";
        const CRuntimeClass* const found = pages.GetPageClass(row.page, topic, address);
        ASSERT_NE(found, nullptr) << row.page;
        EXPECT_EQ(found->className, row.className);
        EXPECT_EQ(pages.GetPageTitle(row.page), row.title);
        EXPECT_EQ(FindPage(row.page)->helpContext, row.help);
        EXPECT_EQ(topic + address, "");
    }
}

TEST(Pages, OfTheRootsAreHtmlPages) {
    const CDlgEnumerator pages;
    std::string topic;
    std::string address;
    EXPECT_EQ(pages.GetPageClass(1, topic, address), nullptr);
    EXPECT_EQ(topic, "/RYN/RYN_UserGuide_Online/RYN_setup/Setup.htm");
    EXPECT_EQ(address, "res://RynEdit.dll/Setup.htm");
    EXPECT_EQ(pages.GetPageClass(10, topic, address), nullptr);
    EXPECT_EQ(topic, "/RYN/RYN_UserGuide_Online/RYN_output/Output.htm");
    EXPECT_EQ(address, "res://RynEdit.dll/Output.htm");
    SetLanguage(Language::Japanese);
    EXPECT_EQ(FindPage(1)->rootTitle, "Setup");
    EXPECT_EQ(pages.GetPageTitle(4), "解析");
    SetLanguage(Language::English);
}

TEST(Pages, OfOtherNumbersHaveNothing) {
    const CDlgEnumerator pages;
    for (const std::uint32_t page : {0U, 6U, 7U, 8U, 9U, 19U, 4294967295U}) {
        std::string topic = "before";
        std::string address = "before";
        EXPECT_EQ(pages.GetPageClass(page, topic, address), nullptr);
        EXPECT_EQ(topic + address + pages.GetPageTitle(page), "");
    }
    EXPECT_EQ(pages.GetPageTitle(1) + pages.GetPageTitle(10), "");
}

} // namespace
} // namespace ryn
