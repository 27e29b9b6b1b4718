#pragma once

#include <string>
#include <vector>

namespace ryn {

/// One finding of a section's check.
struct CMessage {
    int page = 0;     ///< number of the page that the fault belongs to
    std::string text; ///< formatted, in the current language
    int flag = 1;     ///< always 1
};

/// Findings in the order of the tests.
using CMessageList = std::vector<CMessage>;

} // namespace ryn
