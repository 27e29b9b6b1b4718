#pragma once

#include <array>
#include <span>
#include <string>
#include <string_view>
#include <variant>
#include <vector>

#include "base/status.h"
#include "params/global_kvf.h"

namespace ryn::cli {

/// Of the plotting position formulas, by their numbers in the setup file.
inline constexpr std::array<std::string_view, 5> kPlottingMethodNames = {
    "Weibull", "Hazen", "Gringorten", "Blom", "Cunnane"};

/// A member that holds a file name: absolute in memory, typed relative to the caller's directory.
struct FileNameMember {
    std::string* name;
};

/// An element of a list; the one behind the last appends.
template <typename T>
struct ListElement {
    std::vector<T>* list;
    std::size_t index;
};

/// The name of a combination; one that is set counts as the user's own.
struct CombinationName {
    DieCombination* combination;
};

using SettingMember =
    std::variant<int*, double*, bool*, std::string*, FileNameMember, COleDateTime*, IndexRange*,
                 std::vector<double>*, std::vector<int>*, ListElement<COleDateTime>,
                 ListElement<int>, CombinationName>;

/// One keyword of the parameter file that the command line can set. Points into the sections.
struct Setting {
    std::string name; ///< sections and keyword with points between: "BasicInput.Threshold"
    SettingMember member;
    /// Names for an int's values 0, 1, ...; other values are refused. Empty: any int.
    std::span<const std::string_view> choices = {};
};

/// Every keyword that can be set, in file order. Lists end with the element that would be appended
/// next, so that the table is to be made anew after each change of a list.
std::vector<Setting> SettingsOf(CGlobalKvf& root);

/// Applies "Section.Keyword=value". Relative file names count from `callerDirectory`. A fault names
/// what was typed, and the nearest names or what is expected.
Status ApplyAssignment(CGlobalKvf& root, std::string_view assignment,
                       const std::string& callerDirectory);

} // namespace ryn::cli
