#include "import/unit_text.h"

#include <algorithm>

#include "import/table_text.h"

namespace ryn {

namespace {

constexpr std::string_view kUnitWords =
    "m|mm|cm|dm|km|um|meter|meters|metre|metres|millimeter|millimeters|millimetre|millimetres|"
    "centimeters|ft|feet|foot|in|inch|inches|mi|nmi|nm|l|liter|litre|ml|s|sec|second|seconds|min|"
    "minute|minutes|mn|h|hr|hour|hours|d|dy|day|days|mo|mon|month|months|a|yr|year|years|cfs|cms|"
    "cumec|cumecs|cusec|cusecs|mcm|c|f|k|deg|degree|degrees|degc|degf|degk|degt|celsius|fahrenheit|"
    "kelvin|pa|hpa|kpa|mb|mbar|bar|dbar|psi|atm|kg|g|mg|ug|t|n|kn|w|kw|mw|j|kj|mj|v|mv|kt|kts|knot|"
    "knots|mph|kmh|kph|psu|ppt|ppm|ntu|rad|hz|percent|cubic|square|per|ha|acre|af|mol|umol|us|ms|"
    "okta|oktas|octas";

/// Degree signs, superscripts and the middle dot taken away, which units have and words do not.
std::string WithoutUnitSigns(std::string_view text) {
    std::string plain(text);
    for (const std::string_view sign :
         {"\xC2\xB0", "\xC2\xB2", "\xC2\xB3", "\xC2\xB7", "\xC2\xB9", "\xE2\x81\xBB", "\xC2\xB5"}) {
        for (std::size_t at = plain.find(sign); at != std::string::npos; at = plain.find(sign))
            plain.replace(at, sign.size(), " ");
    }
    return plain;
}

/// The position of the bracket that the text's last one closes, or npos.
std::size_t OpeningBracket(std::string_view text, char open, char close) {
    if (text.empty() || text.back() != close)
        return std::string_view::npos;
    return text.rfind(open);
}

} // namespace

bool LooksLikeUnit(std::string_view text) {
    constexpr std::size_t kLongestUnit = 30;
    text = Trimmed(text);
    if (text.empty() || text.size() > kLongestUnit)
        return false;
    // Signs alone, which the words below do not cover.
    if (text == "%" || text == "\xC2\xB0")
        return true;
    const std::string plain = WithoutUnitSigns(text);
    const bool onlyUnitSigns = std::all_of(plain.begin(), plain.end(), [](char c) {
        return IsLetter(c) || IsDigit(c) ||
               std::string_view(" /*.^-+%").find(c) != std::string_view::npos;
    });
    const std::vector<std::string> words = Words(plain);
    return onlyUnitSigns && !words.empty() &&
           std::all_of(words.begin(), words.end(),
                       [](const std::string& word) { return IsOneOf(word, kUnitWords); });
}

void SplitNameAndUnit(std::string_view title, std::string* name, std::string* unit) {
    title = Trimmed(title);
    std::size_t cut = OpeningBracket(title, '[', ']');
    if (cut == std::string_view::npos) {
        cut = OpeningBracket(title, '(', ')');
        if (cut != std::string_view::npos &&
            // Square brackets always hold a unit; round ones hold all sorts of remarks.
            !LooksLikeUnit(title.substr(cut + 1, title.size() - cut - 2)))
            cut = std::string_view::npos;
    }
    if (cut != std::string_view::npos) {
        *unit = std::string(Trimmed(title.substr(cut + 1, title.size() - cut - 2)));
        title = Trimmed(title.substr(0, cut));
    } else if (cut = title.rfind(", ");
               cut != std::string_view::npos && LooksLikeUnit(title.substr(cut + 2))) {
        *unit = std::string(Trimmed(title.substr(cut + 2)));
        title = title.substr(0, cut);
    }
    *name = std::string(Trimmed(title));
    std::replace(name->begin(), name->end(), '\n', ' ');
}

std::string PlainUnit(std::string_view text) {
    struct Alias {
        std::string_view name;
        std::string_view unit;
    };
    // The unit library reads "cms" as centimetre-seconds or not at all, and "kn" as kilonewton.
    constexpr Alias kAliases[] = {{"cfs", "ft3/s"},
                                  {"cusec", "ft3/s"},
                                  {"cusecs", "ft3/s"},
                                  {"cms", "m3/s"},
                                  {"cumec", "m3/s"},
                                  {"cumecs", "m3/s"},
                                  {"kts", "knot"},
                                  {"kn", "knot"},
                                  {"kmh", "km/h"},
                                  {"kph", "km/h"},
                                  {"mph", "mile/h"},
                                  {"inches", "inch"},
                                  {"millimeters", "mm"},
                                  {"millimetres", "mm"},
                                  {"feet", "ft"},
                                  {"sec", "s"},
                                  {"-", ""},
                                  {"none", ""},
                                  {"n/a", ""},
                                  {"unitless", ""}};
    text = Trimmed(text);
    for (const Alias& alias : kAliases)
        if (Lowercase(text) == alias.name)
            return std::string(alias.unit);
    return std::string(text);
}

} // namespace ryn
