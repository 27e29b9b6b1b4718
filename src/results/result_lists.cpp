#include "results/result_lists.h"

#include <algorithm>
#include <limits>
#include <string>

namespace ryn {

void LoadDoubles(const KvfSection* section, std::string_view keyword, std::size_t count,
                 DoubleList* list) {
    const KvfKeyword* const found = kvfKeywordByNameNum(section, keyword, 1);
    const std::size_t present = static_cast<std::size_t>(kvfGetNoParams(found));
    const int end = static_cast<int>(std::min(count, present));
    list->reserve(list->size() + static_cast<std::size_t>(end));
    for (int i = 1; i <= end; ++i) {
        const KvfParam* const parameter = kvfParamByNum(found, i);
        const KvfType type = kvfParamType(*parameter);
        const bool isNumber =
            type == KvfType::Int || type == KvfType::Float || type == KvfType::Double;
        list->push_back(isNumber ? kvfParamDouble(*parameter)
                                 : std::numeric_limits<double>::quiet_NaN());
    }
}

void SaveDoubles(KvfTree* file, std::string_view keyword, const DoubleList& list) {
    kvfAddKeyword(file, keyword);
    for (const double value : list)
        kvfAddDouble(file, value);
}

std::size_t LoadCount(const KvfSection* section, std::string_view keyword) {
    int count = 0;
    kvfGetParam(section, keyword, &count, 1, 1);
    return static_cast<std::size_t>(std::max(count, 0));
}

void SaveCount(KvfTree* file, std::string_view keyword, std::size_t count) {
    kvfPutParam(file, keyword, static_cast<int>(count));
}

std::string ItemSectionName(std::size_t number) {
    return "Item" + std::to_string(number);
}

void ForEachItem(const KvfSection* parent, const std::function<void(const KvfSection*)>& visit) {
    // Ten times what the engine takes. Each becomes some thirty keywords when it is written, so
    // that a small file of empty sections would grow without bound.
    constexpr std::size_t kMostItems = 10'000;
    for (std::size_t number = 1; number <= kMostItems; ++number) {
        const KvfSection* const item = kvfSectionByNameNum(parent, ItemSectionName(number), 1);
        if (item == nullptr)
            return;
        visit(item);
    }
}

void ForEachCombination(const KvfSection* target,
                        const std::function<void(const KvfSection*)>& visit) {
    ForEachItem(kvfSectionByNameNum(target, "DistributionAnalysis", 1), visit);
}

} // namespace ryn
