#pragma once

#include <cstdint>
#include <vector>

#include "results/display_keywords.h"
#include "results/goodness_of_fit_settings.h"
#include "results/result_lists.h"
#include "results/settings_template.h"

namespace ryn {

/// The quantiles of one D/E combination, one for each return period of the owner; unit of the data.
struct SEQItem {
    DoubleList TyearEvent;    ///< estimated quantile
    DoubleList AvgTyearEvent; ///< average (Monte Carlo) or jackknife estimate
    DoubleList StdTyearEvent; ///< standard deviation, or jackknife estimation error
};

/// Page 15, "Estimated quantiles and standard errors". The goodness-of-fit values that its table
/// shows too are those of the owner's CGoodnessOfFitSettings.
class CEstimateQuantileSettings : public CSettingsTemplate {
  public:
    void SaveSettings(KvfTree* file, const std::string& baseDirectory) override;
    void LoadSettings(const KvfSection* settings, const std::string& baseDirectory) override;
    void LoadOutput(const KvfSection* target, const std::string& baseDirectory) override;
    void Clear();

    /// Shows a row for just those statistics that were computed for `item`.
    void SetStatisticFlags(const SGOFItem& item);

    const std::vector<SEQItem>& Items() const { return items; }

    bool Calculations = true; ///< stored and read back; no page depends on it
    bool KolmogorovSmirnov = false;
    bool ChiSquared = false;
    bool LeastSquares = false;
    bool LogLikelihood = false;
    bool PPCC = false;
    bool PPCC2 = false;
    SelectedItemList SelectedItems; ///< which combinations are columns
    std::int32_t Precision = 3;     ///< least number of decimals
    FontRecord Font;                ///< starts as the platform's message font

  private:
    std::vector<SEQItem> items;
};

} // namespace ryn
