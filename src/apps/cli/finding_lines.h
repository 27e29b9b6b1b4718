#pragma once

#include <iosfwd>
#include <string>

#include "document/ryn_edit_doc.h"

namespace ryn::cli {

/// A finding's text as one harmless line.
std::string FindingText(const CMessage& finding);

/// One line for each finding, with its page.
void PrintFindings(const CMessageList& findings, const CRynEditDoc& document, std::ostream& out);

} // namespace ryn::cli
