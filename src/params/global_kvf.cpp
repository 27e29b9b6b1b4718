#include "params/global_kvf.h"

#include "base/file_access.h"

namespace ryn {

CGlobalKvf::CGlobalKvf(CKvfBase* parentSection) : CKvfBase(parentSection) {
    basicInput.SetParent(this);
    defineEvs.SetParent(this);
    analysis.SetParent(this);
    distributions.SetParent(this);
    gridInput.SetParent(this);
}

int CGlobalKvf::Check(CMessageList& messages, int flag) {
    if (flag == 0)
        return 0;
    int found = basicInput.Check(messages, flag);
    found += defineEvs.Check(messages, flag);
    found += analysis.Check(messages, flag);
    found += distributions.Check(messages, flag);
    return found;
}

int CGlobalKvf::CheckForRun() {
    CMessageList dropped;
    int found = defineEvs.Check(dropped, 1);
    found += analysis.Check(dropped, 1);
    found += distributions.Check(dropped, 1);
    return found;
}

void CGlobalKvf::Write(KvfTree* file, const std::string& baseDirectory) {
    kvfAddTarget(file, "RynEditor");
    basicInput.Write(file, baseDirectory);
    gridInput.Write(file, baseDirectory);
    defineEvs.Write(file, baseDirectory);
    analysis.Write(file, baseDirectory);
    distributions.Write(file, baseDirectory);
    WriteExtremeValues(file);
    kvfEndSection(file);
}

void CGlobalKvf::WriteExtremeValues(KvfTree* file) {
    const bool fromSeries = !defineEvs.InputFileName.empty();
    const bool fromOutput = !fromSeries && !basicInput.OutputFileName.empty();
    bool isRead = true;
    if (fromSeries)
        isRead = values.ReadSeries(defineEvs.InputFileName, ItemIndex(defineEvs.InputItem));
    else if (fromOutput)
        isRead = values.ReadSeries(basicInput.OutputFileName, 0);
    seriesError = isRead ? Status::Ok() : values.ReadError();
    values.WriteExtremeValueSection(
        file, [this](const COleDateTime& date) { return analysis.SampleOfDate(date); });
    if (fromSeries || fromOutput)
        values.ClearSeries();
}

void CGlobalKvf::Read(const KvfSection* target, const std::string& baseDirectory) {
    (void)SetCurrentDirectory(baseDirectory);
    if (target == nullptr) // a file without the target leaves the defaults in place
        return;
    basicInput.Read(target, baseDirectory);
    gridInput.Read(target, baseDirectory);
    defineEvs.Read(target, baseDirectory);
    analysis.Read(target, baseDirectory);
    distributions.Read(target, baseDirectory);
}

} // namespace ryn
