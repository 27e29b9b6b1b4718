#include <cmath>
#include <cstdlib>
#include <fstream>
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "netcdf/nc_values.h"

#include "support/scratch_directory.h"

namespace ryn {
namespace {

/// Values of a variable `v` of four numbers, with NaN shown as -1.
std::vector<float> Decoded(const std::string& type, const std::string& attributes,
                           const std::string& data, const std::string& kind = "classic") {
    const std::string base = test::ScratchDirectory() + "values_" + type;
    std::ofstream(base + ".cdl") << "netcdf v { dimensions: n = 4 ; variables: " << type
                                 << " v(n) ;\n"
                                 << attributes << "\ndata: v = " << data << " ; }";
    const std::string make = "ncgen -k " + kind + " -o " + base + ".nc " + base + ".cdl";
    EXPECT_EQ(std::system(make.c_str()), 0);
    NcFile file;
    EXPECT_TRUE(NcFile::Open(base + ".nc", &file).IsOk());
    NcValues values(&file, file.FindVariable("v"));
    std::vector<float> result(4);
    const std::vector<std::size_t> start = {0};
    const std::vector<std::size_t> count = {4};
    EXPECT_TRUE(values.Read(start, count, result.data()).IsOk());
    for (float& value : result)
        if (std::isnan(value))
            value = -1.0F;
    return result;
}

using Floats = std::vector<float>;

TEST(NetcdfValues, UnpackAndLeaveOutWhatIsMissing) {
    EXPECT_EQ(Decoded("float", "", "1, 2, NaN, Infinity"), (Floats{1, 2, -1, -1}));
    EXPECT_EQ(Decoded("float", "v:_FillValue = -9.f ;", "1, -9, 9.96921e36, 4")[1], -1.0F);
    EXPECT_EQ(
        Decoded("float", "v:missing_value = -999.9 ;", "1, -999.9, 3, 9.9692099683868690e+36f"),
        (Floats{1, -1, 3, -1}));
    EXPECT_EQ(
        Decoded("float", "v:_FillValue = -9.f ; v:missing_value = -8.f, -7.f ;", "-9, -8, -7, 4"),
        (Floats{-1, -1, -1, 4}));
    EXPECT_EQ(Decoded("double", "v:missing_value = 1.e20f ;", "1, 1e20, 1e300, 4"),
              (Floats{1, -1, -1, 4}));
    EXPECT_EQ(Decoded("short", "v:scale_factor = 0.5 ; v:add_offset = 10. ; v:_FillValue = -2s ;",
                      "0, 1, -2, -32767"),
              (Floats{10, 10.5, -1, -16373.5}));
    EXPECT_EQ(Decoded("int", "", "0, 1, -2147483647, 7"), (Floats{0, 1, -1, 7}));
    EXPECT_EQ(Decoded("byte", "v:_Unsigned = \"true\" ; v:_FillValue = -1b ;", "0, 127, -128, -1"),
              (Floats{0, 127, 128, -1}));
    EXPECT_EQ(Decoded("int64", "v:scale_factor = 0.001 ;", "1000, 2000, 0, 5000", "nc4"),
              (Floats{1, 2, 0, 5}));
}

TEST(NetcdfValues, AttributesOfTheWrongKindAreNone) {
    EXPECT_EQ(
        Decoded("float", "v:missing_value = \"none\" ; v:scale_factor = \"2\" ;", "1, 2, 3, 4"),
        (Floats{1, 2, 3, 4}));
    EXPECT_EQ(Decoded("float", "v:scale_factor = 2., 3. ;", "1, 2, 3, 4"), (Floats{1, 2, 3, 4}));
}

} // namespace
} // namespace ryn
