#include "apps/cli/number_column.h"

#include <algorithm>
#include <cmath>

#include "base/number_text.h"
#include "strings/catalogue.h"

namespace ryn::cli {

namespace {

constexpr std::string_view kBlanks = " \t\r\v\f";

std::string_view Trimmed(std::string_view text) {
    const std::size_t first = text.find_first_not_of(kBlanks);
    if (first == std::string_view::npos)
        return {};
    return text.substr(first, text.find_last_not_of(kBlanks) - first + 1);
}

constexpr std::string_view kSeparators = " \t;,";

std::string_view FirstField(std::string_view line) {
    return Trimmed(line.substr(0, line.find_first_of(kSeparators)));
}

bool HasSeveralFields(std::string_view line) {
    const std::size_t end = std::min(line.find_first_of(kSeparators), line.size());
    return line.find_first_not_of(kSeparators, end) != std::string_view::npos;
}

bool IsDigits(std::string_view text) {
    return !text.empty() && text.find_first_not_of("0123456789") == std::string_view::npos;
}

/// "12,5": a number with a decimal comma, or two columns.
bool HasAmbiguousComma(std::string_view line) {
    const std::size_t comma = line.find(',');
    if (comma == std::string_view::npos)
        return false;
    std::string_view whole = line.substr(0, comma);
    if (!whole.empty() && (whole.front() == '-' || whole.front() == '+'))
        whole.remove_prefix(1);
    return IsDigits(whole) && IsDigits(line.substr(comma + 1));
}

class ColumnReader {
  public:
    explicit ColumnReader(const std::string& textName) : name(textName) {}

    Status ReadLine(std::string_view line) {
        ++lineNumber;
        line = Trimmed(line.substr(0, line.find('#')));
        if (line.empty())
            return Status::Ok();
        const std::optional<double> number = ParseDouble(FirstField(line));
        const bool isFirst = column.values.empty() && column.heading.empty();
        if (!number && isFirst) {
            column.heading = line;
            return Status::Ok();
        }
        if (!number || !std::isfinite(*number))
            return Status::InputFault(
                FormatText(kTextCliNoNumber, name, lineNumber, std::string(FirstField(line))));
        ambiguous = ambiguous && HasAmbiguousComma(line);
        if (wideLine == 0 && HasSeveralFields(line))
            wideLine = lineNumber;
        column.values.push_back(*number);
        return Status::Ok();
    }

    Status Finish(NumberColumn* result) {
        if (column.values.empty())
            return Status::InputFault(FormatText(kTextCliNoNumbers, name));
        if (ambiguous)
            return Status::InputFault(FormatText(kTextCliDecimalComma, name));
        if (wideLine != 0)
            return Status::InputFault(FormatText(kTextCliSeveralColumns, name, wideLine));
        *result = std::move(column);
        return Status::Ok();
    }

  private:
    const std::string& name;
    NumberColumn column;
    bool ambiguous = true;
    int lineNumber = 0;
    int wideLine = 0; // the first with several columns
};

} // namespace

Status ReadNumberColumn(std::string_view text, const std::string& name, NumberColumn* column) {
    constexpr std::string_view kByteOrderMark = "\xef\xbb\xbf";
    if (text.substr(0, kByteOrderMark.size()) == kByteOrderMark)
        text.remove_prefix(kByteOrderMark.size());
    ColumnReader reader(name);
    while (!text.empty()) {
        const std::size_t end = text.find('\n');
        if (Status status = reader.ReadLine(text.substr(0, end)); !status)
            return status;
        text.remove_prefix(end == std::string_view::npos ? text.size() : end + 1);
    }
    return reader.Finish(column);
}

} // namespace ryn::cli
