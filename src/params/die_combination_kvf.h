#pragma once

#include <string>

#include "framework/kvf_base.h"

namespace ryn {

/// Values of CDieCombinationKvf::DistributionType.
enum DistributionTypes : int {
    kGeneralizedExtremeValue = 0,
    kGumbel = 1,
    kWeibull = 2,
    kFrechet = 3,
    kGeneralisedPareto = 4,
    kGammaPearson3 = 5,
    kLogPearson3 = 6,
    kLogNormal = 7,
    kExponential = 8,
    kSquareRootExponential = 9,
    kTruncatedGumbel = 10,
};

enum EstimationMethods : int { kMoments = 0, kMaximumLikelihood = 1, kLMoments = 2 };

/// The settings of one D/E combination: a probability distribution with an estimation method and
/// its options. Members are named as their keywords.
struct DieCombination {
    std::string ItemName;       ///< in lists and results
    bool IsDefaultName = false; ///< true: the name is the user's own; false: generated
    bool SampleCorrection = false;
    int DistributionType = kGeneralizedExtremeValue;
    int EstimationMethod = kMoments;
    int EstimateLocationType = 0; ///< 0 fixed location parameter, 1 estimated
    int LogPearsonType = 0;       ///< 0 moments in log space, 1 in real space
    int LogNormalType =
        0; ///< 0, 1 bias correction of skewness I, II; 2, 3 lower bound quantile I, II
};

/// One D/E combination as a part of the parameter file. It opens no section of its own.
class CDieCombinationKvf : public CKvfBase, public DieCombination {
  public:
    using CKvfBase::CKvfBase;
    explicit CDieCombinationKvf(const DieCombination& settings) : DieCombination(settings) {}

    void Write(KvfTree* file, const std::string& baseDirectory) override;
    /// From the handle of the combination's own section.
    void Read(const KvfSection* section, const std::string& baseDirectory) override;
};

} // namespace ryn
