#pragma once

#include "unit/stats/named_combinations.h"

#include <string>
#include <vector>

namespace ryn::stats::testing {

/// A combination under the name that results show, for a kind of series.
struct NamedCombination {
    std::string name;
    SeriesKind kind;
    Combination combination;
};

/// All that are offered, with every option that makes a difference.
inline std::vector<NamedCombination> EveryCombination() {
    const std::vector<std::string> ofBoth = {
        "P3/MOM",       "P3/LMOM",       "LP3/MOM/LOG", "LP3/MOM/REAL", "LP3/LMOM",
        "LN2/MOM",      "LN2/ML",        "LN2/LMOM",    "LN3/MOM/BI",   "LN3/MOM/BII",
        "LN3/MOM/LBQI", "LN3/MOM/LBQII", "LN3/ML"};
    const std::vector<std::string> ofMaxima = {
        "GEV/MOM", "GEV/ML",   "GEV/LMOM", "GUM/MOM", "GUM/MOM corr", "GUM/ML", "GUM/LMOM",
        "WEI/MOM", "WEI/LMOM", "FRE/MOM",  "GP/MOM",  "GP/LMOM",      "SQE/ML"};
    const std::vector<std::string> ofPeaks = {
        "GP2/MOM",   "GP2/ML",    "GP2/LMOM",  "GP3/MOM",   "GP3/LMOM", "WEI2/MOM", "WEI2/ML",
        "WEI2/LMOM", "WEI3/MOM",  "WEI3/LMOM", "GAM/MOM",   "GAM/ML",   "GAM/LMOM", "EXP1/MOM",
        "EXP1/ML",   "EXP1/LMOM", "EXP2/MOM",  "EXP2/LMOM", "TGUM/ML"};
    std::vector<NamedCombination> all;
    const auto add = [&all](const std::vector<std::string>& names, SeriesKind kind) {
        for (const std::string& name : names) {
            all.push_back({name, kind, Named(name)});
        }
    };
    add(ofBoth, SeriesKind::AnnualMaximum);
    add(ofMaxima, SeriesKind::AnnualMaximum);
    add(ofBoth, SeriesKind::PartialDuration);
    add(ofPeaks, SeriesKind::PartialDuration);
    return all;
}

} // namespace ryn::stats::testing
