#include "apps/cli/grid_case.h"

#include "apps/cli/input_file.h"
#include "base/path_parts.h"
#include "run/point_series.h"
#include "strings/catalogue.h"

namespace ryn::cli {

Status TestGridSettings(CaseFile& file) {
    const CBasicInputKvf& basic = file.Root().BasicInput();
    if (basic.SelectionMethod != file.Root().DefineEVS().SelectionMethod)
        return Status::InputFault(FormatText(kTextCliGridMethodsDiffer, file.ShownName(),
                                             basic.SelectionMethod,
                                             file.Root().DefineEVS().SelectionMethod));
    // Written so that NaN, which a hand-edited file can hold, is refused too.
    if (basic.SelectionMethod == kSelectPartialDurations && !(basic.AvgAnNum > 0.0))
        return Status::InputFault(FormatText(kTextCliGridNoRate, file.ShownName()));
    // The number of peaks is the rate times this, and none is no series.
    if (basic.SelectionMethod == kSelectPartialDurations &&
        basic.PdsDataType != kPartialDurationsByThreshold && !(basic.RecordLength > 0.0))
        return Status::InputFault(FormatText(kTextCliGridNoRecordLength, file.ShownName()));
    const CTsq2InputKvf& input = file.Root().GridInput();
    return input.UseTsq2Input && !input.Tsq2InputFile.empty()
               ? TestReadable(FullPath(input.Tsq2InputFile, SplitPath(file.Path()).directory))
               : Status::Ok();
}

Status TestGridPlan(CaseFile& file) {
    GridPlan plan;
    if (Status made =
            MakeGridPlan(file.Root().GridInput(), SplitPath(file.Path()).directory, &plan);
        !made)
        return Status::InputFault(file.ShownName() + ": " + made.Text());
    PointSeries series;
    return series.Open(plan);
}

} // namespace ryn::cli
