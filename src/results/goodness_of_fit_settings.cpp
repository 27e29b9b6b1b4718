#include "results/goodness_of_fit_settings.h"

#include "results/result_lists.h"

namespace ryn {

namespace {

using Page = CGoodnessOfFitSettings;

constexpr DisplayFlag<Page> kFlags[] = {
    {"ChiSquared", &Page::ChiSquared},
    {"KolmogorovSmirnov", &Page::KolmogorovSmirnov},
    {"SLSC", &Page::SLSC},
    {"PPCC", &Page::PPCC},
    {"PPCC2", &Page::PPCC2},
    {"LogLikelihood", &Page::LogLikelihood},
};

/// One statistic's keywords, in file order. A statistic without a level has no keyword for it.
struct Statistic {
    const char* flagKeyword;
    bool SGOFItem::*flag;
    const char* valueKeyword;
    double SGOFItem::*value;
    const char* levelKeyword;
    double SGOFItem::*level;
};

constexpr Statistic kStatistics[] = {
    {"ChiSquaredTest", &SGOFItem::ChiSquaredTest, "ChiSquaredStatistic",
     &SGOFItem::ChiSquaredStatistic, "ChiSquaredLevel", &SGOFItem::ChiSquaredLevel},
    {"KolmogorovSmirnovTest", &SGOFItem::KolmogorovSmirnovTest, "KolmogorovSmirnovStatistic",
     &SGOFItem::KolmogorovSmirnovStatistic, "KolmogorovSmirnovLevel",
     &SGOFItem::KolmogorovSmirnovLevel},
    {"SLSCTest", &SGOFItem::SLSCTest, "SLSCStatistic", &SGOFItem::SLSCStatistic, nullptr, nullptr},
    {"PPCCTest", &SGOFItem::PPCCTest, "PPCCStatistic", &SGOFItem::PPCCStatistic, nullptr, nullptr},
    {"PPCC2Test", &SGOFItem::PPCC2Test, "PPCC2Statistic", &SGOFItem::PPCC2Statistic, nullptr,
     nullptr},
    {"LogLikelihood", &SGOFItem::LogLikelihood, "LogLikelihoodStatistic",
     &SGOFItem::LogLikelihoodStatistic, nullptr, nullptr},
};

SGOFItem LoadStatistics(const KvfSection* section) {
    SGOFItem item;
    for (const Statistic& statistic : kStatistics) {
        kvfGetParam(section, statistic.flagKeyword, &(item.*statistic.flag), 1, 1);
        kvfGetParam(section, statistic.valueKeyword, &(item.*statistic.value), 1, 1);
        if (statistic.levelKeyword != nullptr)
            kvfGetParam(section, statistic.levelKeyword, &(item.*statistic.level), 1, 1);
    }
    return item;
}

} // namespace

void SaveStatistics(KvfTree* file, const SGOFItem& item) {
    kvfAddSection(file, "GoodnessOfFitStatistics");
    for (const Statistic& statistic : kStatistics) {
        kvfPutParam(file, statistic.flagKeyword, item.*statistic.flag);
        kvfPutParam(file, statistic.valueKeyword, item.*statistic.value);
        if (statistic.levelKeyword != nullptr)
            kvfPutParam(file, statistic.levelKeyword, item.*statistic.level);
    }
    kvfEndSection(file);
}

void CGoodnessOfFitSettings::SaveSettings(KvfTree* file, const std::string& /*baseDirectory*/) {
    kvfAddSection(file, "GoodnessOfFitSettings");
    SaveFlags(file, *this, kFlags);
    kvfPutParam(file, "Precision", Precision);
    SaveFont(file, Font);
    SaveSelectedItems(file, SelectedItems);
    kvfEndSection(file);
}

void CGoodnessOfFitSettings::LoadSettings(const KvfSection* settings,
                                          const std::string& /*baseDirectory*/) {
    Clear();
    const KvfSection* const section = kvfSectionByNameNum(settings, "GoodnessOfFitSettings", 1);
    LoadFlags(section, *this, kFlags);
    kvfGetParam(section, "Precision", &Precision, 1, 1);
    LoadFont(section, &Font);
    LoadSelectedItems(section, &SelectedItems);
}

void CGoodnessOfFitSettings::LoadOutput(const KvfSection* target,
                                        const std::string& /*baseDirectory*/) {
    ForEachCombination(target, [this](const KvfSection* combination) {
        items.push_back(
            LoadStatistics(kvfSectionByNameNum(combination, "GoodnessOfFitStatistics", 1)));
        GrowSelectedItems(items.size(), &SelectedItems);
        ShowWhatWasComputed(items.back());
    });
}

void CGoodnessOfFitSettings::ShowWhatWasComputed(const SGOFItem& item) {
    ChiSquared = item.ChiSquaredTest;
    KolmogorovSmirnov = item.KolmogorovSmirnovTest;
    SLSC = item.SLSCTest;
    PPCC = item.PPCCTest;
    PPCC2 = item.PPCC2Test;
    LogLikelihood = item.LogLikelihood;
}

void CGoodnessOfFitSettings::Clear() {
    items.clear();
    SelectedItems.clear();
}

} // namespace ryn
