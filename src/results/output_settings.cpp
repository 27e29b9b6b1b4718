#include "results/output_settings.h"

namespace ryn {

namespace {

/// The entry of a list that a file from elsewhere may have left too short; else an empty one.
template <class Item>
const Item& At(const std::vector<Item>& list, std::size_t index) {
    static const Item kNone{};
    return index < list.size() ? list[index] : kNone;
}

void SaveDensities(KvfTree* file, const char* section, const DoubleList& values) {
    kvfAddSection(file, section);
    SaveDoubles(file, "PDF", values);
    kvfEndSection(file);
}

/// A table or a curve: both kinds of item hold the same three lists.
template <class Item>
void SaveEvents(KvfTree* file, const char* section, const Item& item) {
    kvfAddSection(file, section);
    SaveDoubles(file, "TyearEvent", item.TyearEvent);
    SaveDoubles(file, "AvgTyearEvent", item.AvgTyearEvent);
    SaveDoubles(file, "StdTyearEvent", item.StdTyearEvent);
    kvfEndSection(file);
}

} // namespace

template <class Visit>
void COutputSettings::ForEachPage(Visit visit) {
    visit(Quantiles);
    visit(Frequency);
    visit(GoodnessOfFit);
    visit(Histogram);
    visit(Independence);
    visit(SampleStats);
    visit(Probability);
    visit(PlottingPos);
}

COutputSettings::COutputSettings() {
    ForEachPage([this](auto& page) { page.SetParent(this); });
}

void COutputSettings::SaveSettings(KvfTree* file, const std::string& baseDirectory) {
    kvfAddSection(file, "OutputSettings");
    ForEachPage([&](CSettingsTemplate& page) { page.SaveSettings(file, baseDirectory); });
    kvfEndSection(file);
}

void COutputSettings::LoadSettings(const KvfSection* target, const std::string& baseDirectory) {
    Clear();
    const KvfSection* const settings = kvfSectionByNameNum(target, "OutputSettings", 1);
    ForEachPage([&](CSettingsTemplate& page) { page.LoadSettings(settings, baseDirectory); });
}

void COutputSettings::LoadOutput(const KvfSection* target, const std::string& baseDirectory) {
    const KvfSection* const heading = kvfSectionByNameNum(target, "Settings", 1);
    kvfGetParam(heading, "ItemName", &ItemName, 1, 1);
    kvfGetParam(heading, "Unit", &Unit, 1, 1);
    kvfGetParam(heading, "Title", &Title, 1, 1);
    kvfGetParam(heading, "Subtitle", &Subtitle, 1, 1);
    const KvfSection* const analysis = kvfSectionByNameNum(target, "DistributionAnalysis", 1);
    LoadDoubles(analysis, "ReturnPeriods", LoadCount(analysis, "NoReturnPeriods"), &ReturnPeriods);
    ForEachCombination(target, [this](const KvfSection* combination) {
        kvfGetParam(combination, "ItemName", &ItemNames.emplace_back(), 1, 1);
    });
    ForEachPage([&](CSettingsTemplate& page) { page.LoadOutput(target, baseDirectory); });
    if (!GoodnessOfFit.Items().empty())
        Quantiles.SetStatisticFlags(GoodnessOfFit.Items().front());
    valid = true;
    hasOutput = true;
}

void COutputSettings::SaveOutput(KvfTree* file) const {
    kvfAddSection(file, "Settings");
    kvfPutParam(file, "ItemName", ItemName);
    kvfPutParam(file, "Unit", Unit);
    kvfPutParam(file, "Title", Title);
    kvfPutParam(file, "Subtitle", Subtitle);
    kvfEndSection(file);
    Independence.SaveOutput(file);
    SampleStats.SaveOutput(file);
    Histogram.SaveOutput(file);
    Probability.SaveOutput(file);
    kvfAddSection(file, "DistributionAnalysis");
    SaveCount(file, "NoItemPDFPlot", Frequency.XvaluePDFPlot.size());
    SaveDoubles(file, "XvaluePDFPlot", Frequency.XvaluePDFPlot);
    kvfPutParam(file, "NoItemProbabilityPlot", Probability.NoItemProbabilityPlot);
    SaveDoubles(file, "ProbabilityPlot", Probability.ProbabilityPlot);
    SaveCount(file, "NoReturnPeriods", ReturnPeriods.size());
    SaveDoubles(file, "ReturnPeriods", ReturnPeriods);
    for (std::size_t i = 0; i < ItemNames.size(); ++i)
        SaveCombination(file, i);
    kvfEndSection(file);
}

void COutputSettings::SaveCombination(KvfTree* file, std::size_t index) const {
    kvfAddSection(file, ItemSectionName(index + 1));
    kvfPutParam(file, "ItemName", ItemNames[index]);
    SaveParameters(file, At(SampleStats.Items(), index));
    SaveStatistics(file, At(GoodnessOfFit.Items(), index));
    SaveDensities(file, "PDFTable", At(Histogram.Estimated(), index));
    SaveDensities(file, "PDFPlot", At(Frequency.Densities(), index));
    SaveEvents(file, "TyearEventTable", At(Quantiles.Items(), index));
    SaveEvents(file, "TyearEventPlot", At(Probability.Curves(), index));
    kvfEndSection(file);
}

void COutputSettings::Clear() {
    ForEachPage([](auto& page) { page.Clear(); });
    ItemNames.clear();
    ReturnPeriods.clear();
    valid = false;
    hasOutput = false;
}

void COutputSettings::UseMessageFont(const FontRecord& font) {
    Quantiles.Font = font;
    GoodnessOfFit.Font = font;
}

} // namespace ryn
