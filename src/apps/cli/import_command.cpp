#include "apps/cli/import_command.h"

#include <algorithm>
#include <memory>
#include <ostream>
#include <set>

#include "apps/cli/command_options.h"
#include "apps/cli/console_ports.h"
#include "apps/cli/import_json.h"
#include "apps/cli/input_file.h"
#include "apps/cli/plain_text.h"
#include "base/file_access.h"
#include "import/import.h"
#include "import/unit_text.h"
#include "strings/catalogue.h"
#include "units/units.h"

namespace ryn::cli {

namespace {

Status TestFiles(const ImportCommandOptions& options) {
    if (Status status = TestReadable(options.input); !status)
        return status;
    if (IsSameFile(options.input, options.output))
        return Status::InputFault(FormatText(kTextCliOverInput, options.output));
    return TestReplaceable(options.output, options.consent);
}

void AddColumnOptions(CLI::App& command, ImportCommandOptions* options) {
    ImportOptions* const table = &options->table;
    AddListOption(command, {"--time", "COL", kTextCliHelpImportTime}, &table->timeColumns);
    AddListOption(command, {"--item", "COL", kTextCliHelpImportItem}, &table->itemColumns);
    AddListOption(command, {"--unit", "U", kTextCliHelpImportUnit}, &options->units);
    AddListOption(command, {"--name", "N", kTextCliHelpImportName}, &options->names);
}

void AddLayoutOptions(CLI::App& command, ImportOptions* table) {
    AddPlainTextOption(command, {"--delimiter", "C", kTextCliHelpDelimiter}, &table->delimiter);
    AddCountOption(command, {"--skip", "N", kTextCliHelpSkip}, &table->skipLines);
    AddPlainTextOption(command, {"--comment", "C", kTextCliHelpComment}, &table->comment);
    AddPlainTextOption(command, {"--time-format", "F", kTextCliHelpTimeFormat}, &table->timeFormat);
    AddPlainTextOption(command, {"--decimal", "C", kTextCliHelpDecimal}, &table->decimal);
    AddPlainTextOption(command, {"--encoding", "E", kTextCliHelpEncoding}, &table->encoding);
}

void AddRowOptions(CLI::App& command, ImportOptions* table) {
    AddListOption(command, {"--missing", "CODE", kTextCliHelpMissing}, &table->missing);
    AddPlainTextOption(command, {"--start", "DATE", kTextCliHelpStart}, &table->start);
    AddPlainTextOption(command, {"--step", "S", kTextCliHelpStep}, &table->step);
    command.add_flag("--sort", table->sort, std::string(Text(kTextCliHelpSort)));
    AddPlainTextOption(command, {"--duplicates", "refuse|first|last|max", kTextCliHelpDuplicates},
                       &table->duplicates);
}

Status TestCount(const char* option, std::size_t given, std::size_t items) {
    return given == items
               ? Status::Ok()
               : Status::InputFault(FormatText(kTextCliItemCounts, option, static_cast<int>(given),
                                               static_cast<int>(items)));
}

/// Units and names go by the order of the items; one unit serves for all.
Status TestCounts(const ImportCommandOptions& options, std::size_t items) {
    Status status;
    if (options.units.size() > 1)
        status = TestCount("--unit", options.units.size(), items);
    if (status && !options.names.empty())
        status = TestCount("--name", options.names.size(), items);
    return status;
}

Status DescribeItems(const ImportCommandOptions& options, std::vector<ImportedItem>& items) {
    if (Status status = TestCounts(options, items.size()); !status)
        return status;
    for (std::size_t i = 0; i < items.size(); ++i) {
        if (!options.units.empty())
            items[i].unit = options.units[options.units.size() == 1 ? 0 : i];
        if (!options.names.empty())
            items[i].name = options.names[i];
    }
    return Status::Ok();
}

Status Import(const ImportCommandOptions& options, Console& console, ImportReport* report) {
    ProgressLine progress(console);
    ImportCallbacks callbacks;
    callbacks.progress = [&progress](long long done, long long total) {
        progress.ShowProgress(done, total);
    };
    callbacks.editItems = [&options](std::vector<ImportedItem>& items) {
        return DescribeItems(options, items);
    };
    return ImportFile(options.input, options.output, options.table, report, callbacks);
}

/// A unit that nothing can convert is kept, since a later version may know it; but mostly it is
/// mistyped.
void NoteUnknownUnits(const ImportReport& report, Console& console) {
    std::set<std::string> told;
    for (const ImportedItem& item : report.items) {
        const std::string unit = PlainUnit(item.unit);
        if (!unit.empty() && !IsKnownUnit(UnitOfText(unit)) && told.insert(unit).second)
            ShowNote(console, FormatText(kTextCliUnknownUnit, report.source, unit));
    }
}

} // namespace

int RunImport(const ImportCommandOptions& options, Console& console) {
    // Without --item there is one item.
    const std::size_t items = std::max<std::size_t>(options.table.itemColumns.size(), 1);
    if (const int refused = Report(console, TestCounts(options, items)))
        return refused;
    if (const int refused = Report(console, TestFiles(options)))
        return refused;
    ImportReport report;
    if (const int refused = Report(console, Import(options, console, &report)))
        return refused;
    NoteUnknownUnits(report, console);
    if (options.form == OutputForm::Json) {
        PrintJson(console, JsonOfImport(report));
        return kExitDone;
    }
    for (const std::string& line : ReportLines(report))
        console.out << PlainLine(line) << '\n';
    console.out << FormatText(kTextCliSaved, PlainLine(options.output)) << '\n';
    return kExitDone;
}

void AddImportCommand(CommandLine& line) {
    auto options = std::make_shared<ImportCommandOptions>();
    CLI::App& command = line.Add({"import", kTextCliHelpImport, [options](Console& console) {
                                      return RunImport(*options, console);
                                  }});
    AddFileArgument(command, "TABLE", kTextCliHelpTable, &options->input);
    AddFileArgument(command, "OUT.tsq0", kTextCliHelpImportOutput, &options->output);
    AddColumnOptions(command, options.get());
    AddLayoutOptions(command, &options->table);
    AddRowOptions(command, &options->table);
    AddJsonOption(command, &options->form);
    AddConsentOption(command, &options->consent);
}

} // namespace ryn::cli
