#include "import/japanese_text.h"

#include <cstddef>

namespace ryn {

namespace {

unsigned Byte(char c) {
    return static_cast<unsigned char>(c);
}

bool IsBetween(unsigned byte, unsigned low, unsigned high) {
    return byte >= low && byte <= high;
}

/// Counts of what speaks for an encoding and against it.
struct Evidence {
    long common = 0; ///< characters that hardly come about by chance
    long rare = 0;   ///< those that do

    bool IsEnough() const { return common > 0 && common >= rare; }
};

} // namespace

bool LooksLikeShiftJis(std::string_view text) {
    Evidence evidence;
    bool followsPair = false;
    for (std::size_t i = 0; i < text.size(); ++i) {
        const unsigned lead = Byte(text[i]);
        // Katakana of half width are single bytes, and so are the accents of Western Europe.
        const bool isSingle = lead < 0x80 || IsBetween(lead, 0xA1, 0xDF);
        if (isSingle) {
            evidence.rare += lead >= 0x80 && !followsPair ? 1 : 0;
            followsPair = followsPair && lead >= 0x80;
            continue;
        }
        if (!IsBetween(lead, 0x81, 0x9F) && !IsBetween(lead, 0xE0, 0xFC))
            return false;
        if (++i == text.size())
            break;
        const unsigned trail = Byte(text[i]);
        if (!IsBetween(trail, 0x40, 0xFC) || trail == 0x7F)
            return false;
        // Punctuation, kana and the common characters begin below 0xA0, where Windows-1252 has
        // quotes and dashes: these stand alone, and have a letter or a blank behind them.
        const bool isCommon = lead < 0xA0 && (trail >= 0x80 || followsPair);
        (isCommon ? evidence.common : evidence.rare) += 1;
        followsPair = true;
    }
    return evidence.IsEnough();
}

bool LooksLikeEucJp(std::string_view text) {
    Evidence evidence;
    for (std::size_t i = 0; i < text.size(); ++i) {
        const unsigned lead = Byte(text[i]);
        if (lead < 0x80)
            continue;
        // 0x8E and 0x8F begin katakana of half width and characters of three bytes.
        const std::size_t length = lead == 0x8F ? 3 : 2;
        if (lead != 0x8E && lead != 0x8F && !IsBetween(lead, 0xA1, 0xFE))
            return false;
        for (std::size_t k = 1; k < length && i + k < text.size(); ++k)
            if (!IsBetween(Byte(text[i + k]), 0xA1, 0xFE))
                return false;
        // Signs, kana and the common characters.
        const bool isCommon = IsBetween(lead, 0xA1, 0xA5) || IsBetween(lead, 0xB0, 0xCF);
        (isCommon ? evidence.common : evidence.rare) += 1;
        i += length - 1;
    }
    // One pair may be two accents of Western Europe side by side.
    return evidence.IsEnough() && evidence.common >= 2;
}

} // namespace ryn
