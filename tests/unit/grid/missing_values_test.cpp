#include <limits>

#include "unit/grid/grid_fixture.h"

namespace ryn {
namespace {

using test::NetcdfSample;
using test::OpenGrid;
using test::SampleGrid;

constexpr float kNan = std::numeric_limits<float>::quiet_NaN();
constexpr float kFloatFill = 9.9692099683868690e+36F;

/// The sample with one number at the cell (1, 1) of step 0 and another at (2, 1).
SampleGrid WithCells(double first, double second) {
    SampleGrid sample;
    sample.value = [=](int x, int y, int step) {
        const bool isThere = y == 1 && step == 0;
        return isThere && x == 1   ? first
               : isThere && x == 2 ? second
                                   : static_cast<double>(test::CellValue(x, y, step));
    };
    return sample;
}

TEST(GridMissingValues, AreTheDeleteValueHoweverTheyAreMarked) {
    struct Case {
        const char* what;
        double fill;         ///< _FillValue; 0 for none
        double missingValue; ///< missing_value; 0 for none
        double first;
        double second;
        float deleteValue;
    };
    const double nan = static_cast<double>(kNan);
    const Case cases[] = {
        {"_FillValue", -999, 0, -999, -999, -999.0F},
        {"missing_value alone", 0, 1e20, 1e20, 1e20, 1e20F},
        {"missing_value that differs", -1.7e38, 1e34, 1e34, -1.7e38, -1.7e38F},
        {"NaN beside a fill value", 1e20, 0, nan, 1e20, 1e20F},
        {"NaN as fill value", nan, 0, nan, nan, kFloatFill},
        {"NaN as fill value and a missing_value", nan, -9, nan, -9, -9.0F},
        {"infinite", 1e20, 0, std::numeric_limits<double>::infinity(), 1e20, 1e20F},
        {"the library's own fill", 0, 0, kFloatFill, kFloatFill, kFloatFill},
    };
    for (const Case& c : cases) {
        SampleGrid sample = WithCells(c.first, c.second);
        sample.define = [&](NetcdfSample& file) {
            if (c.fill != 0.0)
                file.Mark("q", "_FillValue", c.fill);
            if (c.missingValue != 0.0)
                file.Mark("q", "missing_value", c.missingValue);
        };
        OpenGrid grid(sample.Write("missing"));
        EXPECT_EQ(grid.header.DeleteValue(), c.deleteValue) << c.what;
        EXPECT_EQ(grid.At(1, 1, 0), c.deleteValue) << c.what;
        EXPECT_EQ(grid.At(2, 1, 0), c.deleteValue) << c.what;
        EXPECT_EQ(grid.At(3, 1, 0), 13.0F) << c.what;
        const std::vector<float> tile = grid.Read({1, 0, 1, 1, 1, 1, 0, 2}, 4096);
        EXPECT_EQ(tile, (std::vector{c.deleteValue, 111.0F})) << c.what;
        GridSummary summary;
        EXPECT_EQ(grid.engine.Summarise(1, 0, &summary), kGridOk);
        EXPECT_EQ(summary.missing, 2U) << c.what;
        EXPECT_EQ(summary.values, 60U);
        EXPECT_EQ(summary.smallest, 0.0F);
        EXPECT_EQ(summary.largest, 423.0F);
    }
}

TEST(GridMissingValues, OfPackedNumbersDoNotTakeAPossibleValue) {
    SampleGrid sample = WithCells(-32767, -32766);
    sample.type = NC_SHORT;
    sample.define = [](NetcdfSample& file) {
        file.Number("q", "scale_factor", 0.01).Number("q", "add_offset", 273.15);
        file.Mark("q", "_FillValue", -32767).Mark("q", "missing_value", -32766);
    };
    OpenGrid grid(sample.Write("packed"));
    EXPECT_EQ(grid.header.DeleteValue(), kFloatFill);
    EXPECT_EQ(grid.At(1, 1, 0), kFloatFill);
    EXPECT_EQ(grid.At(2, 1, 0), kFloatFill);
    EXPECT_FLOAT_EQ(grid.At(3, 2, 4), 273.15F + 4.23F);
}

TEST(GridMissingValues, OfOneItemAreNotDataOfAnother) {
    SampleGrid sample = WithCells(-999, 5);
    sample.define = [](NetcdfSample& file) {
        file.Mark("q", "_FillValue", -999).Variable("other", NC_FLOAT, {"time", "lat", "lon"});
        file.Mark("other", "_FillValue", 1e20);
    };
    sample.fill = [](NetcdfSample& file) {
        std::vector<double> values(60, -999.0);
        values[5] = 1e20;
        file.Values("other", values);
    };
    OpenGrid grid(sample.Write("two_fills"));
    EXPECT_EQ(grid.header.DeleteValue(), kFloatFill);
    EXPECT_EQ(grid.At(1, 1, 0, 1), kFloatFill);
    EXPECT_EQ(grid.At(0, 0, 0, 2), -999.0F);
    EXPECT_EQ(grid.At(1, 1, 0, 2), kFloatFill);
}

TEST(GridMissingValues, ThroughoutLeaveNoRange) {
    SampleGrid sample;
    sample.value = [](int, int, int) { return static_cast<double>(kNan); };
    OpenGrid grid(sample.Write("nothing"));
    GridSummary summary;
    EXPECT_EQ(grid.engine.Summarise(1, 0, &summary), kGridOk);
    EXPECT_EQ(summary.MissingShare(), 1.0);
    EXPECT_TRUE(std::isnan(summary.smallest) && std::isnan(summary.largest));
}

} // namespace
} // namespace ryn
