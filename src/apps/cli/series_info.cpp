#include "apps/cli/series_info.h"

#include <algorithm>
#include <cmath>
#include <limits>
#include <ostream>

#include "apps/cli/date_text.h"
#include "apps/cli/plain_text.h"
#include "apps/cli/text_table.h"
#include "base/number_text.h"
#include "strings/catalogue.h"

namespace ryn::cli {

namespace {

void Extend(ItemExtent& extent, const COleDateTime& date, float value) {
    if (!std::isfinite(value)) {
        ++extent.missingCount;
        return;
    }
    const DatedValue sample{date, value};
    if (extent.valueCount++ == 0) {
        extent.first = sample;
        extent.minimum = sample;
        extent.maximum = sample;
    }
    extent.last = sample;
    if (value < extent.minimum.value)
        extent.minimum = sample;
    if (value > extent.maximum.value)
        extent.maximum = sample;
}

void ExtendTimes(SeriesInfo& info, const COleDateTime& date) {
    if (!info.first.IsValid()) {
        info.first = date;
        info.last = date;
        return;
    }
    if (!IsClearlyBefore(info.last, date))
        ++info.backwardSteps;
    const double longest = (info.gapTo - info.gapFrom).GetTotalDays(); // NaN at the start
    if (!((date - info.last).GetTotalDays() <= longest)) {
        info.gapFrom = info.last;
        info.gapTo = date;
    }
    info.last = date;
}

/// The lengths of the time steps, which tell a regular axis.
class StepLengths {
  public:
    void Add(double time) {
        if (times++ == 0) {
            first = time;
        } else {
            shortest = std::min(shortest, time - last);
            longest = std::max(longest, time - last);
        }
        last = time;
    }
    /// To the millisecond; nothing when they differ, or there are fewer than `least`.
    std::optional<double> Common(int least) const {
        const double tolerance = std::min(0.5, 0.1 * shortest);
        if (times <= least || !(shortest > 0.0) || longest - shortest > tolerance)
            return std::nullopt;
        return std::round((last - first) / (times - 1) * 1e3) / 1e3;
    }

