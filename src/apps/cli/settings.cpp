#include "apps/cli/settings.h"

#include <algorithm>
#include <array>

#include "apps/cli/nearest_names.h"
#include "apps/cli/setting_value.h"
#include "strings/catalogue.h"

namespace ryn::cli {

namespace {

using Names = std::span<const std::string_view>;

constexpr std::array<std::string_view, 2> kSelectionMethods = {"AMS", "PDS"};
constexpr std::array<std::string_view, 2> kPdsDataTypes = {"threshold", "number"};
constexpr std::array<std::string_view, 2> kUncertaintyTypes = {"MonteCarlo", "Jackknife"};
constexpr std::array<std::string_view, 3> kSplitMethods = {"date", "season", "custom"};

/// Collects the settings of one section.
class SectionSettings {
  public:
    SectionSettings(std::vector<Setting>& settings, std::string_view sectionName)
        : list(settings),
          prefix(std::string(sectionName) + ".") {}

    void Add(std::string_view keyword, SettingMember member, Names choices = {}) {
        list.push_back({prefix + std::string(keyword), member, choices});
    }

  private:
    std::vector<Setting>& list;
    std::string prefix;
};

void AddBasicInput(std::vector<Setting>& settings, CBasicInputKvf& basic) {
    SectionSettings section(settings, "BasicInput");
    section.Add("SelectionMethod", &basic.SelectionMethod, kSelectionMethods);
    section.Add("PdsDataType", &basic.PdsDataType, kPdsDataTypes);
    section.Add("InputFileName", FileNameMember{&basic.InputFileName});
    section.Add("InputItem", &basic.InputItem);
    section.Add("OutputFileName", FileNameMember{&basic.OutputFileName});
    section.Add("IncludeSeasonalAnalysis", &basic.IncludeSeasonalAnalysis);
    section.Add("InterTimeSpecified", &basic.InterTimeSpecified);
    section.Add("InterLevelSpecified", &basic.InterLevelSpecified);
    section.Add("Threshold", &basic.Threshold);
    section.Add("AvgAnNum", &basic.AvgAnNum);
    section.Add("InterTime", &basic.InterTime);
    section.Add("InterLevel", &basic.InterLevel);
    section.Add("RecordLength", &basic.RecordLength);
    section.Add("AmsStartDate", &basic.AmsStartDate);
    section.Add("SeasonalStartDate", &basic.SeasonalStartDate);
    section.Add("SeasonalEndDate", &basic.SeasonalEndDate);
}

void AddGridInput(std::vector<Setting>& settings, CTsq2InputKvf& grid) {
    SectionSettings section(settings, "Tsq2Input");
    section.Add("UseTsq2Input", &grid.UseTsq2Input);
    section.Add("Tsq2InputFile", FileNameMember{&grid.Tsq2InputFile});
    section.Add("Tsq2ItemNo", &grid.Tsq2ItemNo);
    section.Add("X_Range_And_Interval", &grid.X_Range_And_Interval);
    section.Add("Y_Range_And_Interval", &grid.Y_Range_And_Interval);
    section.Add("Time_Range_And_Interval", &grid.Time_Range_And_Interval);
    section.Add("Tsq2OutputFile", FileNameMember{&grid.Tsq2OutputFile});
    section.Add("UncertaintyCal", &grid.UncertaintyCal);
    section.Add("SaveEVS", &grid.SaveEVS);
}

void AddDefineEvs(std::vector<Setting>& settings, CDefineEVSKvf& evs) {
    SectionSettings section(settings, "DefineEVS");
    section.Add("SelectionMethod", &evs.SelectionMethod, kSelectionMethods);
    section.Add("InputFileName", FileNameMember{&evs.InputFileName});
    section.Add("OutputFileName", FileNameMember{&evs.OutputFileName});
    section.Add("InputItem", &evs.InputItem);
    section.Add("Title", &evs.Title);
    section.Add("Subtitle", &evs.Subtitle);
    section.Add("Threshold", &evs.Threshold);
    section.Add("AvgAnNum", &evs.AvgAnNum);
}

void AddAnalysisChoices(std::vector<Setting>& settings, CAnalysisKvf& analysis) {
    SectionSettings section(settings, "Analysis");
    section.Add("RunTest", &analysis.RunTest);
    section.Add("TestForTrend", &analysis.TestForTrend);
    section.Add("TestForShiftInMean", &analysis.TestForShiftInMean);
    section.Add("ChiSquaredTest", &analysis.ChiSquaredTest);
    section.Add("KolmogorovSmirnovTest", &analysis.KolmogorovSmirnovTest);
    section.Add("SLSCTest", &analysis.SLSCTest);
    section.Add("PPCCTest", &analysis.PPCCTest);
    section.Add("PPCCTest2", &analysis.PPCCTest2);
    section.Add("LogLikelihood", &analysis.LogLikelihood);
    section.Add("UncertaintyCalcType", &analysis.UncertaintyCalcType, kUncertaintyTypes);
    section.Add("PlottingMethod", &analysis.PlottingMethod, kPlottingMethodNames);
}

void AddAnalysisLists(std::vector<Setting>& settings, CAnalysisKvf& analysis) {
    SectionSettings periods(settings, "Analysis.EvaluatedReturnPeriods");
    periods.Add("AnnualReturnPeriod", &analysis.AnnualReturnPeriod);
    periods.Add("Item", &analysis.EvaluatedReturnPeriods);
    SectionSettings(settings, "Analysis.SelectedPeriods").Add("Item", &analysis.SelectedPeriods);
    SectionSettings(settings, "Analysis").Add("SplitMethod", &analysis.SplitMethod, kSplitMethods);
    SectionSettings split(settings, "Analysis.SplitDate");
    for (std::size_t i = 0; i <= analysis.SplitDates.size(); ++i)
        split.Add("Date" + std::to_string(i + 1),
                  ListElement<COleDateTime>{&analysis.SplitDates, i});
    for (std::size_t i = 0; i <= analysis.Intervals.size(); ++i)
        split.Add("Interval" + std::to_string(i + 1), ListElement<int>{&analysis.Intervals, i});
}

void AddDistributions(std::vector<Setting>& settings, CProbabilityDistribKvf& distributions) {
    int number = 0;
    for (const auto& combination : distributions.Combinations) {
        SectionSettings section(settings,
                                "ProbabilityDistribution.Item" + std::to_string(++number));
        section.Add("ItemName", CombinationName{combination.get()});
        section.Add("SampleCorrection", &combination->SampleCorrection);
    }
}

/// The part before the first point.
std::string SectionOf(std::string_view name) {
    return std::string(name.substr(0, name.find('.')));
}

/// A fault with a list of nearest names behind it, where there are any.
Status UnknownName(int textId, std::string_view typed, const std::vector<std::string>& candidates) {
    std::string text = FormatText(textId, std::string(typed));
    if (const std::vector<std::string> nearest = NearestNames(typed, candidates); !nearest.empty())
        text += FormatText(kTextCliNearest, JoinNames(nearest));
    return Status::InputFault(text);
}

Status UnknownSetting(const std::vector<Setting>& settings, std::string_view typed) {
    const std::string section = SectionOf(typed);
    std::vector<std::string> sections;
    std::vector<std::string> names;
    for (const Setting& setting : settings) {
        const std::string known = SectionOf(setting.name);
        if (std::find(sections.begin(), sections.end(), known) == sections.end())
            sections.push_back(known);
        if (known == section)
            names.push_back(setting.name);
    }
    return names.empty() ? UnknownName(kTextCliUnknownSection, section, sections)
                         : UnknownName(kTextCliUnknownKeyword, typed, names);
}

} // namespace

std::vector<Setting> SettingsOf(CGlobalKvf& root) {
    std::vector<Setting> settings;
    AddBasicInput(settings, root.BasicInput());
    AddGridInput(settings, root.GridInput());
    AddDefineEvs(settings, root.DefineEVS());
    AddAnalysisChoices(settings, root.Analysis());
    AddAnalysisLists(settings, root.Analysis());
    AddDistributions(settings, root.Distributions());
    return settings;
}

Status ApplyAssignment(CGlobalKvf& root, std::string_view assignment,
                       const std::string& callerDirectory) {
    const std::size_t sign = assignment.find('=');
    const std::string_view name = assignment.substr(0, sign);
    if (sign == std::string_view::npos || name.find('.') == std::string_view::npos)
        return Status::InputFault(FormatText(kTextCliNoAssignment, std::string(assignment)));
    const std::string_view value = assignment.substr(sign + 1);
    const std::vector<Setting> settings = SettingsOf(root);
    const auto setting = std::find_if(settings.begin(), settings.end(),
                                      [name](const Setting& s) { return s.name == name; });
    if (setting == settings.end())
        return UnknownSetting(settings, name);
    if (!SetValue(*setting, value, callerDirectory))
        return Status::InputFault(FormatText(kTextCliBadValue, setting->name, std::string(value),
                                             ExpectedValue(*setting)));
    return Status::Ok();
}

} // namespace ryn::cli
