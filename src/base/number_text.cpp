#include "base/number_text.h"

#include <algorithm>
#include <array>
#include <charconv>
#include <cmath>
#include <system_error>

namespace ryn {

namespace {

template <typename Number>
std::string Shortest(Number value) {
    if (std::isnan(value))
        return "nan"; // whatever its sign
    std::array<char, 64> buffer{};
    const auto end = std::to_chars(buffer.data(), buffer.data() + buffer.size(), value).ptr;
    return {buffer.data(), end};
}

std::string_view WithoutPlus(std::string_view text) {
    if (text.size() > 1 && text[0] == '+' && text[1] != '-' && text[1] != '+')
        text.remove_prefix(1);
    return text;
}

/// The power of ten of the first digit that counts, of a text that is a number: 2 for "123",
/// -3 for "0.00123". Exponents beyond a million are cut to it.
long long PowerOfTen(std::string_view text) {
    constexpr long long kLargest = 1'000'000;
    const std::size_t mark = std::min(text.find_first_of("eE"), text.size());
    const std::string_view digits = text.substr(0, mark);
    long long exponent = 0;
    if (mark < text.size()) {
        const std::string_view written = WithoutPlus(text.substr(mark + 1));
        const auto read =
            std::from_chars(written.data(), written.data() + written.size(), exponent);
        if (read.ec != std::errc())
            exponent = written.front() == '-' ? -kLargest : kLargest;
        exponent = std::clamp(exponent, -kLargest, kLargest);
    }
    const std::size_t point = std::min(digits.find('.'), digits.size());
    const std::size_t first = std::min(digits.find_first_of("123456789"), digits.size());
    const auto distance = static_cast<long long>(point) - static_cast<long long>(first);
    return exponent + (first < point ? distance - 1 : distance);
}

template <typename Number>
std::optional<Number> Parse(std::string_view text) {
    text = WithoutPlus(text);
    Number value{};
    const char* const end = text.data() + text.size();
    const auto [stop, error] = std::from_chars(text.data(), end, value);
    if (stop != end || text.empty())
        return std::nullopt;
    if (error == std::errc::result_out_of_range && PowerOfTen(text) < 0)
        return text.front() == '-' ? -Number{0} : Number{0};
    if (error != std::errc())
        return std::nullopt;
    return value;
}

} // namespace

std::string ShortestText(double value) {
    return Shortest(value);
}

std::string ShortestText(float value) {
    return Shortest(value);
}

std::string FixedText(double value, int decimals) {
    if (std::isnan(value))
        return "nan";
    // 309 digits before the point at most, the decimals, point, sign.
    std::string buffer(static_cast<std::size_t>(decimals > 0 ? decimals : 0) + 320, '\0');
    const auto end = std::to_chars(buffer.data(), buffer.data() + buffer.size(), value,
                                   std::chars_format::fixed, decimals > 0 ? decimals : 0)
                         .ptr;
    buffer.resize(static_cast<std::size_t>(end - buffer.data()));
    return buffer;
}

std::optional<double> ParseDouble(std::string_view text) {
    return Parse<double>(text);
}

std::optional<float> ParseFloat(std::string_view text) {
    return Parse<float>(text);
}

std::optional<int> ParseInt(std::string_view text) {
    text = WithoutPlus(text);
    int value = 0;
    const char* const end = text.data() + text.size();
    const auto [stop, error] = std::from_chars(text.data(), end, value);
    if (text.empty() || stop != end || error != std::errc())
        return std::nullopt;
    return value;
}

} // namespace ryn
