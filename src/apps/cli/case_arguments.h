#pragma once

#include <optional>
#include <string>
#include <vector>

#include "base/status.h"
#include "params/global_kvf.h"

namespace ryn::cli {

/// What `new` and `set` change in an analysis.
struct CaseArguments {
    std::vector<std::string> assignments; ///< "Section.Keyword=value"
    /// Names of combinations; when there are any they take the place of the list that is there.
    std::vector<std::string> fits;
    std::optional<std::string> periods; ///< "2,10,100": takes the place of the return periods

    bool AreEmpty() const { return assignments.empty() && fits.empty() && !periods; }
};

/// Applies the arguments: first assignments, then --fit and --periods, last assignments to
/// combinations, so that the order on the command line plays a part only among equals. An input
/// file without an item gets item 1. After a fault the sections are to be thrown away.
Status ApplyArguments(CGlobalKvf& root, const CaseArguments& arguments,
                      const std::string& callerDirectory);

/// A combination looked for by its generated name.
struct CombinationQuery {
    std::string name;
    int selectionMethod = 0; ///< 0 annual maxima, 1 partial durations
    std::string decidedBy;   ///< what the user can change to have the other kind
};

/// A fault says of which kind the name is and lists the names on offer.
Status FindCombination(const CombinationQuery& query, DieCombination* combination);

} // namespace ryn::cli
