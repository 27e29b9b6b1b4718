#include "import/decimal_watch.h"

#include "import/table_text.h"

namespace ryn {

namespace {

constexpr std::size_t kGroup = 3; // digits between signs of thousands

/// "999", "8888": written for a missing value as often as for one.
bool IsOneDigitRepeated(std::string_view digits) {
    return digits.find_first_not_of(digits[0]) == std::string_view::npos;
}

} // namespace

void DecimalWatch::LookCloser(long line, std::size_t column, std::string_view number) {
    const bool isNegative = !number.empty() && number[0] == '-';
    if (isNegative || (!number.empty() && number[0] == '+'))
        number.remove_prefix(1);
    const std::size_t sign = number.find(layout.decimal);
    if (sign == std::string_view::npos) {
        // Codes for missing values are mostly negative.
        if (!isNegative && IsDigits(number))
            LookAtWhole(line, column, number);
        return;
    }
    const bool isLikeThousands = sign > 0 && sign <= kGroup && number[0] != '0' &&
                                 number.size() == sign + 1 + kGroup &&
                                 IsDigits(number.substr(sign + 1));
    if (!isLikeThousands)
        isSettled = true;
    else if (!inDoubt)
        inDoubt = {line, column, std::string(number)};
}

void DecimalWatch::LookAtWhole(long line, std::size_t column, std::string_view digits) {
    if (digits.size() < kGroup || digits[0] == '0' || IsOneDigitRepeated(digits))
        return;
    if (digits.size() > kGroup)
        isSettled = true; // thousands without a sign
    else if (!hundreds)
        hundreds = {line, column, std::string(digits)};
}

Status DecimalWatch::Verdict() const {
    const bool isComma = layout.decimal == ',';
    if (isSettled || !inDoubt || (!isComma && !hundreds))
        return Status::Ok();
    const std::string sign = isComma ? "comma" : "point";
    std::string text = "line " + std::to_string(inDoubt->line) + ": the " + sign + " in " +
                       Quoted(inDoubt->number) + ", column " +
                       ColumnTitle(layout, inDoubt->column) + ", may part decimals or thousands";
    if (hundreds)
        text += " (line " + std::to_string(hundreds->line) + " has " + Quoted(hundreds->number) +
                " without one)";
    return Status::InputFault(text + "; if it is a decimal " + sign + " say so with --decimal " +
                              layout.decimal + " (thousands separators are not read)");
}

} // namespace ryn
