#include "tsq/errors.h"

#include <cstring>
#include <utility>

#include "tsq/tsq.h"

namespace ryn {

namespace {

// Each thread has its own, so that one's failure is not taken for another's.
thread_local Status lastError;
thread_local TsqErrorHandler errorHandler;

/// Without its directory, which depends on the machine that compiled it.
const char* BaseName(const char* sourceFile) {
    const char* const slash = std::strrchr(sourceFile, '/');
    return slash != nullptr ? slash + 1 : sourceFile;
}

} // namespace

int FailReading(Status status) {
    lastError = std::move(status);
    return static_cast<int>(lastError.Kind());
}

int FailWriting(Status status, SourcePlace place) {
    const int type = FailReading(std::move(status));
    // A copy, since a handler may install another one.
    if (const TsqErrorHandler handler = errorHandler)
        handler(type, BaseName(place.file), place.line);
    return type;
}

Status tsqTakeError() {
    return std::exchange(lastError, Status::Ok());
}

TsqErrorHandler tsqAddCommonErrorHandler(TsqErrorHandler handler) {
    return std::exchange(errorHandler, std::move(handler));
}

} // namespace ryn
