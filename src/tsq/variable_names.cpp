#include "tsq/variable_names.h"

namespace ryn {

namespace {

constexpr std::size_t kMaxBytes = 64;

bool IsLetter(char c) {
    return (c >= 'a' && c <= 'z') || (c >= 'A' && c <= 'Z');
}

bool IsDigit(char c) {
    return c >= '0' && c <= '9';
}

/// Each stretch of other characters becomes one underscore.
std::string Plain(std::string_view text) {
    std::string plain;
    for (const char c : text.substr(0, kMaxBytes)) {
        if (IsLetter(c) || IsDigit(c))
            plain += c;
        else if (!plain.empty() && plain.back() != '_')
            plain += '_';
    }
    if (!plain.empty() && plain.back() == '_')
        plain.pop_back();
    return plain;
}

} // namespace

std::string VariableNames::For(std::string_view itemName, std::size_t number) {
    std::string base = Plain(itemName);
    if (base.empty())
        base = "item_" + std::to_string(number);
    else if (!IsLetter(base.front()))
        base = "item_" + base;
    std::string name = base;
    // Counted on, since thousands of items may differ only behind the bytes that are kept.
    for (std::size_t& last = lastNumber.try_emplace(base, 1).first->second;
         !used.insert(name).second;)
        name = base + "_" + std::to_string(++last);
    return name;
}

} // namespace ryn
