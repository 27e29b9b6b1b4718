#include "netcdf/cf_time_axis.h"

#include <algorithm>
#include <cctype>
#include <cmath>
#include <string>
#include <utility>

namespace ryn {

namespace {

constexpr std::size_t kBlock = 65536;
constexpr std::size_t kMaxSteps = 2147483647;

std::string LowerText(const NcFile& file, const NcVariable& variable, const std::string& name) {
    std::string text = file.Text(variable.id, name).value_or("");
    std::ranges::transform(text, text.begin(),
                           [](unsigned char c) { return static_cast<char>(std::tolower(c)); });
    return text;
}

/// The only dimension that is longer than 1, else the first one; -1 when there is none or several
/// are longer.
int OnlyDimension(const NcFile& file, const NcVariable& variable) {
    int found = -1;
    bool foundLong = false;
    for (std::size_t i = 0; i < variable.dimensions.size(); ++i) {
        const bool isLong = file.DimensionOf(variable, i).length != 1;
        if (isLong && foundLong)
            return -1;
        if (isLong || found < 0)
            found = variable.dimensions[i];
        foundLong = foundLong || isLong;
    }
    return found;
}

/// How surely a variable holds the times; 0 when it does not.
int TimeLikeness(const NcFile& file, const NcVariable& variable) {
    const int dimension = IsNumeric(variable.type) ? OnlyDimension(file, variable) : -1;
    if (dimension < 0)
        return 0;
    CfTime time;
    const std::string units = file.Text(variable.id, "units").value_or("");
    const bool isTimeUnit = CfTime::Parse(units, "", &time).IsOk();
    const bool saysTime = LowerText(file, variable, "axis") == "t" ||
                          LowerText(file, variable, "standard_name") == "time";
    const bool isNamedTime = variable.name == "time" || variable.name == "Time" ||
                             variable.name == "TIME" || variable.name == "t";
    // Durations ("lead time", "s") are times only when something else says so.
    const bool sinceDate = units.find(" since ") != std::string::npos;
    if (!sinceDate && !saysTime && !(isNamedTime && (isTimeUnit || units.empty())))
        return 0;
    const bool isCoordinate =
        variable.name == file.Dimensions()[static_cast<std::size_t>(dimension)].name;
    return 1 + (isNamedTime ? 1 : 0) + (saysTime ? 2 : 0) + (sinceDate ? 4 : 0) +
           (isCoordinate ? 8 : 0);
}

/// Packed or missing values are rare on a time axis, and legal.
struct TimePacking {
    double scale = 1.0;
    double offset = 0.0;

    TimePacking(const NcFile& file, const NcVariable& time)
        : scale(file.Number(time.id, "scale_factor").value_or(1.0)),
          offset(file.Number(time.id, "add_offset").value_or(0.0)) {}
};

/// A compressed file can hold a thousand times its size (the most that deflate makes of equal
/// bytes), but not any number that its header states.
Status CheckStepCount(const NcFile& file, const NcVariable& time, std::size_t steps) {
    constexpr std::uint64_t kMostExpansion = 1100;
    if (steps > kMaxSteps)
        return file.InputFault(time, "has more than 2147483647 time steps");
    const std::uint64_t bytes = steps * static_cast<std::uint64_t>(BytesOf(time.type));
    if (bytes / kMostExpansion > file.FileSize())
        return file.InputFault(time, "counts " + std::to_string(steps) +
                                         " time steps, more than the file can hold");
    return Status::Ok();
}

class AxisReader {
  public:
    AxisReader(const NcFile& source, const NcVariable& variable)
        : file(source),
          time(variable),
          packing(source, variable),
          start(Rank(), 0),
          count(Rank(), 1) {
        const int dimension = TimeDimensionOf(file, time);
        for (std::size_t i = 0; i < time.dimensions.size(); ++i)
            if (time.dimensions[i] == dimension)
                place = i;
        steps = file.DimensionOf(time, place).length;
    }

    std::size_t Steps() const { return steps; }

    /// Hands each time to `take`, which gives back a reason for refusing it, or null.
    template <typename Take>
    Status ForEach(Take take) {
        std::vector<double> block(std::min(kBlock, steps));
        for (std::size_t first = 0; first < steps; first += kBlock) {
            start[place] = first;
            count[place] = std::min(kBlock, steps - first);
            if (Status status = file.Read(time, start, count, block.data()); !status)
                return status;
            for (std::size_t i = 0; i < count[place]; ++i) {
                const char* const reason = take(block[i] * packing.scale + packing.offset);
                if (reason != nullptr)
                    return file.InputFault(time, std::string(reason) + " at step " +
                                                     std::to_string(first + i + 1));
            }
        }
        return Status::Ok();
    }

  private:
    std::size_t Rank() const { return time.dimensions.size(); }

    const NcFile& file;
    const NcVariable& time;
    TimePacking packing;
    std::vector<std::size_t> start;
    std::vector<std::size_t> count;
    std::size_t place = 0;
    std::size_t steps = 0;
};

/// Months and years that are not all whole are mean ones.
Status ChooseMonths(AxisReader* reader, CfTime* time) {
    bool areWhole = true;
    Status status = reader->ForEach([&](double value) {
        areWhole = areWhole && value == std::floor(value);
        return static_cast<const char*>(nullptr);
    });
    if (status && !areWhole)
        time->UseMeanMonths();
    return status;
}

} // namespace

int TimeDimensionOf(const NcFile& file, const NcVariable& time) {
    return OnlyDimension(file, time);
}

const NcVariable* FindTimeVariable(const NcFile& file) {
    const NcVariable* best = nullptr;
    int bestLikeness = 0;
    for (const NcVariable& variable : file.Variables()) {
        const int likeness = TimeLikeness(file, variable);
        if (likeness > bestLikeness) {
            best = &variable;
            bestLikeness = likeness;
        }
    }
    return best;
}

Status ReadCfTime(const NcFile& file, const NcVariable& time, CfTime* result) {
    const Status status = CfTime::Parse(file.Text(time.id, "units").value_or(""),
                                        file.Text(time.id, "calendar").value_or(""), result);
    return status ? Status::Ok() : file.InputFault(time, "has a fault: " + status.Text());
}

Status ReadCfTimeAxis(const NcFile& file, const NcVariable& time, TimeOrder order,
                      CfTimeAxis* axis) {
    CfTimeAxis read;
    if (Status status = ReadCfTime(file, time, &read.time); !status)
        return status;
    AxisReader reader(file, time);
    if (Status status = CheckStepCount(file, time, reader.Steps()); !status)
        return status;
    if (read.time.CountsMonths())
        if (Status status = ChooseMonths(&reader, &read.time); !status)
            return status;
    auto& steps = read.milliseconds;
    Status status = reader.ForEach([&](double value) -> const char* {
        const auto milliseconds = read.time.Milliseconds(value);
        if (!milliseconds)
            return "has no date between the years 100 and 9999";
        if (order == TimeOrder::Ascending && !steps.empty() && *milliseconds <= steps.back())
            return *milliseconds == steps.back() ? "repeats a time" : "goes back in time";
        steps.push_back(*milliseconds);
        return nullptr;
    });
    if (status)
        *axis = std::move(read);
    return status;
}

} // namespace ryn
