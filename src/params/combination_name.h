#pragma once

#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "params/die_combination_kvf.h"

namespace ryn {

/// The generated name of a combination: distribution code, "/", MOM, ML or LMOM, and options, as in
/// "GEV/LMOM", "LP3/MOM/LOG", "LN3/MOM/BI". The codes differ between an annual maximum series
/// (selection method 0) and a partial duration series (1). Empty for a distribution without a code
/// there.
std::string GeneratedName(const DieCombination& combination, int selectionMethod);

/// The combination with a generated name, its fields derived from the name; nothing for a name that
/// cannot arise for the selection method. The name may be in any case.
std::optional<DieCombination> CombinationOfName(std::string_view name, int selectionMethod);

/// Every name that can arise for a selection method, in the order of the dialogs' lists.
std::vector<std::string> GeneratedNames(int selectionMethod);

} // namespace ryn
