#include "engine/report_text.h"

#include <algorithm>
#include <array>
#include <charconv>
#include <cmath>
#include <cstddef>

namespace ryn {

namespace {

constexpr int kDigits = 6;
// A sign, six digits in fixed notation down to 0.0001, and two blanks between columns.
constexpr std::size_t kColumnWidth = 15;
constexpr std::size_t kNameWidth = 26;

/// The power of ten of the first digit after rounding: 9.999999 is 10.0000 and has a power of 1.
int PowerAfterRounding(double value) {
    const int power = static_cast<int>(std::floor(std::log10(std::fabs(value))));
    const double next = std::pow(10.0, power + 1);
    return std::fabs(value) >= next * (1 - 0.5 * std::pow(10.0, -kDigits)) ? power + 1 : power;
}

// A cell too long for its column still stands apart from the one before.
void AppendRight(std::string& text, std::string_view cell, std::size_t width) {
    text.append(cell.size() < width ? width - cell.size() : 1, ' ');
    text += cell;
}

} // namespace

// By to_chars, which knows no locale, and at the speed that 10^5 ranks want.
std::string SixDigits(double value) {
    if (std::isnan(value))
        return "-";
    std::array<char, 64> buffer{};
    char* const end = buffer.data() + buffer.size();
    const int power = value == 0 || std::isinf(value) ? 0 : PowerAfterRounding(value);
    // Levels and discharges in people's own notation; beyond, zeros would have to be counted.
    const bool isFixed = power >= -4 && power <= 8;
    const auto written =
        std::to_chars(buffer.data(), end, value,
                      isFixed ? std::chars_format::fixed : std::chars_format::scientific,
                      isFixed ? std::max(0, kDigits - 1 - power) : kDigits - 1);
    return {buffer.data(), written.ptr};
}

void AppendRow(std::string& text, std::initializer_list<std::string_view> cells) {
    for (const std::string_view cell : cells)
        AppendRight(text, cell, kColumnWidth);
    text += '\n';
}

void AppendValue(std::string& text, std::string_view name, std::string_view value) {
    text += "  ";
    text += name;
    text.append(name.size() < kNameWidth ? kNameWidth - name.size() : 1, ' ');
    AppendRight(text, value, kColumnWidth);
    text += '\n';
}

namespace {

/// Characters, not bytes: names come in any script.
std::size_t CharacterCount(std::string_view text) {
    return static_cast<std::size_t>(std::count_if(text.begin(), text.end(), [](char byte) {
        return (static_cast<unsigned char>(byte) & 0xC0U) != 0x80U;
    }));
}

} // namespace

void AppendHeading(std::string& text, std::string_view heading, char underline) {
    text += '\n';
    text += heading;
    text += '\n';
    text.append(CharacterCount(heading), underline);
    text += '\n';
}

} // namespace ryn
