#include "run/scratch_files.h"

#include <cstdlib>
#include <filesystem>
#include <random>
#include <system_error>
#include <utility>

#include "base/path_parts.h"

namespace ryn {

namespace {

std::string TemporaryDirectory(const std::string& otherDirectory) {
    const char* const named = std::getenv("TMPDIR");
    std::error_code error;
    const bool isDirectory =
        named != nullptr && *named != '\0' && std::filesystem::is_directory(named, error);
    return WithTrailingSeparator(FullPath(isDirectory ? named : otherDirectory));
}

/// Drawn, so that nobody can lay a link of that name in a directory that all may write.
std::string RandomLetters() {
    constexpr std::string_view kLetters = "abcdefghijklmnopqrstuvwxyz234567";
    static thread_local std::random_device source; // opening one takes longer than drawing
    std::string text;
    for (int i = 0; i < 2; ++i)
        for (unsigned bits = source(), n = 0; n < 6; ++n, bits /= 32)
            text += kLetters[bits % 32];
    return text;
}

} // namespace

ScratchFiles ScratchFiles::OnDisk(const std::string& otherDirectory) {
    return ScratchFiles(TemporaryDirectory(otherDirectory));
}

ScratchFiles ScratchFiles::InOwnDirectory(const std::string& otherDirectory) {
    ScratchFiles made(
        WithTrailingSeparator(TemporaryDirectory(otherDirectory) + "RYNTsq0_" + RandomLetters()));
    made.ownDirectory = made.directory;
    std::error_code error; // a directory that is not there is found out by the first file
    std::filesystem::create_directory(made.directory, error);
    return made;
}

ScratchFiles::~ScratchFiles() {
    std::error_code error;
    if (!ownDirectory.empty())
        std::filesystem::remove(ownDirectory, error); // empty, since points take theirs away
}

// A directory that does not exist on disk: no other data file may be taken for one in memory.
ScratchFiles ScratchFiles::InMemory(const std::string& otherDirectory) {
    ScratchFiles made(
        WithTrailingSeparator(TemporaryDirectory(otherDirectory) + "RYNTsq0_" + RandomLetters()));
    made.memory = std::make_unique<TsqMemoryDirectory>(made.directory);
    return made;
}

std::string ScratchFiles::NewName(int point) const {
    std::string name;
    do
        name = directory + "RYNTsq0_" + std::to_string(point) + "_" + RandomLetters();
    while (tsqFileExists(name + ".tsq0"));
    return name;
}

void ScratchFiles::Remove(const std::string& path) {
    std::error_code error;
    if (memory)
        memory->Remove(path);
    else
        std::filesystem::remove(path, error);
}

} // namespace ryn
