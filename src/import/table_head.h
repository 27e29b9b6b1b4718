#pragma once

#include <string>
#include <string_view>
#include <vector>

#include "base/status.h"
#include "import/text_encoding.h"
#include "import/text_source.h"

namespace ryn {

/// The first lines of a table, from which its layout is found out.
struct TableHead {
    struct Line {
        long number = 0;  ///< from 1
        std::string text; ///< in UTF-8
    };
    TextEncoding encoding = TextEncoding::Utf8;
    std::vector<Line> lines; ///< without blank ones
    bool isWhole = false;    ///< the table ends within them
};

/// How much of a table is looked at.
struct HeadLimits {
    std::size_t lines = 0; ///< lines that are no comments
    std::size_t bytes = 0;
};

/// The encoding of a table by its first bytes; leaves the source at its start.
Status FindEncoding(TextSource& source, TextEncoding* encoding);

/// Reads the first lines, passing over `skipLines` of them; leaves the source at its start.
Status ReadHead(TextSource& source, TextEncoding encoding, long skipLines, HeadLimits limits,
                TableHead* head);

} // namespace ryn
