#pragma once

#include <cstddef>
#include <vector>

#include "base/status.h"

namespace ryn {

/// The steps [first, end) of a column of numbers, `width` of them for each step. The numbers belong
/// to the storage or to whoever filled the block.
template <typename T>
struct StepBlock {
    const T* numbers = nullptr;
    std::size_t first = 0;
    std::size_t size = 0; ///< steps
    std::size_t width = 1;
    std::vector<T> storage;

    bool Holds(std::size_t step) const { return step - first < size; }
    const T* At(std::size_t step) const { return numbers + (step - first) * width; }
};

/// Where the numbers of a data file come from, block by block.
class StepSource {
  public:
    virtual ~StepSource() = default;
    /// Fills the block that begins at a step or holds it. Only called for steps of the file.
    virtual Status LoadTimes(std::size_t step, StepBlock<double>* block) = 0;
    virtual Status LoadValues(std::size_t item, std::size_t step, StepBlock<float>* block) = 0;
    /// Numbers of an item that its file marks as missing.
    virtual Status CountMissing(std::size_t item, std::size_t* missing) = 0;
};

} // namespace ryn
