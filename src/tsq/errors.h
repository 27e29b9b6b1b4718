#pragma once

#include <source_location>

#include "base/status.h"

namespace ryn {

/// Keeps a failure for tsqTakeError. Gives back what an operation returns then: a number other
/// than 0.
int FailReading(Status status);
/// The same, and tells the installed handler, with the place in the library's sources.
int FailWriting(Status status, const std::source_location& place = std::source_location::current());

} // namespace ryn
