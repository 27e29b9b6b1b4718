#pragma once

#include "stats/combination.h"
#include "stats/estimate.h"
#include "unit/stats/reference_files.h"

#include <map>
#include <stdexcept>
#include <string>
#include <vector>

namespace ryn::stats::testing {

/// The combination that results show under `name`, as "GP2/LMOM" or "LN3/MOM/BI".
inline Combination Named(const std::string& name) {
    struct Code {
        DistributionType distribution;
        LocationType location;
    };
    using enum DistributionType;
    static const std::map<std::string, Code> codes = {
        {"GEV", {Gev, LocationType::Fixed}},
        {"GUM", {DistributionType::Gumbel, LocationType::Fixed}},
        {"WEI", {Weibull, LocationType::Fixed}},
        {"WEI2", {Weibull, LocationType::Fixed}},
        {"WEI3", {Weibull, LocationType::Estimated}},
        {"FRE", {Frechet, LocationType::Fixed}},
        {"GP", {DistributionType::GeneralisedPareto, LocationType::Fixed}},
        {"GP2", {DistributionType::GeneralisedPareto, LocationType::Fixed}},
        {"GP3", {DistributionType::GeneralisedPareto, LocationType::Estimated}},
        {"P3", {GammaPearson3, LocationType::Estimated}},
        {"GAM", {GammaPearson3, LocationType::Fixed}},
        {"LP3", {LogPearson3, LocationType::Fixed}},
        {"LN2", {LogNormal, LocationType::Fixed}},
        {"LN3", {LogNormal, LocationType::Estimated}},
        {"EXP1", {DistributionType::Exponential, LocationType::Fixed}},
        {"EXP2", {DistributionType::Exponential, LocationType::Estimated}},
        {"SQE", {SquareRootExponential, LocationType::Fixed}},
        {"TGUM", {TruncatedGumbel, LocationType::Fixed}},
    };
    static const std::map<std::string, EstimationMethod> methods = {
        {"MOM", EstimationMethod::Moments},
        {"ML", EstimationMethod::MaximumLikelihood},
        {"LMOM", EstimationMethod::LMoments}};
    const auto slash = name.find('/');
    const Code code = codes.at(name.substr(0, slash));
    const auto end = name.find_first_of(" /", slash + 1);
    Combination combination;
    combination.distribution = code.distribution;
    combination.location = code.location;
    combination.method = methods.at(name.substr(slash + 1, end - slash - 1));
    combination.sampleCorrection = name.ends_with(" corr");
    combination.logPearson =
        name.ends_with("/REAL") ? LogPearsonType::RealSpace : LogPearsonType::LogSpace;
    static const std::map<std::string, LogNormalType> bounds = {
        {"BI", LogNormalType::SkewnessCorrectionI},
        {"BII", LogNormalType::SkewnessCorrectionII},
        {"LBQI", LogNormalType::LowerBoundQuantileI},
        {"LBQII", LogNormalType::LowerBoundQuantileII}};
    const auto bound = bounds.find(name.substr(name.rfind('/') + 1));
    if (bound != bounds.end()) {
        combination.logNormal = bound->second;
    }
    return combination;
}

/// Every name that the two dialogs can make, and the Gumbel's with sample size correction.
inline const std::vector<std::string>& AllNames() {
    static const std::vector<std::string> names = {
        "GEV/MOM",      "GEV/ML",    "GEV/LMOM",      "GUM/MOM",     "GUM/MOM corr", "GUM/ML",
        "GUM/LMOM",     "WEI/MOM",   "WEI/LMOM",      "WEI2/MOM",    "WEI3/MOM",     "WEI2/ML",
        "WEI2/LMOM",    "WEI3/LMOM", "FRE/MOM",       "GP/MOM",      "GP/LMOM",      "GP2/MOM",
        "GP3/MOM",      "GP2/ML",    "GP2/LMOM",      "GP3/LMOM",    "P3/MOM",       "P3/LMOM",
        "GAM/MOM",      "GAM/ML",    "GAM/LMOM",      "LP3/MOM/LOG", "LP3/MOM/REAL", "LP3/LMOM",
        "LN2/MOM",      "LN2/ML",    "LN2/LMOM",      "LN3/MOM/BI",  "LN3/MOM/BII",  "LN3/ML",
        "LN3/MOM/LBQI", "EXP1/MOM",  "LN3/MOM/LBQII", "EXP2/MOM",    "EXP1/ML",      "EXP1/LMOM",
        "EXP2/LMOM",    "SQE/ML",    "TGUM/ML"};
    return names;
}

/// How the reference series came from their records.
inline SeriesFrame FrameOf(const std::string& series) {
    if (series == "rain40") {
        return {SeriesKind::PartialDuration, 40, 44.0 / 48};
    }
    if (series == "rain30") {
        return {SeriesKind::PartialDuration, 30, 152.0 / 48};
    }
    if (series == "pp38") {
        return {SeriesKind::PartialDuration, 3.8, 1};
    }
    return {};
}

} // namespace ryn::stats::testing
