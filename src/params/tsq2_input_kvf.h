#pragma once

#include <string>

#include "framework/kvf_base.h"

namespace ryn {

/// A range of indices with its step.
struct IndexRange {
    int first = 0;
    int last = 0;
    int step = 0;
};

/// Section Tsq2Input: a batch analysis over a grid file. The only section that may be absent from a
/// parameter file. Its two file names are stored as they stand. It has no findings.
class CTsq2InputKvf : public CKvfBase {
  public:
    using CKvfBase::CKvfBase;

    void Write(KvfTree* file, const std::string& baseDirectory) override;
    void Read(const KvfSection* enclosing, const std::string& baseDirectory) override;

    bool UseTsq2Input = false;
    std::string Tsq2InputFile;
    int Tsq2ItemNo = 0;
    IndexRange X_Range_And_Interval;
    IndexRange Y_Range_And_Interval;
    IndexRange Time_Range_And_Interval;
    std::string Tsq2OutputFile;
    bool UncertaintyCal = true;
    bool SaveEVS = false;
};

} // namespace ryn
