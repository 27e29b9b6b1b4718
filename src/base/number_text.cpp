#include "base/number_text.h"

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

/// True where a number out of range is too small rather than too large: its exponent is negative,
/// or it starts with 0 and has none.
bool IsUnderflow(std::string_view text) {
    const std::size_t exponent = text.find_first_of("eE");
    if (exponent != std::string_view::npos)
        return exponent + 1 < text.size() && text[exponent + 1] == '-';
    if (!text.empty() && text[0] == '-')
        text.remove_prefix(1);
    return !text.empty() && (text[0] == '0' || text[0] == '.');
}

template <typename Number>
std::optional<Number> Parse(std::string_view text) {
    text = WithoutPlus(text);
    Number value{};
    const char* const end = text.data() + text.size();
    const auto [stop, error] = std::from_chars(text.data(), end, value);
    if (stop != end || text.empty())
        return std::nullopt;
    if (error == std::errc::result_out_of_range && IsUnderflow(text))
        return Number{0};
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
