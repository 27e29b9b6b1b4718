#pragma once

#include <cmath>
#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "base/file_access.h"
#include "support/scratch_directory.h"
#include "tsq/tsq.h"
#include "units/units.h"

namespace ryn::test {

inline std::string PathOf(const std::string& name) {
    return test::ScratchDirectory() + "tsq_" + name;
}

/// One step of a file that is written or was read: its time, and the values of all items.
struct Step {
    double time = 0.0;
    std::vector<float> values;
    friend bool operator==(const Step&, const Step&) = default;
};

inline TsqHeaderHandle NewHeader(int items, const std::string& title = "A title") {
    TsqHeaderHandle header;
    EXPECT_EQ(tsqHeaderCreate(4, title, "RYNEditor", 100, items, 1, &header), 0);
    for (int i = 1; i <= items; ++i)
        tsqSetItemInfo(header.get(), tsqItemD(header.get(), i), 102, "Item " + std::to_string(i),
                       UnitOfText("m3/s"), kTsqDataTypeFloat);
    return header;
}

/// A header with one item on a non-equidistant calendar axis in seconds.
inline TsqHeaderHandle NewSeries(const std::string& title = "A title") {
    TsqHeaderHandle header = NewHeader(1, title);
    EXPECT_EQ(tsqSetNeqCalendarAxis(header.get(), "1990-01-01", "00:00:00", kUnitSecond, 0.0, 2),
              0);
    return header;
}

/// Creates, writes and closes; gives back the first result that is not 0.
inline int Write(const std::string& path, TsqHeader* header, const std::vector<Step>& steps) {
    TsqFileHandle file;
    int result = tsqFileCreate(path, header, &file);
    for (const Step& step : steps)
        for (std::size_t i = 0; result == 0 && i < step.values.size(); ++i)
            result = tsqWriteItemTimeStep(header, file.get(), step.time, &step.values[i]);
    const int closed = tsqFileClose(header, &file);
    return result != 0 ? result : closed;
}

inline int CountOf(const TsqHeader* header) {
    int count = -1;
    tsqGetEqTimeAxis(header, nullptr, nullptr, nullptr, nullptr, &count, nullptr);
    tsqGetNeqTimeAxis(header, nullptr, nullptr, nullptr, nullptr, &count, nullptr);
    tsqGetEqCalendarAxis(header, nullptr, nullptr, nullptr, nullptr, nullptr, nullptr, &count,
                         nullptr);
    tsqGetNeqCalendarAxis(header, nullptr, nullptr, nullptr, nullptr, nullptr, nullptr, &count,
                          nullptr);
    static_cast<void>(tsqTakeError()); // three of the four are of another type
    return count;
}

/// A file open for reading.
struct Reading {
    TsqHeaderHandle header;
    TsqFileHandle file;
    int result = 0;

    explicit Reading(const std::string& path) : result(tsqFileRead(path, &header, &file)) {}

    std::vector<Step> Steps() {
        std::vector<Step> steps;
        tsqFindBlockDynamic(header.get(), file.get());
        for (int i = 0; i < CountOf(header.get()); ++i) {
            Step step;
            for (int item = 0; item < tsqGetNoOfItems(header.get()); ++item) {
                float value = 0.0F;
                EXPECT_EQ(tsqReadItemTimeStep(header.get(), file.get(), &step.time, &value), 0);
                step.values.push_back(value);
            }
            steps.push_back(step);
        }
        return steps;
    }
    std::string ItemName(int number) {
        std::string name;
        tsqGetItemInfo(tsqItemD(header.get(), number), nullptr, nullptr, &name, nullptr, nullptr,
                       nullptr);
        return name;
    }
    std::string Date() const {
        std::string date;
        std::string time;
        tsqGetNeqCalendarAxis(header.get(), &date, &time, nullptr, nullptr, nullptr, nullptr,
                              nullptr, nullptr);
        tsqGetEqCalendarAxis(header.get(), &date, &time, nullptr, nullptr, nullptr, nullptr,
                             nullptr, nullptr);
        return date + " " + time;
    }
};

inline std::string Bytes(const std::string& path) {
    std::string bytes;
    const Status status = ReadWholeFile(path, std::size_t{1} << 26, &bytes);
    EXPECT_TRUE(status.IsOk()) << status.Text();
    return bytes;
}

inline void WriteBytes(const std::string& path, const std::string& bytes) {
    std::filesystem::remove(path); // emptying a file instead makes the disk flush it
    std::ofstream(path, std::ios::binary) << bytes;
}

/// Makes a netCDF file from its description.
inline std::string MakeNetcdf(const std::string& name, const std::string& cdl,
                              const std::string& kind = "classic") {
    const std::string path = PathOf(name + ".nc");
    WriteBytes(path + ".cdl", "netcdf x {\n" + cdl + "\n}\n");
    const std::string make = "ncgen -k " + kind + " -o " + path + " " + path + ".cdl";
    EXPECT_EQ(std::system(make.c_str()), 0);
    return path;
}

/// Output of a program.
inline std::string Output(const std::string& command) {
    const std::string path = PathOf("output.txt");
    EXPECT_EQ(std::system((command + " > " + path).c_str()), 0) << command;
    return Bytes(path);
}

} // namespace ryn::test
