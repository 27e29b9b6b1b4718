#include "tsq/step_writer.h"

#include <algorithm>
#include <climits>
#include <cmath>
#include <new>
#include <utility>

#include "base/path_parts.h"
#include "tsq/encode.h"
#include "tsq/memory_store.h"

namespace ryn {

Status StepWriter::Create(const std::string& path, const TsqHeader& header,
                          std::unique_ptr<StepWriter>* writer) {
    if (path.empty())
        return Status::SystemFault("no file name");
    if (header.axis.type == 0)
        return Status::InputFault(path + ": the data file has no time axis");
    if (Status status = CheckCoordinates(path, header); !status)
        return status;
    auto made = std::make_unique<StepWriter>();
    // The current directory may be another one by the time the file is closed.
    made->path = MemoryStore::Instance().AbsolutePath(path);
    made->isInMemory = MemoryStore::Instance().Covers(made->path);
    if (!made->isInMemory)
        if (Status status = made->target.Open(made->path); !status)
            return status;
    made->content.header = header;
    made->content.values.resize(header.items.size());
    made->millisecondsInUnit = MillisecondsInUnit(header.axis.unit);
    *writer = std::move(made);
    return Status::Ok();
}

bool StepWriter::Fail(const std::string& reason) {
    failure = Status::InputFault(path + ": " + reason);
    return false;
}

bool StepWriter::AppendTime(double time) {
    if (count >= static_cast<std::size_t>(INT_MAX))
        return Fail("a data file has at most 2147483647 time steps");
    // The axis tells the times, and what callers pass may be absolute.
    if (content.header.axis.IsEquidistant())
        return true;
    if (!std::isfinite(time))
        return Fail("the time of step " + std::to_string(count + 1) + " is not finite");
    content.times.push_back(RoundedToMillisecond(time, millisecondsInUnit));
    return true;
}

void StepWriter::AppendPlane(const TsqItem& of, const float* values) {
    // A hole in a result grid must look like one to other programs, which know the fill value.
    std::vector<float>& column = content.values[item];
    const auto first = static_cast<std::ptrdiff_t>(column.size());
    column.insert(column.end(), values, values + of.cells);
    std::ranges::replace_if(
        column.begin() + first, column.end(), [](float value) { return std::isnan(value); },
        content.header.deleteFloat);
}

bool StepWriter::AppendTimes(const double* times, std::size_t size) {
    if (size > static_cast<std::size_t>(INT_MAX) - count)
        return Fail("a data file has at most 2147483647 time steps");
    if (content.header.axis.IsEquidistant())
        return true;
    if (!std::all_of(times, times + size, [](double time) { return std::isfinite(time); }))
        return Fail("the time of a step is not finite");
    const std::size_t first = content.times.size();
    content.times.resize(first + size);
    std::transform(times, times + size, content.times.begin() + static_cast<std::ptrdiff_t>(first),
                   [this](double time) { return RoundedToMillisecond(time, millisecondsInUnit); });
    return true;
}

bool StepWriter::AppendSteps(const double* times, const float* values, std::size_t size) try {
    const bool isPlain =
        content.header.items.size() == 1 && content.header.items[0].dimensions == 0;
    if (failure && !isPlain)
        return Fail("whole steps are appended to a plain series of one item only");
    if (!failure || !AppendTimes(times, size))
        return false;
    content.values[0].insert(content.values[0].end(), values, values + size);
    count += size;
    return true;
} catch (const std::bad_alloc&) {
    failure = Status::SystemFault(path + ": not enough memory for the time steps");
    return false;
}

bool StepWriter::Append(double time, const float* values) try {
    if (!failure || (item == 0 && !AppendTime(time)))
        return false;
    const TsqItem& written = content.header.items[item];
    if (written.dimensions == 0)
        content.values[item].push_back(*values);
    else
        AppendPlane(written, values);
    if (++item == content.header.items.size()) {
        item = 0;
        ++count;
    }
    return true;
} catch (const std::bad_alloc&) {
    failure = Status::SystemFault(path + ": not enough memory for the time steps");
    return false;
}

void StepWriter::CompleteAxis() {
    TsqAxis& axis = content.header.axis;
    axis.count = static_cast<int>(count);
    if (count == 0)
        axis.span = 0.0;
    else
        axis.span = axis.IsEquidistant() ? static_cast<double>(count - 1) * axis.step
                                         : content.times.back();
}

Status StepWriter::Finish() {
    if (failure && item != 0)
        Fail("the last time step lacks items");
    if (!failure)
        return failure;
    CompleteAxis();
    if (isInMemory)
        return MemoryStore::Instance().Put(path, std::move(content));
    if (Status status = EncodeNetcdf(content, target.TemporaryName(), path); !status)
        return status;
    return target.Commit(content.header.durability);
}

} // namespace ryn
