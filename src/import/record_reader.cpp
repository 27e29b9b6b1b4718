#include "import/record_reader.h"

namespace ryn {

ReadResult RecordReader::SkipLines(long count) {
    std::string_view line;
    ReadResult result = ReadResult::Found;
    for (; count > 0 && result == ReadResult::Found; --count)
        result = lines.Read(&line);
    return result;
}

ReadResult RecordReader::ReadLine(TableRecord* record) {
    const ReadResult result = lines.Read(&record->text);
    record->line = lines.LineNumber();
    return result;
}

ReadResult RecordReader::Split(TableRecord* record, FieldList* fields) {
    // The usual case: the row is one line.
    if (fields->Split(record->text, delimiter))
        return ReadResult::Found;
    // Each line with a quote is a new look at the whole, so that their number is the factor by
    // which a hostile table can slow this down.
    constexpr int kMostLooks = 100;
    joined.assign(record->text);
    std::string_view next;
    for (int looks = 0; looks < kMostLooks && joined.size() <= LineReader::kLongestLine;) {
        const ReadResult result = lines.Read(&next);
        if (result == ReadResult::Failed)
            return result;
        if (result == ReadResult::End)
            break;
        joined.append("\n").append(next);
        // Only a line with a quote can close one.
        if (next.find('"') == std::string_view::npos)
            continue;
        ++looks;
        if (fields->Split(joined, delimiter)) {
            record->text = joined;
            return ReadResult::Found;
        }
    }
    error = Status::InputFault(source.Name() + ": line " + std::to_string(record->line) +
                               ": a quote opens that is never closed");
    return ReadResult::Failed;
}

} // namespace ryn
