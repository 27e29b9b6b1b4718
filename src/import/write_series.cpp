#include "import/write_series.h"

#include "import/unit_text.h"
#include "tsq/tsq.h"
#include "units/units.h"

namespace ryn {

namespace {

constexpr int kEquidistantFile = 1;
constexpr int kNonEquidistantFile = 4;
constexpr int kApplicationVersion = 100;
constexpr int kStatisticsKind = 1;
constexpr int kAxisIndex = 2;

// An equidistant axis needs no times in the file, and tells the reader that nothing is missing.
// Both kinds read back the same moments.
std::optional<Millis> EqualStep(const std::vector<Millis>& times) {
    if (times.size() < 2)
        return std::nullopt;
    const Millis step = times[1] - times[0];
    for (std::size_t i = 2; i < times.size(); ++i)
        if (times[i] - times[i - 1] != step)
            return std::nullopt;
    return step;
}

double Seconds(Millis millis) {
    return static_cast<double>(millis) / static_cast<double>(kMillisPerSecond);
}

/// The whole second at or before a moment.
Millis WholeSecond(Millis moment) {
    const Millis rest = (moment % kMillisPerSecond + kMillisPerSecond) % kMillisPerSecond;
    return moment - rest;
}

/// Sets the axis; *origin is the moment from which the file counts its times.
int SetAxis(const TableSamples& samples, std::optional<Millis> step, TsqHeader* header,
            Millis* origin) {
    if (samples.isRelative) {
        *origin = 0;
        if (!step)
            return tsqSetNeqTimeAxis(header, kUnitSecond, 0.0, kAxisIndex);
        return tsqSetEqTimeAxis(header, kUnitSecond, Seconds(samples.times[0]), Seconds(*step),
                                kAxisIndex);
    }
    // The axis's date and time have whole seconds; the rest goes into its start, or into the times.
    *origin = WholeSecond(samples.times[0]);
    const std::string date = DateText(*origin);
    const std::string clock = ClockText(*origin);
    if (!step)
        return tsqSetNeqCalendarAxis(header, date, clock, kUnitSecond, 0.0, kAxisIndex);
    return tsqSetEqCalendarAxis(header, date, clock, kUnitSecond,
                                Seconds(samples.times[0] - *origin), Seconds(*step), kAxisIndex);
}

/// Name, unit and the kind of quantity that the unit suggests.
int DescribeItems(TsqHeader* header, ImportReport* report) {
    int result = 0;
    for (std::size_t i = 0; i < report->items.size() && result == 0; ++i) {
        ImportedItem& item = report->items[i];
        // A unit that the library does not know keeps its text.
        const int unit = UnitOfText(PlainUnit(item.unit));
        const int type = ItemTypeOfUnit(unit);
        item.itemType = ItemTypeText(type);
        TsqItem* const target = tsqItemD(header, static_cast<int>(i) + 1);
        result = tsqSetItemInfo(header, target, type, item.name, unit, kTsqDataTypeFloat);
        if (result == 0)
            result = tsqSetItemAxisEqD0(target, kUnitUndefined);
    }
    return result;
}

/// All items of a step, then the next step, as the store wants them.
int WriteSteps(const TableSamples& samples, Millis origin, TsqHeader* header, TsqFile* file) {
    int result = 0;
    for (std::size_t i = 0; i < samples.Count() && result == 0; ++i) {
        // From integers of milliseconds: a sum of steps would drift.
        const double time = Seconds(samples.times[i] - origin);
        for (const std::vector<float>& item : samples.values)
            result = result == 0 ? tsqWriteItemTimeStep(header, file, time, &item[i]) : result;
    }
    return result;
}

/// The store's own words, which name the file and the reason.
Status LastError(const std::string& path) {
    const Status error = tsqTakeError();
    return error ? Status::SystemFault(path + ": the data file could not be written") : error;
}

} // namespace

Status WriteSeries(const std::string& path, const std::string& title, const TableSamples& samples,
                   ImportReport* report) {
    const std::optional<Millis> step = EqualStep(samples.times);
    TsqHeaderHandle header;
    TsqFileHandle file;
    Millis origin = 0;
    int result = tsqHeaderCreate(step ? kEquidistantFile : kNonEquidistantFile, title, "RYNEditor",
                                 kApplicationVersion, static_cast<int>(samples.values.size()),
                                 kStatisticsKind, &header);
    if (result == 0)
        result = tsqSetDataType(header.get(), kTsqDataTypeFloat);
    if (result == 0)
        result = SetAxis(samples, step, header.get(), &origin);
    if (result == 0)
        result = DescribeItems(header.get(), report);
    if (result == 0)
        result = tsqFileCreate(path, header.get(), &file);
    if (result == 0)
        result = WriteSteps(samples, origin, header.get(), file.get());
    // Only a file that was written whole is closed, which gives it its name; otherwise it vanishes
    // with its handle.
    if (result == 0)
        result = tsqFileClose(header.get(), &file);
    if (result != 0)
        return LastError(path);
    report->samples = static_cast<long>(samples.Count());
    report->isRelative = samples.isRelative;
    report->first = samples.times.front();
    report->last = samples.times.back();
    report->equalStep = step;
    return Status::Ok();
}

} // namespace ryn
