#include "params/define_evs_kvf.h"

#include "base/file_access.h"
#include "base/path_parts.h"
#include "base/qx_path.h"
#include "params/basic_input_kvf.h"
#include "strings/catalogue.h"
#include "tsq/tsq.h"

namespace ryn {

namespace {

constexpr int kPage = 3;

CMessage Finding(int id) {
    return {kPage, std::string(Text(id))};
}

/// Name and unit text of the first item of a data file; empty when it cannot be read.
void FirstItemOf(const std::string& path, std::string* name, std::string* unit) {
    TsqHeaderHandle header;
    TsqFileHandle file;
    if (tsqFileRead(path, &header, &file) != 0)
        return;
    tsqGetItemInfo(tsqItemD(header.get(), 1), nullptr, nullptr, name, nullptr, unit, nullptr);
    tsqFileClose(header.get(), &file);
    tsqHeaderDestroy(&header);
}

} // namespace

int CDefineEVSKvf::Check(CMessageList& messages, int /*flag*/) {
    const std::size_t before = messages.size();
    if (InputFileName.empty())
        messages.push_back(Finding(kTextInputFileMissing));
    else if (!CanOpenForReading(InputFileName))
        messages.push_back(Finding(kTextCannotOpenInputFile));
    if (OutputFileName.empty())
        messages.push_back(Finding(kTextOutputFileMissing));
    if (SelectionMethod == kSelectPartialDurations)
        CheckPartialDurations(messages);
    return static_cast<int>(messages.size() - before);
}

void CDefineEVSKvf::CheckPartialDurations(CMessageList& messages) const {
    constexpr double kTolerance = 1e-8;
    // Written so that NaN, which a hand-edited file can hold, is a fault.
    if (!(Threshold >= 0.0))
        messages.push_back(Finding(kTextThresholdNotNegative));
    if (!(AvgAnNum > 0.0))
        messages.push_back(Finding(kTextRecordLengthPositive));
    if (!InputFileName.empty() && InputItem != 0 && Threshold - summary.minimum.value > kTolerance)
        messages.push_back({kPage, FormatText(kTextThresholdAtMostMinimum, summary.minimum.value)});
}

void CDefineEVSKvf::Write(KvfTree* file, const std::string& baseDirectory) {
    std::string itemName;
    std::string unit;
    if (!InputFileName.empty())
        FirstItemOf(InputFileName, &itemName, &unit);
    kvfAddSection(file, "DefineEVS");
    kvfPutParam(file, "SelectionMethod", SelectionMethod);
    kvfPutParam(file, "InputFileName", CQxPath(InputFileName).GetFileNameRelativeTo(baseDirectory));
    kvfPutParam(file, "OutputFileName",
                CQxPath(OutputFileName).GetFileNameRelativeTo(baseDirectory));
    kvfPutParam(file, "InputItem", InputItem);
    kvfPutParam(file, "Title", Title);
    kvfPutParam(file, "Subtitle", Subtitle);
    kvfPutParam(file, "ItemName", itemName);
    kvfPutParam(file, "Unit", unit);
    kvfPutParam(file, "Threshold", Threshold);
    kvfPutParam(file, "AvgAnNum", AvgAnNum);
    kvfEndSection(file);
}

void CDefineEVSKvf::Read(const KvfSection* enclosing, const std::string& baseDirectory) {
    const KvfSection* const section = kvfSectionByNameNum(enclosing, "DefineEVS", 1);
    kvfGetParam(section, "SelectionMethod", &SelectionMethod, 1, 1);
    kvfGetParam(section, "InputFileName", &InputFileName, 1, 1);
    InputFileName = FullPath(InputFileName, baseDirectory);
    kvfGetParam(section, "OutputFileName", &OutputFileName, 1, 1);
    OutputFileName = FullPath(OutputFileName, baseDirectory);
    kvfGetParam(section, "InputItem", &InputItem, 1, 1);
    kvfGetParam(section, "Title", &Title, 1, 1);
    kvfGetParam(section, "Subtitle", &Subtitle, 1, 1);
    kvfGetParam(section, "Threshold", &Threshold, 1, 1);
    kvfGetParam(section, "AvgAnNum", &AvgAnNum, 1, 1);
    if (!InputFileName.empty() && InputItem != 0)
        summary.ReadSummary(InputFileName, ItemIndex(InputItem));
}

void CDefineEVSKvf::SyncFromExtraction(const CBasicInputKvf& basic) {
    if (!basic.Extracted)
        return;
    InputFileName = basic.OutputFileName;
    InputItem = 1;
    SelectionMethod = basic.SelectionMethod;
    const int events = summary.ReadSummary(InputFileName, 0) ? summary.count : 0;
    double recordLength = events;
    if (SelectionMethod == kSelectPartialDurations) {
        recordLength = basic.RecordLength;
        if (basic.PdsDataType == kPartialDurationsByThreshold)
            Threshold = basic.Threshold;
        else if (events > 0) // an empty series has no smallest value
            Threshold = summary.minimum.value;
    }
    AvgAnNum = recordLength != 0.0 ? events / recordLength : 0.0;
}

} // namespace ryn
