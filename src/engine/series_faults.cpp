#include <algorithm>
#include <cmath>

#include "engine/engine_input.h"
#include "engine/plain_text.h"

namespace ryn {

namespace {

// No combination is fitted to fewer.
constexpr std::size_t kFewestValues = 5;

/// The first value that `isBad` says so of, as its fault; nothing where there is none.
template <typename Predicate>
void FindFirst(const std::vector<double>& values, Predicate isBad, const std::string& what,
               Sentences& faults) {
    const auto bad = std::find_if(values.begin(), values.end(), isBad);
    if (bad != values.end())
        faults.push_back("value " + std::to_string(bad - values.begin() + 1) +
                         " of the series is " + NumberText(*bad) + what);
}

std::string CountFault(std::size_t count) {
    if (count == 0)
        return "the series is empty: no event was selected";
    return "the series has " + std::to_string(count) + " value(s); at least " +
           std::to_string(kFewestValues) + " are needed";
}

} // namespace

Sentences SeriesFaults(const EngineInput& input) {
    const std::vector<double>& values = input.values;
    if (values.size() < kFewestValues)
        return {CountFault(values.size())};
    Sentences faults;
    FindFirst(
        values, [](double x) { return !std::isfinite(x); }, ", which is no number", faults);
    if (!faults.empty()) // comparisons with NaN would add nonsense
        return faults;
    if (std::equal(values.begin() + 1, values.end(), values.begin()))
        faults.push_back("all values of the series are equal (" + NumberText(values.front()) + ")");
    if (input.frame.kind == stats::SeriesKind::PartialDuration) {
        // What a value at the threshold may lose when it is stored as a 32-bit float.
        const double lowest = input.threshold - 1e-6 * std::max(1.0, std::fabs(input.threshold));
        FindFirst(
            values, [=](double x) { return x < lowest; },
            ", below DefineEVS/Threshold " + NumberText(input.threshold), faults);
    }
    return faults;
}

} // namespace ryn
