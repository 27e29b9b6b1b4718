#pragma once

#include <cstdint>
#include <string>
#include <vector>

#include "params/global_kvf.h"
#include "results/output_settings.h"

namespace ryn {

/// What a batch keeps of each point, in this order: seven sample statistics; three parameters of
/// each D/E combination; the goodness-of-fit statistics asked for of each; the quantiles of each,
/// with their averages and standard deviations where these are kept too.
struct ResultLayout {
    int combinations = 0;
    int statistics = 0; ///< goodness-of-fit statistics of a combination, 0 to 6
    int returnPeriods = 0;
    bool withUncertainty = false; ///< three numbers of a quantile instead of one

    static ResultLayout Of(CGlobalKvf& root);

    int QuantilesOfCombination() const { return (withUncertainty ? 3 : 1) * returnPeriods; }
    /// 64 bits: a parameter file can name more than any data file has items.
    std::int64_t Items() const {
        return 7 + std::int64_t{combinations} * (3 + statistics + QuantilesOfCombination());
    }
};

/// The numbers of one point in the order of the layout; `missing` for a parameter that a
/// distribution does not have, and for what is no number or none that a 32-bit float holds.
std::vector<float> PointResults(const COutputSettings& results, const ResultLayout& layout,
                                float missing);

/// Whether the results' lists have the lengths that the layout was made for.
bool HasLayout(const COutputSettings& results, const ResultLayout& layout);

/// An item of the output grid file.
struct ResultItem {
    std::string name;
    bool isQuantity = false; ///< has the type and the unit of the grid's item
};

/// The items in the order of the layout, named after the parameter file's combinations and return
/// periods and the results' parameter symbols.
std::vector<ResultItem> ResultItems(CGlobalKvf& root, const COutputSettings& results,
                                    const ResultLayout& layout);

} // namespace ryn
