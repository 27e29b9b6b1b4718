#include "import/table_head.h"

#include "import/line_reader.h"
#include "import/table_text.h"

namespace ryn {

Status FindEncoding(TextSource& source, TextEncoding* encoding) {
    // Long enough to reach past an ASCII preamble to the first name with an accent.
    constexpr std::size_t kLooked = std::size_t{1} << 16;
    std::string start(kLooked, '\0');
    std::size_t size = 0;
    for (std::size_t got = 1; got > 0 && size < kLooked; size += got) {
        Status status = source.Read(start.data() + size, kLooked - size, &got);
        if (!status)
            return status;
    }
    if (size == 0)
        return Status::InputFault(source.Name() + ": is empty");
    *encoding = GuessEncoding(std::string_view(start).substr(0, size));
    return source.Rewind();
}

Status ReadHead(TextSource& source, TextEncoding encoding, long skipLines, HeadLimits limits,
                TableHead* head) {
    TableHead read;
    read.encoding = encoding;
    LineReader reader(source, encoding);
    std::string_view line;
    std::size_t counted = 0;
    ReadResult result = ReadResult::Found;
    while (counted < limits.lines && reader.BytesRead() < limits.bytes) {
        result = reader.Read(&line);
        if (result != ReadResult::Found)
            break;
        // Lines keep the numbers that an editor shows.
        if (reader.LineNumber() <= skipLines || Trimmed(line).empty())
            continue;
        // A long licence in comments must not use up the look at the rows.
        counted += line[0] == '#' ? 0 : 1;
        read.lines.push_back({reader.LineNumber(), ToUtf8(line, encoding)});
    }
    if (result == ReadResult::Failed)
        return reader.Error();
    read.isWhole = result == ReadResult::End;
    *head = std::move(read);
    return source.Rewind();
}

} // namespace ryn
