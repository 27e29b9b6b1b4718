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

bool StepReader::LoadValues() {
    StepBlock<float>& block = blocks[item];
    block.size = 0;
    failure = source->LoadValues(item, step, &block);
    if (!failure)
        block.size = 0;
    return failure.IsOk();
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
