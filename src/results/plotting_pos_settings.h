#pragma once

#include <cstdint>

#include "results/display_keywords.h"
#include "results/settings_template.h"

namespace ryn {

/// Page 11, "Extreme value series and plotting position". It has choices only; what it shows are
/// the data of the owner's CProbabilitySettings.
class CPlottingPosSettings : public CSettingsTemplate {
  public:
    void SaveSettings(KvfTree* file, const std::string& baseDirectory) override;
    void LoadSettings(const KvfSection* settings, const std::string& baseDirectory) override;
    void LoadOutput(const KvfSection* /*target*/, const std::string& /*baseDirectory*/) override {}
    /// There are no lists to empty.
    void Clear() {}

    bool Weibull = true;
    bool Hazen = true;
    bool Gringorten = true;
    bool Blom = true;
    bool Cunnane = true;
    std::int32_t Precision = 3; ///< decimals of data and probabilities
    FontRecord Font = PlainPageFont();
};

} // namespace ryn
