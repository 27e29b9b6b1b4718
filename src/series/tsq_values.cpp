#include "series/tsq_values.h"

#include <array>
#include <charconv>
#include <cmath>
#include <limits>
#include <string_view>

#include "series/annual_maxima.h"
#include "series/partial_durations.h"
#include "series/series_file.h"
#include "strings/catalogue.h"
#include "tsq/tsq.h"
#include "units/units.h"

namespace ryn {

namespace {

constexpr double kSecondsPerDay = 86400.0;

/// Reads "%d-%d-%d %d:%d:%d"; an invalid date when the text is none.
COleDateTime ParseDateAndTime(std::string_view text) {
    constexpr std::string_view kSeparators = "-- ::";
    std::array<int, 6> fields{};
    const char* place = text.data();
    const char* const end = text.data() + text.size();
    for (std::size_t i = 0; i < fields.size(); ++i) {
        if (i > 0 && (place == end || *place++ != kSeparators[i - 1]))
            return {};
        const auto [stop, error] = std::from_chars(place, end, fields[i]);
        if (error != std::errc())
            return {};
        place = stop;
    }
    return {fields[0], fields[1], fields[2], fields[3], fields[4], fields[5]};
}

/// The axis's start offset as days, hours, minutes and seconds, each cut to an integer. A number a
/// hair below a whole second, as the conversion to hours leaves it, counts as that second.
COleDateTimeSpan StartSpan(double hours) {
    const double seconds = hours * 3600.0;
    const double nearest = std::round(seconds);
    const double whole = std::fabs(seconds - nearest) < 1e-6 ? nearest : std::trunc(seconds);
    const double days = std::trunc(whole / kSecondsPerDay);
    const auto rest = static_cast<int>(whole - days * kSecondsPerDay);
    return {static_cast<long>(days), rest / 3600, rest / 60 % 60, rest % 60};
}

/// std::floor without its call, which this loop's speed hangs on; the same for every number below
/// 2^62, and beyond it a date is out of range anyway.
double Floor(double value) {
    if (!(std::fabs(value) < 0x1p62))
        return value;
    const auto whole = static_cast<double>(static_cast<long long>(value));
    return whole > value ? whole - 1.0 : whole;
}

struct Axis {
    AxisKind kind = AxisKind::EquidistantRelative;
    std::string date = "1900-01-01"; // where a relative axis counts from
    std::string time = "00:00:00";
    int unit = 0;
    double start = 0.0;
    double step = 0.0; // of an equidistant axis
    int count = 0;

    bool IsEquidistant() const {
        return kind == AxisKind::EquidistantRelative || kind == AxisKind::EquidistantCalendar;
    }
};

bool ReadAxis(const TsqHeader* header, Axis* axis) {
    switch (tsqGetTimeAxisType(header)) {
    case kTsqEqTimeAxis:
        axis->kind = AxisKind::EquidistantRelative;
        return tsqGetEqTimeAxis(header, &axis->unit, nullptr, &axis->start, &axis->step,
                                &axis->count, nullptr) == 0;
    case kTsqNeqTimeAxis:
        axis->kind = AxisKind::NonEquidistantRelative;
        return tsqGetNeqTimeAxis(header, &axis->unit, nullptr, &axis->start, nullptr, &axis->count,
                                 nullptr) == 0;
    case kTsqEqCalendarAxis:
        axis->kind = AxisKind::EquidistantCalendar;
        return tsqGetEqCalendarAxis(header, &axis->date, &axis->time, &axis->unit, nullptr,
                                    &axis->start, &axis->step, &axis->count, nullptr) == 0;
    case kTsqNeqCalendarAxis:
        axis->kind = AxisKind::NonEquidistantCalendar;
        return tsqGetNeqCalendarAxis(header, &axis->date, &axis->time, &axis->unit, nullptr,
                                     &axis->start, nullptr, &axis->count, nullptr) == 0;
    default:
        return false;
    }
}

/// Days from the start date to a step of an equidistant axis, whose stored time is not looked at.
COleDateTimeSpan EquidistantSpan(int index, double stepSeconds) {
    const double seconds = index * stepSeconds;
    const double days = Floor(seconds / kSecondsPerDay);
    const auto rest = static_cast<int>(seconds - days * kSecondsPerDay);
    return {static_cast<long>(days), rest / 3600, rest / 60 % 60, rest % 60};
}

Status TimeOutOfCalendar(const std::string& path) {
    return Status::InputFault(path + ": a time step lies outside the years 100 to 9999");
}

} // namespace

/// A data file opened at one item, with its time axis understood.
struct CTsqValues::OpenItem {
    TsqHeaderHandle header;
    TsqFileHandle file;
    Axis axis;
    double startCount = 0.0; // the start date's linear count
    double toSecondsFactor = 1.0;
    double toSecondsOffset = 0.0;
    int itemIndex = 0;
    int itemCount = 0;
    int itemType = 0;
    int itemUnit = 0;
    std::string itemName;

