#include "import/netcdf_series.h"

#include <algorithm>
#include <cmath>

#include "base/number_text.h"
#include "import/table_text.h"
#include "tsq/tsq.h"
#include "units/units.h"

namespace ryn {

namespace {

struct Axis {
    bool isRelative = false;
    Millis origin = 0;
    double millisInUnit = 0.0;
    int count = 0;
};

Status TakeError(const std::string& path) {
    const Status error = tsqTakeError();
    return error ? Status::InputFault(path + ": cannot be read") : error;
}

/// The axis, of whichever of the four types it is.
bool ReadAxis(const TsqHeader* header, Axis* axis) {
    std::string date;
    std::string clock;
    int unit = kUnitUndefined;
    double start = 0.0;
    // Files of other programs have a non-equidistant axis in seconds; the other types come from
    // files of this system, which are taken as well.
    switch (tsqGetTimeAxisType(header)) {
    case kTsqEqTimeAxis:
        tsqGetEqTimeAxis(header, &unit, nullptr, &start, nullptr, &axis->count, nullptr);
        axis->isRelative = true;
        break;
    case kTsqNeqTimeAxis:
        tsqGetNeqTimeAxis(header, &unit, nullptr, &start, nullptr, &axis->count, nullptr);
        axis->isRelative = true;
        break;
    case kTsqEqCalendarAxis:
        tsqGetEqCalendarAxis(header, &date, &clock, &unit, nullptr, &start, nullptr, &axis->count,
                             nullptr);
        break;
    default:
        tsqGetNeqCalendarAxis(header, &date, &clock, &unit, nullptr, &start, nullptr, &axis->count,
                              nullptr);
    }
    double seconds = 0.0;
    if (qtyConvertUnit(unit, 1.0, kUnitSecond, &seconds) != 0)
        return false;
    axis->millisInUnit = seconds * static_cast<double>(kMillisPerSecond);
    TimeParts parts;
    if (!axis->isRelative &&
        (ParseDate(date + " " + clock, DateForm::YearMonthDay, &parts) != TimeResult::Ok ||
         MomentOf(parts, {}, &axis->origin) != TimeResult::Ok))
        return false;
    // The times of the steps count from the axis's start, which may lie behind its date.
    axis->origin += std::llround(start * axis->millisInUnit);
    return true;
}

struct ItemInfo {
    std::string name;
    std::string unit;
    std::size_t size = 0;
};

ItemInfo InfoOf(TsqHeader* header, int number) {
    ItemInfo info;
    const TsqItem* item = tsqItemD(header, number);
    tsqGetItemInfo(item, nullptr, nullptr, &info.name, nullptr, &info.unit, nullptr);
    info.size = tsqGetItemSize(item);
    return info;
}

/// By number from 1, else by name in any case.
std::optional<int> FindItem(TsqHeader* header, const std::string& nameOrNumber) {
    const int count = tsqGetNoOfItems(header);
    const std::optional<int> number = ParseInt(nameOrNumber);
    if (number && *number >= 1 && *number <= count)
        return number;
    for (int i = 1; i <= count; ++i)
        if (Lowercase(InfoOf(header, i).name) == Lowercase(nameOrNumber))
            return i;
    return std::nullopt;
}

std::string ItemTitle(TsqHeader* header, int number) {
    return std::to_string(number) + " " + Quoted(InfoOf(header, number).name);
}

Status ChooseNamed(const std::string& path, const std::vector<std::string>& names,
                   TsqHeader* header, std::vector<int>* chosen) {
    for (const std::string& name : names) {
        const std::optional<int> item = FindItem(header, name);
        if (!item)
            return Status::InputFault(path + ": --item " + Quoted(name) + ": no such item");
        if (InfoOf(header, *item).size != 1)
            return Status::InputFault(
                path + ": item " + ItemTitle(header, *item) +
                " has values at many places; import takes series of one place");
        if (std::find(chosen->begin(), chosen->end(), *item) != chosen->end())
            return Status::InputFault(path + ": --item " + Quoted(name) + " names an item twice");
        chosen->push_back(*item);
    }
    return Status::Ok();
}

Status ChooseItems(const std::string& path, const ImportSettings& settings, TsqHeader* header,
                   std::vector<int>* chosen, ImportReport* report) {
    if (!settings.itemColumns.empty())
        return ChooseNamed(path, settings.itemColumns, header, chosen);
    // A file of one station often has its coordinates beside the series; what has values at many
    // places is passed over as long as one series is left.
    for (int i = 1; i <= tsqGetNoOfItems(header); ++i) {
        if (InfoOf(header, i).size != 1)
            continue;
        if (chosen->empty())
            chosen->push_back(i);
        else
            report->otherItems.push_back(ItemTitle(header, i));
    }
    if (chosen->empty())
        return Status::InputFault(path + ": every item has values at many places (a grid, or "
                                         "stations); import takes series of one place");
    return Status::Ok();
}

/// Codes that the file does not mark itself; what it marks arrives as NaN.
void ApplyGivenCodes(const MissingRules& missing, float* value, ImportReport* report) {
    if (std::find(missing.numbers.begin(), missing.numbers.end(), *value) == missing.numbers.end())
        return;
    const std::string text = ShortestText(*value);
    const auto known =
        std::find_if(report->missing.begin(), report->missing.end(),
                     [&text](const OccurredText& code) { return code.text == text; });
    if (known != report->missing.end())
        ++known->count;
    else
        report->missing.push_back({text, 1, {}});
    *value = kNoValue;
}

/// Step by step, which the store turns into blocks.
Status ReadSteps(const std::string& path, const Axis& axis, const std::vector<int>& chosen,
                 const ImportSettings& settings, TsqHeader* header, TsqFile* file,
                 TableSamples* samples, ImportReport* report) {
    samples->isRelative = axis.isRelative;
    samples->values.resize(chosen.size());
    const int items = tsqGetNoOfItems(header);
    if (tsqFindBlockDynamic(header, file) != 0 && axis.count > 0)
        return TakeError(path);
    for (int step = 0; step < axis.count; ++step) {
        double time = 0.0;
        for (int item = 1; item <= items; ++item) {
            const auto at = std::find(chosen.begin(), chosen.end(), item);
            float value = 0.0F;
            // Items that are not asked for are passed over without being loaded.
            if (tsqReadItemTimeStep(header, file, &time, at == chosen.end() ? nullptr : &value) !=
                0)
                return TakeError(path);
            if (at == chosen.end())
                continue;
            ApplyGivenCodes(settings.missing, &value, report);
            samples->values[static_cast<std::size_t>(at - chosen.begin())].push_back(value);
        }
        samples->times.push_back(axis.origin + std::llround(time * axis.millisInUnit));
        // Messages name steps where those about tables name lines.
        samples->lines.push_back(static_cast<std::uint32_t>(step + 1));
    }
    report->rowsRead = axis.count;
    return Status::Ok();
}

} // namespace

bool IsNetcdf(std::string_view start) {
    // A table may begin with the letters CDF too; the version behind them is no character.
    constexpr std::string_view kClassic = "CDF";
    constexpr std::string_view kHdf5 = "\x89HDF\r\n\x1A\n";
    return (start.substr(0, kClassic.size()) == kClassic && start.size() > 3 && start[3] >= 1 &&
            start[3] <= 5) ||
           start.substr(0, kHdf5.size()) == kHdf5;
}

Status ReadNetcdfSeries(const std::string& path, const ImportSettings& settings,
                        TableSamples* samples, ImportReport* report) {
    report->form = "netCDF file";
    TsqHeaderHandle header;
    TsqFileHandle file;
    // In any order: sorting is the user's choice here as for tables, and the fault then names the
    // steps.
    if (tsqFileReadUnordered(path, &header, &file) != 0)
        return TakeError(path);
    Axis axis;
    if (!ReadAxis(header.get(), &axis))
        return Status::InputFault(path + ": its time axis cannot be read");
    std::vector<int> chosen;
    Status status = ChooseItems(path, settings, header.get(), &chosen, report);
    if (!status)
        return status;
    for (const int item : chosen) {
        const ItemInfo info = InfoOf(header.get(), item);
        report->items.push_back({ItemTitle(header.get(), item), info.name, info.unit, {}});
    }
    status = ReadSteps(path, axis, chosen, settings, header.get(), file.get(), samples, report);
    return status;
}

} // namespace ryn
