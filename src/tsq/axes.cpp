#include <cmath>
#include <optional>
#include <utility>

#include "base/number_text.h"
#include "base/ole_date_time.h"
#include "tsq/errors.h"
#include "tsq/records.h"
#include "tsq/tsq.h"

namespace ryn {

namespace {

constexpr int kMonth = 1405;
constexpr int kYear = 1406;

template <typename T>
void Give(T* output, const T& value) {
    if (output != nullptr)
        *output = value;
}

bool HasAxis(const TsqHeader* header, TsqAxisType type) {
    return header != nullptr && header->axis.type == type;
}

int WrongAxis() {
    return FailReading(Status::InputFault("the file's time axis is of another type"));
}

void GiveUnit(const TsqAxis& axis, int* unit, std::string* unitText) {
    Give(unit, axis.unit);
    if (unitText != nullptr)
        *unitText = UnitText(axis.unit);
}

/// A date and a time as a normal text of each; nothing when they are none. Leading zeros may be
/// missing.
std::optional<std::pair<std::string, std::string>> NormalDate(const std::string& date,
                                                              const std::string& time) {
    const auto part = [](const std::string& text, char mark, int place) {
        std::size_t begin = 0;
        for (; place > 0 && begin != std::string::npos; --place)
            begin = text.find(mark, begin) == std::string::npos ? std::string::npos
                                                                : text.find(mark, begin) + 1;
        if (begin == std::string::npos)
            return -1;
        const std::string digits = text.substr(begin, text.find(mark, begin) - begin);
        return ParseInt(digits).value_or(-1);
    };
    const COleDateTime moment(part(date, '-', 0), part(date, '-', 1), part(date, '-', 2),
                              part(time, ':', 0), part(time, ':', 1), part(time, ':', 2));
    if (!moment.IsValid() || part(date, '-', 3) != -1 || part(time, ':', 3) != -1)
        return std::nullopt;
    return std::pair(moment.Format("%Y-%m-%d"), moment.Format("%H:%M:%S"));
}

int SetAxis(TsqHeader* header, TsqAxis axis) {
    if (header == nullptr)
        return FailWriting(Status::InputFault("no header"));
    if (MillisecondsInUnit(axis.unit) == 0.0)
        return FailWriting(Status::InputFault(header->title + ": the time axis's unit is no time"));
    if (!std::isfinite(axis.start) || !std::isfinite(axis.step))
        return FailWriting(Status::InputFault(header->title + ": the time axis is not finite"));
    if (axis.IsEquidistant() && !(axis.step > 0.0))
        return FailWriting(
            Status::InputFault(header->title + ": the time axis's step is not above 0"));
    header->axis = std::move(axis);
    return 0;
}

int SetCalendarAxis(TsqHeader* header, const std::string& date, const std::string& time,
                    TsqAxis axis) {
    const std::string title = header != nullptr ? header->title : std::string();
    const auto normal = NormalDate(date, time);
    if (!normal)
        return FailWriting(Status::InputFault(
            title + ": the time axis starts at no valid date: \"" + date + " " + time + "\""));
    if (axis.unit == kMonth || axis.unit == kYear)
        return FailWriting(
            Status::InputFault(title + ": months and years are no units of a calendar axis"));
    axis.date = normal->first;
    axis.time = normal->second;
    return SetAxis(header, std::move(axis));
}

TsqAxis PlainAxis(TsqAxisType type, int unit, double start, int index) {
    TsqAxis axis;
    axis.type = type;
    axis.unit = unit;
    axis.start = start;
    axis.index = index;
    return axis;
}

} // namespace

double MillisecondsInUnit(int unit) {
    double seconds = 0.0;
    return qtyConvertUnit(unit, 1.0, kUnitSecond, &seconds) == 0 ? seconds * 1000.0 : 0.0;
}

int tsqGetTimeAxisType(const TsqHeader* header) {
    return header != nullptr ? header->axis.type : 0;
}

TsqAxis tsqGetTimeAxis(const TsqHeader* header) {
    TsqAxis axis = header != nullptr ? header->axis : TsqAxis();
    if (!axis.IsCalendar()) {
        axis.date = "1900-01-01";
        axis.time = "00:00:00";
    }
    return axis;
}

int tsqGetEqTimeAxis(const TsqHeader* header, int* unit, std::string* unitText, double* start,
                     double* step, int* count, int* index) {
    if (!HasAxis(header, kTsqEqTimeAxis))
        return WrongAxis();
    GiveUnit(header->axis, unit, unitText);
    Give(start, header->axis.start);
    Give(step, header->axis.step);
    Give(count, header->axis.count);
    Give(index, header->axis.index);
    return 0;
}

int tsqGetNeqTimeAxis(const TsqHeader* header, int* unit, std::string* unitText, double* start,
                      double* span, int* count, int* index) {
    if (!HasAxis(header, kTsqNeqTimeAxis))
        return WrongAxis();
    GiveUnit(header->axis, unit, unitText);
    Give(start, header->axis.start);
    Give(span, header->axis.span);
    Give(count, header->axis.count);
    Give(index, header->axis.index);
    return 0;
}

int tsqGetEqCalendarAxis(const TsqHeader* header, std::string* dateText, std::string* timeText,
                         int* unit, std::string* unitText, double* start, double* step, int* count,
                         int* index) {
    if (!HasAxis(header, kTsqEqCalendarAxis))
        return WrongAxis();
    Give(dateText, header->axis.date);
    Give(timeText, header->axis.time);
    GiveUnit(header->axis, unit, unitText);
    Give(start, header->axis.start);
    Give(step, header->axis.step);
    Give(count, header->axis.count);
    Give(index, header->axis.index);
    return 0;
}

int tsqGetNeqCalendarAxis(const TsqHeader* header, std::string* dateText, std::string* timeText,
                          int* unit, std::string* unitText, double* start, double* span, int* count,
                          int* index) {
    if (!HasAxis(header, kTsqNeqCalendarAxis))
        return WrongAxis();
    Give(dateText, header->axis.date);
    Give(timeText, header->axis.time);
    GiveUnit(header->axis, unit, unitText);
    Give(start, header->axis.start);
    Give(span, header->axis.span);
    Give(count, header->axis.count);
    Give(index, header->axis.index);
    return 0;
}

int tsqSetEqTimeAxis(TsqHeader* header, int unit, double start, double step, int index) {
    TsqAxis axis = PlainAxis(kTsqEqTimeAxis, unit, start, index);
    axis.step = step;
    return SetAxis(header, std::move(axis));
}

int tsqSetNeqTimeAxis(TsqHeader* header, int unit, double start, int index) {
    return SetAxis(header, PlainAxis(kTsqNeqTimeAxis, unit, start, index));
}

int tsqSetEqCalendarAxis(TsqHeader* header, const std::string& dateText,
                         const std::string& timeText, int unit, double start, double step,
                         int index) {
    TsqAxis axis = PlainAxis(kTsqEqCalendarAxis, unit, start, index);
    axis.step = step;
    return SetCalendarAxis(header, dateText, timeText, std::move(axis));
}

int tsqSetNeqCalendarAxis(TsqHeader* header, const std::string& dateText,
                          const std::string& timeText, int unit, double start, int index) {
    return SetCalendarAxis(header, dateText, timeText,
                           PlainAxis(kTsqNeqCalendarAxis, unit, start, index));
}

} // namespace ryn
