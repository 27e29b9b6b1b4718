#include <array>
#include <filesystem>
#include <fstream>
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "base/file_access.h"
#include "netcdf/nc_file.h"
#include "netcdf/nc_writer.h"
#include "support/scratch_directory.h"

namespace ryn {
namespace {

std::string PathOf(const std::string& name) {
    return test::ScratchDirectory() + "netcdf_" + name;
}

void WriteBytes(const std::string& path, const std::string& bytes) {
    std::filesystem::remove(path); // emptying a file instead makes the disk flush it
    std::ofstream(path, std::ios::binary) << bytes;
}

std::string Bytes(const std::string& path) {
    std::string bytes;
    EXPECT_TRUE(ReadWholeFile(path, 1 << 20, &bytes).IsOk());
    return bytes;
}

std::string MakeWith(NcFormat format) {
    const std::string path = PathOf("made.nc");
    WriteBytes(path, "");
    NcWriter writer(path, path, format);
    const int time = writer.DefineDimension("time", 5);
    const int place = writer.DefineDimension("place", 3);
    const int times = writer.DefineVariable("time", NcType::Double, std::array{time});
    const int level = writer.DefineVariable("level", NcType::Float, std::array{time, place});
    writer.PutText(times, "units", "s");
    writer.PutInt(kNcGlobal, "number", 7);
    writer.EndDefinitions();
    const std::array<double, 5> seconds = {0, 1, 2, 3, 4};
    const std::vector<float> levels(15, 2.5F);
    const std::array<std::size_t, 2> start{};
    writer.Write(times, start, std::array<std::size_t, 1>{5}, seconds.data());
    writer.Write(level, start, std::array<std::size_t, 2>{5, 3}, levels.data());
    EXPECT_TRUE(writer.Finish().IsOk());
    return path;
}

Status OpenBytes(const std::string& bytes) {
    const std::string path = PathOf("opened.nc");
    WriteBytes(path, bytes);
    NcFile file;
    return NcFile::Open(path, &file);
}

TEST(NetcdfFile, ReadsBackWhatWasWritten) {
    for (const NcFormat format : {NcFormat::Offset64, NcFormat::Data64}) {
        const std::string path = MakeWith(format);
        NcFile file;
        ASSERT_TRUE(NcFile::Open(path, &file).IsOk());
        EXPECT_EQ(Bytes(path)[3], format == NcFormat::Offset64 ? 2 : 5);
        ASSERT_NE(file.FindVariable("level"), nullptr);
        EXPECT_EQ(file.FindVariable("nothing"), nullptr);
        EXPECT_EQ(file.Text(0, "units"), "s");
        EXPECT_EQ(file.Number(kNcGlobal, "number"), 7.0);
        EXPECT_EQ(file.Text(kNcGlobal, "number"), std::nullopt);
        std::array<float, 2> values{};
        const NcVariable& level = *file.FindVariable("level");
        ASSERT_TRUE(file.Read(level, std::array<std::size_t, 2>{4, 1},
                              std::array<std::size_t, 2>{1, 2}, values.data())
                        .IsOk());
        EXPECT_EQ(values[1], 2.5F);
        EXPECT_FALSE(file.Read(level, std::array<std::size_t, 2>{5, 0},
                               std::array<std::size_t, 2>{1, 1}, values.data())
                         .IsOk());
    }
}

TEST(NetcdfFile, TakesTheOlderFormatUpToFourGigabytes) {
    EXPECT_EQ(FormatForVariable(0xFFFFFFFBU), NcFormat::Offset64);
    EXPECT_EQ(FormatForVariable(0xFFFFFFFCU), NcFormat::Data64);
}

TEST(NetcdfFile, NoCutFileOpens) {
    for (const NcFormat format : {NcFormat::Offset64, NcFormat::Data64}) {
        const std::string whole = Bytes(MakeWith(format));
        for (std::size_t length = 0; length < whole.size(); ++length)
            EXPECT_FALSE(OpenBytes(whole.substr(0, length)).IsOk()) << length;
    }
}

TEST(NetcdfFile, SaysHowMuchIsCutOff) {
    const std::string whole = Bytes(MakeWith(NcFormat::Offset64));
    const Status status = OpenBytes(whole.substr(0, whole.size() - 4));
    EXPECT_EQ(status.Text(), PathOf("opened.nc") + ": the file is cut off: it has " +
                                 std::to_string(whole.size() - 4) +
                                 " bytes, and its header describes at least " +
                                 std::to_string(whole.size()));
}

TEST(NetcdfFile, ReadsEveryByteFlippedWithoutACrash) {
    const std::string whole = Bytes(MakeWith(NcFormat::Offset64));
    int opened = 0;
    for (std::size_t place = 0; place < whole.size(); ++place)
        for (const int flip : {0x01, 0x80, 0xff}) {
            std::string bytes = whole;
            bytes[place] = static_cast<char>(bytes[place] ^ flip);
            opened += OpenBytes(bytes).IsOk() ? 1 : 0;
        }
    EXPECT_GT(opened, 0); // names and values are free
}

TEST(NetcdfFile, RefusesCountsThatLie) {
    const std::string whole = Bytes(MakeWith(NcFormat::Offset64));
    const auto with = [&](std::size_t place, const std::string& number) {
        std::string bytes = whole;
        bytes.replace(place, number.size(), number);
        return OpenBytes(bytes).Text();
    };
    const std::string huge = "\x7f\xff\xff\xff";
    const std::string file = PathOf("opened.nc") + ": ";
    EXPECT_EQ(with(12, huge), file + "the header counts more entries than the file has room for");
    EXPECT_EQ(with(16, huge), file + "a name is longer than 256 bytes");
    EXPECT_NE(with(24, huge).find("the file is cut off"), std::string::npos); // length of time
    EXPECT_EQ(with(4, "\xff\xff\xff\xff"), file + "the number of records was never written");
}

TEST(NetcdfFile, RefusesWhatIsNoNetcdf) {
    const std::string reason = PathOf("opened.nc") + ": no netCDF file";
    EXPECT_EQ(OpenBytes("time,value\n2000-01-01,3\n").Text(), reason);
    EXPECT_EQ(OpenBytes("CDF\x03 and more of it").Text(), reason);
    EXPECT_FALSE(OpenBytes("").IsOk());
    EXPECT_FALSE(OpenBytes("\x89HDF\r\n\x1a\n and nothing else").IsOk());
    NcFile file;
    EXPECT_FALSE(NcFile::Open(test::ScratchDirectory(), &file).IsOk());
    EXPECT_FALSE(NcFile::Open("/dev/null", &file).IsOk());
    EXPECT_FALSE(NcFile::Open(PathOf("missing.nc"), &file).IsOk());
    EXPECT_FALSE(NcFile::Open("http://127.0.0.1:9/opened.nc", &file).IsOk());
}

TEST(NetcdfFile, ANameIsNothingButAName) {
    const std::string made = MakeWith(NcFormat::Offset64);
    for (const std::string name : {"a#mode=bytes.nc", "back\\slash.nc", "[x]y.nc", "流量 2.nc"}) {
        const std::string path = PathOf(name);
        std::filesystem::copy_file(made, path, std::filesystem::copy_options::overwrite_existing);
        NcFile file;
        EXPECT_TRUE(NcFile::Open(path, &file).IsOk()) << name;
    }
}

} // namespace
} // namespace ryn
