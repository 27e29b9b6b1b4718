#include "results/probability_settings.h"

#include <utility>

namespace ryn {

namespace {

/// Exceedance as non-exceedance probabilities, and the other way round.
DoubleList Complements(DoubleList probabilities) {
    for (double& probability : probabilities)
        probability = 1.0 - probability;
    return probabilities;
}

} // namespace

void CProbabilitySettings::SaveSettings(KvfTree* file, const std::string& /*baseDirectory*/) {
    kvfAddSection(file, "ProbabilitySettings");
    kvfPutParam(file, "PlottingPosition", PlottingPosition);
    kvfPutParam(file, "ProbabilityPaper", ProbabilityPaper);
    kvfPutParam(file, "DisplayError", DisplayError);
    kvfPutParam(file, "FrequencyFactor", FrequencyFactor);
    kvfPutParam(file, "LeftAxisType", LeftAxisType);
    kvfPutParam(file, "RightAxisType", RightAxisType);
    SaveSelectedItems(file, SelectedItems);
    kvfEndSection(file);
}

void CProbabilitySettings::LoadSettings(const KvfSection* settings,
                                        const std::string& /*baseDirectory*/) {
    Clear();
    const KvfSection* const section = kvfSectionByNameNum(settings, "ProbabilitySettings", 1);
    kvfGetParam(section, "PlottingPosition", &PlottingPosition, 1, 1);
    kvfGetParam(section, "ProbabilityPaper", &ProbabilityPaper, 1, 1);
    kvfGetParam(section, "DisplayError", &DisplayError, 1, 1);
    kvfGetParam(section, "FrequencyFactor", &FrequencyFactor, 1, 1);
    kvfGetParam(section, "LeftAxisType", &LeftAxisType, 1, 1);
    kvfGetParam(section, "RightAxisType", &RightAxisType, 1, 1);
    LoadSelectedItems(section, &SelectedItems);
}

void CProbabilitySettings::LoadObservations(const KvfSection* target) {
    const KvfSection* const section = kvfSectionByNameNum(target, "ProbabilityPlotObs", 1);
    LoadDoubles(section, "XobsSort", LoadCount(section, "Nobs"), &XobsSort);
    const std::size_t observations = XobsSort.size();
    Nobs = static_cast<std::int32_t>(observations);
    ForEachItem(section, [this, observations](const KvfSection* formula) {
        SProbabilityItem item;
        kvfGetParam(formula, "PlottingMethod", &item.PlottingMethod, 1, 1);
        LoadDoubles(formula, "ExceedanceProbability", observations, &item.Probabilities);
        item.Probabilities = Complements(std::move(item.Probabilities));
        plottingPositions.push_back(std::move(item));
    });
}

void CProbabilitySettings::LoadOutput(const KvfSection* target,
                                      const std::string& /*baseDirectory*/) {
    LoadObservations(target);
    const KvfSection* const analysis = kvfSectionByNameNum(target, "DistributionAnalysis", 1);
    LoadDoubles(analysis, "ProbabilityPlot", LoadCount(analysis, "NoItemProbabilityPlot"),
                &ProbabilityPlot);
    const std::size_t points = ProbabilityPlot.size();
    NoItemProbabilityPlot = static_cast<std::int32_t>(points);
    ForEachCombination(target, [this, points](const KvfSection* combination) {
        const KvfSection* const plot = kvfSectionByNameNum(combination, "TyearEventPlot", 1);
        SProbDEItem item;
        LoadDoubles(plot, "TyearEvent", points, &item.TyearEvent);
        LoadDoubles(plot, "AvgTyearEvent", points, &item.AvgTyearEvent);
        LoadDoubles(plot, "StdTyearEvent", points, &item.StdTyearEvent);
        curves.push_back(std::move(item));
        GrowSelectedItems(curves.size(), &SelectedItems);
    });
}

void CProbabilitySettings::SaveOutput(KvfTree* file) const {
    kvfAddSection(file, "ProbabilityPlotObs");
    kvfPutParam(file, "Nobs", Nobs);
    SaveDoubles(file, "XobsSort", XobsSort);
    std::size_t number = 0;
    for (const SProbabilityItem& item : plottingPositions) {
        kvfAddSection(file, ItemSectionName(++number));
        kvfPutParam(file, "PlottingMethod", item.PlottingMethod);
        SaveDoubles(file, "ExceedanceProbability", Complements(item.Probabilities));
        kvfEndSection(file);
    }
    kvfEndSection(file);
}

void CProbabilitySettings::Clear() {
    Nobs = 0;
    NoItemProbabilityPlot = 0;
    XobsSort.clear();
    ProbabilityPlot.clear();
    plottingPositions.clear();
    curves.clear();
    SelectedItems.clear();
}

} // namespace ryn
