#include "engine/plain_text.h"

#include <cmath>
#include <cstddef>
#include <limits>

#include "base/number_text.h"
#include "kvf/characters.h"

namespace ryn {

namespace {

// The codes U+0080 to U+009F hold a second set of control characters, next line among them; U+2028
// and U+2029 part lines and paragraphs.
bool BreaksLine(std::string_view character) {
    if (character.size() == 1)
        return KvfIsControl(character.front());
    if (character.size() == 2)
        return character[0] == '\xC2' && static_cast<unsigned char>(character[1]) < 0xA0;
    return character == "\xE2\x80\xA8" || character == "\xE2\x80\xA9";
}

} // namespace

// One character for each, so that nothing a name holds moves what stands behind it.
std::string PlainText(std::string_view text) {
    std::string line;
    line.reserve(text.size());
    for (std::size_t position = 0; position < text.size();) {
        const std::size_t length = KvfUtf8Length(text, position);
        const std::string_view character = text.substr(position, length);
        if (length == 0)
            line += '?';
        else if (BreaksLine(character))
            line += ' ';
        else
            line += character;
        position += length == 0 ? 1 : length;
    }
    return line;
}

std::string PlainName(std::string_view name) {
    constexpr std::size_t kLongest = 160;
    if (name.size() <= kLongest)
        return PlainText(name);
    // Cut between characters: half of one would show as a question mark.
    std::size_t end = 0;
    while (true) {
        const std::size_t length = KvfUtf8Length(name, end);
        const std::size_t next = end + (length == 0 ? 1 : length);
        if (next > kLongest)
            return PlainText(name.substr(0, end)) + "...";
        end = next;
    }
}

std::string NumberText(double value) {
    // Beyond the range of floats the cast has no defined result.
    if (std::fabs(value) > static_cast<double>(std::numeric_limits<float>::max()))
        return ShortestText(value);
    return ShortestText(static_cast<float>(value));
}

std::string PeriodText(double years) {
    constexpr double kLongestPlain = 1e9;
    const bool isPlain =
        std::isfinite(years) && std::fabs(years) < kLongestPlain && years == std::floor(years);
    return isPlain ? FixedText(years, 0) : ShortestText(years);
}

} // namespace ryn
