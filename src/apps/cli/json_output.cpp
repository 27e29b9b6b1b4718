#include "apps/cli/json_output.h"

#include <algorithm>
#include <cmath>
#include <ostream>

#include "apps/cli/date_text.h"
#include "base/number_text.h"

namespace ryn::cli {

namespace {

void PrintValue(std::ostream& out, const Json& value, const std::string& indent);

/// The shortest text that reads back as the same double, which the library's own is not always;
/// with a ".0" where it would read as a whole number.
std::string DoubleText(double value) {
    std::string text = ShortestText(value);
    if (text.find_first_not_of("-0123456789") == std::string::npos)
        text += ".0";
    return text;
}

std::string Dumped(const Json& value) {
    if (value.is_number_float())
        return DoubleText(value.get<double>());
    return value.dump(-1, ' ', false, Json::error_handler_t::replace);
}

/// A container without a container in it stays on one line: dates are lists of five numbers.
bool IsFlat(const Json& value) {
    return value.empty() ||
           (value.is_array() && std::none_of(value.begin(), value.end(), [](const Json& element) {
                return element.is_structured();
            }));
}

void PrintFlatArray(std::ostream& out, const Json& array) {
    out << '[';
    for (std::size_t i = 0; i < array.size(); ++i)
        out << (i == 0 ? "" : ", ") << Dumped(array[i]);
    out << ']';
}

void PrintLines(std::ostream& out, const Json& container, const std::string& indent) {
    const std::string inner = indent + "  ";
    out << (container.is_object() ? "{" : "[");
    bool isFirst = true;
    for (auto element = container.begin(); element != container.end(); ++element) {
        out << (isFirst ? "\n" : ",\n") << inner;
        isFirst = false;
        if (container.is_object())
            out << Dumped(element.key()) << ": ";
        PrintValue(out, *element, inner);
    }
    out << '\n' << indent << (container.is_object() ? '}' : ']');
}

void PrintValue(std::ostream& out, const Json& value, const std::string& indent) {
    if (!value.is_structured() || value.empty())
        out << Dumped(value);
    else if (IsFlat(value))
        PrintFlatArray(out, value);
    else
        PrintLines(out, value, indent);
}

} // namespace

Json JsonOf(double value) {
    return std::isfinite(value) ? Json(value) : Json(nullptr);
}

Json JsonOf(float value) {
    // The double nearest to the shortest text of the float prints as that text.
    return std::isfinite(value) ? Json(*ParseDouble(ShortestText(value))) : Json(nullptr);
}

Json JsonOf(const COleDateTime& date) {
    return date.IsValid() ? Json(IsoText(date)) : Json(nullptr);
}

void PrintJson(Console& console, const Json& value) {
    PrintValue(console.out, value, "");
    console.out << '\n';
}

} // namespace ryn::cli
