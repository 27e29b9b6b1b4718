#pragma once

#include "base/status.h"

namespace ryn {

/// Keeps a failure for tsqTakeError. Gives back what an operation returns then: a number other
/// than 0.
int FailReading(Status status);
/// A line of the library's sources.
struct SourcePlace {
    const char* file;
    int line;

    /// The caller's. (clang 14 has no std::source_location, but its two built-in functions.)
    static SourcePlace Current(const char* file = __builtin_FILE(), int line = __builtin_LINE()) {
        return {file, line};
    }
};

/// The same, and tells the installed handler, with the place in the library's sources.
int FailWriting(Status status, SourcePlace place = SourcePlace::Current());

} // namespace ryn
