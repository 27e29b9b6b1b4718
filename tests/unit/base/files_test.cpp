#include <csignal>
#include <filesystem>
#include <memory>
#include <sys/stat.h>
#include <sys/wait.h>
#include <unistd.h>
#include <vector>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "base/atomic_file.h"
#include "base/file_access.h"
#include "support/temporary_directory.h"

namespace ryn {
namespace {

using test::TemporaryDirectory;
using ::testing::HasSubstr;

Status Save(const std::string& path, const std::string& content) {
    return WriteFileAtomically(path, content, Durability::Flushed);
}

TEST(AtomicFile, ReplacesTheTargetAndKeepsItsPermissions) {
    const TemporaryDirectory directory;
    const std::string path = directory.Write("a.txt", "old");
    ::chmod(path.c_str(), 0640);
    ASSERT_TRUE(Save(path, "new"));
    EXPECT_EQ(directory.Read("a.txt"), "new");
    struct stat info {};
    ASSERT_EQ(::stat(path.c_str(), &info), 0);
    EXPECT_EQ(info.st_mode & 07777U, 0640U);
    EXPECT_EQ(directory.EntryCount(), 1U);
}

TEST(AtomicFile, LeavesTheTargetUntilItIsCommitted) {
    const TemporaryDirectory directory;
    const std::string path = directory.Write("a.txt", "old");
    {
        AtomicFile file;
        ASSERT_TRUE(file.Open(path));
        file.Write("half");
        EXPECT_EQ(directory.Read("a.txt"), "old");
    }
    EXPECT_EQ(directory.Read("a.txt"), "old");
    EXPECT_EQ(directory.EntryCount(), 1U);
}

TEST(AtomicFile, FollowsALinkToItsFile) {
    const TemporaryDirectory directory;
    std::filesystem::create_symlink("real.txt", directory.Root() / "link.txt");
    ASSERT_TRUE(Save(directory.Path("link.txt"), "text"));
    EXPECT_EQ(directory.Read("real.txt"), "text");
    EXPECT_TRUE(std::filesystem::is_symlink(directory.Root() / "link.txt"));
    std::filesystem::create_symlink("loop", directory.Root() / "loop");
    EXPECT_FALSE(Save(directory.Path("loop"), "text"));
}

TEST(AtomicFile, RefusesWhatIsNoRegularFile) {
    const TemporaryDirectory directory;
    EXPECT_THAT(Save("/dev/full", "x").Text(), HasSubstr("/dev/full: not a regular file"));
    EXPECT_THAT(Save(directory.Path("none/a.txt"), "x").Text(), HasSubstr("none/a.txt"));
    EXPECT_FALSE(Save(directory.Root().string(), "x"));
    EXPECT_FALSE(Save("", "x"));
    EXPECT_FALSE(Save(directory.Path(std::string("a.txt\0.ryn", 10)), "x"));
    EXPECT_EQ(directory.EntryCount(), 0U);
}

TEST(AtomicFile, TakesANameAsLongAsTheSystemAllows) {
    const TemporaryDirectory directory;
    const std::string name(255, 'n');
    ASSERT_TRUE(Save(directory.Path(name), "text"));
    EXPECT_EQ(directory.Read(name), "text");
}

TEST(AtomicFile, LeavesTheOldOrTheNewFileWhenKilledAtAnyMoment) {
    const TemporaryDirectory directory;
    const std::string old(100000, 'o');
    const std::string fresh(100000, 'n');
    const std::string path = directory.Write("a.txt", old);
    for (int delay = 0; delay < 40; ++delay) {
        const pid_t child = ::fork();
        if (child == 0) {
            for (;;) {
                (void)WriteFileAtomically(path, fresh, Durability::Unflushed);
                (void)WriteFileAtomically(path, old, Durability::Unflushed);
            }
        }
        ASSERT_GT(child, 0);
        ::usleep(static_cast<useconds_t>(200 + delay * 37));
        ::kill(child, SIGKILL);
        ::waitpid(child, nullptr, 0);
        const std::string content = directory.Read("a.txt");
        ASSERT_TRUE(content == old || content == fresh) << content.size();
    }
}

/// The signal that ended a child which has one file half written, and another one finished.
int SignalThatEnded(const TemporaryDirectory& directory, int signal) {
    const pid_t child = ::fork();
    if (child == 0) {
        ::signal(SIGHUP, SIG_IGN);
        RemoveTemporariesOnSignals();
        std::filesystem::current_path(directory.Root());
        AtomicFile done;
        AtomicFile open;
        if (!done.Open("done.txt") || !open.Open("open.txt"))
            ::_exit(1);
        done.Write("new");
        open.Write(std::string(100000, 'x'));
        if (!done.Commit(Durability::Unflushed))
            ::_exit(1);
        std::filesystem::current_path("/"); // the names must not hang on where the process is
        ::raise(signal);
        std::filesystem::current_path(directory.Root());
        open.Write("y");
        ::_exit(open.Commit(Durability::Unflushed) ? 0 : 1);
    }
    int state = 0;
    ::waitpid(child, &state, 0);
    return WIFSIGNALED(state) ? WTERMSIG(state) : 0;
}

TEST(AtomicFile, LeavesNoTemporaryFileWhenASignalEndsTheProcess) {
    for (const int signal : {SIGINT, SIGTERM, SIGKILL}) {
        const TemporaryDirectory directory;
        EXPECT_EQ(SignalThatEnded(directory, signal), signal);
        EXPECT_EQ(directory.Read("done.txt"), "new");
        // Nothing can be done about a kill, which shows that there was a file to remove.
        EXPECT_EQ(directory.EntryCount(), signal == SIGKILL ? 2U : 1U);
    }
    const TemporaryDirectory directory;
    EXPECT_EQ(SignalThatEnded(directory, SIGHUP), 0) << "it was ignored before";
    EXPECT_EQ(directory.EntryCount(), 2U);
}

TEST(AtomicFile, IsMadeAlsoWhenTooManyAreOpenToBeMarked) {
    const TemporaryDirectory directory;
    std::vector<std::unique_ptr<AtomicFile>> open;
    for (int i = 0; i < 40; ++i) {
        open.push_back(std::make_unique<AtomicFile>());
        ASSERT_TRUE(open.back()->Open(directory.Path(std::to_string(i))));
    }
    for (const auto& file : open)
        EXPECT_TRUE(file->Commit(Durability::Unflushed));
    EXPECT_EQ(directory.EntryCount(), 40U);
}

TEST(FileAccess, TellsWhatCanBeRead) {
    const TemporaryDirectory directory;
    EXPECT_TRUE(CanOpenForReading(directory.Write("a.txt", "")));
    EXPECT_FALSE(CanOpenForReading(directory.Path("none")));
    EXPECT_FALSE(CanOpenForReading(directory.Root().string()));
    ASSERT_EQ(::mkfifo(directory.Path("pipe").c_str(), 0600), 0);
    EXPECT_TRUE(CanOpenForReading(directory.Path("pipe"))); // and does not wait for a writer
}

TEST(FileAccess, EmptiesAFileOrMakesIt) {
    const TemporaryDirectory directory;
    ASSERT_TRUE(EmptyFile(directory.Write("a.txt", "text")));
    ASSERT_TRUE(EmptyFile(directory.Path("b.txt")));
    EXPECT_EQ(directory.Read("a.txt"), "");
    EXPECT_TRUE(directory.Has("b.txt"));
    EXPECT_FALSE(EmptyFile(directory.Root().string()));
}

TEST(FileAccess, ReadsAWholeFileUpToALimit) {
    const TemporaryDirectory directory;
    const std::string path = directory.Write("a.txt", std::string("a\0b", 3));
    std::string content = "before";
    ASSERT_TRUE(ReadWholeFile(path, 3, &content));
    EXPECT_EQ(content, std::string("a\0b", 3));
    content = "before";
    EXPECT_THAT(ReadWholeFile(path, 2, &content).Text(), HasSubstr("larger than 2 bytes"));
    EXPECT_THAT(ReadWholeFile(directory.Path(""), 10, &content).Text(), HasSubstr("directory"));
    EXPECT_EQ(content, "before");
}

TEST(FileAccess, KnowsAFileByItsOtherName) {
    const TemporaryDirectory directory;
    const std::string path = directory.Write("a.txt", "");
    std::filesystem::create_symlink("a.txt", directory.Root() / "b.txt");
    EXPECT_TRUE(IsSameFile(path, directory.Path("b.txt")));
    EXPECT_FALSE(IsSameFile(path, directory.Path("none")));
}

} // namespace
} // namespace ryn
