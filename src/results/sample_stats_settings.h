#pragma once

#include <cstdint>
#include <string>
#include <vector>

#include "controls/text_plot.h"
#include "results/display_keywords.h"
#include "results/settings_template.h"

namespace ryn {

/// The estimated parameters of one D/E combination: which the distribution has, their symbols and
/// their estimates.
struct SSampleStatItem {
    bool bParEst1 = false;
    bool bParEst2 = false;
    bool bParEst3 = false;
    std::string strParEst1;
    std::string strParEst2;
    std::string strParEst3;
    double ParEst1 = 0;
    double ParEst2 = 0;
    double ParEst3 = 0;
};

/// Page 14, "Sample statistics and estimated parameters".
class CSampleStatsSettings : public CSettingsTemplate {
  public:
    void SaveSettings(KvfTree* file, const std::string& baseDirectory) override;
    void LoadSettings(const KvfSection* settings, const std::string& baseDirectory) override;
    void LoadOutput(const KvfSection* target, const std::string& baseDirectory) override;
    /// Writes the section SampleStatistics.
    void SaveOutput(KvfTree* file) const;
    void Clear();

    void FillText(CQxTextOcxPlot& control) const;

    const std::vector<SSampleStatItem>& Items() const { return items; }

    std::int32_t SampleSize = 0;
    bool bPDS = false;    ///< the series is a partial duration series
    double Threshold = 0; ///< of a partial duration series; unit of the data
    double AvgAnNum = 0;  ///< of a partial duration series: exceedances a year
    double Mean = 0;
    double Variance = 0;
    double Skewness = 0;
    double Kurtosis = 0;
    double Beta_0 = 0;
    double Beta_1 = 0;
    double Beta_2 = 0;
    double Beta_3 = 0;
    double L_1 = 0;
    double L_2 = 0;
    double L_skewness = 0;
    double L_Kurtosis = 0;
    SelectedItemList SelectedItems; ///< which combinations' parameters are shown
    FontRecord Font = PlainPageFont();

  private:
    std::string StatisticsText() const;
    std::string ParametersText() const;

    std::vector<SSampleStatItem> items;
};

/// Writes the section ParameterEstimates of one combination.
void SaveParameters(KvfTree* file, const SSampleStatItem& item);

} // namespace ryn