    OpenItem() = default;
    OpenItem(const OpenItem&) = delete;
    OpenItem& operator=(const OpenItem&) = delete;
    ~OpenItem() {
        tsqFileClose(header.get(), &file);
        tsqHeaderDestroy(&header);
    }

    double Seconds(double time) const { return time * toSecondsFactor + toSecondsOffset; }
    COleDateTime DateByFile(double time) const {
        return COleDateTime::FromLinearCount(startCount + Floor(Seconds(time)) / kSecondsPerDay);
    }
    COleDateTime DateByStep(int index) const {
        return COleDateTime::FromLinearCount(
            startCount + EquidistantSpan(index, axis.step * toSecondsFactor).GetTotalDays());
    }

    Status UnderstandAxis(const std::string& path);
    Status FindItem(const std::string& path);
    /// Calls use(index, time, value) for each time step.
    template <typename Use>
    bool Walk(Use use);
};

Status CTsqValues::OpenItem::UnderstandAxis(const std::string& path) {
    if (!ReadAxis(header.get(), &axis))
        return Status::InputFault(path + ": the time axis cannot be read");
    double hours = 0.0;
    if (qtyConvertUnit(axis.unit, axis.start, kUnitHour, &hours) != 0 ||
        !UnitConversion(axis.unit, kUnitSecond, &toSecondsFactor, &toSecondsOffset))
        return Status::InputFault(path + ": the unit of the time axis is no unit of time");
    constexpr double kLongestOffset = 9000.0 * 366 * 24; // hours: the length of the calendar
    if (!(std::fabs(hours) < kLongestOffset))
        return Status::InputFault(path + ": the start of the time axis is out of range");
    if (axis.IsEquidistant() &&
        !(std::fabs(Seconds(axis.step)) * axis.count < 3600.0 * kLongestOffset))
        return Status::InputFault(path + ": the step of the time axis is out of range");
    const COleDateTime startDate = ParseDateAndTime(axis.date + " " + axis.time) + StartSpan(hours);
    startCount = startDate.LinearCount();
    if (!startDate.IsValid())
        return Status::InputFault(path + ": the time axis starts at no valid date: \"" + axis.date +
                                  " " + axis.time + "\"");
    return Status::Ok();
}

Status CTsqValues::OpenItem::FindItem(const std::string& path) {
    itemCount = tsqGetNoOfItems(header.get());
    TsqItem* const item = tsqItemD(header.get(), itemIndex + 1);
    if (item == nullptr)
        return Status::InputFault(path + ": there is no item " + std::to_string(itemIndex + 1) +
                                  "; the file has " + std::to_string(itemCount));
    if (tsqGetItemDimensions(item) != 0)
        return Status::InputFault(path + ": item " + std::to_string(itemIndex + 1) +
                                  " is no plain series: it has spatial dimensions");
    tsqGetItemInfo(item, &itemType, nullptr, &itemName, &itemUnit, nullptr, nullptr);
    int missing = 0;
    if (tsqCountMissing(header.get(), file.get(), itemIndex + 1, &missing) != 0)
        return Status::InputFault(path + ": " + tsqTakeError().Text());
    if (missing != 0)
        return Status::InputFault(path + ": item " + std::to_string(itemIndex + 1) + " has " +
                                  std::to_string(missing) +
                                  " missing values; import the file to leave them out");
    if (tsqFindBlockDynamic(header.get(), file.get()) != 0)
        return tsqTakeError();
    return Status::Ok();
}

template <typename Use>
bool CTsqValues::OpenItem::Walk(Use use) {
    for (int step = 0; step < axis.count; ++step) {
        for (int skipped = 0; skipped < itemIndex; ++skipped)
            if (tsqReadItemTimeStep(header.get(), file.get(), nullptr, nullptr) != 0)
                return false;
        double time = 0.0;
        float value = 0.0F;
        if (tsqReadItemTimeStep(header.get(), file.get(), &time, &value) != 0)
            return false;
        for (int skipped = itemIndex + 1; skipped < itemCount; ++skipped)
            if (tsqReadItemTimeStep(header.get(), file.get(), nullptr, nullptr) != 0)
                return false;
        use(step, time, static_cast<double>(value));
    }
    return true;
}

Status CTsqValues::Open(const std::string& path, int itemIndex, OpenItem* open) const {
    if (tsqFileRead(path, &open->header, &open->file) != 0)
        return tsqTakeError();
    open->itemIndex = itemIndex;
    if (Status status = open->UnderstandAxis(path); !status)
        return status;
    return open->FindItem(path);
}

void CTsqValues::TakeOver(const OpenItem& open) {
    axisKind = open.axis.kind;
    count = open.axis.count;
    itemType = open.itemType;
    itemUnit = open.itemUnit;
    itemName = open.itemName;
    timeUnit = open.axis.unit;
}

bool CTsqValues::ReadSummary(const std::string& path, int itemIndex) {
    const STSItem lowest{{}, kHighestValue, 0};
    const STSItem highest{{}, -kHighestValue, 0};
    minimum = lowest;
    maximum = highest;
    OpenItem open;
    readError = Open(path, itemIndex, &open);
    if (!readError)
        return false;
    STSItem smallest = lowest;
    STSItem largest = highest;
    STSItem firstSample;
    STSItem lastSample;
    const bool whole = open.Walk([&](int step, double time, double value) {
        if (step == 0)
            firstSample = {open.DateByFile(time), value, 0};
        if (step == open.axis.count - 1)
            lastSample = {open.DateByFile(time), value, 0};
        if (smallest.value > value)
            smallest = {open.DateByFile(time), value, 0};
        if (value > largest.value)
            largest = {open.DateByFile(time), value, 0};
    });
    if (!whole) {
        readError = tsqTakeError();
        return false;
    }
    if (open.axis.count > 0 && !(firstSample.date.IsValid() && lastSample.date.IsValid())) {
        readError = TimeOutOfCalendar(path);
        return false;
    }
    TakeOver(open);
    minimum = smallest;
    maximum = largest;
    first = firstSample;
    last = lastSample;
    return true;
}

bool CTsqValues::ReadSeries(const std::string& path, int itemIndex) {
    OpenItem open;
    readError = Open(path, itemIndex, &open);
    if (!readError)
        return false;
    SampleArray read;
    read.reserve(static_cast<std::size_t>(open.axis.count));
    const bool equidistant = open.axis.IsEquidistant();
    bool datesValid = true;
    const bool whole = open.Walk([&](int step, double time, double value) {
        const COleDateTime date = equidistant ? open.DateByStep(step) : open.DateByFile(time);
        datesValid = datesValid && date.IsValid();
        read.push_back({date, value, 0});
    });
    if (!whole || !datesValid) {
        readError = whole ? TimeOutOfCalendar(path) : tsqTakeError();
        return false;
    }
    TakeOver(open);
    title = tsqGetFileTitle(open.header.get());
    samples = std::move(read);
    return true;
}

void CTsqValues::ClearSeries() {
    samples = SampleArray();
    count = 0;
}

ExtractionReport CTsqValues::ExtractSeries(const std::string& outputPath, SelectionRules& rules,
                                           bool silent) {
    ExtractionReport report;
    std::vector<const STSItem*> selection;
    if (rules.SelectionMethod == kSelectAnnualMaxima) {
        AnnualMaxima maxima = SelectAnnualMaxima(samples, rules);
        selection = std::move(maxima.selection);
        report.missingYears = std::move(maxima.missingYears);
        if (!report.missingYears.empty())
            ports->missingYears->ShowMissingYears(report.missingYears);
    } else {
        PartialDurations peaks = SelectPartialDurations(samples, rules);
        selection = std::move(peaks.selection);
        report.parametersChanged = peaks.fewerThanRequired;
        if (peaks.fewerThanRequired) {
            rules.AvgAnNum = peaks.AvgAnNum;
            rules.Threshold = peaks.Threshold;
            if (!silent)
                ports->messages->Show(MessageKind::Warning,
                                      std::string(Text(kTextPeaksFewerThanRequired)));
        }
    }
    report.selected = static_cast<int>(selection.size());
    if (!selection.empty()) {
        report.first = selection.front()->date;
        report.last = selection.back()->date;
    }
    const SeriesFileContent content{title, itemName, itemType, itemUnit,
                                    axisKind == AxisKind::EquidistantCalendar ||
                                        axisKind == AxisKind::NonEquidistantCalendar};
    report.written = WriteSeriesFile(outputPath, content, selection, *ports);
    return report;
}

void CTsqValues::WriteExtremeValueSection(
    KvfTree* file, const std::function<int(const COleDateTime&)>& subsampleOf) const {
    kvfAddSection(file, "ExtremeValueSection");
    kvfPutParam(file, "NoOfItems", static_cast<int>(samples.size()));
    kvfAddKeyword(file, "ExtremeValues");
    for (const STSItem& sample : samples)
        kvfAddFloat(file, static_cast<float>(sample.value));
    kvfAddKeyword(file, "SampleNo");
    for (const STSItem& sample : samples)
        kvfAddInt(file, subsampleOf(sample.date));
    kvfEndSection(file);
}

} // namespace ryn
