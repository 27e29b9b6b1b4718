#include "tsq/step_reader.h"

#include <utility>

namespace ryn {

StepReader::StepReader(std::string filePath, const TsqHeader& header,
                       std::unique_ptr<StepSource> from)
    : path(std::move(filePath)),
      source(std::move(from)),
      count(static_cast<std::size_t>(header.axis.count)),
      equidistantStep(header.axis.IsEquidistant() ? header.axis.step : 0.0),
      blocks(header.items.size()) {}

void StepReader::Rewind() {
    step = 0;
    item = 0;
    failure = Status::Ok();
}

bool StepReader::LoadTimes() {
    // Emptied first, so that a block that was half filled is not read later.
    times.size = 0;
    failure = source->LoadTimes(step, &times);
    if (!failure)
        times.size = 0;
    return failure.IsOk();
}

bool StepReader::LoadValues(std::size_t wanted) {
    StepBlock<float>& block = blocks[wanted];
    block.size = 0;
    failure = source->LoadValues(wanted, step, &block);
    if (!failure)
        block.size = 0;
    return failure.IsOk();
}

bool StepReader::NextBlock(std::size_t wanted, TsqBlock* block) {
    if (item != 0) {
        failure = Status::InputFault(path + ": a time step is begun");
        return false;
    }
    TsqBlock found;
    if (step < count && !FindBlock(wanted, &found))
        return false;
    step += static_cast<std::size_t>(found.count);
    *block = found;
    return true;
}

bool StepReader::FindBlock(std::size_t wanted, TsqBlock* found) {
    StepBlock<float>& values = blocks[wanted];
    if (!values.Holds(step) && !LoadValues(wanted))
        return false;
    std::size_t end = std::min(count, values.first + values.size);
    if (!(equidistantStep > 0.0)) {
        if (!times.Holds(step) && !LoadTimes())
            return false;
        end = std::min(end, times.first + times.size);
        found->times = times.At(step);
    }
    found->values = values.At(step);
    found->count = static_cast<int>(end - step);
    return true;
}

bool StepReader::NoteFailure() {
    if (step >= count)
        failure = Status::InputFault(path + ": no time step behind the last one");
    return false;
}

Status StepReader::CountMissing(std::size_t itemIndex, std::size_t* missing) {
    return source->CountMissing(itemIndex, missing);
}

} // namespace ryn
