#pragma once

#include <string>
#include <string_view>

#include "import/field_split.h"
#include "import/line_reader.h"

namespace ryn {

/// A row of a table: one line, or several where a quoted field holds line breaks.
struct TableRecord {
    long line = 0;         ///< number of its first line, from 1
    std::string_view text; ///< as it stands in the file
};

/// Rows of a table, quotes followed over line ends. Memory stays bounded: a row is no longer than
/// LineReader::kLongestLine.
class RecordReader {
  public:
    RecordReader(TextSource& textSource, TextEncoding encoding, char fieldDelimiter)
        : source(textSource),
          lines(textSource, encoding),
          delimiter(fieldDelimiter) {}

    /// Passes over lines at the start.
    ReadResult SkipLines(long count);
    /// The next line as it stands, to be passed over or split; valid until the next call.
    ReadResult ReadLine(TableRecord* record);
    /// Splits the line that ReadLine gave into fields, reading on where a quote is open. Failed
    /// when the quote never closes; the error names the line where it opened.
    ReadResult Split(TableRecord* record, FieldList* fields);

    const Status& Error() const { return error ? lines.Error() : error; }

  private:
    TextSource& source;
    LineReader lines;
    char delimiter;
    std::string joined;
    Status error;
};

} // namespace ryn
