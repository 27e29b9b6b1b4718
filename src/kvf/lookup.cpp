#include <cmath>
#include <cstdint>
#include <optional>

#include "kvf/kvf.h"
#include "kvf/tree.h"

namespace ryn {

namespace {

template <typename Type>
std::optional<Type> Exactly(const KvfParam& param) {
    const Type* const value = std::get_if<Type>(&param.value);
    return value != nullptr ? std::optional<Type>(*value) : std::nullopt;
}

std::optional<float> ToFloat(const KvfParam& param) {
    const int* const integer = std::get_if<int>(&param.value);
    if (integer == nullptr)
        return Exactly<float>(param);
    const auto value = static_cast<float>(*integer);
    // Compared as 64-bit numbers: 2^31, to which the largest ints round, is no int.
    return static_cast<std::int64_t>(value) == *integer ? std::optional(value) : std::nullopt;
}

std::optional<double> ToDouble(const KvfParam& param) {
    if (const int* const integer = std::get_if<int>(&param.value))
        return *integer;
    if (const float* const single = std::get_if<float>(&param.value))
        return *single;
    return Exactly<double>(param);
}

const std::string* ToText(const KvfParam& param) {
    if (const KvfText* const text = std::get_if<KvfText>(&param.value))
        return text->text;
    const KvfFileName* const name = std::get_if<KvfFileName>(&param.value);
    return name != nullptr ? name->text : nullptr;
}

const KvfParam* FindParam(const KvfSection* parent, std::string_view keyword, int occurrence,
                          int index) {
    return kvfParamByNum(kvfKeywordByNameNum(parent, keyword, occurrence), index);
}

/// Stores what `convert` makes of a parameter.
template <typename Type, typename Convert>
int Get(const KvfParam* param, Convert convert, Type* value) {
    if (param == nullptr || value == nullptr)
        return 0;
    const auto converted = convert(*param);
    if (!converted)
        return 0;
    *value = *converted;
    return 1;
}

} // namespace

const KvfSection* kvfTargetByNameNum(const KvfTree* tree, std::string_view name, int occurrence) {
    return tree == nullptr ? nullptr : kvfSectionByNameNum(tree->Root(), name, occurrence);
}

const KvfSection* kvfSectionByNameNum(const KvfSection* parent, std::string_view name,
                                      int occurrence) {
    return static_cast<KvfSection*>(KvfFindChild(parent, KvfNodeKind::Section, name, occurrence));
}

const KvfKeyword* kvfKeywordByNameNum(const KvfSection* parent, std::string_view name,
                                      int occurrence) {
    return static_cast<KvfKeyword*>(KvfFindChild(parent, KvfNodeKind::Keyword, name, occurrence));
}

int kvfGetNoParams(const KvfKeyword* keyword) {
    return keyword == nullptr ? 0 : static_cast<int>(keyword->count);
}

const KvfParam* kvfParamByNum(const KvfKeyword* keyword, int index) {
    if (index < 1 || index > kvfGetNoParams(keyword))
        return nullptr;
    return &keyword->tree->Param(keyword->first + static_cast<std::size_t>(index) - 1);
}

int kvfIsBool(const KvfParam* param) {
    return param != nullptr && kvfParamType(*param) == KvfType::Bool ? 1 : 0;
}

bool kvfGetBool(const KvfParam* param) {
    return param != nullptr && Exactly<bool>(*param).value_or(false);
}

int kvfGetParam(const KvfSection* parent, std::string_view keyword, int* value, int occurrence,
                int index) {
    return Get(FindParam(parent, keyword, occurrence, index), Exactly<int>, value);
}

int kvfGetParam(const KvfSection* parent, std::string_view keyword, bool* value, int occurrence,
                int index) {
    return Get(FindParam(parent, keyword, occurrence, index), Exactly<bool>, value);
}

int kvfGetParam(const KvfSection* parent, std::string_view keyword, float* value, int occurrence,
                int index) {
    return Get(FindParam(parent, keyword, occurrence, index), ToFloat, value);
}

int kvfGetParam(const KvfSection* parent, std::string_view keyword, double* value, int occurrence,
                int index) {
    return Get(FindParam(parent, keyword, occurrence, index), ToDouble, value);
}

int kvfGetParam(const KvfSection* parent, std::string_view keyword, std::string* value,
                int occurrence, int index) {
    return Get(FindParam(parent, keyword, occurrence, index), ToText, value);
}

int kvfGetParamFilename(const KvfSection* parent, std::string_view keyword, std::string* value,
                        int occurrence, int index) {
    return kvfGetParam(parent, keyword, value, occurrence, index);
}

int kvfGetListParam(const KvfSection* parent, std::string_view keyword, int occurrence,
                    std::string_view format, std::initializer_list<int*> values) {
    const KvfKeyword* const found = kvfKeywordByNameNum(parent, keyword, occurrence);
    if (found == nullptr || format.size() != values.size() ||
        format.find_first_not_of('i') != std::string_view::npos)
        return 0;
    std::vector<int> numbers;
    for (std::size_t i = 0; i < values.size(); ++i) {
        int number = 0;
        if (Get(kvfParamByNum(found, static_cast<int>(i) + 1), Exactly<int>, &number) == 0)
            return 0;
        numbers.push_back(number);
    }
    auto next = numbers.begin();
    for (int* const value : values) {
        if (value != nullptr)
            *value = *next;
        ++next;
    }
    return 1;
}

KvfType kvfParamType(const KvfParam& parameter) {
    return static_cast<KvfType>(parameter.value.index());
}

int kvfParamInt(const KvfParam& parameter) {
    return Exactly<int>(parameter).value_or(0);
}

double kvfParamDouble(const KvfParam& parameter) {
    return ToDouble(parameter).value_or(0.0);
}

float kvfParamFloat(const KvfParam& parameter) {
    return Exactly<float>(parameter).value_or(0.0F);
}

std::string_view kvfParamText(const KvfParam& parameter) {
    const std::string* const text = ToText(parameter);
    return text == nullptr ? std::string_view() : std::string_view(*text);
}

} // namespace ryn
