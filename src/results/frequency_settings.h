#pragma once

#include <vector>

#include "results/display_keywords.h"
#include "results/result_lists.h"
#include "results/settings_template.h"

namespace ryn {

/// Page 17, "Frequency plot": the density curves of the combinations. The bars are those of the
/// owner's CHistogramSettings.
class CFrequencySettings : public CSettingsTemplate {
  public:
    void SaveSettings(KvfTree* file, const std::string& baseDirectory) override;
    void LoadSettings(const KvfSection* settings, const std::string& baseDirectory) override;
    void LoadOutput(const KvfSection* target, const std::string& baseDirectory) override;
    void Clear();

    /// For each combination the density at each of XvaluePDFPlot, in one over the data's unit.
    const std::vector<DoubleList>& Densities() const { return densities; }

    DoubleList XvaluePDFPlot;       ///< abscissae, shared by all combinations; unit of the data
    SelectedItemList SelectedItems; ///< which combinations are drawn

  private:
    std::vector<DoubleList> densities;
};

} // namespace ryn
