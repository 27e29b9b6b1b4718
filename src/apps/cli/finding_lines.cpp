#include "apps/cli/finding_lines.h"

#include <ostream>

#include "apps/cli/plain_text.h"
#include "strings/catalogue.h"

namespace ryn::cli {

std::string FindingText(const CMessage& finding) {
    std::string text = PlainLine(finding.text);
    // One of the texts ends in a blank, as prescribed for the forms.
    text.erase(text.find_last_not_of(' ') + 1);
    return text;
}

void PrintFindings(const CMessageList& findings, const CRynEditDoc& document, std::ostream& out) {
    for (const CMessage& finding : findings) {
        const std::string title =
            document.GetEnumerator()->GetPageTitle(static_cast<std::uint32_t>(finding.page));
        out << FormatText(kTextCliFinding, finding.page, title, FindingText(finding)) << '\n';
    }
}

} // namespace ryn::cli
