#pragma once

#include <memory>
#include <string>
#include <vector>

#include "framework/kvf_base.h"
#include "params/die_combination_kvf.h"

namespace ryn {

/// Section ProbabilityDistribution: the ordered list of D/E combinations. Their order is the order
/// of the results. It has no findings.
class CProbabilityDistribKvf : public CKvfBase {
  public:
    using CKvfBase::CKvfBase;

    void Write(KvfTree* file, const std::string& baseDirectory) override;
    /// The list ends at the first missing Item1, Item2, ...
    void Read(const KvfSection* enclosing, const std::string& baseDirectory) override;

    std::vector<std::unique_ptr<CDieCombinationKvf>> Combinations;
};

} // namespace ryn
