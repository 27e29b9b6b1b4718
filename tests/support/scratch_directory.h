#pragma once

#include <string>

#include "support/temporary_directory.h"

namespace ryn::test {

/// A directory of the process's own, with its trailing separator, gone at its end: cases run as
/// processes side by side.
inline const std::string& ScratchDirectory() {
    static const TemporaryDirectory directory;
    static const std::string path = directory.Root().string() + "/";
    return path;
}

} // namespace ryn::test
