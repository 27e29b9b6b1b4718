#pragma once

#include <string>
#include <vector>

#include "base/ole_date_time.h"
#include "framework/kvf_base.h"

namespace ryn {

/// How the series splits into two subsamples for the test for shift in mean.
enum SplitMethods : int {
    kSplitByDate = 0,   ///< the first split date
    kSplitBySeason = 1, ///< the first two split dates are the season's start and end
    kSplitCustom = 2,   ///< dates in pairs, the n-th with the n-th interval's sample number
};

/// Section Analysis: tests, goodness-of-fit statistics, uncertainty, plotting positions, return
/// periods and subsamples. Its findings belong to page 4.
class CAnalysisKvf : public CKvfBase {
  public:
    using CKvfBase::CKvfBase;

    /// Return periods must be greater than the smallest one that the series can have. Without a
    /// parent nothing is checked.
    int Check(CMessageList& messages, int flag) override;
    void Write(KvfTree* file, const std::string& baseDirectory) override;
    void Read(const KvfSection* enclosing, const std::string& baseDirectory) override;

    /// The subsample of a sample: 0 when it belongs to none.
    int SampleOfDate(const COleDateTime& date) const;

    bool RunTest = false;
    bool TestForTrend = false;
    bool TestForShiftInMean = false;
    bool ChiSquaredTest = false;
    bool KolmogorovSmirnovTest = false;
    bool SLSCTest = false;
    bool PPCCTest = false;
    bool PPCCTest2 = false;
    bool LogLikelihood = false;
    bool AnnualReturnPeriod = false; ///< return periods of a PDS are those of the annual maximum
    int UncertaintyCalcType = 0;     ///< 0 Monte Carlo, 1 jackknife
    int PlottingMethod = 0;          ///< 0 Weibull, 1 Hazen, 2 Gringorten, 3 Blom, 4 Cunnane
    int SplitMethod = kSplitByDate;
    std::vector<COleDateTime> SplitDates{{1990, 1, 1, 0, 0, 0}};
    std::vector<int> Intervals;
    std::vector<double> EvaluatedReturnPeriods; ///< years
    std::vector<int> SelectedPeriods;           ///< carried from file to file

  private:
    double SmallestReturnPeriod() const;
    int SampleBySeason(const COleDateTime& date) const;
    int SampleByCustomPeriods(const COleDateTime& date) const;
    void WriteSplitDates(KvfTree* file) const;
    void ReadSplitDates(const KvfSection* section);
};

} // namespace ryn
