#include "params/tsq2_input_kvf.h"

namespace ryn {

namespace {

void PutRange(KvfTree* file, const char* keyword, const IndexRange& range) {
    kvfPutListParam(file, keyword, "iii", {range.first, range.last, range.step});
}

void GetRange(const KvfSection* section, const char* keyword, IndexRange* range) {
    kvfGetListParam(section, keyword, 1, "iii", {&range->first, &range->last, &range->step});
}

} // namespace

void CTsq2InputKvf::Write(KvfTree* file, const std::string& /*baseDirectory*/) {
    kvfAddSection(file, "Tsq2Input");
    kvfPutParam(file, "UseTsq2Input", UseTsq2Input);
    kvfPutParamFilename(file, "Tsq2InputFile", Tsq2InputFile);
    kvfPutParam(file, "Tsq2ItemNo", Tsq2ItemNo);
    PutRange(file, "X_Range_And_Interval", X_Range_And_Interval);
    PutRange(file, "Y_Range_And_Interval", Y_Range_And_Interval);
    PutRange(file, "Time_Range_And_Interval", Time_Range_And_Interval);
    kvfPutParamFilename(file, "Tsq2OutputFile", Tsq2OutputFile);
    kvfPutParam(file, "UncertaintyCal", UncertaintyCal);
    kvfPutParam(file, "SaveEVS", SaveEVS);
    kvfEndSection(file);
}

void CTsq2InputKvf::Read(const KvfSection* enclosing, const std::string& /*baseDirectory*/) {
    const KvfSection* const section = kvfSectionByNameNum(enclosing, "Tsq2Input", 1);
    if (section == nullptr)
        return;
    kvfGetParam(section, "UseTsq2Input", &UseTsq2Input, 1, 1);
    kvfGetParamFilename(section, "Tsq2InputFile", &Tsq2InputFile, 1, 1);
    kvfGetParam(section, "Tsq2ItemNo", &Tsq2ItemNo, 1, 1);
    GetRange(section, "X_Range_And_Interval", &X_Range_And_Interval);
    GetRange(section, "Y_Range_And_Interval", &Y_Range_And_Interval);
    GetRange(section, "Time_Range_And_Interval", &Time_Range_And_Interval);
    kvfGetParamFilename(section, "Tsq2OutputFile", &Tsq2OutputFile, 1, 1);
    kvfGetParam(section, "UncertaintyCal", &UncertaintyCal, 1, 1);
    kvfGetParam(section, "SaveEVS", &SaveEVS, 1, 1);
}

} // namespace ryn
