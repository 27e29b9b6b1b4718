#pragma once

#include "stats/parameter.h"

#include <cstddef>

namespace ryn::stats {

/// Families of distributions; the numbers are those of the setup file.
enum class DistributionType {
    Gev = 0,
    Gumbel = 1,
    Weibull = 2,
    Frechet = 3,
    GeneralisedPareto = 4,
    GammaPearson3 = 5,
    LogPearson3 = 6,
    LogNormal = 7,
    Exponential = 8,
    SquareRootExponential = 9,
    TruncatedGumbel = 10,
};

/// How parameters are found; the numbers are those of the setup file.
enum class EstimationMethod { Moments = 0, MaximumLikelihood = 1, LMoments = 2 };

/// Where the moments of a log-Pearson 3 distribution are taken (log space: Bulletin 17B, IACWD
/// 1982; real space: Bobee 1975); the numbers are those of the setup file.
enum class LogPearsonType { LogSpace = 0, RealSpace = 1 };

/// How the lower bound of a three-parameter log-normal distribution is found by moments: from the
/// sample skewness corrected for bias (I: Fisher's G1; II: Bobee and Robitaille 1975), or from
/// order statistics (I: Iwai; II: Stedinger 1980). The numbers are those of the setup file.
enum class LogNormalType {
    SkewnessCorrectionI = 0,
    SkewnessCorrectionII = 1,
    LowerBoundQuantileI = 2,
    LowerBoundQuantileII = 3,
};

/// A distribution with a method of estimation and their options. Options that do not apply to the
/// distribution and the method are ignored.
struct Combination {
    DistributionType distribution = DistributionType::Gev;
    EstimationMethod method = EstimationMethod::Moments;
    LocationType location = LocationType::Fixed;
    LogPearsonType logPearson = LogPearsonType::LogSpace;
    LogNormalType logNormal = LogNormalType::SkewnessCorrectionI;
    bool sampleCorrection = false; ///< Gumbel by moments: Gumbel's finite-sample constants
};

/// What a series consists of; the numbers are those of the setup file.
enum class SeriesKind { AnnualMaximum = 0, PartialDuration = 1 };

/// How the values of a series came from the record.
struct SeriesFrame {
    SeriesKind kind = SeriesKind::AnnualMaximum;
    double threshold = 0; ///< partial durations: every peak lies above it; unit of the values
    double rate = 1;      ///< partial durations: mean number of peaks a year
};

/// Whether a distribution and a method go with a kind of series.
enum class Offer { Offered, DistributionNotOffered, MethodNotOffered };

/// Numbers that are none of the enumerators count as not offered.
Offer OfferOf(const Combination& combination, SeriesKind kind);

/// Whether the location (or the lower bound) of the fitted distribution is fixed or estimated:
/// the combination's own option where it counts, otherwise what the family and the method demand.
/// An annual maximum series has three-parameter Weibull, Pareto and Pearson distributions whatever
/// the option says; maximum likelihood fixes the location in a partial duration series, but for
/// the log-normal, and L-moments fix it for the log-normal.
LocationType EffectiveLocation(const Combination& combination, SeriesKind kind);

/// The symbols of the parameters that a fit estimates, in the order in which results list them,
/// known without a fit; empty for a number that is no distribution.
SymbolList EstimatedSymbols(const Combination& combination, SeriesKind kind);

/// The smallest sample that is fitted: max(5, p + 2) for p estimated parameters.
std::size_t MinimumCount(const Combination& combination, SeriesKind kind);

} // namespace ryn::stats
