#include "series/tsq_values.h"

#include <algorithm>
#include <array>
#include <charconv>
#include <cmath>
#include <cstdint>
#include <new>
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
constexpr double kSecondsGrace = 1e-6;

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
    const double whole =
        std::fabs(seconds - nearest) < kSecondsGrace ? nearest : std::trunc(seconds);
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

/// Days from the start date to a step of an equidistant axis, whose stored time is not looked at.
COleDateTimeSpan EquidistantSpan(int index, double stepSeconds) {
    const double seconds = index * stepSeconds + kSecondsGrace;
    const double days = Floor(seconds / kSecondsPerDay);
    const auto rest = static_cast<int>(seconds - days * kSecondsPerDay);
    return {static_cast<long>(days), rest / 3600, rest / 60 % 60, rest % 60};
}

/// What a summary keeps of an item.
struct Extent {
    STSItem minimum{{}, CTsqValues::kHighestValue, 0};
    STSItem maximum{{}, -CTsqValues::kHighestValue, 0};
    STSItem first;
    STSItem last;
};

Status OutOfMemory(const std::string& path) {
    return Status::SystemFault(path + ": there is not enough memory for the series");
}

Status TimeOutOfCalendar(const std::string& path) {
    return Status::InputFault(path + ": a time step lies outside the years 100 to 9999");
}

} // namespace

/// A data file opened at one item, with its time axis understood.
struct CTsqValues::OpenItem {
    TsqHeaderHandle header;
    TsqFileHandle file;
    TsqAxis axis;
    double startCount = 0.0; // the start date's linear count
    double toSecondsFactor = 1.0;
    double toSecondsOffset = 0.0;
    int itemIndex = 0;
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

    /// Whole seconds of a time; one that conversions left a hair short of a second counts as it.
    double WholeSeconds(double time) const {
        return Floor(time * toSecondsFactor + toSecondsOffset + kSecondsGrace);
    }
    COleDateTime DateByFile(double time) const {
        return COleDateTime::FromLinearCount(startCount + WholeSeconds(time) / kSecondsPerDay);
    }
    COleDateTime DateByStep(int index) const {
        return COleDateTime::FromLinearCount(
            startCount + EquidistantSpan(index, axis.step * toSecondsFactor).GetTotalDays());
    }

    /// Appends the samples of consecutive steps, from `first` on.
    void AppendSamples(int first, const TsqBlock& block, SampleArray* samples) const;
    Status UnderstandAxis(const std::string& path);
    Status FindItem(const std::string& path);
    /// The time of a step by the file, in the axis's unit.
    double TimeOf(const TsqBlock& block, int first, int i) const {
        return block.times != nullptr ? block.times[i] : (first + i) * axis.step;
    }
    /// Calls use(first step, block) for each block of time steps, until it gives false.
    template <typename Use>
    bool Walk(Use use);
};

Status CTsqValues::OpenItem::UnderstandAxis(const std::string& path) {
    axis = tsqGetTimeAxis(header.get());
    if (axis.type == 0)
        return Status::InputFault(path + ": the time axis cannot be read");
    double hours = 0.0;
    if (qtyConvertUnit(axis.unit, axis.start, kUnitHour, &hours) != 0 ||
        !UnitConversion(axis.unit, kUnitSecond, &toSecondsFactor, &toSecondsOffset))
        return Status::InputFault(path + ": the unit of the time axis is no unit of time");
    constexpr double kLongestOffset = 10000.0 * 366 * 24; // hours: more than the calendar has
    if (!(std::fabs(hours) < kLongestOffset))
        return Status::InputFault(path + ": the start of the time axis is out of range");
    if (axis.IsEquidistant() &&
        !(std::fabs(axis.step * toSecondsFactor) * axis.count < 3600.0 * kLongestOffset))
        return Status::InputFault(path + ": the step of the time axis is out of range");
    const COleDateTime startDate = ParseDateAndTime(axis.date + " " + axis.time) + StartSpan(hours);
    startCount = startDate.LinearCount();
    if (!startDate.IsValid())
        return Status::InputFault(path + ": the time axis starts at no valid date: \"" + axis.date +
                                  " " + axis.time + "\"");
    return Status::Ok();
}

