#include <csignal>
#include <filesystem>
#include <string>
#include <sys/stat.h>
#include <vector>

#include <gtest/gtest.h>

#include "unit/tsq/series_fixture.h"

#include "support/scratch_directory.h"

namespace ryn {
namespace {

using test::Bytes;
using test::NewSeries;
using test::PathOf;
using test::Reading;
using test::Write;
using test::WriteBytes;

std::string SmallSeries() {
    const std::string path = PathOf("small.tsq0");
    TsqHeaderHandle header = NewSeries();
    EXPECT_EQ(Write(path, header.get(), {{0.0, {1.0F}}, {60.0, {2.0F}}, {120.0, {3.0F}}}), 0);
    return Bytes(path);
}

/// Opens bytes as a file and reads all that it offers; true when it opens.
bool ReadsAll(const std::string& bytes) {
    const std::string path = PathOf("hostile.tsq0");
    WriteBytes(path, bytes);
    Reading read(path);
    if (read.result != 0) {
        EXPECT_FALSE(tsqTakeError().Text().empty());
        return false;
    }
    const int items = tsqGetNoOfItems(read.header.get());
    double time = 0.0;
    for (int i = 0; i < test::CountOf(read.header.get()) * items; ++i) {
        const TsqItem* const item = tsqItemD(read.header.get(), i % items + 1);
        std::vector<float> values(tsqGetItemSize(item));
        if (tsqReadItemTimeStep(read.header.get(), read.file.get(), &time, values.data()) != 0)
            break;
    }
    return true;
}

TEST(HostileFile, CutAnywhereIsRefused) {
    const std::string whole = SmallSeries();
    ASSERT_TRUE(ReadsAll(whole));
    for (std::size_t length = 0; length < whole.size(); ++length)
        EXPECT_FALSE(ReadsAll(whole.substr(0, length))) << length;
}

TEST(HostileFile, AnyByteFlippedIsReadOrRefused) {
    const std::string whole = SmallSeries();
    for (std::size_t place = 0; place < whole.size(); ++place)
        for (const int flip : {0x01, 0x40, 0xff}) {
            std::string bytes = whole;
            bytes[place] = static_cast<char>(bytes[place] ^ flip);
            ReadsAll(bytes);
        }
}

TEST(HostileFile, GarbageBehindTheEndIsHarmless) {
    EXPECT_TRUE(ReadsAll(SmallSeries() + std::string(1000, 'x')));
}

TEST(HostileFile, IsNoNetcdf) {
    EXPECT_FALSE(ReadsAll("Date,Value\n1990-01-01,3.5\n"));
    EXPECT_FALSE(ReadsAll(""));
    EXPECT_FALSE(ReadsAll(std::string(4096, '\0')));
    EXPECT_NE(Reading(test::ScratchDirectory()).result, 0);
    EXPECT_NE(Reading("").result, 0);
    const std::string pipe = PathOf("pipe");
    ::mkfifo(pipe.c_str(), 0600);
    EXPECT_NE(Reading(pipe).result, 0); // and does not wait for a writer
    EXPECT_EQ(tsqTakeError().Text(), pipe + ": not a regular file");
}

TEST(HostileFile, AttributesOfTheWrongTypeAreSetAside) {
    const std::string path = test::MakeNetcdf(
        "wrong_types",
        "dimensions: time = 2 ; variables: double time(time) ; time:units = \"s\" ;"
        " time:ryn_axis = \"four\" ; time:ryn_start = 1, 2 ; float q(time) ; q:long_name = 5 ;"
        " q:units = 3.5 ; q:ryn_type = 1e300 ; q:ryn_unit = \"m\" ; q:ryn_reference = 1.f ;"
        " :ryn_format = 1 ; :title = 3 ; :ryn_file_type = 2.5 ; data: time = 1, 2 ; q = 3, 4 ;");
    Reading read(path);
    ASSERT_EQ(read.result, 0) << tsqTakeError().Text();
    EXPECT_EQ(tsqGetTimeAxisType(read.header.get()), kTsqNeqTimeAxis);
    EXPECT_EQ(tsqGetFileTitle(read.header.get()), "");
    EXPECT_EQ(read.Steps()[1].values[0], 4.0F);
}

TEST(HostileFile, AMountainOfTextIsNoName) {
    const std::string path = test::MakeNetcdf(
        "long_text", "dimensions: time = 1 ; variables: double time(time) ; time:units = \"s\" ;"
                     " float q(time) ; q:long_name = \"" +
                         std::string(70000, 'n') + "\" ; q:units = \"" + std::string(70000, 'm') +
                         "\" ; data: time = 1 ; q = 3 ;");
    Reading read(path);
    ASSERT_EQ(read.result, 0) << tsqTakeError().Text();
    EXPECT_EQ(read.ItemName(1), "q");
}

TEST(HostileFile, ATimeThatIsNoNumberStopsTheReading) {
    const std::string path = test::MakeNetcdf(
        "nan_time",
        "dimensions: time = 3 ; variables: double time(time) ;"
        " time:units = \"seconds since 2000-01-01\" ; time:calendar = \"proleptic_gregorian\" ;"
        " time:ryn_axis = 4 ; time:ryn_unit = 1400 ; time:ryn_start = 0. ; float q(time) ;"
        " :ryn_format = 1 ; data: time = 0, NaN, 2 ; q = 3, 4, 5 ;");
    Reading read(path);
    ASSERT_EQ(read.result, 0) << tsqTakeError().Text();
    double time = 0.0;
    EXPECT_NE(tsqReadItemTimeStep(read.header.get(), read.file.get(), &time, nullptr), 0);
    EXPECT_EQ(tsqTakeError().Text(), path + ": \"time\" is not finite at step 2");
}

} // namespace
} // namespace ryn
