#pragma once

#include <string>

#include "framework/kvf_base.h"
#include "series/selection_rules.h"
#include "series/tsq_values.h"

namespace ryn {

/// Section BasicInput: which time series to read, how to select its extremes, and where to write
/// the extreme value series. Its findings belong to page 2.
class CBasicInputKvf : public CKvfBase, public SelectionRules {
  public:
    using CKvfBase::CKvfBase;

    int Check(CMessageList& messages, int flag) override;
    void Write(KvfTree* file, const std::string& baseDirectory) override;
    void Read(const KvfSection* enclosing, const std::string& baseDirectory) override;

    /// An extraction was run since the document was opened and its output stands for DefineEVS;
    /// never stored.
    bool Extracted = false;
    std::string OutputFileName; ///< the series file to write; absolute, or empty
    std::string InputFileName;  ///< the data file to read; absolute, or empty
    int InputItem = 0;          ///< from 1; 0: none chosen
    /// Extent of the selected input item.
    CTsqValues summary;

  private:
    void CheckPartialDurations(CMessageList& messages) const;
};

} // namespace ryn
