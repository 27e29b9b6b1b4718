#pragma once

#include <cstdint>
#include <vector>

#include "results/display_keywords.h"
#include "results/result_lists.h"
#include "results/settings_template.h"

namespace ryn {

/// Page 16, "Histogram and frequency function".
class CHistogramSettings : public CSettingsTemplate {
  public:
    void SaveSettings(KvfTree* file, const std::string& baseDirectory) override;
    void LoadSettings(const KvfSection* settings, const std::string& baseDirectory) override;
    void LoadOutput(const KvfSection* target, const std::string& baseDirectory) override;
    /// Writes the section Histogram.
    void SaveOutput(KvfTree* file) const;
    void Clear();

    /// For each combination the estimated frequency of each interval.
    const std::vector<DoubleList>& Estimated() const { return estimated; }

    std::int32_t NoIntHistogram = 0; ///< number of intervals; as many as there are frequencies
    double XstartHistogram = 0;      ///< lower end of the first interval; unit of the data
    double XstepHistogram = 0;       ///< interval width; unit of the data
    DoubleList FrequencyHistogram;   ///< observed frequency of each interval, as a density
    std::int32_t Precision = 3;      ///< least number of decimals
    SelectedItemList SelectedItems;  ///< which combinations are columns
    FontRecord Font = PlainPageFont();

  private:
    std::vector<DoubleList> estimated;
};

} // namespace ryn
