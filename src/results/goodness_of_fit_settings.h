#pragma once

#include <cstdint>
#include <vector>

#include "results/display_keywords.h"
#include "results/settings_template.h"

namespace ryn {

/// The goodness-of-fit statistics of one D/E combination: which were computed, and their values. A
/// statistic that was computed and does not exist is NaN.
struct SGOFItem {
    bool ChiSquaredTest = false;
    bool KolmogorovSmirnovTest = false;
    bool SLSCTest = false;
    bool PPCCTest = false;
    bool PPCC2Test = false;
    bool LogLikelihood = false;
    double ChiSquaredStatistic = 0;
    double ChiSquaredLevel = 0; ///< level of significance, percent
    double KolmogorovSmirnovStatistic = 0;
    double KolmogorovSmirnovLevel = 0; ///< level of significance, percent
    double SLSCStatistic = 0;
    double PPCCStatistic = 0;
    double PPCC2Statistic = 0;
    double LogLikelihoodStatistic = 0;
};

/// Page 13, "Goodness-of-fit statistics".
class CGoodnessOfFitSettings : public CSettingsTemplate {
  public:
    void SaveSettings(KvfTree* file, const std::string& baseDirectory) override;
    void LoadSettings(const KvfSection* settings, const std::string& baseDirectory) override;
    /// The choice of statistics ends up as what was computed for the last combination: a stored
    /// choice does not survive a load.
    void LoadOutput(const KvfSection* target, const std::string& baseDirectory) override;
    void Clear();

    const std::vector<SGOFItem>& Items() const { return items; }

    std::int32_t Precision = 3; ///< least number of decimals
    bool ChiSquared = false;
    bool KolmogorovSmirnov = false;
    bool SLSC = false;
    bool PPCC = false;
    bool PPCC2 = false;
    bool LogLikelihood = false;
    SelectedItemList SelectedItems; ///< which combinations are shown
    FontRecord Font;                ///< starts as the platform's message font

  private:
    void ShowWhatWasComputed(const SGOFItem& item);

    std::vector<SGOFItem> items;
};

/// Writes the section GoodnessOfFitStatistics of one combination.
void SaveStatistics(KvfTree* file, const SGOFItem& item);

} // namespace ryn
