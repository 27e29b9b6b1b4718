#include "results/sample_stats_settings.h"

#include <algorithm>

#include "results/number_rule.h"
#include "results/output_settings.h"
#include "results/result_lists.h"
#include "strings/catalogue.h"

namespace ryn {

namespace {

using Page = CSampleStatsSettings;

struct Moment {
    const char* keyword;
    double Page::*member;
    int line; ///< the text that shows it
};

/// A section of moments, in file and page order.
struct MomentGroup {
    const char* section;
    int heading;
    Moment moments[4];
};

constexpr MomentGroup kGroups[] = {
    {"OrdinaryMoments",
     kTextOrdinaryMoments,
     {{"Mean", &Page::Mean, kTextMean},
      {"Variance", &Page::Variance, kTextVariance},
      {"Skewness", &Page::Skewness, kTextSkewness},
      {"Kurtosis", &Page::Kurtosis, kTextKurtosis}}},
    {"ProbabilityWeightedMoments",
     kTextWeightedMoments,
     {{"Beta_0", &Page::Beta_0, kTextBeta0},
      {"Beta_1", &Page::Beta_1, kTextBeta1},
      {"Beta_2", &Page::Beta_2, kTextBeta2},
      {"Beta_3", &Page::Beta_3, kTextBeta3}}},
    {"LMoments",
     kTextLMoments,
     {{"L_1", &Page::L_1, kTextL1},
      {"L_2", &Page::L_2, kTextL2},
      {"L_skewness", &Page::L_skewness, kTextLSkewness},
      {"L_Kurtosis", &Page::L_Kurtosis, kTextLKurtosis}}},
};

struct Parameter {
    const char* flagKeyword;
    bool SSampleStatItem::*flag;
    const char* symbolKeyword;
    std::string SSampleStatItem::*symbol;
    const char* estimateKeyword;
    double SSampleStatItem::*estimate;
};

constexpr Parameter kParameters[] = {
    {"bParEst1", &SSampleStatItem::bParEst1, "strParEst1", &SSampleStatItem::strParEst1, "ParEst1",
     &SSampleStatItem::ParEst1},
    {"bParEst2", &SSampleStatItem::bParEst2, "strParEst2", &SSampleStatItem::strParEst2, "ParEst2",
     &SSampleStatItem::ParEst2},
    {"bParEst3", &SSampleStatItem::bParEst3, "strParEst3", &SSampleStatItem::strParEst3, "ParEst3",
     &SSampleStatItem::ParEst3},
};

SSampleStatItem LoadParameters(const KvfSection* section) {
    SSampleStatItem item;
    for (const Parameter& parameter : kParameters) {
        kvfGetParam(section, parameter.flagKeyword, &(item.*parameter.flag), 1, 1);
        kvfGetParam(section, parameter.symbolKeyword, &(item.*parameter.symbol), 1, 1);
        kvfGetParam(section, parameter.estimateKeyword, &(item.*parameter.estimate), 1, 1);
    }
    return item;
}

} // namespace

void SaveParameters(KvfTree* file, const SSampleStatItem& item) {
    kvfAddSection(file, "ParameterEstimates");
    for (const Parameter& parameter : kParameters) {
        kvfPutParam(file, parameter.flagKeyword, item.*parameter.flag);
        kvfPutParam(file, parameter.symbolKeyword, item.*parameter.symbol);
        kvfPutParam(file, parameter.estimateKeyword, item.*parameter.estimate);
    }
    kvfEndSection(file);
}

void CSampleStatsSettings::SaveSettings(KvfTree* file, const std::string& /*baseDirectory*/) {
    kvfAddSection(file, "SampleStatsSettings");
    SaveFont(file, Font);
    SaveSelectedItems(file, SelectedItems);
    kvfEndSection(file);
}

void CSampleStatsSettings::LoadSettings(const KvfSection* settings,
                                        const std::string& /*baseDirectory*/) {
    Clear();
    const KvfSection* const section = kvfSectionByNameNum(settings, "SampleStatsSettings", 1);
    LoadFont(section, &Font);
    LoadSelectedItems(section, &SelectedItems);
}

void CSampleStatsSettings::LoadOutput(const KvfSection* target,
                                      const std::string& /*baseDirectory*/) {
    const KvfSection* const section = kvfSectionByNameNum(target, "SampleStatistics", 1);
    kvfGetParam(section, "SampleSize", &SampleSize, 1, 1);
    kvfGetParam(section, "bPDS", &bPDS, 1, 1);
    kvfGetParam(section, "Threshold", &Threshold, 1, 1);
    kvfGetParam(section, "AvgAnNum", &AvgAnNum, 1, 1);
    for (const MomentGroup& group : kGroups) {
        const KvfSection* const moments = kvfSectionByNameNum(section, group.section, 1);
        for (const Moment& moment : group.moments)
            kvfGetParam(moments, moment.keyword, &(this->*moment.member), 1, 1);
    }
    ForEachCombination(target, [this](const KvfSection* combination) {
        items.push_back(LoadParameters(kvfSectionByNameNum(combination, "ParameterEstimates", 1)));
        GrowSelectedItems(items.size(), &SelectedItems);
    });
}

void CSampleStatsSettings::SaveOutput(KvfTree* file) const {
    kvfAddSection(file, "SampleStatistics");
    kvfPutParam(file, "SampleSize", SampleSize);
    kvfPutParam(file, "bPDS", bPDS);
    kvfPutParam(file, "Threshold", Threshold);
    kvfPutParam(file, "AvgAnNum", AvgAnNum);
    for (const MomentGroup& group : kGroups) {
        kvfAddSection(file, group.section);
        for (const Moment& moment : group.moments)
            kvfPutParam(file, moment.keyword, this->*moment.member);
        kvfEndSection(file);
    }
    kvfEndSection(file);
}

void CSampleStatsSettings::Clear() {
    items.clear();
    SelectedItems.clear();
}

std::string CSampleStatsSettings::StatisticsText() const {
    std::string text = std::string(Text(kTextSampleStatistics)) + "\n\n";
    text += FormatText(kTextSampleSize, SampleSize) + '\n';
    if (bPDS) {
        text += FormatText(kTextThresholdLevel, WithoutNanSign(Threshold)) + '\n';
        text += FormatText(kTextAverageAnnualNumber, WithoutNanSign(AvgAnNum)) + '\n';
    }
    text += '\n';
    for (const MomentGroup& group : kGroups) {
        text += std::string(Text(group.heading)) + '\n';
        for (const Moment& moment : group.moments)
            text += FormatText(moment.line, WithoutNanSign(this->*moment.member)) + '\n';
        text += '\n';
    }
    return text;
}

std::string CSampleStatsSettings::ParametersText() const {
    std::string text = std::string(Text(kTextEstimatedParameters)) + "\n\n";
    const std::vector<std::string>& names = GetParent()->ItemNames;
    // A file from elsewhere can hold lists of unequal length: the shortest ends the page.
    const std::size_t count = std::min({names.size(), items.size(), SelectedItems.size()});
    for (std::size_t i = 0; i < count; ++i) {
        if (!SelectedItems[i])
            continue;
        text += names[i] + '\n';
        for (const Parameter& parameter : kParameters)
            if (items[i].*parameter.flag)
                text += fmt::sprintf("  %s = %.3f\n", items[i].*parameter.symbol,
                                     WithoutNanSign(items[i].*parameter.estimate));
        text += '\n';
    }
    return text;
}

void CSampleStatsSettings::FillText(CQxTextOcxPlot& control) const {
    std::string text = GetParent()->Title + '\n' + GetParent()->Subtitle + "\n\n";
    if (GetParent()->HasOutput()) // else there are headings alone, and no numbers
        text += StatisticsText() + ParametersText();
    control.SetText(std::move(text));
}

} // namespace ryn
