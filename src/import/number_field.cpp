#include "import/number_field.h"

#include <algorithm>
#include <array>
#include <charconv>
#include <cmath>
#include <system_error>

#include "import/table_text.h"

namespace ryn {

namespace {

constexpr std::string_view kUnicodeMinus = "\xE2\x88\x92";
constexpr std::size_t kLongestNumber = 400; // digits of the largest double in full, and some

// The second part: German archives ("Lücke", also in Latin-1), spreadsheets, and the words that
// USGS daily files put in the place of a value.
constexpr std::string_view kMissingWords =
    "na|n/a|n.a.|nan|nan(ind)|null|(null)|none|nil|nd|n.d.|m|miss|missing|nodata|no data|gap|\\n|?|"
    "lücke|l\xFC"
    "cke|luecke|ausfall|#n/a|#value!|#div/0!|#ref!|#num!|"
    "ice|eqp|bkw|dis|mnt|ssn|rat|tst|fld";

/// "-", "--", "---", ".", "..", "***", "--:--": nothing but such signs.
bool IsOnlySigns(std::string_view field) {
    return std::all_of(field.begin(), field.end(),
                       [](char c) { return c == '-' || c == '*' || c == '.' || c == ':'; });
}

/// Letters and signs that gauge networks put behind a value. Digits and separators are none, or a
/// mistyped number would lose its end.
bool IsMark(std::string_view text) {
    constexpr std::size_t kLongestMark = 3;
    return !text.empty() && text.size() <= kLongestMark &&
           std::all_of(text.begin(), text.end(), [](char c) {
               return IsLetter(c) || c == '*' || c == '#' || c == '?' || c == '+' || c == '!' ||
                      c == '%' || c == '~' || c == '$' || c == '^';
           });
}

/// The number's characters with a decimal point, for the C++ library; empty when a point stands
/// where the table has a decimal comma.
class PlainNumber {
  public:
    PlainNumber(std::string_view field, char decimal) {
        if (field.substr(0, kUnicodeMinus.size()) == kUnicodeMinus) {
            buffer[size++] = '-';
            field.remove_prefix(kUnicodeMinus.size());
        } else if (field.size() > 1 && field[0] == '+' &&
                   (IsDigit(field[1]) || field[1] == decimal)) {
            field.remove_prefix(1);
        }
        if (field.size() + size > buffer.size())
            return;
        for (const char c : field)
            buffer[size++] = c == decimal ? '.' : (c == '.' ? ',' : c);
    }
    const char* begin() const { return buffer.data(); }
    const char* end() const { return buffer.data() + size; }
    bool IsEmpty() const { return size == 0; }
    /// Something that starts as a number does: not a word that the library would read ("inf").
    bool StartsAsNumber() const {
        const std::size_t first = buffer[0] == '-' ? 1 : 0;
        if (first >= size)
            return false;
        return IsDigit(buffer[first]) ||
               (buffer[first] == '.' && first + 1 < size && IsDigit(buffer[first + 1]));
    }

  private:
    std::array<char, kLongestNumber> buffer; // filled up to `size` only: this runs for each field
    std::size_t size = 0;
};

bool IsInfinityWord(std::string_view field) {
    if (!field.empty() && (field[0] == '-' || field[0] == '+'))
        field.remove_prefix(1);
    return IsOneOf(field, "inf|infinity");
}

/// A number out of a float's range: too large, or so small that it is zero.
NumberField OutOfRange(const PlainNumber& number, const char* stop) {
    double wide = 0.0;
    const auto [end, error] = std::from_chars(number.begin(), stop, wide);
    if (error == std::errc() && std::abs(wide) < 1.0)
        return {NumberKind::Value, 0.0F, {}};
    // Beyond a double too: a negative exponent tells an underflow from an overflow.
    const std::string_view text(number.begin(), static_cast<std::size_t>(stop - number.begin()));
    const std::size_t exponent = text.find_first_of("eE");
    if (error != std::errc() && exponent != std::string_view::npos && exponent + 1 < text.size() &&
        text[exponent + 1] == '-')
        return {NumberKind::Value, 0.0F, {}};
    return {NumberKind::TooLarge, 0.0F, {}};
}

/// A number from the start of the field, and a mark or nothing behind it.
NumberField ReadPlain(const PlainNumber& number, std::string_view field) {
    NumberField result{NumberKind::Value, 0.0F, {}};
    const auto [stop, error] = std::from_chars(number.begin(), number.end(), result.value);
    if (error == std::errc::invalid_argument)
        return {};
    if (error == std::errc::result_out_of_range)
        result = OutOfRange(number, stop);
    if (stop == number.end())
        return result;
    const std::string_view rest =
        Trimmed(field.substr(field.size() - static_cast<std::size_t>(number.end() - stop)));
    if (!IsMark(rest) || result.kind != NumberKind::Value)
        return {};
    return {NumberKind::Marked, result.value, rest};
}

/// "1,234.5", "1.234,5", "1 234", "1'234".
bool IsGrouped(std::string_view field, char decimal) {
    if (!field.empty() && (field[0] == '-' || field[0] == '+'))
        field.remove_prefix(1);
    const std::size_t first = field.find_first_not_of("0123456789");
    if (first == 0 || first == std::string_view::npos || first > 3 || field[0] == '0' ||
        field[first] == decimal)
        return false;
    const std::string_view sign = field.substr(first, field[first] == '\xC2' ? 2 : 1);
    if (sign != "," && sign != "." && sign != " " && sign != "'" && sign != "\xC2\xA0")
        return false;
    const std::string_view group = field.substr(first + sign.size());
    return group.size() >= 3 && IsDigits(group.substr(0, 3)) &&
           (group.size() == 3 || !IsDigit(group[3]));
}

} // namespace

bool IsMissingWord(std::string_view field) {
    constexpr std::size_t kLongestWord = 8;
    if (field.empty())
        return true;
    if (IsDigit(field.back()) || IsDigit(field[0])) // nearly every field of a table ends here
        return false;
    return IsOnlySigns(field) || (field.size() <= kLongestWord && IsOneOf(field, kMissingWords));
}

NumberField ReadNumber(std::string_view field, char decimal) {
    if (IsMissingWord(field))
        return {NumberKind::Missing, 0.0F, {}};
    if (field[0] == '<' || field[0] == '>') {
        const NumberField bound = ReadNumber(Trimmed(field.substr(1)), decimal);
        return bound.kind == NumberKind::Value
                   ? NumberField{NumberKind::Censored, bound.value, field.substr(0, 1)}
                   : NumberField{};
    }
    const PlainNumber number(field, decimal);
    if (!number.IsEmpty() && number.StartsAsNumber()) {
        const NumberField read = ReadPlain(number, field);
        return read.kind == NumberKind::NoNumber && IsGrouped(field, decimal)
                   ? NumberField{NumberKind::Grouped, 0.0F, {}}
                   : read;
    }
    return IsInfinityWord(field) ? NumberField{NumberKind::NotFinite, 0.0F, {}} : NumberField{};
}

} // namespace ryn
