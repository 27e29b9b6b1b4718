#include <filesystem>
#include <optional>

#include <gtest/gtest.h>

#include "unit/tsq/series_fixture.h"

#include "support/scratch_directory.h"

namespace ryn {
namespace {

using test::Bytes;
using test::NewHeader;
using test::NewSeries;
using test::PathOf;
using test::Reading;
using test::Step;
using test::Write;

const std::vector<Step> kTwo = {{0.0, {1.5F}}, {60.0, {-0.0F}}};

std::string MemoryPath(const std::string& name) {
    return PathOf("only_in_memory/") + name;
}

TEST(MemoryFile, IsWrittenAndReadWithoutTouchingTheDisk) {
    TsqMemoryDirectory directory(PathOf("only_in_memory"));
    TsqHeaderHandle header = NewSeries();
    const std::string path = MemoryPath("a.tsq0");
    EXPECT_FALSE(tsqFileExists(path));
    ASSERT_EQ(Write(path, header.get(), kTwo), 0);
    EXPECT_TRUE(tsqFileExists(path));
    EXPECT_FALSE(std::filesystem::exists(PathOf("only_in_memory")));
    EXPECT_GE(directory.Size(), 2 * (sizeof(double) + sizeof(float)));
    Reading read(PathOf("only_in_memory/x/.././a.tsq0"));
    ASSERT_EQ(read.result, 0) << tsqTakeError().Text();
    EXPECT_EQ(read.Date(), "1990-01-01 00:00:00");
    EXPECT_EQ(read.ItemName(1), "Item 1");
    EXPECT_EQ(read.Steps(), kTwo);
    int missing = -1;
    EXPECT_EQ(tsqCountMissing(read.header.get(), read.file.get(), 1, &missing), 0);
    EXPECT_EQ(missing, 0);
}

TEST(MemoryFile, ReadsLikeTheFileOnDisk) {
    TsqMemoryDirectory directory(PathOf("only_in_memory"));
    for (const bool isEquidistant : {false, true}) {
        TsqHeaderHandle header = NewHeader(2);
        if (isEquidistant)
            tsqSetEqCalendarAxis(header.get(), "2000-02-29", "12:00:00", kUnitHour, 1.5, 0.1, 3);
        else
            tsqSetNeqTimeAxis(header.get(), kUnitHour, 0.25, 3);
        const std::vector<Step> steps = {{0.0, {1, 2}}, {0.1, {3, 4}}, {7.0 / 3.0, {5, 6}}};
        ASSERT_EQ(Write(MemoryPath("b.tsq0"), header.get(), steps), 0);
        ASSERT_EQ(Write(PathOf("b.tsq0"), header.get(), steps), 0);
        Reading inMemory(MemoryPath("b.tsq0"));
        Reading onDisk(PathOf("b.tsq0"));
        EXPECT_EQ(inMemory.Steps(), onDisk.Steps());
        EXPECT_EQ(inMemory.Date(), onDisk.Date());
        ASSERT_TRUE(tsqCopyFile(MemoryPath("b.tsq0"), PathOf("b_copy.tsq0")).IsOk());
        EXPECT_EQ(Bytes(PathOf("b_copy.tsq0")), Bytes(PathOf("b.tsq0")));
        ASSERT_TRUE(tsqCopyFile(PathOf("b.tsq0"), MemoryPath("c.tsq0")).IsOk());
        EXPECT_EQ(Reading(MemoryPath("c.tsq0")).Steps(), onDisk.Steps());
    }
}

TEST(MemoryFile, IsGoneWithItsDirectoryButNotUnderAReader) {
    auto directory = std::make_optional<TsqMemoryDirectory>(PathOf("only_in_memory"));
    TsqHeaderHandle header = NewSeries();
    ASSERT_EQ(Write(MemoryPath("d.tsq0"), header.get(), kTwo), 0);
    ASSERT_EQ(Write(MemoryPath("e.tsq0"), header.get(), kTwo), 0);
    Reading read(MemoryPath("d.tsq0"));
    EXPECT_TRUE(directory->Remove(MemoryPath("d.tsq0")));
    EXPECT_FALSE(directory->Remove(MemoryPath("d.tsq0")));
    EXPECT_FALSE(directory->Remove(PathOf("elsewhere.tsq0")));
    EXPECT_NE(Reading(MemoryPath("d.tsq0")).result, 0);
    EXPECT_EQ(tsqTakeError().Text(), MemoryPath("d.tsq0") + ": No such file or directory");
    TsqFileHandle unfinished;
    ASSERT_EQ(tsqFileCreate(MemoryPath("f.tsq0"), header.get(), &unfinished), 0);
    directory.reset();
    EXPECT_EQ(read.Steps(), kTwo);
    EXPECT_NE(tsqFileClose(header.get(), &unfinished), 0);
    TsqMemoryDirectory again(PathOf("only_in_memory"));
    EXPECT_EQ(again.Size(), 0U);
    EXPECT_FALSE(tsqFileExists(MemoryPath("e.tsq0")));
}

TEST(MemoryFile, OtherDirectoriesStayOnDisk) {
    const std::string kept = PathOf("memory_parent/");
    std::filesystem::create_directories(kept + "kept");
    TsqMemoryDirectory directory(kept);
    TsqHeaderHandle header = NewSeries();
    ASSERT_EQ(Write(kept + "kept/g.tsq0", header.get(), kTwo), 0);
    EXPECT_TRUE(std::filesystem::exists(kept + "kept/g.tsq0"));
    EXPECT_EQ(directory.Size(), 0U);
}

TEST(CopyFile, CopiesBytesOnDiskAndNamesWhatFails) {
    TsqHeaderHandle header = NewSeries();
    ASSERT_EQ(Write(PathOf("from.tsq0"), header.get(), kTwo), 0);
    ASSERT_TRUE(tsqCopyFile(PathOf("from.tsq0"), PathOf("to.tsq0")).IsOk());
    EXPECT_EQ(Bytes(PathOf("to.tsq0")), Bytes(PathOf("from.tsq0")));
    EXPECT_FALSE(tsqCopyFile(PathOf("missing.tsq0"), PathOf("to.tsq0")).IsOk());
    EXPECT_FALSE(tsqCopyFile(PathOf("from.tsq0"), test::ScratchDirectory()).IsOk());
    EXPECT_EQ(Reading(PathOf("to.tsq0")).Steps(), kTwo);
}

} // namespace
} // namespace ryn
