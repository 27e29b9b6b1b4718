#include "grid/delete_value.h"

#include <algorithm>
#include <cmath>
#include <limits>

#include "netcdf/nc_values.h"

namespace ryn {

namespace {

bool IsPacked(const NcFile& file, const NcVariable& variable) {
    return file.Number(variable.id, "scale_factor").value_or(1.0) != 1.0 ||
           file.Number(variable.id, "add_offset").value_or(0.0) != 0.0;
}

/// What the values handed on show as missing, as floats. A packed mark is none: unpacked it is a
/// number like others, and as it stands in the file it may be data once unpacked.
std::vector<float> MarksOf(const NcFile& file, const NcVariable& variable) {
    std::vector<float> marks;
    if (IsPacked(file, variable))
        return marks;
    const NcValues values(&file, &variable);
    for (const double mark : values.MissingMarks())
        if (std::abs(mark) <= static_cast<double>(std::numeric_limits<float>::max()))
            marks.push_back(static_cast<float>(mark));
    return marks;
}

} // namespace

float ChooseDeleteValue(const NcFile& file, const std::vector<GridVariable>& items) {
    constexpr float kFloatFill = 9.9692099683868690e+36F;
    std::vector<std::vector<float>> others;
    others.reserve(items.size());
    for (const GridVariable& item : items)
        others.push_back(MarksOf(file, *item.variable));
    for (const float mark : others.front()) {
        const auto hasMark = [mark](const std::vector<float>& marks) {
            return std::ranges::find(marks, mark) != marks.end();
        };
        if (std::ranges::all_of(others, hasMark))
            return mark;
    }
    return kFloatFill;
}

} // namespace ryn
