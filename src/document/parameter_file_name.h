#pragma once

#include <string>

#include "base/status.h"

namespace ryn {

/// A parameter file is saved as ".RYN" and opened as ".RYN" or ".ryn". Where the file system tells
/// the two apart, these functions see to it that one analysis stays one file.

/// True for the two extensions, and for no other mix of case.
bool IsParameterFileName(const std::string& path);

/// The name as it stands on disk: where `path` does not exist and its other spelling does, that
/// one.
std::string FindParameterFile(const std::string& path);

/// The name that a save of `path` writes: its extension replaced by `extension` (without point).
std::string SavedParameterFileName(const std::string& path, const std::string& extension);

/// Readies a save to `savedName` of a document that was opened as `openedName` or asked to be saved
/// as `askedName`: where one of the two is the ".ryn" spelling of the same file and it alone
/// exists, it is renamed, so that nobody edits a stale twin. Where both spellings exist as two
/// files, the save is a failure that names both.
Status SettleSpelling(const std::string& openedName, const std::string& askedName,
                      const std::string& savedName);

/// Keeps a file that could not be read whole before a save replaces it: as NAME.broken, or
/// NAME.broken2 and so on where that is taken. What is no regular file is passed over.
Status KeepBrokenFile(const std::string& path);

} // namespace ryn
