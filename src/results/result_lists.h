#pragma once

#include <cstddef>
#include <functional>
#include <string>
#include <string_view>
#include <vector>

#include "kvf/kvf.h"

namespace ryn {

/// Lists of the result tree: keywords with many numbers, and numbered sections.

using DoubleList = std::vector<double>;

/// Appends the first `count` numbers of a keyword, or as many as there are: a count is a claim of
/// the file. A parameter that is no number is NaN.
void LoadDoubles(const KvfSection* section, std::string_view keyword, std::size_t count,
                 DoubleList* list);
void SaveDoubles(KvfTree* file, std::string_view keyword, const DoubleList& list);

/// The int of `keyword` as a count: 0 where it is missing or negative.
std::size_t LoadCount(const KvfSection* section, std::string_view keyword);
void SaveCount(KvfTree* file, std::string_view keyword, std::size_t count);

/// "Item1", "Item2", ...
std::string ItemSectionName(std::size_t number);

/// Calls `visit` with the sections Item1, Item2, ... of `parent`, up to the first that is missing,
/// but no more than 10 000.
void ForEachItem(const KvfSection* parent, const std::function<void(const KvfSection*)>& visit);

/// The same for the D/E combinations: the item sections of DistributionAnalysis in target
/// RYNoutput.
void ForEachCombination(const KvfSection* target,
                        const std::function<void(const KvfSection*)>& visit);

} // namespace ryn
