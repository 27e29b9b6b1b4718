#pragma once

#include <string>

#include "base/status.h"
#include "framework/kvf_base.h"
#include "params/analysis_kvf.h"
#include "params/basic_input_kvf.h"
#include "params/define_evs_kvf.h"
#include "params/probability_distrib_kvf.h"
#include "params/tsq2_input_kvf.h"
#include "series/tsq_values.h"

namespace ryn {

/// The root of the parameter tree: target RynEditor of a .ryn file. The tree that it writes is the
/// analysis engine's input.
class CGlobalKvf : public CKvfBase {
  public:
    explicit CGlobalKvf(CKvfBase* parentSection = nullptr);

    /// With flag 0 nothing; else the findings of basic input, define EVS, analysis, distributions.
    int Check(CMessageList& messages, int flag) override;
    /// Number of findings that stop a run; the basic input does not take part.
    int CheckForRun();
    /// Writes target and sections, and section ExtremeValueSection from the series file that is in
    /// force: that of define EVS, else the basic input's output, else none.
    void Write(KvfTree* file, const std::string& baseDirectory) override;
    /// Sets the process's current directory to `baseDirectory`, against which the sections then
    /// resolve relative names. A null target leaves every section as it is.
    void Read(const KvfSection* target, const std::string& baseDirectory) override;

    CBasicInputKvf& BasicInput() { return basicInput; }
    CDefineEVSKvf& DefineEVS() { return defineEvs; }
    const CDefineEVSKvf& DefineEVS() const { return defineEvs; }
    CAnalysisKvf& Analysis() { return analysis; }
    CProbabilityDistribKvf& Distributions() { return distributions; }
    CTsq2InputKvf& GridInput() { return gridInput; }
    /// Why the last Write could not read the series in force, which is then an empty one in the
    /// tree; Ok when it could, and when there is none.
    const Status& SeriesError() const { return seriesError; }
    /// Room for the series being extracted or written; empty between user actions.
    CTsqValues& Values() { return values; }

  private:
    void WriteExtremeValues(KvfTree* file);

    CBasicInputKvf basicInput;
    CDefineEVSKvf defineEvs;
    CAnalysisKvf analysis;
    CProbabilityDistribKvf distributions;
    CTsqValues values;
    Status seriesError;
    CTsq2InputKvf gridInput;
};

} // namespace ryn
