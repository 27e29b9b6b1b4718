#include "results/histogram_settings.h"

namespace ryn {

void CHistogramSettings::SaveSettings(KvfTree* file, const std::string& /*baseDirectory*/) {
    kvfAddSection(file, "HistogramSettings");
    kvfPutParam(file, "Precision", Precision);
    SaveFont(file, Font);
    SaveSelectedItems(file, SelectedItems);
    kvfEndSection(file);
}

void CHistogramSettings::LoadSettings(const KvfSection* settings,
                                      const std::string& /*baseDirectory*/) {
    Clear();
    const KvfSection* const section = kvfSectionByNameNum(settings, "HistogramSettings", 1);
    kvfGetParam(section, "Precision", &Precision, 1, 1);
    LoadFont(section, &Font);
    LoadSelectedItems(section, &SelectedItems);
}

void CHistogramSettings::LoadOutput(const KvfSection* target,
                                    const std::string& /*baseDirectory*/) {
    const KvfSection* const section = kvfSectionByNameNum(target, "Histogram", 1);
    kvfGetParam(section, "XstartHistogram", &XstartHistogram, 1, 1);
    kvfGetParam(section, "XstepHistogram", &XstepHistogram, 1, 1);
    LoadDoubles(section, "FrequencyHistogram", LoadCount(section, "NoIntHistogram"),
                &FrequencyHistogram);
    const std::size_t intervals = FrequencyHistogram.size();
    NoIntHistogram = static_cast<std::int32_t>(intervals);
    ForEachCombination(target, [this, intervals](const KvfSection* combination) {
        LoadDoubles(kvfSectionByNameNum(combination, "PDFTable", 1), "PDF", intervals,
                    &estimated.emplace_back());
        GrowSelectedItems(estimated.size(), &SelectedItems);
    });
}

void CHistogramSettings::SaveOutput(KvfTree* file) const {
    kvfAddSection(file, "Histogram");
    kvfPutParam(file, "NoIntHistogram", NoIntHistogram);
    kvfPutParam(file, "XstartHistogram", XstartHistogram);
    kvfPutParam(file, "XstepHistogram", XstepHistogram);
    SaveDoubles(file, "FrequencyHistogram", FrequencyHistogram);
    kvfEndSection(file);
}

void CHistogramSettings::Clear() {
    NoIntHistogram = 0;
    FrequencyHistogram.clear();
    estimated.clear();
    SelectedItems.clear();
}

} // namespace ryn
