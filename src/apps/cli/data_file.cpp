#include "apps/cli/data_file.h"

#include <cmath>

#include "apps/cli/date_text.h"
#include "strings/catalogue.h"
#include "units/units.h"

namespace ryn::cli {

namespace {

/// The library's own reason for a failure of which the caller knows no other.
Status StoreError(const std::string& path) {
    Status error = tsqTakeError();
    return error ? Status::InputFault(path) : error;
}

} // namespace

DataFile::~DataFile() {
    tsqFileClose(header.get(), &file);
    tsqHeaderDestroy(&header);
}

Status DataFile::Open(const std::string& path) {
    fileName = path;
    (void)tsqTakeError();
    if (tsqFileRead(path, &header, &file) != 0)
        return StoreError(path);
    title = tsqGetFileTitle(header.get());
    ReadItems();
    return ReadAxis();
}

Status DataFile::ReadAxis() {
    axis = tsqGetTimeAxis(header.get());
    double offset = 0.0;
    const std::optional<COleDateTime> zero = ParseDate(axis.date + "T" + axis.time, 0);
    if (axis.type == 0 || !zero || !UnitConversion(axis.unit, kUnitSecond, &unitSeconds, &offset))
        return Status::InputFault(FormatText(kTextCliBadTimeAxis, fileName));
    origin = *zero;
    return Status::Ok();
}

void DataFile::ReadItems() {
    const int count = tsqGetNoOfItems(header.get());
    for (int number = 1; number <= count; ++number) {
        TsqItem* const item = tsqItemD(header.get(), number);
        DataItem read;
        read.number = number;
        tsqGetItemInfo(item, nullptr, nullptr, &read.name, nullptr, &read.unit, nullptr);
        read.isPlainSeries = tsqGetItemDimensions(item) == 0;
        items.push_back(std::move(read));
    }
}

std::vector<int> DataFile::PlainItems() const {
    std::vector<int> numbers;
    for (const DataItem& item : items)
        if (item.isPlainSeries)
            numbers.push_back(item.number);
    return numbers;
}

double DataFile::SecondsOf(int index, double time) const {
    // The steps of an equidistant axis are computed, as the analysis does, and not looked up.
    return (axis.start + (axis.IsEquidistant() ? index * axis.step : time)) * unitSeconds;
}

COleDateTime DataFile::DateOf(double seconds) const {
    // Stored times are rounded to the millisecond; half of one keeps a whole second whole.
    return origin + COleDateTimeSpan(std::floor(seconds + 5e-4) / 86400.0);
}

Status DataFile::ReadStep(const std::vector<int>& itemNumbers, double* time, float* values) {
    std::size_t wanted = 0;
    for (const DataItem& item : items) {
        const bool asked = wanted < itemNumbers.size() && itemNumbers[wanted] == item.number;
        float* const value = asked ? values + wanted++ : nullptr;
        double* const stepTime = item.number == 1 ? time : nullptr;
        if (tsqReadItemTimeStep(header.get(), file.get(), stepTime, value) != 0)
            return StoreError(fileName);
    }
    return Status::Ok();
}

Status DataFile::Walk(const std::vector<int>& itemNumbers,
                      const std::function<bool(const DataStep&)>& use) {
    if (axis.count == 0)
        return Status::Ok();
    if (tsqFindBlockDynamic(header.get(), file.get()) != 0)
        return StoreError(fileName);
    std::vector<float> values(itemNumbers.size());
    for (int index = 0; index < axis.count; ++index) {
        double time = 0.0;
        if (Status read = ReadStep(itemNumbers, &time, values.data()); !read)
            return read;
        const double seconds = SecondsOf(index, time);
        const COleDateTime date = DateOf(seconds);
        if (!date.IsValid())
            return Status::InputFault(FormatText(kTextCliTimeOutOfCalendar, fileName, index + 1));
        if (!use({index, date, seconds, values}))
            break;
    }
    return Status::Ok();
}

} // namespace ryn::cli
