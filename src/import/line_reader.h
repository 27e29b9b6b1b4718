#pragma once

#include <memory>
#include <optional>
#include <string>
#include <string_view>

#include "base/status.h"
#include "import/text_decoder.h"
#include "import/text_source.h"

namespace ryn {

/// What a reader has for its caller.
enum class ReadResult { Found, End, Failed };

/// Lines of a table without their ends, which may be LF, CRLF or CR, also mixed. Holds one block
/// and one line, never the file. Encodings with a decoder come out as UTF-8; others as they
/// are.
class LineReader {
  public:
    /// A longer line is a fault: no table has one, and it would take all memory.
    static constexpr std::size_t kLongestLine = std::size_t{1} << 20;

    /// Starts at the source's current position, which must be its first byte.
    LineReader(TextSource& textSource, TextEncoding textEncoding);

    /// The next line; valid until the next call. Failed for a line with a NUL byte or longer than
    /// kLongestLine, and when the source cannot be read.
    ReadResult Read(std::string_view* line);

    /// Number of the line given last, from 1.
    long LineNumber() const { return lineNumber; }
    /// Bytes given out so far, line ends not counted.
    std::size_t BytesRead() const { return bytesRead; }
    const Status& Error() const { return error; }

  private:
    bool Fill();
    bool FindLineEnd();
    std::size_t NextPosition(char c, std::optional<std::size_t>* known) const;
    ReadResult Fail(std::string reason);
    ReadResult GiveLine(std::size_t length, std::size_t lengthWithEnd, std::string_view* line);

    TextSource& source;
    TextEncoding encoding;
    std::unique_ptr<TextDecoder> decoder;
    std::string buffer;
    std::size_t begin = 0;
    // Where the next LF and CR stand, so that a file without CRs is searched for them once a block.
    std::optional<std::size_t> nextLf;
    std::optional<std::size_t> nextCr;
    std::size_t lineEnd = 0;
    bool atStart = true;
    bool atEnd = false;
    long lineNumber = 0;
    std::size_t bytesRead = 0;
    Status error;
};

} // namespace ryn
