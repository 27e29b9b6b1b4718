#include "results/frequency_settings.h"

namespace ryn {

void CFrequencySettings::SaveSettings(KvfTree* file, const std::string& /*baseDirectory*/) {
    kvfAddSection(file, "FrequencySettings");
    SaveSelectedItems(file, SelectedItems);
    kvfEndSection(file);
}

void CFrequencySettings::LoadSettings(const KvfSection* settings,
                                      const std::string& /*baseDirectory*/) {
    Clear();
    LoadSelectedItems(kvfSectionByNameNum(settings, "FrequencySettings", 1), &SelectedItems);
}

void CFrequencySettings::LoadOutput(const KvfSection* target,
                                    const std::string& /*baseDirectory*/) {
    const KvfSection* const analysis = kvfSectionByNameNum(target, "DistributionAnalysis", 1);
    LoadDoubles(analysis, "XvaluePDFPlot", LoadCount(analysis, "NoItemPDFPlot"), &XvaluePDFPlot);
    const std::size_t points = XvaluePDFPlot.size();
    ForEachCombination(target, [this, points](const KvfSection* combination) {
        LoadDoubles(kvfSectionByNameNum(combination, "PDFPlot", 1), "PDF", points,
                    &densities.emplace_back());
        GrowSelectedItems(densities.size(), &SelectedItems);
    });
}

void CFrequencySettings::Clear() {
    densities.clear();
    XvaluePDFPlot.clear();
    SelectedItems.clear();
}

} // namespace ryn
