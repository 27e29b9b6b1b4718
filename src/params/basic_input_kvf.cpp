#include "params/basic_input_kvf.h"

#include "base/file_access.h"
#include "base/path_parts.h"
#include "base/qx_path.h"
#include "params/date_keyword.h"
#include "strings/catalogue.h"

namespace ryn {

namespace {

constexpr int kPage = 2;

} // namespace

int CBasicInputKvf::Check(CMessageList& messages, int /*flag*/) {
    const std::size_t before = messages.size();
    if (!InputFileName.empty() && !CanOpenForReading(InputFileName))
        messages.push_back({kPage, std::string(Text(kTextCannotOpenInputFile))});
    if (SelectionMethod == kSelectPartialDurations)
        CheckPartialDurations(messages);
    return static_cast<int>(messages.size() - before);
}

void CBasicInputKvf::CheckPartialDurations(CMessageList& messages) const {
    const bool byThreshold = PdsDataType == kPartialDurationsByThreshold;
    const auto add = [&messages](int id) { messages.push_back({kPage, std::string(Text(id))}); };
    // Written so that NaN, which a hand-edited file can hold, is a fault.
    if (!(RecordLength > 0.0))
        add(kTextRecordLengthPositive);
    if (byThreshold && !(Threshold >= 0.0))
        add(kTextThresholdNotNegative);
    if (!byThreshold && !(AvgAnNum > 0.0))
        add(kTextAverageNumberPositive);
    if (InterTimeSpecified && !(InterTime >= 0.0))
        add(kTextInterTimeNotNegative);
    if (InterLevelSpecified && !(InterLevel >= 0.0 && InterLevel <= 1.0))
        add(kTextInterLevelFraction);
    // A summary that was never filled has no maximum to compare with.
    const bool summarised = summary.maximum.value != -CTsqValues::kHighestValue;
    if (byThreshold && !InputFileName.empty() && InputItem != 0 && summarised &&
        Threshold > summary.maximum.value)
        messages.push_back({kPage, FormatText(kTextThresholdBelowMaximum, summary.maximum.value)});
}

void CBasicInputKvf::Write(KvfTree* file, const std::string& baseDirectory) {
    kvfAddSection(file, "BasicInput");
    kvfPutParam(file, "SelectionMethod", SelectionMethod);
    kvfPutParam(file, "PdsDataType", PdsDataType);
    kvfPutParam(file, "InputFileName", CQxPath(InputFileName).GetFileNameRelativeTo(baseDirectory));
    kvfPutParam(file, "InputItem", InputItem);
    kvfPutParam(file, "OutputFileName",
                CQxPath(OutputFileName).GetFileNameRelativeTo(baseDirectory));
    kvfPutParam(file, "IncludeSeasonalAnalysis", IncludeSeasonalAnalysis);
    kvfPutParam(file, "InterTimeSpecified", InterTimeSpecified);
    kvfPutParam(file, "InterLevelSpecified", InterLevelSpecified);
    kvfPutParam(file, "Threshold", Threshold);
    kvfPutParam(file, "AvgAnNum", AvgAnNum);
    kvfPutParam(file, "InterTime", InterTime);
    kvfPutParam(file, "InterLevel", InterLevel);
    kvfPutParam(file, "RecordLength", RecordLength);
    PutDate(file, "AmsStartDate", AmsStartDate);
    PutDate(file, "SeasonalStartDate", SeasonalStartDate);
    PutDate(file, "SeasonalEndDate", SeasonalEndDate);
    kvfEndSection(file);
}

void CBasicInputKvf::Read(const KvfSection* enclosing, const std::string& baseDirectory) {
    const KvfSection* const section = kvfSectionByNameNum(enclosing, "BasicInput", 1);
    kvfGetParam(section, "SelectionMethod", &SelectionMethod, 1, 1);
    kvfGetParam(section, "PdsDataType", &PdsDataType, 1, 1);
    kvfGetParam(section, "InputFileName", &InputFileName, 1, 1);
    InputFileName = FullPath(InputFileName, baseDirectory);
    kvfGetParam(section, "InputItem", &InputItem, 1, 1);
    kvfGetParam(section, "OutputFileName", &OutputFileName, 1, 1);
    OutputFileName = FullPath(OutputFileName, baseDirectory);
    kvfGetParam(section, "IncludeSeasonalAnalysis", &IncludeSeasonalAnalysis, 1, 1);
    kvfGetParam(section, "InterTimeSpecified", &InterTimeSpecified, 1, 1);
    kvfGetParam(section, "InterLevelSpecified", &InterLevelSpecified, 1, 1);
    kvfGetParam(section, "Threshold", &Threshold, 1, 1);
    kvfGetParam(section, "AvgAnNum", &AvgAnNum, 1, 1);
    kvfGetParam(section, "InterTime", &InterTime, 1, 1);
    kvfGetParam(section, "InterLevel", &InterLevel, 1, 1);
    kvfGetParam(section, "RecordLength", &RecordLength, 1, 1);
    GetDate(section, "AmsStartDate", &AmsStartDate);
    GetDate(section, "SeasonalStartDate", &SeasonalStartDate);
    GetDate(section, "SeasonalEndDate", &SeasonalEndDate);
    if (!InputFileName.empty() && InputItem != 0)
        summary.ReadSummary(InputFileName, ItemIndex(InputItem));
}

} // namespace ryn
