#include "apps/cli/export_command.h"

#include <cmath>
#include <functional>
#include <memory>
#include <ostream>

#include "apps/cli/command_options.h"
#include "apps/cli/console_ports.h"
#include "apps/cli/data_file.h"
#include "apps/cli/date_text.h"
#include "apps/cli/input_file.h"
#include "base/atomic_file.h"
#include "base/file_access.h"
#include "base/number_text.h"
#include "strings/catalogue.h"

namespace ryn::cli {

namespace {

/// Takes a piece of the table; false when no more is wanted.
using Sink = std::function<bool(std::string_view)>;

/// A field of a table whose fields stand between commas.
std::string Quoted(const std::string& field) {
    if (field.find_first_of(",\"\r\n") == std::string::npos)
        return field;
    std::string quoted = "\"";
    for (const char c : field)
        quoted += c == '"' ? std::string("\"\"") : std::string(1, c);
    return quoted + '"';
}

std::string Heading(const DataFile& file, const std::vector<int>& itemNumbers) {
    std::string line = "time";
    for (const int number : itemNumbers) {
        const DataItem& item = file.Items()[static_cast<std::size_t>(number - 1)];
        line += "," + Quoted(item.unit.empty() ? item.name : item.name + " [" + item.unit + "]");
    }
    return line + '\n';
}

void AppendStep(const DataStep& step, std::string& text) {
    text += IsoText(step.date);
    for (const float value : step.values) {
        text += ',';
        if (!std::isnan(value))
            text += ShortestText(value);
    }
    text += '\n';
}

Status WriteTable(DataFile& file, const std::vector<int>& itemNumbers, const Sink& sink,
                  ProgressPort& progress) {
    constexpr std::size_t kPiece = std::size_t{1} << 16;
    std::string text = Heading(file, itemNumbers);
    Status walked = file.Walk(itemNumbers, [&](const DataStep& step) {
        AppendStep(step, text);
        if (text.size() < kPiece)
            return true;
        progress.ShowProgress(step.index, file.StepCount());
        const bool goOn = sink(text);
        text.clear();
        return goOn;
    });
    if (walked)
        sink(text);
    return walked;
}

Status ChooseItems(const DataFile& file, const ExportOptions& options, std::vector<int>* numbers) {
    *numbers = file.PlainItems();
    if (!options.item)
        return numbers->empty() ? Status::InputFault(FormatText(kTextCliNoSeries, options.file))
                                : Status::Ok();
    const int wanted = *options.item;
    const int count = static_cast<int>(file.Items().size());
    if (wanted < 1 || wanted > count)
        return Status::InputFault(FormatText(kTextCliNoSuchItem, options.file, wanted, count));
    if (!file.Items()[static_cast<std::size_t>(wanted - 1)].isPlainSeries)
        return Status::InputFault(FormatText(kTextCliItemIsSpatial, options.file, wanted));
    *numbers = {wanted};
    return Status::Ok();
}

Status WriteToFile(DataFile& file, const std::vector<int>& itemNumbers,
                   const ExportOptions& options, ProgressPort& progress) {
    if (Status status = TestReplaceable(*options.output, options.consent); !status)
        return status;
    if (IsSameFile(options.file, *options.output))
        return Status::InputFault(FormatText(kTextCliOverInput, *options.output));
    AtomicFile output;
    if (Status status = output.Open(*options.output); !status)
        return status;
    const Sink append = [&output](std::string_view text) {
        output.Write(text);
        return true;
    };
    if (Status status = WriteTable(file, itemNumbers, append, progress); !status)
        return status;
    return output.Commit(Durability::Flushed);
}

Status WriteToConsole(DataFile& file, const std::vector<int>& itemNumbers, Console& console,
                      ProgressPort& progress) {
    const Sink print = [&console](std::string_view text) {
        console.out << text;
        return console.out.good(); // a reader that went away needs no more
    };
    return WriteTable(file, itemNumbers, print, progress);
}

} // namespace

int RunExport(const ExportOptions& options, Console& console) {
    if (const int refused = Report(console, TestReadable(options.file)))
        return refused;
    DataFile file;
    std::vector<int> itemNumbers;
    Status status = file.Open(options.file);
    if (status)
        status = ChooseItems(file, options, &itemNumbers);
    if (!status)
        return Report(console, status);
    ProgressLine progress(console);
    status = options.output && *options.output != "-"
                 ? WriteToFile(file, itemNumbers, options, progress)
                 : WriteToConsole(file, itemNumbers, console, progress);
    progress.Clear();
    return Report(console, status);
}

void AddExportCommand(CommandLine& line) {
    auto options = std::make_shared<ExportOptions>();
    CLI::App& command = line.Add({"export", kTextCliHelpExport, [options](Console& console) {
                                      return RunExport(*options, console);
                                  }});
    AddFileArgument(command, "FILE.tsq0", kTextCliHelpDataFile, &options->file);
    AddIntOption(command, {"--item", "N", kTextCliHelpExportItem}, 1, &options->item);
    AddTextOption(command, {"-o,--output", "TABLE.csv", kTextCliHelpExportOutput},
                  &options->output);
    AddConsentOption(command, &options->consent);
}

} // namespace ryn::cli
