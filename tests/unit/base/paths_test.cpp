#include <filesystem>

#include <gtest/gtest.h>

#include "base/path_parts.h"
#include "base/qx_path.h"
#include "support/temporary_directory.h"

namespace ryn {
namespace {

TEST(PathParts, PutTogetherAreThePathAgain) {
    for (const char* path :
         {"/a/b.c/case.ryn", "case", ".ryn", "/", "a/", "..", "a..ryn", "流量.tsq0"}) {
        const PathParts parts = SplitPath(path);
        EXPECT_EQ(parts.directory + parts.name + parts.extension, path);
    }
    EXPECT_EQ(SplitPath("/a/b.c/case.x.ryn").name, "case.x");
    EXPECT_EQ(SplitPath("/a.b/case").extension, "");
    EXPECT_EQ(SplitPath("/a/.ryn").name, ".ryn");
    EXPECT_EQ(SplitPath("..").extension, "");
}

TEST(FullPath, CountsFromTheCurrentDirectoryAtAnyLength) {
    const test::TemporaryDirectory directory;
    std::filesystem::current_path(directory.Root());
    EXPECT_EQ(FullPath(""), "");
    EXPECT_EQ(FullPath("a/../b.ryn"), directory.Path("b.ryn"));
    EXPECT_EQ(FullPath("/x/./y"), "/x/y");
    const std::string longName = std::string(300, 'd') + "/case.ryn";
    EXPECT_EQ(FullPath(longName), directory.Path(longName));
}

TEST(FullPath, LeadsThroughLinksWhereTheSystemLeads) {
    const test::TemporaryDirectory directory;
    std::filesystem::create_directories(directory.Root() / "real/deep");
    std::filesystem::create_directory_symlink("real/deep", directory.Root() / "link");
    directory.Write("real/gauge.tsq0", "");
    EXPECT_EQ(FullPath(directory.Path("link/../gauge.tsq0")), directory.Path("real/gauge.tsq0"));
    EXPECT_EQ(FullPath("new.tsq0", directory.Path("link")), directory.Path("real/deep/new.tsq0"));
    EXPECT_EQ(FullPath(directory.Path("link")), directory.Path("link"));
    EXPECT_EQ(CQxPath(directory.Path("link/a.tsq0")).GetFileNameRelativeTo(directory.Path("link")),
              "a.tsq0");
    EXPECT_EQ(
        CQxPath(directory.Path("real/deep/a.tsq0")).GetFileNameRelativeTo(directory.Path("link/")),
        "a.tsq0");
}

TEST(CQxPath, TellsItsDirectoryWithTheSeparator) {
    EXPECT_EQ(CQxPath("/a/b/case.ryn").GetDirectoryName(), "/a/b/");
    EXPECT_EQ(CQxPath("case.ryn").GetDirectoryName(), "");
}

TEST(CQxPath, IsSeenFromAnotherDirectory) {
    const CQxPath path("/data/gauges/a b.tsq0");
    EXPECT_EQ(path.GetFileNameRelativeTo("/data/"), "gauges/a b.tsq0");
    EXPECT_EQ(path.GetFileNameRelativeTo("/data/gauges"), "a b.tsq0");
    EXPECT_EQ(path.GetFileNameRelativeTo("/data/cases/x/"), "../../gauges/a b.tsq0");
    EXPECT_EQ(path.GetFileNameRelativeTo(""), "/data/gauges/a b.tsq0");
    EXPECT_EQ(CQxPath("").GetFileNameRelativeTo("/data"), "");
    EXPECT_EQ(CQxPath("a.tsq0").GetFileNameRelativeTo("/data"), "a.tsq0");
}

} // namespace
} // namespace ryn
