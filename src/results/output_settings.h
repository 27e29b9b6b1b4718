#pragma once

#include <string>
#include <vector>

#include "results/estimate_quantile_settings.h"
#include "results/frequency_settings.h"
#include "results/goodness_of_fit_settings.h"
#include "results/histogram_settings.h"
#include "results/independence_hom_settings.h"
#include "results/plotting_pos_settings.h"
#include "results/probability_settings.h"
#include "results/result_lists.h"
#include "results/sample_stats_settings.h"
#include "results/settings_template.h"

namespace ryn {

/// The results of one analysis and what its eight output pages show of them.
///
/// D/E combinations are matched by position: the n-th entry of ItemNames and of every list of the
/// pages stems from section "Item<n>" of DistributionAnalysis.
class COutputSettings : public CSettingsTemplate {
  public:
    COutputSettings();
    // The pages point to their owner.
    COutputSettings(const COutputSettings&) = delete;
    COutputSettings& operator=(const COutputSettings&) = delete;

    /// Adds section OutputSettings with the eight pages' sections to the target that is open.
    void SaveSettings(KvfTree* file, const std::string& baseDirectory) override;
    /// Reads the pages' choices from target OutputSettings. Clears first.
    void LoadSettings(const KvfSection* target, const std::string& baseDirectory) override;
    /// Takes the results in target RYNoutput, which makes the model valid. It appends: the model is
    /// to be empty.
    void LoadOutput(const KvfSection* target, const std::string& baseDirectory) override;
    /// Writes the six sections of the results into the target that is open: what the model holds,
    /// and nothing else that a read file may have held.
    void SaveOutput(KvfTree* file) const;
    /// Drops the results; display settings and the kept plots stay.
    void Clear();

    bool IsValid() const { return valid; }
    void SetValid(bool present) { valid = present; }
    /// Whether results were taken since the last Clear. A file of display settings alone makes the
    /// model valid, and there is nothing to show.
    bool HasOutput() const { return hasOutput; }

    /// Gives the pages that start with the platform's message font that font.
    void UseMessageFont(const FontRecord& font);

    // The pages, in the order in which every operation visits them.
    CEstimateQuantileSettings Quantiles;
    CFrequencySettings Frequency;
    CGoodnessOfFitSettings GoodnessOfFit;
    CHistogramSettings Histogram;
    CIndependenceHomSettings Independence;
    CSampleStatsSettings SampleStats;
    CProbabilitySettings Probability;
    CPlottingPosSettings PlottingPos;

    std::string Title;                  ///< heads every page
    std::string Subtitle;               ///< second heading line of every page
    std::string ItemName;               ///< the analysed data item
    std::string Unit;                   ///< its unit
    std::vector<std::string> ItemNames; ///< one for each D/E combination, in the engine's order
    DoubleList ReturnPeriods;           ///< years

    KvfHandle HistogramKvf; ///< look of the frequency plot, target Histogram; may be null
    KvfHandle GraphsKvf;    ///< look of the probability plot, target Graphs; may be null

  private:
    template <class Visit>
    void ForEachPage(Visit visit);
    void SaveCombination(KvfTree* file, std::size_t index) const;

    bool valid = false;
    bool hasOutput = false;
};

} // namespace ryn
