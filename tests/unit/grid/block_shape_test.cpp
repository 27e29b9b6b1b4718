#include "grid/block_shape.h"

#include <algorithm>
#include <set>

#include <gtest/gtest.h>
#include <rapidcheck/gtest.h>

namespace ryn {
namespace {

using Lengths = std::vector<std::size_t>;

TEST(BlockShape, GrowsAlongTheFastestDimensionsInWholeChunks) {
    EXPECT_EQ(BlockShape(Lengths{1, 1, 1}, Lengths{100, 20, 30}, 3000), (Lengths{5, 20, 30}));
    EXPECT_EQ(BlockShape(Lengths{1, 1, 1}, Lengths{100, 20, 30}, 70), (Lengths{1, 2, 30}));
    // A chunk of 3 may begin anywhere in 5 places, which then touch up to three.
    EXPECT_EQ(BlockShape(Lengths{7, 2, 3}, Lengths{100, 20, 5}, 140), (Lengths{7, 4, 9}));
    EXPECT_EQ(BlockShape(Lengths{100, 2, 3}, Lengths{100, 20, 30}, 150), (Lengths{25, 2, 3}));
    EXPECT_EQ(BlockShape(Lengths{100, 2, 3}, Lengths{100, 20, 30}, 1), (Lengths{1, 1, 1}));
}

RC_GTEST_PROP(BlockShape, CutsEveryRunWhollyWithinTheBudgetAndNoChunkTwice, ()) {
    const auto small = [](int most) {
        return static_cast<std::size_t>(*rc::gen::inRange(1, most));
    };
    Lengths chunk;
    Lengths extent;
    std::vector<Run> runs;
    std::size_t chunkVolume = 1;
    for (int i = 0; i < 3; ++i) {
        chunk.push_back(small(8));
        extent.push_back(small(30));
        runs.push_back({small(20) - 1, extent.back()});
        chunkVolume *= std::min(chunk.back(), extent.back());
    }
    const std::size_t budget = small(4000);
    const Lengths shape = BlockShape(chunk, extent, budget);
    std::size_t largest = 1;
    for (std::size_t i = 0; i < 3; ++i) {
        const std::vector<Run> pieces = CutRun(runs[i], chunk[i], shape[i]);
        std::size_t next = runs[i].start;
        std::size_t most = 0;
        std::set<std::size_t> chunks;
        for (const Run& piece : pieces) {
            RC_ASSERT(piece.start == next && piece.count > 0U);
            next += piece.count;
            most = std::max(most, piece.count);
            // Whole chunks in each piece, unless a chunk alone is beyond the budget.
            if (chunkVolume <= budget && extent[i] >= chunk[i])
                for (std::size_t c = piece.start / chunk[i]; c <= (next - 1) / chunk[i]; ++c)
                    RC_ASSERT(chunks.insert(c).second);
        }
        RC_ASSERT(next == runs[i].start + runs[i].count);
        largest *= most;
    }
    RC_ASSERT(largest <= budget);
}

} // namespace
} // namespace ryn
