#include "apps/cli/import_command.h"

#include <memory>
#include <ostream>
#include <set>

#include "apps/cli/command_options.h"
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

void AddColumnOptions(CLI::App& command, ImportOptions* table) {
    AddListOption(command, {"--time", "COL", kTextCliHelpImportTime}, &table->timeColumns);
    AddListOption(command, {"--item", "COL", kTextCliHelpImportItem}, &table->itemColumns);
    AddPlainTextOption(command, {"--unit", "U", kTextCliHelpImportUnit}, &table->unit);
    AddPlainTextOption(command, {"--name", "N", kTextCliHelpImportName}, &table->name);
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
    if (const int refused = Report(console, TestFiles(options)))
        return refused;
    ImportReport report;
    const Status imported = ImportFile(options.input, options.output, options.table, &report);
    if (!imported)
        return Report(console, imported);
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
    AddColumnOptions(command, &options->table);
    AddLayoutOptions(command, &options->table);
    AddRowOptions(command, &options->table);
    AddJsonOption(command, &options->form);
    AddConsentOption(command, &options->consent);
}

} // namespace ryn::cli
