#pragma once

#include <cstdint>
#include <vector>

#include "results/display_keywords.h"
#include "results/result_lists.h"
#include "results/settings_template.h"

namespace ryn {

/// The plotting positions of the observations under one formula.
struct SProbabilityItem {
    std::int32_t PlottingMethod = 0; ///< 0 Weibull, 1 Hazen, 2 Gringorten, 3 Blom, 4 Cunnane
    DoubleList Probabilities; ///< non-exceedance: one minus the ExceedanceProbability of the file
};

/// The fitted quantile curve of one D/E combination, at each probability of ProbabilityPlot.
struct SProbDEItem {
    DoubleList TyearEvent;
    DoubleList AvgTyearEvent;
    DoubleList StdTyearEvent;
};

/// Page 18, "Probability plot": the observations with their plotting positions, and the fitted
/// quantile curves.
class CProbabilitySettings : public CSettingsTemplate {
  public:
    void SaveSettings(KvfTree* file, const std::string& baseDirectory) override;
    void LoadSettings(const KvfSection* settings, const std::string& baseDirectory) override;
    void LoadOutput(const KvfSection* target, const std::string& baseDirectory) override;
    /// Writes the section ProbabilityPlotObs.
    void SaveOutput(KvfTree* file) const;
    void Clear();

    const std::vector<SProbabilityItem>& PlottingPositions() const { return plottingPositions; }
    const std::vector<SProbDEItem>& Curves() const { return curves; }

    std::int32_t Nobs = 0;                  ///< as many as there are observations
    std::int32_t NoItemProbabilityPlot = 0; ///< as many as there are curve probabilities
    DoubleList XobsSort;                    ///< in plotting order, the largest first
    DoubleList ProbabilityPlot;             ///< non-exceedance probabilities of the curves
    std::int32_t PlottingPosition = 0;      ///< formula of the points, as PlottingMethod
    std::int32_t ProbabilityPaper = 0;      ///< 0 Gumbel, 1 log-normal, 2 semi-logarithmic
    std::int32_t LeftAxisType = 1;          ///< 0 probability, 1 return period, 2 reduced variate
    std::int32_t RightAxisType = 0;         ///< the same codes
    bool DisplayError = true;               ///< draw the confidence limits
    float FrequencyFactor = 1.0F;           ///< half-width of the limits, in standard deviations
    SelectedItemList SelectedItems;         ///< which combinations are drawn

  private:
    void LoadObservations(const KvfSection* target);

    std::vector<SProbabilityItem> plottingPositions;
    std::vector<SProbDEItem> curves;
};

} // namespace ryn
