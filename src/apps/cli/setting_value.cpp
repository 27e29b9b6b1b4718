#include "apps/cli/setting_value.h"

#include <cmath>

#include "apps/cli/date_text.h"
#include "base/number_text.h"
#include "base/path_parts.h"
#include "strings/catalogue.h"

namespace ryn::cli {

namespace {

/// The year of a day that is typed without one, where the member has none either.
constexpr int kUsualYear = 1990;

std::optional<double> ParseFinite(std::string_view text) {
    const std::optional<double> number = ParseDouble(text);
    return number && std::isfinite(*number) ? number : std::nullopt;
}

std::optional<bool> ParseBool(std::string_view text) {
    if (text == "true" || text == "1")
        return true;
    if (text == "false" || text == "0")
        return false;
    return std::nullopt;
}

std::vector<std::string_view> SplitAtCommas(std::string_view text) {
    std::vector<std::string_view> parts;
    while (!text.empty()) {
        const std::size_t comma = text.find(',');
        parts.push_back(text.substr(0, comma));
        if (comma == std::string_view::npos)
            break;
        text.remove_prefix(comma + 1);
        if (text.empty())
            parts.push_back(text); // an empty element behind the last comma is a fault
    }
    return parts;
}

std::optional<std::vector<int>> ParseIntList(std::string_view text) {
    std::vector<int> numbers;
    for (const std::string_view part : SplitAtCommas(text)) {
        const std::optional<int> number = ParseInt(part);
        if (!number)
            return std::nullopt;
        numbers.push_back(*number);
    }
    return numbers;
}

/// Stores what was read, if anything was.
template <typename T, typename Member>
bool Store(const std::optional<T>& value, Member& member) {
    if (value)
        member = *value;
    return value.has_value();
}

template <typename T>
bool StoreElement(const ListElement<T>& element, const std::optional<T>& value) {
    if (!value)
        return false;
    if (element.index == element.list->size())
        element.list->push_back(*value);
    else
        element.list->at(element.index) = *value;
    return true;
}

/// Reads a text into the member that it is called with.
struct ValueReader {
    std::string_view text;
    std::span<const std::string_view> choices;
    const std::string& callerDirectory;

    bool operator()(int* member) const { return Store(ParseChoice(), *member); }
    bool operator()(double* member) const { return Store(ParseFinite(text), *member); }
    bool operator()(bool* member) const { return Store(ParseBool(text), *member); }
    bool operator()(std::string* member) const {
        member->assign(text);
        return true;
    }
    bool operator()(FileNameMember member) const {
        *member.name = AbsoluteName(std::string(text), callerDirectory);
        return true;
    }
    bool operator()(COleDateTime* member) const { return Store(ParseDateLike(*member), *member); }
    bool operator()(IndexRange* member) const {
        const std::optional<std::vector<int>> numbers = ParseIntList(text);
        if (!numbers || numbers->size() != 3)
            return false;
        *member = {numbers->at(0), numbers->at(1), numbers->at(2)};
        return true;
    }
    bool operator()(std::vector<double>* member) const {
        return Store(ParseNumberList(text), *member);
    }
    bool operator()(std::vector<int>* member) const { return Store(ParseIntList(text), *member); }
    bool operator()(const ListElement<COleDateTime>& element) const {
        const bool exists = element.index < element.list->size();
        return StoreElement(
            element, ParseDateLike(exists ? element.list->at(element.index) : COleDateTime()));
    }
    bool operator()(const ListElement<int>& element) const {
        return StoreElement(element, ParseInt(text));
    }
    bool operator()(CombinationName member) const {
        if (text.empty())
            return false;
        member.combination->ItemName = text;
        member.combination->IsDefaultName = true;
        return true;
    }

