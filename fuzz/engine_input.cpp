#include <cstddef>
#include <cstdint>
#include <cstdlib>
#include <string_view>

#include "engine/rynengine.h"
#include "kvf/kvf.h"

namespace {

/// The engine would write its files wherever the input says.
bool NamesAFile(const ryn::KvfTree* tree) {
    const ryn::KvfSection* const target = ryn::kvfTargetByNameNum(tree, "RynEditor", 1);
    const ryn::KvfSection* const section = ryn::kvfSectionByNameNum(target, "DefineEVS", 1);
    return ryn::kvfKeywordByNameNum(section, "OutputFileName", 1) != nullptr;
}

} // namespace

/// A tree that the store reads ends in one of the four statuses, with results for two of them that
/// the store writes and reads again.
extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    const std::string_view text(reinterpret_cast<const char*>(data), size);
    const ryn::KvfHandle input = ryn::kvfLoadText(text, "input");
    if (!input || NamesAFile(input.get()))
        return 0;
    ryn::KvfHandle output = ryn::kvfCreate();
    std::int32_t status = -1;
    ryn::RYNENGINE(&input, &output, &status);
    const bool hasResults = ryn::kvfTargetByNameNum(output.get(), "RYNoutput", 1) != nullptr;
    if (status < 0 || status > 3 || hasResults != (status == 0 || status == 2))
        std::abort();
    if (hasResults && !ryn::kvfLoadText(ryn::kvfText(output.get()), "results"))
        std::abort();
    return 0;
}
