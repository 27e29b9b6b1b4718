#include "results/estimate_quantile_settings.h"

#include <utility>

#include "results/output_settings.h"

namespace ryn {

namespace {

using Page = CEstimateQuantileSettings;

constexpr DisplayFlag<Page> kFlags[] = {
    {"Calculations", &Page::Calculations},
    {"KolmogorovSmirnov", &Page::KolmogorovSmirnov},
    {"ChiSquared", &Page::ChiSquared},
    {"LeastSquares", &Page::LeastSquares},
    {"LogLikelihood", &Page::LogLikelihood},
    {"PPCC", &Page::PPCC},
    {"PPCC2", &Page::PPCC2},
};

} // namespace

void CEstimateQuantileSettings::SaveSettings(KvfTree* file, const std::string& /*baseDirectory*/) {
    kvfAddSection(file, "EstimateQuantilesSettings");
    SaveFlags(file, *this, kFlags);
    kvfPutParam(file, "Precision", Precision);
    SaveFont(file, Font);
    SaveSelectedItems(file, SelectedItems);
    kvfEndSection(file);
}

void CEstimateQuantileSettings::LoadSettings(const KvfSection* settings,
                                             const std::string& /*baseDirectory*/) {
    Clear();
    const KvfSection* const section = kvfSectionByNameNum(settings, "EstimateQuantilesSettings", 1);
    LoadFlags(section, *this, kFlags);
    kvfGetParam(section, "Precision", &Precision, 1, 1);
    LoadFont(section, &Font);
    LoadSelectedItems(section, &SelectedItems);
}

void CEstimateQuantileSettings::LoadOutput(const KvfSection* target,
                                           const std::string& /*baseDirectory*/) {
    const std::size_t periods = GetParent()->ReturnPeriods.size();
    ForEachCombination(target, [this, periods](const KvfSection* combination) {
        const KvfSection* const table = kvfSectionByNameNum(combination, "TyearEventTable", 1);
        SEQItem item;
        LoadDoubles(table, "TyearEvent", periods, &item.TyearEvent);
        LoadDoubles(table, "AvgTyearEvent", periods, &item.AvgTyearEvent);
        LoadDoubles(table, "StdTyearEvent", periods, &item.StdTyearEvent);
        items.push_back(std::move(item));
        GrowSelectedItems(items.size(), &SelectedItems);
    });
}

void CEstimateQuantileSettings::Clear() {
    items.clear();
    SelectedItems.clear();
}

void CEstimateQuantileSettings::SetStatisticFlags(const SGOFItem& item) {
    ChiSquared = item.ChiSquaredTest;
    KolmogorovSmirnov = item.KolmogorovSmirnovTest;
    LeastSquares = item.SLSCTest;
    PPCC = item.PPCCTest;
    PPCC2 = item.PPCC2Test;
    LogLikelihood = item.LogLikelihood;
}

} // namespace ryn
