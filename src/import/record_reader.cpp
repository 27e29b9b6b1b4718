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
    if (fields->Split(record->text, delimiter))
        return ReadResult::Found;
    joined.assign(record->text);
    std::string_view next;
    while (joined.size() <= LineReader::kLongestLine) {
        const ReadResult result = lines.Read(&next);
        if (result == ReadResult::Failed)
            return result;
        if (result == ReadResult::End)
            break;
        joined.append("\n").append(next);
        // Only a line with a quote can close one: the others need no second look, which keeps the
        // work proportional to the text.
        if (next.find('"') == std::string_view::npos)
            continue;
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
