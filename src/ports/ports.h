#pragma once

#include "ports/application_port.h"
#include "ports/busy_port.h"
#include "ports/file_choice_port.h"
#include "ports/keyboard_focus_port.h"
#include "ports/message_port.h"
#include "ports/missing_years_port.h"
#include "ports/platform_font_port.h"
#include "ports/progress_port.h"
#include "ports/recent_files_port.h"
#include "ports/text_viewer_port.h"

namespace ryn {

/// The ways to the outside that a document and its commands use. Whoever makes it (host, command
/// line, test) owns the ports and keeps them alive as long as the documents that were given them.
struct Ports {
    MessagePort* messages;
    MissingYearsPort* missingYears;
    FileChoicePort* fileChoice;
    KeyboardFocusPort* keyboardFocus;
    RecentFilesPort* recentFiles;
    ApplicationPort* application;
    ProgressPort* progress;
    BusyPort* busy;
    TextViewerPort* textViewer;
    PlatformFontPort* platformFont;
};

/// Ports that show nothing, answer No (or Cancel where that is offered), choose no file, are named
/// "RYN Editor" and know a sans-serif font: what a document has until it is given others.
const Ports& SilentPorts();

} // namespace ryn
