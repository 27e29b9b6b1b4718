#include "apps/cli/info_command.h"

#include <memory>
#include <ostream>
#include <vector>

#include "apps/cli/command_options.h"
#include "apps/cli/console_ports.h"
#include "apps/cli/data_file.h"
#include "apps/cli/grid_info.h"
#include "apps/cli/input_file.h"
#include "apps/cli/kvf_json.h"
#include "apps/cli/kvf_listing.h"
#include "apps/cli/nearest_names.h"
#include "apps/cli/series_info.h"
#include "base/path_parts.h"
#include "document/parameter_file_name.h"
#include "kvf/kvf.h"
#include "strings/catalogue.h"

namespace ryn::cli {

namespace {

int ShowSeries(const std::string& path, OutputForm form, Console& console) {
    SeriesInfo info;
    ProgressLine progress(console);
    const Status read = ReadSeriesInfo(path, progress, &info);
    progress.Clear();
    if (!read)
        return Report(console, read);
    if (form == OutputForm::Json)
        PrintJson(console, JsonOfSeries(info));
    else
        PrintSeries(console.out, info, path);
    if (info.backwardSteps > 0)
        ShowWarning(console, FormatText(kTextCliBackwardSteps, path, info.backwardSteps));
    return kExitDone;
}

bool IsDataFileName(const std::string& path) {
    const std::string extension = SplitPath(path).extension;
    return extension == ".tsq0" || extension == ".tq0";
}

/// "1 date, 2 co2": the plain series of a data file.
std::string SeriesNames(const DataFile& file) {
    std::vector<std::string> names;
    for (const DataItem& item : file.Items())
        if (item.isPlainSeries)
            names.push_back(std::to_string(item.number) + ' ' + item.name);
    return JoinNames(names);
}

/// A netCDF file that may be read as both.
struct OpenData {
    DataFile series;
    Status seriesStatus;
    CGridEditEngine grid;
    Status gridStatus;

    bool HasSeries() const { return seriesStatus && !series.PlainItems().empty(); }
};

int ShowGrid(OpenData& data, const std::string& path, OutputForm form, Console& console) {
    GridInfo info;
    ProgressLine progress(console);
    const Status read = ReadGridInfo(data.grid, progress, &info);
    progress.Clear();
    if (!read)
        return Report(console, read);
    if (data.HasSeries())
        info.grid.notes.push_back(FormatText(kTextCliGridSeries, SeriesNames(data.series)));
    if (form == OutputForm::Json)
        PrintJson(console, JsonOfGrid(info));
    else
        PrintGrid(console.out, info, path);
    return kExitDone;
}

/// Why a file is neither a series nor a grid, with its name once.
Status NeitherKind(const OpenData& data, const std::string& path) {
    for (const Status* const status : {&data.seriesStatus, &data.gridStatus})
        if (status->Kind() == Fault::System)
            return *status;
    std::string text =
        data.seriesStatus ? FormatText(kTextCliNoSeries, path) : data.seriesStatus.Text();
    if (text == data.gridStatus.Text())
        return Status::InputFault(text);
    std::string noGrid = data.gridStatus.Text();
    if (noGrid.rfind(path + ": ", 0) == 0)
        noGrid.erase(0, path.size() + 2);
    return Status::InputFault(text + "; " + noGrid);
}

/// Where a file is both, its name decides: climate models keep series of dates or of global means
/// beside their grids.
int ShowData(const std::string& path, OutputForm form, Console& console) {
    OpenData data;
    data.seriesStatus = data.series.Open(path);
    if (data.HasSeries() && IsDataFileName(path))
        return ShowSeries(path, form, console);
    (void)data.grid.OpenFile(path, true);
    data.gridStatus = data.grid.LastError();
    if (data.gridStatus)
        return ShowGrid(data, path, form, console);
    if (data.HasSeries() || (data.seriesStatus && IsDataFileName(path)))
        return ShowSeries(path, form, console);
    return Report(console, NeitherKind(data, path));
}

int ShowTree(const std::string& path, OutputForm form, Console& console) {
    const KvfHandle tree = kvfLoadFile(path, 0);
    if (kvfPeekErrorGlb() != 0) {
        kvfGetErrorGlb();
        std::string reason;
        kvfGetSyntaxErr(tree.get(), nullptr, nullptr, &reason);
        return Report(console, Status::InputFault(reason));
    }
    if (form == OutputForm::Json)
        PrintJson(console, JsonOfTree(tree.get()));
    else
        PrintTree(console.out, tree.get());
    return kExitDone;
}

} // namespace

int RunInfo(const InfoOptions& options, Console& console) {
    const std::string path =
        IsParameterFileName(options.file) ? FindParameterFile(options.file) : options.file;
    if (const int refused = Report(console, TestReadable(path)))
        return refused;
    return KindOfFile(path) == FileKind::DataFile ? ShowData(path, options.form, console)
                                                  : ShowTree(path, options.form, console);
}

void AddInfoCommand(CommandLine& line) {
    auto options = std::make_shared<InfoOptions>();
    CLI::App& command = line.Add({"info", kTextCliHelpInfo, [options](Console& console) {
                                      return RunInfo(*options, console);
                                  }});
    AddFileArgument(command, "FILE", kTextCliHelpInfoFile, &options->file);
    AddJsonOption(command, &options->form);
}

} // namespace ryn::cli
