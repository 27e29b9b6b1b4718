#include "import/import.h"

#include <array>
#include <filesystem>
#include <system_error>

#include "base/path_parts.h"
#include "import/dif_table.h"
#include "import/guess_layout.h"
#include "import/item_columns.h"
#include "import/missing_codes.h"
#include "import/netcdf_series.h"
#include "import/read_rows.h"
#include "import/sample_order.h"
#include "import/table_text.h"
#include "import/watched_source.h"
#include "import/write_series.h"

namespace ryn {

namespace {

/// The first bytes tell the files of other kinds from tables.
Status ReadStart(TextSource& source, std::string* start) {
    std::array<char, 64> buffer{};
    std::size_t got = 0;
    Status status = source.Read(buffer.data(), buffer.size(), &got);
    start->assign(buffer.data(), got);
    return status ? source.Rewind() : status;
}

/// Names and units of the items: as the user says, else as the table says.
void NameItems(const ImportSettings& settings, const std::string& fallbackName,
               ImportReport* report) {
    for (std::size_t i = 0; i < report->items.size(); ++i) {
        ImportedItem& item = report->items[i];
        if (!settings.name.empty() && report->items.size() == 1)
            item.name = settings.name;
        if (item.name.empty())
            // A series needs a name on plots; the table's own file name is what its owner knows it
            // by.
            item.name = report->items.size() == 1 ? fallbackName
                                                  : fallbackName + " " + std::to_string(i + 1);
        if (!settings.unit.empty())
            item.unit = settings.unit;
    }
}

/// The items as the table calls them; names that are missing follow.
void DescribeItems(const TableLayout& layout, ImportReport* report) {
    for (const std::size_t item : layout.items) {
        const ColumnLayout& column = layout.columns[item];
        report->items.push_back({ColumnTitle(layout, item), column.name, column.unit, {}});
    }
    if (layout.months.empty())
        return;
    report->items[0].column += " to " + ColumnTitle(layout, layout.months.back());
    report->items[0].name.clear(); // "Jan" is not the item's name
}

Status ReadPlainTable(TextSource& source, const ImportSettings& settings, TableSamples* samples,
                      ImportReport* report) {
    TableLayout& layout = report->layout;
    report->form = "table";
    Status status = GuessLayout(source, settings, &layout);
    if (!status)
        return status;
    DescribeItems(layout, report);
    for (const std::size_t other : OtherItems(layout))
        report->otherItems.push_back(ColumnTitle(layout, other));
    report->notes = layout.notes;
    status = ReadRows(source, layout, settings.missing, samples, report);
    // Only the whole series shows which values stand apart.
    if (status && settings.missing.searchCodes)
        TakeOutCodes(layout, samples, report);
    return status;
}

/// An empty series would be a file that no analysis can use. The codes show when a guess took too
/// much.
Status NoValues(const std::string& source, const ImportReport& report) {
    std::string codes;
    for (const OccurredText& code : report.missing)
        if (code.count > 0)
            codes += (codes.empty() ? ": " : ", ") + Quoted(code.text) + " " +
                     std::to_string(code.count) + " times";
    return Status::InputFault(source + ": none of its " + std::to_string(report.rowsRead) +
                              " rows has a value in every chosen item" +
                              (codes.empty() ? "" : "; taken for missing" + codes));
}

/// What all sources have in common: samples without missing values, in rising order.
Status Finish(const std::string& source, const ImportSettings& settings, TableSamples* samples,
              ImportReport* report) {
    // Before the order is judged: a time that is repeated without a value, as archives do to fill
    // up, is no duplicate.
    DropMissing(samples, report);
    if (samples->Count() == 0)
        return NoValues(source, *report);
    return OrderSamples(source, settings.order, settings.duplicates, samples, report);
}

} // namespace

Status ImportTable(TextSource& source, const ImportOptions& options,
                   const std::string& fallbackName, TableSamples* samples, ImportReport* report) {
    *report = {};
    *samples = {};
    report->source = source.Name();
    ImportSettings settings;
    Status status = ParseImportOptions(options, &settings);
    std::string start;
    if (status)
        status = ReadStart(source, &start);
    if (status)
        status = IsDif(start) ? ReadDif(source, settings, samples, report)
                              : ReadPlainTable(source, settings, samples, report);
    if (!status)
        return status;
    NameItems(settings, fallbackName, report);
    return Finish(source.Name(), settings, samples, report);
}

Status ImportFile(const std::string& input, const std::string& output, const ImportOptions& options,
                  ImportReport* report, const ImportCallbacks& callbacks) {
    *report = {};
    const std::string title = SplitPath(input).name;
    std::unique_ptr<TextSource> source;
    Status status = FileSource::Open(input, &source);
    std::string start;
    if (status)
        status = ReadStart(*source, &start);
    if (!status)
        return status;
    TableSamples samples;
    if (IsNetcdf(start)) {
        ImportSettings settings;
        status = ParseImportOptions(options, &settings);
        report->source = input;
        if (status)
            status = ReadNetcdfSeries(input, settings, &samples, report);
        NameItems(settings, title, report);
        if (status)
            status = Finish(input, settings, &samples, report);
    } else {
        std::error_code unknownSize;
        const auto size = std::filesystem::file_size(input, unknownSize);
        WatchedSource watched(*source, unknownSize ? 0 : static_cast<long long>(size),
                              callbacks.progress);
        status = ImportTable(watched, options, title, &samples, report);
    }
    if (status && callbacks.editItems)
        status = callbacks.editItems(report->items);
    return status ? WriteSeries(output, title, samples, report) : status;
}

} // namespace ryn
