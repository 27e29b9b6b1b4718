#include "tsq/netcdf_source.h"

#include <algorithm>
#include <array>
#include <cmath>
#include <string>
#include <utility>

#include "tsq/records.h"

namespace ryn {

namespace {

// A block of each column stays in the processor's cache between loading and reading.
constexpr std::size_t kBlock = 16384;
// Numbers of one step: 1 GiB of floats.
constexpr std::size_t kMaxCells = std::size_t{1} << 28;

} // namespace

NetcdfSource::NetcdfSource(std::shared_ptr<const NcFile> from, std::size_t steps,
                           TimeColumn timeColumn, std::vector<ItemColumn> columns)
    : file(std::move(from)),
      count(steps),
      time(std::move(timeColumn)),
      items(std::move(columns)) {
    for (const ItemColumn& column : items)
        decoders.emplace_back(file.get(), column.variable);
}

Status NetcdfSource::LoadTimes(std::size_t step, StepBlock<double>* block) {
    if (time.variable == nullptr) {
        block->numbers = time.seconds.data();
        block->size = time.seconds.size();
        return Status::Ok();
    }
    const std::size_t size = std::min(kBlock, count - step);
    block->storage.resize(std::min(kBlock, count));
    if (Status status =
            file->Read(*time.variable, std::array{step}, std::array{size}, block->storage.data());
        !status)
        return status;
    for (std::size_t i = 0; i < size; ++i) {
        double& value = block->storage[i];
        if (!std::isfinite(value))
            return file->InputFault(*time.variable,
                                    "is not finite at step " + std::to_string(step + i + 1));
        if (time.start != 0.0)
            value = RoundedToMillisecond(value - time.start, time.millisecondsInUnit);
    }
    block->numbers = block->storage.data();
    block->first = step;
    block->size = size;
    return Status::Ok();
}

std::size_t NetcdfSource::StepsAt(const ItemColumn& column, std::size_t step) const {
    // Where time is not the slowest dimension, several steps would come interleaved.
    const std::size_t wanted =
        column.isStepwise ? std::max<std::size_t>(1, kBlock / column.cells) : 1;
    return std::min(wanted, count - step);
}

Status NetcdfSource::ReadItem(std::size_t item, std::size_t step, std::size_t steps,
                              float* values) {
    const ItemColumn& column = items[item];
    const NcVariable& variable = *column.variable;
    // The library wants a place and a length for each dimension, those of length 1 included.
    std::vector<std::size_t> start(variable.dimensions.size(), 0);
    std::vector<std::size_t> size;
    for (std::size_t i = 0; i < variable.dimensions.size(); ++i)
        size.push_back(file->DimensionOf(variable, i).length);
    start[column.timePlace] = step;
    size[column.timePlace] = steps;
    return column.isOurs ? file->Read(variable, start, size, values)
                         : decoders[item].Read(start, size, values);
}

Status NetcdfSource::LoadValues(std::size_t item, std::size_t step, StepBlock<float>* block) {
    const ItemColumn& column = items[item];
    if (column.cells > kMaxCells)
        return file->InputFault(*column.variable, "has too many values in a time step");
    const std::size_t steps = StepsAt(column, step);
    block->storage.resize(std::max(block->storage.size(), steps * column.cells));
    if (Status status = ReadItem(item, step, steps, block->storage.data()); !status)
        return status;
    block->numbers = block->storage.data();
    block->first = step;
    block->size = steps;
    block->width = column.cells;
    return Status::Ok();
}

Status NetcdfSource::CountMissing(std::size_t item, std::size_t* missing) {
    std::size_t found = 0;
    StepBlock<float> block;
    for (std::size_t step = 0; !items[item].isOurs && step < count; step += block.size) {
        if (Status status = LoadValues(item, step, &block); !status)
            return status;
        const float* const end = block.numbers + block.size * block.width;
        found += static_cast<std::size_t>(
            std::count_if(block.numbers, end, [](float value) { return std::isnan(value); }));
    }
    *missing = found;
    return Status::Ok();
}

} // namespace ryn
