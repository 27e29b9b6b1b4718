#include "apps/cli/import_json.h"

#include <string_view>

namespace ryn::cli {

namespace {

Json JsonOfTime(const ImportReport& report, Millis time) {
    if (report.samples == 0)
        return nullptr;
    if (report.isRelative)
        return static_cast<double>(time) / static_cast<double>(kMillisPerSecond);
    return DateText(time) + "T" + ClockText(time);
}

Json JsonOfItems(const std::vector<ImportedItem>& items) {
    Json list = Json::array();
    for (const ImportedItem& item : items)
        list.push_back({{"column", item.column}, {"name", item.name}, {"unit", item.unit}});
    return list;
}

Json JsonOfTexts(const std::vector<OccurredText>& texts) {
    Json list = Json::array();
    for (const OccurredText& occurred : texts)
        list.push_back({{"text", occurred.text}, {"count", occurred.count}});
    return list;
}

std::string_view NameOf(DropReason reason) {
    switch (reason) {
    case DropReason::MissingValue:
        return "missing value";
    case DropReason::IncompleteDate:
        return "incomplete date";
    case DropReason::EmptyRow:
        return "empty row";
    case DropReason::Divider:
        return "divider";
    case DropReason::RepeatedHeader:
        return "repeated header";
    case DropReason::Footer:
        return "footer";
    case DropReason::Duplicate:
        return "duplicate";
    }
    return {};
}

Json JsonOfDropped(const std::vector<DroppedRows>& dropped) {
    Json list = Json::array();
    for (const DroppedRows& rows : dropped)
        list.push_back({{"reason", NameOf(rows.reason)},
                        {"count", rows.count},
                        {"firstLines", rows.firstLines}});
    return list;
}

} // namespace

Json JsonOfImport(const ImportReport& report) {
    return {{"form", report.form},
            {"rows", report.rowsRead},
            {"count", report.samples},
            {"relative", report.isRelative},
            {"first", JsonOfTime(report, report.first)},
            {"last", JsonOfTime(report, report.last)},
            {"items", JsonOfItems(report.items)},
            {"missing", JsonOfTexts(report.missing)},
            {"dropped", JsonOfDropped(report.dropped)},
            {"notes", report.notes}};
}

} // namespace ryn::cli
