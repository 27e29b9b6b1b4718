#pragma once

#include <string>

namespace ryn {

/// The temporary files that the process has open, so that a signal which ends it takes them along.
/// Up to 16 at once are known; names beyond that, and names longer than 4095 bytes, are left lying
/// by such an end and by nothing else.

/// Notes a file; the number is for ForgetTemporary.
int NoteTemporary(const std::string& path);
/// The file has gone or has got its own name.
void ForgetTemporary(int number);

/// From now on SIGINT, SIGTERM and SIGHUP remove the noted files before they end the process as
/// they otherwise would. For programs, not for libraries within others.
void RemoveTemporariesOnSignals();

} // namespace ryn
