#include "stats/combination.h"

#include <algorithm>
#include <array>

namespace ryn::stats {

namespace {

// The methods that a distribution has in one kind of series; with none it is not offered at all.
struct Methods {
    bool moments;
    bool likelihood;
    bool lMoments;

    bool Any() const { return moments || likelihood || lMoments; }
    bool Holds(EstimationMethod method) const {
        switch (method) {
        case EstimationMethod::Moments:
            return moments;
        case EstimationMethod::MaximumLikelihood:
            return likelihood;
        case EstimationMethod::LMoments:
            return lMoments;
        }
        return false;
    }
};

struct Row {
    DistributionType distribution;
    Methods annualMaximum;
    Methods partialDuration;
    SymbolList whole; // location estimated
    SymbolList fixed; // location given
};

constexpr Methods kAll{true, true, true};
constexpr Methods kNone{false, false, false};
constexpr Methods kNoLikelihood{true, false, true};
constexpr Methods kOnlyMoments{true, false, false};
constexpr Methods kOnlyLikelihood{false, true, false};

constexpr SymbolList kLocationScale{"xi", "alpha"};
constexpr SymbolList kLocationScaleShape{"xi", "alpha", "kappa"};
constexpr SymbolList kScaleShape{"alpha", "kappa"};

// What the dialogs offer, so that a file from elsewhere can ask for no more than they do.
constexpr std::array<Row, 11> kRows = {{
    {DistributionType::Gev, kAll, kNone, kLocationScaleShape, kLocationScaleShape},
    {DistributionType::Gumbel, kAll, kNone, kLocationScale, kLocationScale},
    {DistributionType::Weibull, kNoLikelihood, kAll, kLocationScaleShape, kScaleShape},
    {DistributionType::Frechet, kOnlyMoments, kNone, kScaleShape, kScaleShape},
    {DistributionType::GeneralisedPareto, kNoLikelihood, kAll, kLocationScaleShape, kScaleShape},
    {DistributionType::GammaPearson3, kNoLikelihood, kAll, kLocationScaleShape, kScaleShape},
    {DistributionType::LogPearson3, kNoLikelihood, kNoLikelihood, kLocationScaleShape,
     kLocationScaleShape},
    {DistributionType::LogNormal, kAll, kAll, {"xi", "mu", "sigma"}, {"mu", "sigma"}},
    {DistributionType::Exponential, kNone, kAll, kLocationScale, {"alpha"}},
    {DistributionType::SquareRootExponential, kOnlyLikelihood, kNone, {"a", "b"}, {"a", "b"}},
    {DistributionType::TruncatedGumbel, kNone, kOnlyLikelihood, kLocationScale, kLocationScale},
}};

const Row* FindRow(DistributionType distribution) {
    const auto* found = std::find_if(kRows.begin(), kRows.end(), [=](const Row& row) {
        return row.distribution == distribution;
    });
    return found == kRows.end() ? nullptr : found;
}

// The L-moments of the log-normal are solved for two parameters only, and its likelihood has a
// useful maximum in three, so that the log-normal goes the other way than the rest.
LocationType LogNormalLocation(const Combination& combination) {
    return combination.method == EstimationMethod::LMoments ? LocationType::Fixed
                                                            : combination.location;
}

} // namespace

Offer OfferOf(const Combination& combination, SeriesKind kind) {
    const Row* row = FindRow(combination.distribution);
    if (row == nullptr) {
        return Offer::DistributionNotOffered;
    }
    const Methods& methods =
        kind == SeriesKind::AnnualMaximum ? row->annualMaximum : row->partialDuration;
    if (!methods.Any()) {
        return Offer::DistributionNotOffered;
    }
    return methods.Holds(combination.method) ? Offer::Offered : Offer::MethodNotOffered;
}

LocationType EffectiveLocation(const Combination& combination, SeriesKind kind) {
    switch (combination.distribution) {
    case DistributionType::LogNormal:
        return LogNormalLocation(combination);
    case DistributionType::Frechet:
    case DistributionType::SquareRootExponential:
        return LocationType::Fixed;
    case DistributionType::Gev:
    case DistributionType::Gumbel:
    case DistributionType::LogPearson3:
    case DistributionType::TruncatedGumbel:
        return LocationType::Estimated;
    case DistributionType::Weibull:
    case DistributionType::GeneralisedPareto:
    case DistributionType::GammaPearson3:
    case DistributionType::Exponential:
        break;
    }
    // Annual maxima have no threshold that could serve as location.
    if (kind == SeriesKind::AnnualMaximum) {
        return LocationType::Estimated;
    }
    // The likelihood of a family with a free lower bound grows without limit towards the smallest
    // value for many shapes.
    return combination.method == EstimationMethod::MaximumLikelihood ? LocationType::Fixed
                                                                     : combination.location;
}

SymbolList EstimatedSymbols(const Combination& combination, SeriesKind kind) {
    const Row* row = FindRow(combination.distribution);
    if (row == nullptr) {
        return {};
    }
    return EffectiveLocation(combination, kind) == LocationType::Estimated ? row->whole
                                                                           : row->fixed;
}

std::size_t MinimumCount(const Combination& combination, SeriesKind kind) {
    return std::max<std::size_t>(5, EstimatedSymbols(combination, kind).size() + 2);
}

} // namespace ryn::stats