Status CTsqValues::OpenItem::FindItem(const std::string& path) {
    TsqItem* const item = tsqItemD(header.get(), itemIndex + 1);
    if (item == nullptr)
        return Status::InputFault(path + ": there is no item " + std::to_string(itemIndex + 1) +
                                  "; the file has " +
                                  std::to_string(tsqGetNoOfItems(header.get())));
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

// Steps of whole days or hours, which most long series have, need no seconds: the sums are those
// that DateByStep makes, and these loops are most of the reading of a series in memory.
void CTsqValues::OpenItem::AppendSamples(int first, const TsqBlock& block,
                                         SampleArray* samples) const {
    constexpr double kLongest = 1e6;
    const double hours = axis.step * toSecondsFactor / 3600.0;
    const bool hasWholeHours =
        axis.IsEquidistant() && hours == std::trunc(hours) && hours > 0.0 && hours < kLongest;
    const auto append = [&](int i, const COleDateTime& date) {
        samples->push_back({date, static_cast<double>(block.values[i]), 0});
    };
    const auto appendAt = [&](int i, double days) {
        append(i, COleDateTime::FromLinearCount(startCount + days));
    };
    if (hasWholeHours && std::fmod(hours, 24.0) == 0.0) {
        for (int i = 0; i < block.count; ++i)
            appendAt(i, (first + i) * (hours / 24.0));
    } else if (hasWholeHours) {
        for (int i = 0; i < block.count; ++i) {
            const std::int64_t passed = static_cast<std::int64_t>(hours) * (first + i);
            const std::int64_t days = passed / 24;
            appendAt(i, static_cast<double>(days) + static_cast<double>(passed - days * 24) / 24.0);
        }
    } else {
        for (int i = 0; i < block.count; ++i)
            append(i, axis.IsEquidistant() ? DateByStep(first + i) : DateByFile(block.times[i]));
    }
}

template <typename Use>
bool CTsqValues::OpenItem::Walk(Use use) {
    TsqBlock block;
    for (int first = 0; first < axis.count; first += block.count) {
        if (tsqReadItemBlock(header.get(), file.get(), itemIndex + 1, &block) != 0 ||
            block.count == 0)
            return false;
        if (!use(first, block))
            return false;
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
    axisKind = AxisKindOf(open.axis.type);
    count = open.axis.count;
    itemType = open.itemType;
    itemUnit = open.itemUnit;
    itemName = open.itemName;
    timeUnit = open.axis.unit;
}

bool CTsqValues::ReadSummary(const std::string& path, int itemIndex) try {
    Extent extent;
    minimum = extent.minimum;
    maximum = extent.maximum;
    OpenItem open;
    readError = Open(path, itemIndex, &open);
    if (!readError)
        return false;
    const auto sampleAt = [&open](const TsqBlock& block, int step, int i) {
        return STSItem{open.DateByFile(open.TimeOf(block, step, i)),
                       static_cast<double>(block.values[i]), 0};
    };
    const bool whole = open.Walk([&](int step, const TsqBlock& block) {
        if (step == 0)
            extent.first = sampleAt(block, step, 0);
        for (int i = 0; i < block.count; ++i) {
            // Strictly, so that of several equal extremes the earliest stands.
            if (extent.minimum.value > static_cast<double>(block.values[i]))
                extent.minimum = sampleAt(block, step, i);
            if (static_cast<double>(block.values[i]) > extent.maximum.value)
                extent.maximum = sampleAt(block, step, i);
        }
        extent.last = sampleAt(block, step, block.count - 1);
        return true;
    });
    const bool dated =
        open.axis.count == 0 || (extent.first.date.IsValid() && extent.last.date.IsValid());
    if (!whole || !dated) {
        readError = whole ? TimeOutOfCalendar(path) : tsqTakeError();
        return false;
    }
    TakeOver(open);
    minimum = extent.minimum;
    maximum = extent.maximum;
    first = extent.first;
    last = extent.last;
    return true;
} catch (const std::bad_alloc&) {
    readError = OutOfMemory(path);
    return false;
}

bool CTsqValues::ReadSeries(const std::string& path, int itemIndex) try {
    OpenItem open;
    readError = Open(path, itemIndex, &open);
    if (!readError)
        return false;
    SampleArray read;
    read.reserve(static_cast<std::size_t>(open.axis.count));
    const bool whole = open.Walk([&](int step, const TsqBlock& block) {
        ports->progress->ShowProgress(step, open.axis.count);
        open.AppendSamples(step, block, &read);
        return true;
    });
    const auto isDated = [](const STSItem& sample) { return sample.date.IsValid(); };
    const bool datesValid =
        read.empty() || (open.axis.IsEquidistant() ? isDated(read.front()) && isDated(read.back())
                                                   : std::ranges::all_of(read, isDated));
    ports->progress->ShowProgress(open.axis.count, open.axis.count);
    if (!whole || !datesValid) {
        readError = whole ? TimeOutOfCalendar(path) : tsqTakeError();
        return false;
    }
    TakeOver(open);
    title = tsqGetFileTitle(open.header.get());
    samples = std::move(read);
    return true;
} catch (const std::bad_alloc&) {
    readError = OutOfMemory(path);
    return false;
}

void CTsqValues::ClearSeries() {
    samples = SampleArray();
    count = 0;
}

std::vector<const STSItem*> CTsqValues::Select(SelectionRules& rules, bool silent,
                                               ExtractionReport* report) {
    if (rules.SelectionMethod != kSelectPartialDurations) {
        AnnualMaxima maxima = SelectAnnualMaxima(samples, rules);
        report->missingYears = std::move(maxima.missingYears);
        if (!report->missingYears.empty())
            ports->missingYears->ShowMissingYears(report->missingYears);
        return std::move(maxima.selection);
    }
    PartialDurations peaks = SelectPartialDurations(samples, rules);
    report->parametersChanged = peaks.fewerThanRequired;
    if (peaks.fewerThanRequired) {
        rules.AvgAnNum = peaks.AvgAnNum;
        rules.Threshold = peaks.Threshold;
        if (!silent)
            ports->messages->Show(MessageKind::Warning,
                                  std::string(Text(kTextPeaksFewerThanRequired)));
    }
    return std::move(peaks.selection);
}

ExtractionReport CTsqValues::ExtractSeries(const std::string& outputPath, SelectionRules& rules,
                                           bool silent) {
    ExtractionReport report;
    try {
        const std::vector<const STSItem*> selection = Select(rules, silent, &report);
        report.selected = static_cast<int>(selection.size());
        if (!selection.empty()) {
            report.first = selection.front()->date;
            report.last = selection.back()->date;
        }
        const bool hasCalendarAxis = axisKind == AxisKind::EquidistantCalendar ||
                                     axisKind == AxisKind::NonEquidistantCalendar;
        report.written = WriteSeriesFile(
            outputPath, {title, itemName, itemType, itemUnit, hasCalendarAxis, durability},
            selection, *ports);
    } catch (const std::bad_alloc&) {
        report.written = OutOfMemory(outputPath);
    }
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
