#include "apps/cli/nearest_names.h"

#include <algorithm>
#include <numeric>
#include <utility>

namespace ryn::cli {

namespace {

std::string LowerCase(std::string_view text) {
    std::string lower(text);
    for (char& c : lower)
        if (c >= 'A' && c <= 'Z')
            c = static_cast<char>(c - 'A' + 'a');
    return lower;
}

/// Levenshtein's distance, row by row.
std::size_t EditDistance(std::string_view a, std::string_view b) {
    std::vector<std::size_t> row(b.size() + 1);
    std::iota(row.begin(), row.end(), std::size_t{0});
    for (std::size_t i = 1; i <= a.size(); ++i) {
        std::size_t diagonal = row[0];
        row[0] = i;
        for (std::size_t j = 1; j <= b.size(); ++j) {
            const std::size_t replaced = diagonal + (a[i - 1] == b[j - 1] ? 0 : 1);
            diagonal = row[j];
            row[j] = std::min({row[j] + 1, row[j - 1] + 1, replaced});
        }
    }
    return row[b.size()];
}

} // namespace

std::vector<std::string> NearestNames(std::string_view typed, const std::vector<std::string>& names,
                                      std::size_t most) {
    // A name of a megabyte is near to none, and its distance would take long.
    constexpr std::size_t kLongest = 100;
    if (typed.empty() || typed.size() > kLongest)
        return {};
    const std::string wanted = LowerCase(typed);
    std::vector<std::pair<std::size_t, std::string>> near;
    for (const std::string& name : names) {
        const std::string candidate = LowerCase(name);
        const std::size_t distance = EditDistance(wanted, candidate);
        const bool contains = wanted.size() > 2 && candidate.find(wanted) != std::string::npos;
        if (contains || distance <= std::max<std::size_t>(2, wanted.size() / 3))
            near.emplace_back(distance, name);
    }
    std::stable_sort(near.begin(), near.end(),
                     [](const auto& a, const auto& b) { return a.first < b.first; });
    std::vector<std::string> nearest;
    for (std::size_t i = 0; i < std::min(most, near.size()); ++i)
        nearest.push_back(near[i].second);
    return nearest;
}

std::string JoinNames(const std::vector<std::string>& names) {
    std::string joined;
    for (const std::string& name : names)
        joined += (joined.empty() ? "" : ", ") + name;
    return joined;
}

} // namespace ryn::cli
