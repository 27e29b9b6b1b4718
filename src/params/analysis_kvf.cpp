#include "params/analysis_kvf.h"

#include <algorithm>
#include <cmath>
#include <limits>

#include "params/date_keyword.h"
#include "params/global_kvf.h"
#include "series/season.h"
#include "series/selection_rules.h"
#include "strings/catalogue.h"

namespace ryn {

namespace {

constexpr int kPage = 4;

struct Flag {
    const char* keyword;
    bool CAnalysisKvf::*member;
};

// In file order.
constexpr Flag kFlags[] = {
    {"RunTest", &CAnalysisKvf::RunTest},
    {"TestForTrend", &CAnalysisKvf::TestForTrend},
    {"TestForShiftInMean", &CAnalysisKvf::TestForShiftInMean},
    {"ChiSquaredTest", &CAnalysisKvf::ChiSquaredTest},
    {"KolmogorovSmirnovTest", &CAnalysisKvf::KolmogorovSmirnovTest},
    {"SLSCTest", &CAnalysisKvf::SLSCTest},
    {"PPCCTest", &CAnalysisKvf::PPCCTest},
    {"PPCCTest2", &CAnalysisKvf::PPCCTest2},
    {"LogLikelihood", &CAnalysisKvf::LogLikelihood},
};

std::string Numbered(const char* name, std::size_t number) {
    return name + std::to_string(number);
}

/// A number cut to an int; the ends of the range for numbers beyond it, 0 for NaN.
int Truncated(double value) {
    constexpr double kLowest = std::numeric_limits<int>::min();
    constexpr double kHighest = std::numeric_limits<int>::max();
    return std::isnan(value) ? 0 : static_cast<int>(std::clamp(value, kLowest, kHighest));
}

} // namespace

double CAnalysisKvf::SmallestReturnPeriod() const {
    const auto* const root = dynamic_cast<const CGlobalKvf*>(GetRoot());
    if (root == nullptr || root->DefineEVS().SelectionMethod != kSelectPartialDurations)
        return 1.0;
    const double rate = root->DefineEVS().AvgAnNum;
    if (rate == 0.0)
        return 1.0;
    return AnnualReturnPeriod ? -1.0 / std::expm1(-rate) : 1.0 / rate;
}

int CAnalysisKvf::Check(CMessageList& messages, int /*flag*/) {
    if (GetParent() == nullptr)
        return 0;
    const double smallest = SmallestReturnPeriod();
    int found = 0;
    for (const double period : EvaluatedReturnPeriods) {
        if (smallest < period) // false for NaN
            continue;
        messages.push_back({kPage, FormatText(kTextReturnPeriodTooSmall, period, smallest)});
        ++found;
    }
    return found;
}

void CAnalysisKvf::Write(KvfTree* file, const std::string& /*baseDirectory*/) {
    kvfAddSection(file, "Analysis");
    for (const Flag& flag : kFlags)
        kvfPutParam(file, flag.keyword, this->*flag.member);
    kvfPutParam(file, "UncertaintyCalcType", UncertaintyCalcType);
    kvfPutParam(file, "PlottingMethod", PlottingMethod);
    kvfAddSection(file, "EvaluatedReturnPeriods");
    kvfPutParam(file, "AnnualReturnPeriod", AnnualReturnPeriod);
    kvfPutParam(file, "NoOfItems", static_cast<int>(EvaluatedReturnPeriods.size()));
    for (const double period : EvaluatedReturnPeriods)
        kvfPutParam(file, "Item", period);
    kvfEndSection(file);
    kvfAddSection(file, "SelectedPeriods");
    kvfPutParam(file, "NoOfItems", static_cast<int>(SelectedPeriods.size()));
    for (const int period : SelectedPeriods)
        kvfPutParam(file, "Item", period);
    kvfEndSection(file);
    kvfPutParam(file, "SplitMethod", SplitMethod);
    WriteSplitDates(file);
    kvfEndSection(file);
}

void CAnalysisKvf::WriteSplitDates(KvfTree* file) const {
    kvfAddSection(file, "SplitDate");
    for (std::size_t i = 0; i < SplitDates.size(); ++i)
        PutDate(file, Numbered("Date", i + 1), SplitDates[i]);
    for (std::size_t i = 0; i < Intervals.size(); ++i)
        kvfPutParam(file, Numbered("Interval", i + 1), Intervals[i]);
    kvfEndSection(file);
}

void CAnalysisKvf::Read(const KvfSection* enclosing, const std::string& /*baseDirectory*/) {
    EvaluatedReturnPeriods.clear();
    SelectedPeriods.clear();
    SplitDates.clear();
    Intervals.clear();
    const KvfSection* const section = kvfSectionByNameNum(enclosing, "Analysis", 1);
    for (const Flag& flag : kFlags)
        kvfGetParam(section, flag.keyword, &(this->*flag.member), 1, 1);
    kvfGetParam(section, "UncertaintyCalcType", &UncertaintyCalcType, 1, 1);
    kvfGetParam(section, "PlottingMethod", &PlottingMethod, 1, 1);

    const KvfSection* const evaluated = kvfSectionByNameNum(section, "EvaluatedReturnPeriods", 1);
    AnnualReturnPeriod = false; // older files do not have it
    if (kvfKeywordByNameNum(evaluated, "AnnualReturnPeriod", 1) != nullptr)
        kvfGetParam(evaluated, "AnnualReturnPeriod", &AnnualReturnPeriod, 1, 1);
    double item = 0.0;
    for (int n = 1; kvfGetParam(evaluated, "Item", &item, n, 1) != 0; ++n)
        EvaluatedReturnPeriods.push_back(item);

    const KvfSection* const selected = kvfSectionByNameNum(section, "SelectedPeriods", 1);
    for (int n = 1; kvfGetParam(selected, "Item", &item, n, 1) != 0; ++n)
        SelectedPeriods.push_back(Truncated(item));

    kvfGetParam(section, "SplitMethod", &SplitMethod, 1, 1);
    ReadSplitDates(kvfSectionByNameNum(section, "SplitDate", 1));
}

void CAnalysisKvf::ReadSplitDates(const KvfSection* section) {
    COleDateTime date;
    for (std::size_t n = 1; GetDate(section, Numbered("Date", n), &date); ++n)
        SplitDates.push_back(date);
    int interval = 0;
    for (std::size_t n = 1; kvfGetParam(section, Numbered("Interval", n), &interval, 1, 1) != 0;
         ++n)
        Intervals.push_back(interval);
}

int CAnalysisKvf::SampleOfDate(const COleDateTime& date) const {
    if (!TestForShiftInMean || SplitDates.empty())
        return 0;
    switch (SplitMethod) {
    case kSplitByDate:
        return IsClearlyBefore(date, SplitDates.front()) ? 1 : 2;
    case kSplitBySeason:
        return SampleBySeason(date);
    case kSplitCustom:
        return SampleByCustomPeriods(date);
    default:
        return 0;
    }
}

int CAnalysisKvf::SampleBySeason(const COleDateTime& date) const {
    if (SplitDates.size() < 2) // half a season divides nothing
        return 0;
    const COleDateTime::Fields fields = date.GetFields();
    const MonthDay day{fields.month, fields.day};
    const MonthDay start = MonthDay::Of(SplitDates[0]).In(fields.year);
    const MonthDay end = MonthDay::Of(SplitDates[1]).In(fields.year);
    // Whether the season wraps goes by the full dates here, years included.
    const bool inSeason = IsClearlyBefore(SplitDates[0], SplitDates[1]) ? start <= day && day <= end
                                                                        : day > start || day < end;
    return inSeason ? 1 : 2;
}

int CAnalysisKvf::SampleByCustomPeriods(const COleDateTime& date) const {
    const std::size_t periods = std::min(SplitDates.size() / 2, Intervals.size());
    for (std::size_t i = 0; i < periods; ++i)
        if (IsClearlyBefore(SplitDates[2 * i], date) &&
            IsClearlyBefore(date, SplitDates[2 * i + 1]))
            return Intervals[i];
    return 0;
}

} // namespace ryn
