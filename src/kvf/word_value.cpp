#include "kvf/word_value.h"

#include <limits>

#include "base/number_text.h"
#include "kvf/characters.h"

namespace ryn {

namespace {

/// What a bare word is by its form. Its number may still be out of range.
enum class WordKind { Int, Float, Double, Other };

std::size_t CountDigits(std::string_view text) {
    std::size_t count = 0;
    while (count < text.size() && KvfIsDigit(text[count]))
        ++count;
    return count;
}

bool TakeSign(std::string_view* text) {
    if (text->empty() || (text->front() != '+' && text->front() != '-'))
        return false;
    text->remove_prefix(1);
    return true;
}

/// Moves over an exponent; false when its letter stands there without digits.
bool TakeExponent(std::string_view* text) {
    if (text->empty() || (text->front() != 'e' && text->front() != 'E'))
        return true;
    text->remove_prefix(1);
    TakeSign(text);
    const std::size_t digits = CountDigits(*text);
    text->remove_prefix(digits);
    return digits > 0;
}

WordKind Classify(std::string_view word) {
    TakeSign(&word);
    std::size_t digits = CountDigits(word);
    word.remove_prefix(digits);
    if (word.empty())
        return digits > 0 ? WordKind::Int : WordKind::Other;
    if (word.front() == '.') {
        const std::size_t decimals = CountDigits(word.substr(1));
        word.remove_prefix(1 + decimals);
        digits += decimals;
    }
    if (digits == 0 || !TakeExponent(&word))
        return WordKind::Other;
    if (word.empty())
        return WordKind::Double;
    return word == "f" ? WordKind::Float : WordKind::Other;
}

std::optional<KvfParam> NamedValue(std::string_view word) {
    constexpr double kInf = std::numeric_limits<double>::infinity();
    constexpr float kInfF = std::numeric_limits<float>::infinity();
    static const struct {
        std::string_view word;
        KvfParam value;
    } kNamed[] = {
        {"true", {true}},    {"false", {false}},
        {"inf", {kInf}},     {"+inf", {kInf}},
        {"-inf", {-kInf}},   {"nan", {std::numeric_limits<double>::quiet_NaN()}},
        {"inff", {kInfF}},   {"+inff", {kInfF}},
        {"-inff", {-kInfF}}, {"nanf", {std::numeric_limits<float>::quiet_NaN()}},
    };
    for (const auto& named : kNamed)
        if (named.word == word)
            return named.value;
    return std::nullopt;
}

template <typename Number>
std::optional<KvfParam> AsParam(std::optional<Number> number) {
    return number ? std::optional(KvfParam{*number}) : std::nullopt;
}

/// The value of a word with a number's form; nothing when it is beyond its type's range.
std::optional<KvfParam> NumberValue(std::string_view word, WordKind kind) {
    if (kind == WordKind::Int)
        return AsParam(ParseInt(word));
    if (kind == WordKind::Float)
        return AsParam(ParseFloat(word.substr(0, word.size() - 1)));
    return AsParam(ParseDouble(word));
}

std::string_view RangeText(WordKind kind) {
    if (kind == WordKind::Int)
        return "an integer from -2147483648 to 2147483647 (beyond that with a decimal point)";
    return kind == WordKind::Float ? "a number in the range of a float"
                                   : "a number in the range of a double";
}

} // namespace

KvfWord KvfReadWord(std::string_view word) {
    const WordKind kind = Classify(word);
    if (kind == WordKind::Other)
        return {NamedValue(word), {}};
    return {NumberValue(word, kind), RangeText(kind)};
}

} // namespace ryn
