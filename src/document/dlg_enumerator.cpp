#include "document/dlg_enumerator.h"

#include <array>

#include "document/page_classes.h"
#include "strings/catalogue.h"

namespace ryn {

namespace {

constexpr PageEntry Root(std::uint32_t page, std::string_view title, std::string_view helpTopic,
                         std::string_view address) {
    return {page, 0, 0, title, {}, 0, helpTopic, address};
}

constexpr PageEntry Setup(std::uint32_t page, int titleId, std::string_view className,
                          int helpContext) {
    return {page, 1, titleId, {}, className, helpContext, {}, {}};
}

constexpr PageEntry Output(std::uint32_t page, int titleId, std::string_view className,
                           int helpContext) {
    return {page, 10, titleId, {}, className, helpContext, {}, {}};
}

constexpr std::array kPages = {
    Root(1, "Setup", "/RYN/RYN_UserGuide_Online/RYN_setup/Setup.htm",
         "res://RynEdit.dll/Setup.htm"),
    Setup(2, kTextPageExtract, "CBasicForm", 135026),
    Setup(3, kTextPageDefine, "CDefineEVSForm", 135028),
    Setup(5, kTextPageDistributions, "CProbabilityForm", 135024),
    Setup(4, kTextPageAnalysis, "CMiscForm", 135025),
    Root(10, "Output", "/RYN/RYN_UserGuide_Online/RYN_output/Output.htm",
         "res://RynEdit.dll/Output.htm"),
    Output(11, kTextPagePlottingPositions, "CTableView", 135033),
    Output(12, kTextPageIndependence, "CTextView", 135034),
    Output(13, kTextPageGoodnessOfFit, "CTableView2", 135035),
    Output(14, kTextPageSampleStatistics, "CTextView2", 135036),
    Output(15, kTextPageQuantiles, "CTableView3", 135037),
    Output(16, kTextPageHistogram, "CTableView4", 135040),
    Output(17, kTextPageFrequencyPlot, "CGraphicalView", 135038),
    Output(18, kTextPageProbabilityPlot, "CGraphicalView2", 135039),
};

} // namespace

std::span<const PageEntry> PageTable() {
    return kPages;
}

const PageEntry* FindPage(std::uint32_t page) {
    for (const PageEntry& entry : kPages)
        if (entry.page == page)
            return &entry;
    return nullptr;
}

std::string CDlgEnumerator::GetPageTitle(std::uint32_t page) const {
    const PageEntry* const entry = FindPage(page);
    return entry == nullptr ? std::string() : std::string(Text(entry->titleId));
}

const CRuntimeClass* CDlgEnumerator::GetPageClass(std::uint32_t page, std::string& helpTopic,
                                                  std::string& pageAddress) const {
    helpTopic.clear();
    pageAddress.clear();
    const PageEntry* const entry = FindPage(page);
    if (entry == nullptr)
        return nullptr;
    helpTopic = entry->helpTopic;
    pageAddress = entry->address;
    return FindPageClass(entry->className);
}

} // namespace ryn
