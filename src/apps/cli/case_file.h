#pragma once

#include <string>

#include "apps/cli/console.h"
#include "apps/cli/console_ports.h"
#include "document/ryn_edit_doc.h"

namespace ryn::cli {

/// An analysis on which a command works. Opening moves the process's current directory.
class CaseFile {
  public:
    CaseFile(Console& shownOn, Consent consent);

    /// A new analysis, to be saved under `name`. Refused where the file exists in either spelling
    /// and there is no consent.
    int New(const std::string& name);
    /// Opens an analysis in the spelling that exists. Anything but a whole parameter file is
    /// refused, so that a broken file is never saved over with defaults.
    int Open(const std::string& name);
    /// Saves under the name that the analysis was opened or made with, and says so.
    int Save();
    /// The same without the line on standard output.
    int SaveQuietly();

    CGlobalKvf& Root() { return document.GetGlobalKvf(); }
    CRynEditDoc& Document() { return document; }
    /// The absolute name, in the spelling that is read or written.
    const std::string& Path() const { return path; }
    /// The name as the user gave it, in the spelling that is read or written.
    const std::string& ShownName() const { return shownName; }

  private:
    int TestName(const std::string& name);

    Console& console;
    Consent answers;
    ConsolePorts ports;
    CRynEditDoc document;
    std::string path; ///< absolute
    std::string shownName;
};

} // namespace ryn::cli
