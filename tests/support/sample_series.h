#pragma once

#include <initializer_list>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

#include "base/ole_date_time.h"
#include "series/sts_item.h"
#include "tsq/tsq.h"
#include "units/units.h"

namespace ryn::test {

/// A date from "1990-10-01", "1990-10-01 06:00" or "1990-10-01 06:00:30".
inline COleDateTime At(std::string_view text) {
    const auto number = [&](std::size_t from, std::size_t length) {
        return text.size() < from + length ? 0 : std::stoi(std::string(text.substr(from, length)));
    };
    return {number(0, 4), number(5, 2), number(8, 2), number(11, 2), number(14, 2), number(17, 2)};
}

using Samples = SampleArray;

inline Samples SamplesOf(std::initializer_list<std::pair<std::string_view, double>> entries) {
    Samples samples;
    for (const auto& [date, value] : entries)
        samples.push_back({At(date), value, 0});
    return samples;
}

/// One sample a day from a date on.
inline Samples Daily(std::string_view start, const std::vector<double>& values) {
    Samples samples;
    for (std::size_t i = 0; i < values.size(); ++i)
        samples.push_back({At(start) + COleDateTimeSpan(static_cast<double>(i)), values[i], 0});
    return samples;
}

inline std::vector<double> ValuesOf(const std::vector<const STSItem*>& selection) {
    std::vector<double> values;
    for (const STSItem* sample : selection)
        values.push_back(sample->value);
    return values;
}

inline std::vector<std::string> DaysOf(const std::vector<const STSItem*>& selection) {
    std::vector<std::string> days;
    for (const STSItem* sample : selection)
        days.push_back(sample->date.Format("%Y-%m-%d"));
    return days;
}

/// Writes samples as a data file of one item on a non-equidistant calendar axis.
inline Status WriteDataFile(const std::string& path, const Samples& samples,
                            const std::string& itemName = "Discharge",
                            const std::string& unit = "m3/s") {
    TsqHeaderHandle header;
    tsqHeaderCreate(4, "gauge", "test", 1, 1, 1, &header);
    const COleDateTime start = samples.empty() ? At("2000-01-01") : samples.front().date;
    tsqSetNeqCalendarAxis(header.get(), start.Format("%Y-%m-%d"), start.Format("%H:%M:%S"),
                          kUnitSecond, 0.0, 0);
    tsqSetItemInfo(header.get(), tsqItemD(header.get(), 1), kItemTypeUndefined, itemName,
                   UnitOfText(unit), kTsqDataTypeFloat);
    TsqFileHandle file;
    if (tsqFileCreate(path, header.get(), &file) != 0)
        return tsqTakeError();
    for (const STSItem& sample : samples) {
        const auto value = static_cast<float>(sample.value);
        tsqWriteItemTimeStep(header.get(), file.get(),
                             (sample.date - start).GetTotalDays() * 86400.0, &value);
    }
    tsqFileClose(header.get(), &file);
    return tsqTakeError();
}

} // namespace ryn::test
