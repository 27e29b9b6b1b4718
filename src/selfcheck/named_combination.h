#pragma once

#include <array>
#include <stdexcept>
#include <string_view>

#include "stats/combination.h"

namespace ryn::selfcheck {

/// A combination under the name that results give it.
struct NamedCombination {
    std::string_view name;
    stats::Combination combination;
};

using enum stats::DistributionType;
using enum stats::EstimationMethod;
using enum stats::LocationType;
using enum stats::LogPearsonType;
using enum stats::LogNormalType;

/// Those of the published cases.
inline constexpr auto kCombinations = std::to_array<NamedCombination>({
    {"GEV/MOM", {Gev, Moments}},
    {"GEV/ML", {Gev, MaximumLikelihood}},
    {"GEV/LMOM", {Gev, LMoments}},
    {"GUM/MOM", {Gumbel, Moments}},
    {"GUM/MOM corrected", {Gumbel, Moments, Fixed, LogSpace, SkewnessCorrectionI, true}},
    {"GUM/ML", {Gumbel, MaximumLikelihood}},
    {"GUM/LMOM", {Gumbel, LMoments}},
    {"WEI/MOM", {Weibull, Moments}},
    {"WEI/LMOM", {Weibull, LMoments}},
    {"WEI2/MOM", {Weibull, Moments}},
    {"WEI2/ML", {Weibull, MaximumLikelihood}},
    {"WEI2/LMOM", {Weibull, LMoments}},
    {"WEI3/MOM", {Weibull, Moments, Estimated}},
    {"WEI3/LMOM", {Weibull, LMoments, Estimated}},
    {"FRE/MOM", {Frechet, Moments}},
    {"GP/MOM", {GeneralisedPareto, Moments}},
    {"GP/LMOM", {GeneralisedPareto, LMoments}},
    {"GP2/MOM", {GeneralisedPareto, Moments}},
    {"GP2/ML", {GeneralisedPareto, MaximumLikelihood}},
    {"GP2/LMOM", {GeneralisedPareto, LMoments}},
    {"GP3/MOM", {GeneralisedPareto, Moments, Estimated}},
    {"GP3/LMOM", {GeneralisedPareto, LMoments, Estimated}},
    {"GAM/MOM", {GammaPearson3, Moments}},
    {"GAM/ML", {GammaPearson3, MaximumLikelihood}},
    {"GAM/LMOM", {GammaPearson3, LMoments}},
    {"P3/MOM", {GammaPearson3, Moments, Estimated}},
    {"P3/LMOM", {GammaPearson3, LMoments, Estimated}},
    {"LP3/MOM/LOG", {LogPearson3, Moments, Fixed, LogSpace}},
    {"LP3/MOM/REAL", {LogPearson3, Moments, Fixed, RealSpace}},
    {"LP3/LMOM", {LogPearson3, LMoments}},
    {"LN2/MOM", {LogNormal, Moments}},
    {"LN2/ML", {LogNormal, MaximumLikelihood}},
    {"LN2/LMOM", {LogNormal, LMoments}},
    {"LN3/MOM/BI", {LogNormal, Moments, Estimated, LogSpace, SkewnessCorrectionI}},
    {"LN3/MOM/BII", {LogNormal, Moments, Estimated, LogSpace, SkewnessCorrectionII}},
    {"LN3/MOM/LBQI", {LogNormal, Moments, Estimated, LogSpace, LowerBoundQuantileI}},
    {"LN3/MOM/LBQII", {LogNormal, Moments, Estimated, LogSpace, LowerBoundQuantileII}},
    {"LN3/ML", {LogNormal, MaximumLikelihood, Estimated}},
    {"EXP1/MOM", {Exponential, Moments}},
    {"EXP1/ML", {Exponential, MaximumLikelihood}},
    {"EXP1/LMOM", {Exponential, LMoments}},
    {"EXP2/MOM", {Exponential, Moments, Estimated}},
    {"EXP2/LMOM", {Exponential, LMoments, Estimated}},
    {"SQE/ML", {SquareRootExponential, MaximumLikelihood}},
    {"TGUM/ML", {TruncatedGumbel, MaximumLikelihood}},
});

/// For tables of constants, where a wrong name does not compile.
constexpr const NamedCombination& Named(std::string_view name) {
    for (const NamedCombination& known : kCombinations)
        if (known.name == name)
            return known;
    throw std::logic_error("no such combination");
}

} // namespace ryn::selfcheck
