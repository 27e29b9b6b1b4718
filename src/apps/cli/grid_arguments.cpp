#include "apps/cli/grid_arguments.h"

#include <array>
#include <string_view>
#include <utility>
#include <vector>

#include "apps/cli/input_file.h"
#include "apps/cli/setting_value.h"
#include "base/file_access.h"
#include "base/number_text.h"
#include "grid/grid_edit.h"
#include "strings/catalogue.h"

namespace ryn::cli {

namespace {

/// A range option: its name, whether it has a step, and how many places its axis has.
struct RangeOption {
    const char* name;
    const std::optional<std::string>& text;
    bool hasStep;
    int size;
};

Status BadRange(const RangeOption& option) {
    return Status::InputFault(FormatText(
        kTextCliBadValue, std::string(option.name), option.text.value_or(""),
        FormatText(option.hasStep ? kTextCliExpectRange : kTextCliExpectSteps, option.size - 1)));
}

/// The numbers between colons; nothing where one is none.
std::optional<std::vector<int>> NumbersIn(std::string_view text) {
    std::vector<int> numbers;
    for (;;) {
        const std::size_t colon = text.find(':');
        const std::optional<int> number = ParseInt(text.substr(0, colon));
        if (!number)
            return std::nullopt;
        numbers.push_back(*number);
        if (colon == std::string_view::npos)
            return numbers;
        text.remove_prefix(colon + 1);
    }
}

Status TakeRange(const RangeOption& option, IndexRange* range) {
    *range = {0, option.size - 1, 1};
    if (!option.text)
        return Status::Ok();
    const std::optional<std::vector<int>> numbers = NumbersIn(*option.text);
    const std::size_t most = option.hasStep ? 3 : 2;
    if (!numbers || numbers->size() < 2 || numbers->size() > most)
        return BadRange(option);
    range->first = numbers->at(0);
    range->last = numbers->at(1);
    if (numbers->size() == 3)
        range->step = numbers->at(2);
    const bool isInside = range->first >= 0 && range->first <= range->last &&
                          range->last < option.size && range->step >= 1;
    return isInside ? Status::Ok() : BadRange(option);
}

Status Needs(const char* option, const char* other) {
    return Status::InputFault(FormatText(kTextCliOptionNeeds, option, other));
}

Status TestTogether(const GridArguments& arguments) {
    const std::array<std::pair<const char*, bool>, 5> others = {
        {{"--grid-item", !!arguments.item},
         {"--x", !!arguments.x},
         {"--y", !!arguments.y},
         {"--time", !!arguments.time},
         {"--grid-out", !!arguments.output}}};
    for (const auto& [name, isGiven] : others)
        if (isGiven && !arguments.grid)
            return Needs(name, "--grid");
    if (arguments.grid && !arguments.item)
        return Needs("--grid", "--grid-item");
    return arguments.grid && !arguments.output ? Needs("--grid", "--grid-out") : Status::Ok();
}

/// A fault with the option that it is about before it.
Status About(const char* option, const Status& fault) {
    const std::string text = std::string(option) + ": " + fault.Text();
    return fault.Kind() == Fault::System ? Status::SystemFault(text) : Status::InputFault(text);
}

Status NoName(const char* option) {
    return Status::InputFault(
        FormatText(kTextCliBadValue, option, "", std::string(Text(kTextCliExpectFile))));
}

/// The results are written over nothing but a file of earlier ones.
Status TestOutput(const std::string& output, const std::string& grid, const std::string& caseFile) {
    if (output.empty())
        return NoName("--grid-out");
    if (grid == output || IsSameFile(grid, output))
        return About("--grid-out", Status::InputFault(FormatText(kTextCliOverInput, output)));
    if (caseFile == output || IsSameFile(caseFile, output))
        return About("--grid-out", Status::InputFault(FormatText(kTextGridOutputTaken, output)));
    const Status replaceable = TestReplaceable(output, Consent::Given);
    return replaceable ? replaceable : About("--grid-out", replaceable);
}

Status TakeRanges(const GridArguments& arguments, const CGridEditHeaderInfo& header,
                  CTsq2InputKvf& input) {
    Status taken =
        TakeRange({"--x", arguments.x, true, header.SizeX()}, &input.X_Range_And_Interval);
    if (taken)
        taken = TakeRange({"--y", arguments.y, true, header.SizeY()}, &input.Y_Range_And_Interval);
    if (taken)
        taken = TakeRange({"--time", arguments.time, false, header.TimeStepPast()},
                          &input.Time_Range_And_Interval);
    return taken;
}

} // namespace

Status ApplyGridArguments(const GridArguments& arguments, const std::string& callerDirectory,
                          const std::string& caseFile, CTsq2InputKvf& input) {
    if (Status fault = TestTogether(arguments); !fault || !arguments.grid)
        return fault;
    const std::string grid = AbsoluteName(*arguments.grid, callerDirectory);
    const std::string output = AbsoluteName(*arguments.output, callerDirectory);
    if (grid.empty())
        return NoName("--grid");
    if (Status readable = TestReadable(grid); !readable)
        return About("--grid", readable);
    if (Status free = TestOutput(output, grid, caseFile); !free)
        return free;
    CGridEditEngine engine;
    if (engine.OpenFile(grid, true) != kGridOk)
        return About("--grid", engine.LastError());
    const CGridEditHeaderInfo header = engine.QueryHeaderInfo();
    if (*arguments.item > header.Items())
        return About("--grid-item", Status::InputFault(FormatText(
                                        kTextGridItemMissing, *arguments.item, header.Items())));
    input.UseTsq2Input = true;
    input.Tsq2InputFile = grid;
    input.Tsq2OutputFile = output;
    input.Tsq2ItemNo = *arguments.item;
    return TakeRanges(arguments, header, input);
}

} // namespace ryn::cli
