#include "series/series_file.h"

#include "strings/catalogue.h"
#include "tsq/tsq.h"
#include "units/units.h"

namespace ryn {

namespace {

constexpr int kFileType = 4;
constexpr const char* kApplicationName = "RYNEditor";
constexpr int kApplicationVersion = 100;
constexpr int kStatisticsKind = 1;
constexpr int kAxisIndex = 2;

/// Shows library errors while it lives, and puts the handler of before back.
class ErrorHandlerScope {
  public:
    explicit ErrorHandlerScope(MessagePort& messages)
        : previous(
              tsqAddCommonErrorHandler([&messages](int type, const char* sourceFile, int line) {
                  messages.Show(MessageKind::Error,
                                FormatText(kTextDataFileError, type, sourceFile, line));
                  return 0;
              })) {}
    ~ErrorHandlerScope() { tsqAddCommonErrorHandler(std::move(previous)); }
    ErrorHandlerScope(const ErrorHandlerScope&) = delete;
    ErrorHandlerScope& operator=(const ErrorHandlerScope&) = delete;

  private:
    TsqErrorHandler previous;
};

void SetAxis(TsqHeader* header, const SeriesFileContent& content,
             const std::vector<const STSItem*>& selection) {
    if (!content.hasCalendarAxis) {
        tsqSetNeqTimeAxis(header, kUnitSecond, 0.0, kAxisIndex);
        return;
    }
    const COleDateTime start =
        selection.empty() ? COleDateTime(1900, 1, 1, 0, 0, 0) : selection.front()->date;
    tsqSetNeqCalendarAxis(header, start.Format("%Y-%m-%d"), start.Format("%H:%M:%S"), kUnitSecond,
                          0.0, kAxisIndex);
}

void DescribeItem(TsqHeader* header, const SeriesFileContent& content) {
    TsqItem* const item = tsqItemD(header, 1);
    tsqSetItemInfo(header, item, content.itemType, content.itemName, content.itemUnit,
                   kTsqDataTypeFloat);
    tsqSetItemValueType(item, 0);
    tsqSetItemRefCoords(item, 0.0F, 0.0F, 0.0F);
    tsqSetItemAxisOrientation(item, 0.0F, 0.0F, 0.0F);
}

void WriteSteps(TsqHeader* header, TsqFile* file, const std::vector<const STSItem*>& selection) {
    for (const STSItem* sample : selection) {
        const double days = (sample->date - selection.front()->date).GetTotalDays();
        const auto value = static_cast<float>(sample->value);
        if (tsqWriteItemTimeStep(header, file, days * 86400.0, &value) != 0)
            return; // the close reports it
    }
}

} // namespace

Status WriteSeriesFile(const std::string& path, const SeriesFileContent& content,
                       const std::vector<const STSItem*>& selection, const Ports& ports) {
    const ErrorHandlerScope handler(*ports.messages);
    (void)tsqTakeError();
    TsqHeaderHandle header;
    tsqHeaderCreate(kFileType, content.title, kApplicationName, kApplicationVersion, 1,
                    kStatisticsKind, &header);
    tsqSetAppTitle(header.get(), ports.application->ApplicationName());
    tsqSetDeleteValFloat(header.get(), 0.0F);
    tsqSetDeleteValDouble(header.get(), 0.0);
    tsqSetDurability(header.get(), content.durability);
    SetAxis(header.get(), content, selection);
    DescribeItem(header.get(), content);
    TsqFileHandle file;
    if (tsqFileCreate(path, header.get(), &file) == 0)
        WriteSteps(header.get(), file.get(), selection);
    tsqFileClose(header.get(), &file);
    tsqHeaderDestroy(&header);
    return tsqTakeError();
}

} // namespace ryn