  private:
    std::optional<int> ParseChoice() const {
        const std::optional<int> number = ParseInt(text);
        if (choices.empty())
            return number;
        for (std::size_t i = 0; i < choices.size(); ++i)
            if (text == choices[i] || number == static_cast<int>(i))
                return static_cast<int>(i);
        return std::nullopt;
    }
    std::optional<COleDateTime> ParseDateLike(const COleDateTime& present) const {
        return ParseDate(text, present.IsValid() ? present.GetYear() : kUsualYear);
    }
};

struct Expectation {
    std::string operator()(const int* /*member*/) const { return Named(kTextCliExpectInt); }
    std::string operator()(const double* /*member*/) const { return Named(kTextCliExpectNumber); }
    std::string operator()(const bool* /*member*/) const { return "true, false"; }
    std::string operator()(const std::string* /*member*/) const {
        return Named(kTextCliExpectText);
    }
    std::string operator()(FileNameMember /*member*/) const { return Named(kTextCliExpectText); }
    std::string operator()(const COleDateTime* /*member*/) const {
        return Named(kTextCliExpectDate);
    }
    std::string operator()(const IndexRange* /*member*/) const {
        return Named(kTextCliExpectThreeInts);
    }
    std::string operator()(const std::vector<double>* /*member*/) const {
        return Named(kTextCliExpectNumbers);
    }
    std::string operator()(const std::vector<int>* /*member*/) const {
        return Named(kTextCliExpectInts);
    }
    std::string operator()(const ListElement<COleDateTime>& /*member*/) const {
        return Named(kTextCliExpectDate);
    }
    std::string operator()(const ListElement<int>& /*member*/) const {
        return Named(kTextCliExpectInt);
    }
    std::string operator()(CombinationName /*member*/) const { return Named(kTextCliExpectText); }

  private:
    static std::string Named(int textId) { return std::string(Text(textId)); }
};

template <typename T>
std::string ListText(const std::vector<T>& list) {
    std::string text;
    for (const T& element : list)
        text += (text.empty() ? "" : ",") + ShortestText(static_cast<double>(element));
    return text;
}

struct ValueWriter {
    std::string operator()(const int* member) const { return std::to_string(*member); }
    std::string operator()(const double* member) const { return ShortestText(*member); }
    std::string operator()(const bool* member) const { return *member ? "true" : "false"; }
    std::string operator()(const std::string* member) const { return *member; }
    std::string operator()(FileNameMember member) const { return *member.name; }
    std::string operator()(const COleDateTime* member) const {
        return member->Format("%Y-%m-%dT%H:%M");
    }
    std::string operator()(const IndexRange* member) const {
        return ListText(std::vector{member->first, member->last, member->step});
    }
    std::string operator()(const std::vector<double>* member) const { return ListText(*member); }
    std::string operator()(const std::vector<int>* member) const { return ListText(*member); }
    std::string operator()(const ListElement<COleDateTime>& element) const {
        return element.index < element.list->size() ? (*this)(&element.list->at(element.index))
                                                    : std::string();
    }
    std::string operator()(const ListElement<int>& element) const {
        return element.index < element.list->size() ? (*this)(&element.list->at(element.index))
                                                    : std::string();
    }
    std::string operator()(CombinationName member) const { return member.combination->ItemName; }
};

} // namespace

bool SetValue(const Setting& setting, std::string_view text, const std::string& callerDirectory) {
    return std::visit(ValueReader{text, setting.choices, callerDirectory}, setting.member);
}

std::string ExpectedValue(const Setting& setting) {
    if (setting.choices.empty())
        return std::visit(Expectation{}, setting.member);
    std::string choices;
    for (std::size_t i = 0; i < setting.choices.size(); ++i)
        choices +=
            (i == 0 ? "" : ", ") + std::to_string(i) + " (" + std::string(setting.choices[i]) + ")";
    return choices;
}

std::string ValueText(const Setting& setting) {
    return std::visit(ValueWriter{}, setting.member);
}

std::optional<std::vector<double>> ParseNumberList(std::string_view text) {
    std::vector<double> numbers;
    for (const std::string_view part : SplitAtCommas(text)) {
        const std::optional<double> number = ParseFinite(part);
        if (!number)
            return std::nullopt;
        numbers.push_back(*number);
    }
    return numbers;
}

std::string AbsoluteName(const std::string& name, const std::string& directory) {
    if (name.empty() || name.front() == '/')
        return FullPath(name);
    return FullPath(WithTrailingSeparator(directory) + name);
}

} // namespace ryn::cli
