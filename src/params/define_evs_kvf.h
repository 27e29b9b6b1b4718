#pragma once

#include <string>

#include "framework/kvf_base.h"
#include "series/tsq_values.h"

namespace ryn {

class CBasicInputKvf;

/// Section DefineEVS: which extreme value series is analysed, where the result file goes, the
/// titles, and the threshold and average annual number of the series. Its findings belong to
/// page 3.
class CDefineEVSKvf : public CKvfBase {
  public:
    using CKvfBase::CKvfBase;

    int Check(CMessageList& messages, int flag) override;
    /// Writes ItemName and Unit too, taken from the first item of the series file, whatever
    /// InputItem says; empty when the file cannot be read. They are not read back.
    void Write(KvfTree* file, const std::string& baseDirectory) override;
    void Read(const KvfSection* enclosing, const std::string& baseDirectory) override;

    /// The result file of a run.
    std::string GetOutputFileName() const { return OutputFileName; }

    /// Takes over what an extraction produced, once `Extracted` of the basic input is set: series
    /// file, selection method, threshold, and events a year. A record length of 0 gives 0 events a
    /// year, as the page shows it; an empty series, and one that cannot be read, has no events and
    /// leaves a threshold that would be its smallest value.
    void SyncFromExtraction(const CBasicInputKvf& basic);

    int SelectionMethod = 0;    ///< 0 the series is an AMS, 1 a PDS
    int InputItem = 0;          ///< from 1; 0: none chosen
    std::string InputFileName;  ///< the series file; absolute, or empty
    std::string OutputFileName; ///< the result file; absolute, or empty
    std::string Title;
    std::string Subtitle;
    double Threshold = 0.0;
    double AvgAnNum = 0.0; ///< average annual number of events
    /// Extent of the series.
    CTsqValues summary;

  private:
    void CheckPartialDurations(CMessageList& messages) const;
};

} // namespace ryn
