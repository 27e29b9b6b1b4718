#include "apps/cli/info_command.h"

#include <memory>
#include <ostream>

#include "apps/cli/command_options.h"
#include "apps/cli/console_ports.h"
#include "apps/cli/grid_info.h"
#include "apps/cli/input_file.h"
#include "apps/cli/kvf_json.h"
#include "apps/cli/kvf_listing.h"
#include "apps/cli/plain_text.h"
#include "apps/cli/series_info.h"
#include "document/parameter_file_name.h"
#include "kvf/kvf.h"
#include "strings/catalogue.h"

namespace ryn::cli {

namespace {

void ShowSeries(const SeriesInfo& info, const InfoOptions& options, const std::string& path,
                Console& console) {
    if (options.form == OutputForm::Json)
        PrintJson(console, JsonOfSeries(info));
    else
        PrintSeries(console.out, info, path);
    if (info.backwardSteps > 0)
        ShowWarning(console, FormatText(kTextCliBackwardSteps, path, info.backwardSteps));
}

void ShowGrid(const GridInfo& info, const InfoOptions& options, const std::string& path,
              Console& console) {
    if (options.form == OutputForm::Json)
        PrintJson(console, JsonOfGrid(info));
    else
        PrintGrid(console.out, info, path);
    for (const std::string& note : info.grid.notes)
        ShowNote(console, note);
}

/// A grid where the file holds one; else its series.
int ShowData(const std::string& path, const InfoOptions& options, Console& console) {
    ProgressLine progress(console);
    GridInfo grid;
    const Status noGrid = ReadGridInfo(path, progress, &grid);
    progress.Clear();
    if (noGrid) {
        ShowGrid(grid, options, path, console);
        return kExitDone;
    }
    SeriesInfo series;
    const Status noSeries = ReadSeriesInfo(path, progress, &series);
    progress.Clear();
    if (!noSeries) {
        // Whoever has a grid in mind learns why it is none, too.
        const int code = Report(console, noSeries);
        ShowNote(console, noGrid.Text());
        return code;
    }
    ShowSeries(series, options, path, console);
    return kExitDone;
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
    return KindOfFile(path) == FileKind::DataFile ? ShowData(path, options, console)
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
