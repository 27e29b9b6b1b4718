#include "apps/cli/case_arguments.h"

#include <algorithm>
#include <memory>
#include <string_view>

#include "apps/cli/nearest_names.h"
#include "apps/cli/setting_value.h"
#include "apps/cli/settings.h"
#include "base/number_text.h"
#include "params/combination_name.h"
#include "strings/catalogue.h"

namespace ryn::cli {

namespace {

constexpr std::string_view kDistributions = "ProbabilityDistribution.";

bool IsOfCombination(const std::string& assignment) {
    return assignment.rfind(kDistributions, 0) == 0;
}

bool AssignsTo(const CaseArguments& arguments, std::string_view name) {
    const std::string start = std::string(name) + "=";
    return std::any_of(arguments.assignments.begin(), arguments.assignments.end(),
                       [&start](const std::string& text) { return text.rfind(start, 0) == 0; });
}

Status Assign(CGlobalKvf& root, const CaseArguments& arguments, bool toCombinations,
              const std::string& callerDirectory) {
    for (const std::string& assignment : arguments.assignments)
        if (IsOfCombination(assignment) == toCombinations)
            if (Status status = ApplyAssignment(root, assignment, callerDirectory); !status)
                return status;
    return Status::Ok();
}

/// A file that is named without an item means its first one.
void ChooseFirstItems(CGlobalKvf& root, const CaseArguments& arguments) {
    if (AssignsTo(arguments, "BasicInput.InputFileName") && root.BasicInput().InputItem == 0)
        root.BasicInput().InputItem = 1;
    if (AssignsTo(arguments, "DefineEVS.InputFileName") && root.DefineEVS().InputItem == 0)
        root.DefineEVS().InputItem = 1;
}

Status ReplaceCombinations(CGlobalKvf& root, const std::vector<std::string>& names) {
    if (names.empty())
        return Status::Ok();
    std::vector<std::unique_ptr<CDieCombinationKvf>> combinations;
    for (const std::string& name : names) {
        DieCombination found;
        const CombinationQuery query{name, root.DefineEVS().SelectionMethod,
                                     "DefineEVS.SelectionMethod"};
        if (Status status = FindCombination(query, &found); !status)
            return status;
        combinations.push_back(std::make_unique<CDieCombinationKvf>(found));
    }
    root.Distributions().Combinations = std::move(combinations);
    return Status::Ok();
}

Status ReplacePeriods(CAnalysisKvf& analysis, const std::optional<std::string>& periods) {
    if (!periods)
        return Status::Ok();
    const std::optional<std::vector<double>> numbers = ParseNumberList(*periods);
    if (!numbers)
        return Status::InputFault(FormatText(kTextCliBadValue, std::string("--periods"), *periods,
                                             std::string(Text(kTextCliExpectNumbers))));
    analysis.EvaluatedReturnPeriods = *numbers;
    return Status::Ok();
}

/// What no kind of series makes right is refused; `check` tells of the rest, which depends on
/// settings that may still come. Periods that the file had are not looked at.
Status TestPeriods(const CAnalysisKvf& analysis, const CaseArguments& arguments) {
    if (!arguments.periods && !AssignsTo(arguments, "Analysis.EvaluatedReturnPeriods.Item"))
        return Status::Ok();
    for (const double period : analysis.EvaluatedReturnPeriods)
        if (!(period > 0.0))
            return Status::InputFault(
                FormatText(kTextCliPeriodTooSmall, ShortestText(period), ShortestText(0.0)));
    return Status::Ok();
}

std::string KindName(int selectionMethod) {
    return std::string(
        Text(selectionMethod == 0 ? kTextCliAnnualMaxima : kTextCliPartialDurations));
}

} // namespace

Status ApplyArguments(CGlobalKvf& root, const CaseArguments& arguments,
                      const std::string& callerDirectory) {
    Status status = Assign(root, arguments, false, callerDirectory);
    if (status)
        ChooseFirstItems(root, arguments);
    if (status)
        status = ReplaceCombinations(root, arguments.fits);
    if (status)
        status = ReplacePeriods(root.Analysis(), arguments.periods);
    if (status)
        status = TestPeriods(root.Analysis(), arguments);
    if (status)
        status = Assign(root, arguments, true, callerDirectory);
    return status;
}

Status FindCombination(const CombinationQuery& query, DieCombination* combination) {
    if (const auto found = CombinationOfName(query.name, query.selectionMethod)) {
        *combination = *found;
        return Status::Ok();
    }
    const int otherMethod = query.selectionMethod == 0 ? 1 : 0;
    const std::string kind = KindName(query.selectionMethod);
    const std::string offered = JoinNames(GeneratedNames(query.selectionMethod));
    return Status::InputFault(
        CombinationOfName(query.name, otherMethod)
            ? FormatText(kTextCliNameOfOtherKind, query.name, KindName(otherMethod), kind,
                         query.decidedBy, offered)
            : FormatText(kTextCliUnknownCombination, query.name, kind, offered));
}

} // namespace ryn::cli
