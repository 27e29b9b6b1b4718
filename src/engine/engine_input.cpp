#include "engine/engine_input.h"

#include <algorithm>

#include <cmath>

#include "engine/plain_text.h"
namespace ryn {

namespace {

using stats::SeriesKind;

struct Range {
    int lowest;
    int highest;

    bool Holds(int value) const { return value >= lowest && value <= highest; }
};

// Of DistributionType and EstimationMethod. Whether a distribution goes with the kind of series is
// a combination's own affair: it fails, and the others are fitted.
constexpr Range kDistributions{0, 10};
constexpr Range kMethods{0, 2};

/// A reader of one of the sections that every analysis has.
SectionReader MainSection(const KvfSection* target, const char* name, Sentences& faults) {
    const KvfSection* const section = kvfSectionByNameNum(target, name, 1);
    if (section == nullptr)
        faults.push_back(std::string("section ") + name + " is missing");
    return {section, name, faults};
}

std::string IsButMustBe(int value, const std::string& wanted) {
    return "is " + std::to_string(value) + ", but must be " + wanted;
}

/// A number that decides what is computed. Without it no series can be analysed.
int RequiredInRange(const SectionReader& reader, const char* keyword, Range range) {
    const int value = reader.Required<int>(keyword);
    if (!range.Holds(value))
        reader.Fault(keyword, IsButMustBe(value, "from " + std::to_string(range.lowest) + " to " +
                                                     std::to_string(range.highest)));
    return value;
}

/// A number that has a harmless default: 0, which is taken with a warning for any other that has no
/// meaning.
int OptionalInRange(const SectionReader& reader, const char* keyword, Range range,
                    Sentences& warnings) {
    const int value = reader.Optional(keyword, 0);
    if (range.Holds(value))
        return value;
    warnings.push_back(reader.PathOf(keyword) + " is " + std::to_string(value) +
                       ", which has no meaning; 0 is taken");
    return 0;
}

// Annual maxima need neither threshold nor rate; a file may hold anything there.
void ReadFrame(const SectionReader& reader, EngineInput& input) {
    const int method = reader.Required<int>("SelectionMethod");
    if (method != 0 && method != 1)
        reader.Fault("SelectionMethod",
                     IsButMustBe(method, "0 (annual maxima) or 1 (partial durations)"));
    if (method != 1) {
        input.threshold = reader.Optional("Threshold", 0.0);
        input.averageNumber = reader.Optional("AvgAnNum", 1.0);
        return;
    }
    input.threshold = reader.Required<double>("Threshold");
    input.averageNumber = reader.Required<double>("AvgAnNum");
    // Written so that NaN is a fault.
    if (!std::isfinite(input.threshold))
        reader.Fault("Threshold", "is " + NumberText(input.threshold) + ", not a level");
    if (reader.Has("AvgAnNum") && !(input.averageNumber > 0 && std::isfinite(input.averageNumber)))
        reader.Fault("AvgAnNum",
                     "is " + NumberText(input.averageNumber) +
                         ", but the mean number of events a year must be greater than 0");
    input.frame = {SeriesKind::PartialDuration, input.threshold, input.averageNumber};
}

void ReadDefinition(const SectionReader& reader, EngineInput& input) {
    ReadFrame(reader, input);
    input.labels = {
        reader.Optional("Title", std::string()), reader.Optional("Subtitle", std::string()),
        reader.Optional("ItemName", std::string()), reader.Optional("Unit", std::string())};
}

/// A list's own count is for people who read the file; the list itself is what counts.
/// A list whose end was lost with an editor's slip would otherwise go unnoticed.
void CompareCount(const SectionReader& reader, std::size_t found, Sentences& warnings) {
    const int told = reader.Optional("NoOfItems", static_cast<int>(found));
    if (told != static_cast<int>(found))
        warnings.push_back(reader.PathOf("NoOfItems") + " is " + std::to_string(told) + ", but " +
                           std::to_string(found) + " were found; these are taken");
}

// Any number is taken; which have an event depends on the series and is told with it.
void ReadPeriods(const SectionReader& reader, InputReading& reading) {
    EngineInput& input = reading.input;
    const bool annual = reader.Optional("AnnualReturnPeriod", false);
    input.meaning = annual ? stats::PeriodMeaning::OfAnnualMaximum : stats::PeriodMeaning::OfEvent;
    // The editor's own reader ends at the first that is no number. Here the rest of the list would
    // be lost without a word, so that it is a fault.
    int occurrence = 0;
    double period = 0;
    while (input.periods.size() <= kMostReturnPeriods &&
           kvfGetParam(reader.Section(), "Item", &period, ++occurrence, 1) != 0)
        input.periods.push_back(period);
    if (input.periods.size() > kMostReturnPeriods)
        return reader.Fault("Item", "occurs more than " + std::to_string(kMostReturnPeriods) +
                                        " times; so many return periods are not evaluated");
    if (kvfKeywordByNameNum(reader.Section(), "Item", occurrence) != nullptr)
        return reader.Fault("Item", "number " + std::to_string(occurrence) + " is not a number");
    CompareCount(reader, input.periods.size(), reading.warnings);
}

// A flag that an older file does not have is off.
void ReadAnalysis(const SectionReader& reader, InputReading& reading) {
    const auto flag = [&reader](const char* keyword) { return reader.Optional(keyword, false); };
    EngineInput& input = reading.input;
    input.tests = {flag("RunTest"), flag("TestForTrend"), flag("TestForShiftInMean")};
    input.measures = {flag("ChiSquaredTest"), flag("KolmogorovSmirnovTest"),
                      flag("SLSCTest"),       flag("PPCCTest"),
                      flag("PPCCTest2"),      flag("LogLikelihood")};
    input.uncertainty = static_cast<UncertaintyMethod>(
        OptionalInRange(reader, "UncertaintyCalcType", {0, 1}, reading.warnings));
    input.plotting = static_cast<stats::PlottingMethod>(
        OptionalInRange(reader, "PlottingMethod", {0, 4}, reading.warnings));
    ReadPeriods(reader.Inside("EvaluatedReturnPeriods"), reading);
}

/// The grid batch stores averages and deviations only where it is told to; their computing takes
/// nearly all of the time.
void ReadGridInput(const KvfSection* target, InputReading& reading) {
    const SectionReader reader(kvfSectionByNameNum(target, "Tsq2Input", 1), "Tsq2Input",
                               reading.faults);
    const bool wanted = reader.Optional("UncertaintyCal", true);
    if (reader.Optional("UseTsq2Input", false) && !wanted)
        reading.input.uncertainty = UncertaintyMethod::None;
}

// By its numbers and never by its name, which the user may choose.
NamedCombination ReadCombination(const SectionReader& reader, Sentences& warnings) {
    NamedCombination read;
    read.name = reader.Optional("ItemName", std::string());
    stats::Combination& combination = read.combination;
    combination.distribution = static_cast<stats::DistributionType>(
        RequiredInRange(reader, "DistributionType", kDistributions));
    combination.method =
        static_cast<stats::EstimationMethod>(RequiredInRange(reader, "EstimationMethod", kMethods));
    combination.location = static_cast<stats::LocationType>(
        OptionalInRange(reader, "EstimateLocationType", {0, 1}, warnings));
    combination.logPearson = static_cast<stats::LogPearsonType>(
        OptionalInRange(reader, "LogPearsonType", {0, 1}, warnings));
    combination.logNormal = static_cast<stats::LogNormalType>(
        OptionalInRange(reader, "LogNormalType", {0, 3}, warnings));
    combination.sampleCorrection = reader.Optional("SampleCorrection", false);
    return read;
}

void ReadCombinations(const SectionReader& reader, InputReading& reading) {
    std::vector<NamedCombination>& combinations = reading.input.combinations;
    // A gap in the numbering ends the list, as for the editor's own reader.
    while (true) {
        const std::string child = "Item" + std::to_string(combinations.size() + 1);
        const SectionReader item = reader.Inside(child);
        if (!item.Exists())
            break;
        if (combinations.size() == kMostCombinations)
            return reader.Fault(child, "is one combination too many: at most " +
                                           std::to_string(kMostCombinations) + " are fitted");
        combinations.push_back(ReadCombination(item, reading.warnings));
    }
    CompareCount(reader, combinations.size(), reading.warnings);
}

/// A list of the series section, whose length must be the one that is told there. `get` is false
/// for a parameter of another type.
template <typename Type, typename Get>
std::vector<Type> ReadList(const SectionReader& reader, const char* keyword, int told, Get get) {
    const KvfKeyword* const list = kvfKeywordByNameNum(reader.Section(), keyword, 1);
    const int count = kvfGetNoParams(list);
    std::vector<Type> values;
    if (told != count) {
        reader.Fault("NoOfItems", "is " + std::to_string(told) + ", but " + keyword + " has " +
                                      std::to_string(count) + " values");
        return values;
    }
    values.reserve(static_cast<std::size_t>(count));
    for (int i = 1; i <= count; ++i) {
        Type value{};
        if (!get(*kvfParamByNum(list, i), value)) {
            reader.Fault(keyword, "has no number at position " + std::to_string(i));
            return {};
        }
        values.push_back(value);
    }
    return values;
}

// Series are stored as floats; a list edited by hand has doubles and ints.
bool GetDouble(const KvfParam& param, double& value) {
    value = kvfParamDouble(param);
    return kvfParamType(param) <= KvfType::Double;
}

bool GetInt(const KvfParam& param, int& value) {
    value = kvfParamInt(param);
    return kvfParamType(param) == KvfType::Int;
}

// The two lists and their count were written together: where they disagree, nobody knows which
// value belongs to which subsample.
void ReadSeries(const SectionReader& reader, EngineInput& input, const Sentences& faults) {
    if (!reader.Exists())
        return;
    // Only a count that is there can disagree with the lists.
    const std::size_t noted = faults.size();
    const int told = reader.Required<int>("NoOfItems");
    if (faults.size() > noted)
        return;
    // Before anything is made room for.
    if (told > static_cast<int>(kMostValues))
        return reader.Fault("NoOfItems", "is " + std::to_string(told) + "; at most " +
                                             std::to_string(kMostValues) + " values are analysed");
    input.values = ReadList<double>(reader, "ExtremeValues", told, GetDouble);
    input.sampleNumbers = ReadList<int>(reader, "SampleNo", told, GetInt);
}

/// Values outside both subsamples are left out, which a number of none of them may not have meant.
void WarnOfSampleNumbers(InputReading& reading) {
    const std::vector<int>& numbers = reading.input.sampleNumbers;
    const auto odd = std::count_if(numbers.begin(), numbers.end(),
                                   [](int number) { return number < 0 || number > 2; });
    if (odd > 0)
        reading.warnings.push_back("ExtremeValueSection/SampleNo is neither 0, 1 nor 2 for " +
                                   std::to_string(odd) + " value(s), which are in no subsample");
}

} // namespace

InputReading ReadEngineInput(const KvfTree* tree) {
    InputReading reading;
    const KvfSection* const target = kvfTargetByNameNum(tree, "RynEditor", 1);
    if (target == nullptr) {
        reading.faults.emplace_back("target RynEditor is missing: this is no parameter file");
        return reading;
    }
    ReadDefinition(MainSection(target, "DefineEVS", reading.faults), reading.input);
    ReadAnalysis(MainSection(target, "Analysis", reading.faults), reading);
    ReadCombinations(MainSection(target, "ProbabilityDistribution", reading.faults), reading);
    ReadSeries(MainSection(target, "ExtremeValueSection", reading.faults), reading.input,
               reading.faults);
    WarnOfSampleNumbers(reading);
    ReadGridInput(target, reading);
    return reading;
}

} // namespace ryn
