#include "apps/cli/console.h"

#include <ostream>

#include "apps/cli/plain_text.h"
#include "strings/catalogue.h"

namespace ryn::cli {

void ShowError(Console& console, std::string_view text) {
    console.err << "ryn: " << PlainLine(text) << '\n';
}

void ShowWarning(Console& console, std::string_view text) {
    ShowError(console, std::string(Text(kTextCliWarning)) + std::string(text));
}

void ShowNote(Console& console, std::string_view text) {
    ShowError(console, std::string(Text(kTextCliNote)) + std::string(text));
}

int Report(Console& console, const Status& status) {
    if (status)
        return kExitDone;
    ShowError(console, status.Text());
    return status.Kind() == Fault::Input ? kExitInput : kExitSystem;
}

} // namespace ryn::cli
