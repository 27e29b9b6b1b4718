#include "import/line_reader.h"

#include <algorithm>
#include <cstring>

namespace ryn {

namespace {

constexpr std::size_t kBlock = std::size_t{1} << 18;

} // namespace

LineReader::LineReader(TextSource& textSource, TextEncoding textEncoding)
    : source(textSource),
      encoding(textEncoding) {
    error = MakeDecoder(encoding, &decoder);
}

ReadResult LineReader::Fail(std::string reason) {
    if (error)
        error = Status::InputFault(source.Name() + ": line " + std::to_string(lineNumber + 1) +
                                   ": " + std::move(reason));
    return ReadResult::Failed;
}

/// Reads one more block behind what is left of the last; false at the end and on failure.
bool LineReader::Fill() {
    buffer.erase(0, begin);
    begin = 0;
    // What was known about line ends counted from the block's old start.
    nextLf.reset();
    nextCr.reset();
    const std::size_t kept = buffer.size();
    std::string block(decoder ? kBlock : 0, '\0');
    if (!decoder)
        buffer.resize(kept + kBlock);
    std::size_t got = 0;
    error = source.Read(decoder ? block.data() : buffer.data() + kept, kBlock, &got);
    std::string_view bytes(decoder ? block.data() : buffer.data() + kept, got);
    const std::size_t mark = atStart ? ByteOrderMarkSize(bytes, encoding) : 0;
    atStart = false;
    if (decoder) {
        decoder->Decode(bytes.substr(mark), &buffer);
    } else {
        buffer.resize(kept + got);
        buffer.erase(0, mark);
    }
    atEnd = got == 0;
    return error && !atEnd;
}

std::size_t LineReader::NextPosition(char c, std::optional<std::size_t>* known) const {
    if (!*known || **known < begin) {
        const std::size_t found = buffer.find(c, begin);
        *known = found == std::string::npos ? buffer.size() : found;
    }
    return **known;
}

/// Finds the end of the line that starts at `begin`, in what has been read.
bool LineReader::FindLineEnd() {
    lineEnd = std::min(NextPosition('\n', &nextLf), NextPosition('\r', &nextCr));
    // A CR that ends the block may be half of a CRLF.
    return lineEnd < buffer.size() &&
           (buffer[lineEnd] == '\n' || lineEnd + 1 < buffer.size() || atEnd);
}

ReadResult LineReader::GiveLine(std::size_t length, std::size_t lengthWithEnd,
                                std::string_view* line) {
    if (length > kLongestLine)
        return Fail("longer than " + std::to_string(kLongestLine) + " bytes; this is no table");
    // A NUL means a binary file or UTF-16 without its mark; going on would give nonsense, line by
    // line.
    *line = std::string_view(buffer).substr(begin, length);
    if (length > 0 && std::memchr(line->data(), 0, length) != nullptr)
        return Fail("holds a NUL byte; this is no text (for UTF-16 give the encoding)");
    begin += lengthWithEnd;
    bytesRead += length;
    ++lineNumber;
    return ReadResult::Found;
}

ReadResult LineReader::Read(std::string_view* line) {
    if (!error)
        return ReadResult::Failed;
    while (!FindLineEnd()) {
        if (buffer.size() - begin > kLongestLine + 1)
            return GiveLine(buffer.size() - begin, 0, line);
        if (atEnd || !Fill()) {
            if (!error)
                return ReadResult::Failed;
            if (FindLineEnd())
                break;
            const std::size_t rest = buffer.size() - begin;
            return rest == 0 ? ReadResult::End : GiveLine(rest, rest, line);
        }
    }
    const std::size_t length = lineEnd - begin;
    const bool isPair =
        buffer[lineEnd] == '\r' && lineEnd + 1 < buffer.size() && buffer[lineEnd + 1] == '\n';
    return GiveLine(length, length + (isPair ? 2 : 1), line);
}

} // namespace ryn