  private:
    int times = 0;
    double first = 0.0;
    double last = 0.0;
    double shortest = std::numeric_limits<double>::infinity();
    double longest = 0.0;
};

std::string_view AxisName(AxisKind kind) {
    switch (kind) {
    case AxisKind::EquidistantRelative:
        return "equidistant relative";
    case AxisKind::NonEquidistantRelative:
        return "non-equidistant relative";
    case AxisKind::EquidistantCalendar:
        return "equidistant calendar";
    case AxisKind::NonEquidistantCalendar:
        return "non-equidistant calendar";
    }
    return {};
}

int AxisTextId(AxisKind kind) {
    return kTextCliAxisEqRelative + static_cast<int>(kind);
}

bool IsEquidistant(AxisKind kind) {
    return kind == AxisKind::EquidistantRelative || kind == AxisKind::EquidistantCalendar;
}

AxisKind Equidistant(AxisKind kind) {
    return kind == AxisKind::NonEquidistantRelative   ? AxisKind::EquidistantRelative
           : kind == AxisKind::NonEquidistantCalendar ? AxisKind::EquidistantCalendar
                                                      : kind;
}

Json JsonOfSample(const DatedValue& sample) {
    if (!sample.date.IsValid())
        return nullptr;
    return {{"date", JsonOf(sample.date)}, {"value", JsonOf(sample.value)}};
}

Json JsonOfItem(const ItemExtent& extent) {
    return {{"name", extent.item.name},
            {"unit", extent.item.unit},
            {"values", extent.valueCount},
            {"missing", extent.missingCount},
            {"first", JsonOfSample(extent.first)},
            {"last", JsonOfSample(extent.last)},
            {"minimum", JsonOfSample(extent.minimum)},
            {"maximum", JsonOfSample(extent.maximum)}};
}

Json JsonOfGap(const SeriesInfo& info) {
    if (!info.gapFrom.IsValid())
        return nullptr;
    // Dates are to the second; their difference would show the rounding of day fractions.
    const double seconds = (info.gapTo - info.gapFrom).GetTotalDays() * 86400.0;
    return {{"from", JsonOf(info.gapFrom)},
            {"to", JsonOf(info.gapTo)},
            {"days", JsonOf(std::round(seconds) / 86400.0)}};
}

std::string TextOf(int id) {
    return std::string(Text(id));
}

std::string GapText(const SeriesInfo& info) {
    return LengthForPeople(info.gapTo - info.gapFrom) + "  (" + DateForPeople(info.gapFrom) +
           " - " + DateForPeople(info.gapTo) + ")";
}

std::string StepText(double seconds) {
    return seconds == std::round(seconds) ? LengthForPeople(COleDateTimeSpan(seconds / 86400.0))
                                          : ShortestText(seconds) + " s";
}

void PrintHead(std::ostream& out, const SeriesInfo& info) {
    TextTable head({Alignment::Left, Alignment::Left});
    if (!info.title.empty())
        head.AddRow({TextOf(kTextCliTitle), info.title});
    head.AddRow({TextOf(kTextCliTimeAxis), TextOf(AxisTextId(info.axis))});
    head.AddRow({TextOf(kTextCliSteps), std::to_string(info.stepCount)});
    if (info.first.IsValid()) {
        head.AddRow({TextOf(kTextCliFirst), DateForPeople(info.first)});
        head.AddRow({TextOf(kTextCliLast), DateForPeople(info.last)});
    }
    if (info.step)
        head.AddRow({TextOf(kTextCliTimeStep), StepText(*info.step)});
    else if (info.gapFrom.IsValid())
        head.AddRow({TextOf(kTextCliLongestGap), GapText(info)});
    head.Print(out);
}

void AddSample(TextTable& table, int labelId, const DatedValue& sample) {
    if (sample.date.IsValid())
        table.AddRow({TextOf(labelId), ShortestText(sample.value), DateForPeople(sample.date)});
}

void PrintItem(std::ostream& out, const ItemExtent& extent) {
    out << '\n' << FormatText(kTextCliItemHeading, extent.item.number, PlainLine(extent.item.name));
    if (!extent.item.unit.empty())
        out << " [" << PlainLine(extent.item.unit) << ']';
    out << '\n';
    if (!extent.item.isPlainSeries) {
        out << "  " << Text(kTextCliSpatialItem) << '\n';
        return;
    }
    TextTable table({Alignment::Left, Alignment::Right, Alignment::Left});
    table.AddRow({TextOf(kTextCliValues), std::to_string(extent.valueCount)});
    if (extent.missingCount > 0)
        table.AddRow({TextOf(kTextCliMissing), std::to_string(extent.missingCount)});
    AddSample(table, kTextCliFirst, extent.first);
    AddSample(table, kTextCliLast, extent.last);
    AddSample(table, kTextCliSmallest, extent.minimum);
    AddSample(table, kTextCliLargest, extent.maximum);
    table.Print(out);
}

} // namespace

Status ReadSeriesInfo(const std::string& path, ProgressPort& progress, SeriesInfo* info) {
    DataFile file;
    if (Status opened = file.Open(path); !opened)
        return opened;
    SeriesInfo read;
    read.title = file.Title();
    read.axis = file.Axis();
    read.stepCount = file.StepCount();
    for (const DataItem& item : file.Items()) {
        ItemExtent extent;
        extent.item = item;
        read.items.push_back(std::move(extent));
    }
    const std::vector<int> numbers = file.PlainItems();
    StepLengths lengths;
    Status walked = file.Walk(numbers, [&](const DataStep& step) {
        ExtendTimes(read, step.date);
        lengths.Add(step.seconds);
        for (std::size_t i = 0; i < numbers.size(); ++i)
            Extend(read.items[static_cast<std::size_t>(numbers[i] - 1)], step.date, step.values[i]);
        constexpr int kStepsBetween = 1 << 16;
        if (step.index % kStepsBetween == 0)
            progress.ShowProgress(step.index, read.stepCount);
        return true;
    });
    read.step = lengths.Common(IsEquidistant(read.axis) ? 1 : 2);
    if (read.step)
        read.axis = Equidistant(read.axis);
    if (walked)
        *info = std::move(read);
    return walked;
}

Json JsonOfSeries(const SeriesInfo& info) {
    Json items = Json::array();
    for (const ItemExtent& extent : info.items)
        items.push_back(JsonOfItem(extent));
    return {
        {"axis", AxisName(info.axis)},   {"step", info.step ? JsonOf(*info.step) : Json(nullptr)},
        {"count", info.stepCount},       {"title", info.title},
        {"first", JsonOf(info.first)},   {"last", JsonOf(info.last)},
        {"longestGap", JsonOfGap(info)}, {"items", std::move(items)}};
}

void PrintSeries(std::ostream& out, const SeriesInfo& info, const std::string& name) {
    out << PlainLine(name) << '\n';
    PrintHead(out, info);
    for (const ItemExtent& extent : info.items)
        PrintItem(out, extent);
}

} // namespace ryn::cli
