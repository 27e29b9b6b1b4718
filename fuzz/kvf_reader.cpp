#include <cstddef>
#include <cstdint>
#include <cstdlib>
#include <string>
#include <string_view>

#include "kvf/kvf.h"

/// A text that loads is written, and what is written loads again and is written alike. One that
/// does not load is described.
extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    const std::string_view text(reinterpret_cast<const char*>(data), size);
    const ryn::KvfHandle tree = ryn::kvfLoadText(text, "input");
    if (!tree) {
        int line = 0;
        int column = 0;
        std::string error;
        ryn::kvfGetSyntaxErr(nullptr, &line, &column, &error);
        if (ryn::kvfPeekErrorGlb() == 0 || line < 1 || column < 1 || error.empty())
            std::abort();
        return 0;
    }
    const std::string written = ryn::kvfText(tree.get());
    const ryn::KvfHandle again = ryn::kvfLoadText(written, "written");
    if (!again || ryn::kvfText(again.get()) != written)
        std::abort();
    return 0;
}
