#include "results/plotting_pos_settings.h"

namespace ryn {

namespace {

using Page = CPlottingPosSettings;

constexpr DisplayFlag<Page> kFlags[] = {
    {"Weibull", &Page::Weibull}, {"Hazen", &Page::Hazen},     {"Gringorten", &Page::Gringorten},
    {"Blom", &Page::Blom},       {"Cunnane", &Page::Cunnane},
};

} // namespace

void CPlottingPosSettings::SaveSettings(KvfTree* file, const std::string& /*baseDirectory*/) {
    kvfAddSection(file, "PlottingPositionSettings");
    SaveFlags(file, *this, kFlags);
    kvfPutParam(file, "Precision", Precision);
    SaveFont(file, Font);
    kvfEndSection(file);
}

void CPlottingPosSettings::LoadSettings(const KvfSection* settings,
                                        const std::string& /*baseDirectory*/) {
    Clear();
    const KvfSection* const section = kvfSectionByNameNum(settings, "PlottingPositionSettings", 1);
    LoadFlags(section, *this, kFlags);
    kvfGetParam(section, "Precision", &Precision, 1, 1);
    LoadFont(section, &Font);
}

} // namespace ryn
