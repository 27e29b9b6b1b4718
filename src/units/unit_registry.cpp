#include "units/unit_registry.h"

#include "units/unit_table.h"
#include "units/units.h"

namespace ryn {

UnitRegistry& UnitRegistry::Instance() {
    static UnitRegistry registry;
    return registry;
}

UnitRegistry::UnitRegistry() {
    for (const UnitRow& row : UnitTable()) {
        codes.emplace(row.text, row.code);
        std::string_view rest = row.aliases;
        while (!rest.empty()) {
            const std::size_t end = rest.find('|');
            codes.emplace(rest.substr(0, end), row.code);
            rest = end == std::string_view::npos ? std::string_view() : rest.substr(end + 1);
        }
    }
}

UnitLibrary& UnitRegistry::Library() {
    if (!library)
        library.emplace();
    return *library;
}

std::string_view UnitRegistry::TextUnlocked(int code) const {
    if (const UnitRow* row = FindUnitRow(code))
        return row->text;
    const auto index = static_cast<std::size_t>(code) - kFirstInternedUnit;
    return code >= kFirstInternedUnit && index < interned.size() ? interned[index]
                                                                 : std::string_view();
}

std::string UnitRegistry::TextOf(int code) {
    const std::lock_guard lock(mutex);
    return std::string(TextUnlocked(code));
}

int UnitRegistry::SameUnitInTable(std::string_view text) {
    if (!Library().Knows(text))
        return kUnitUndefined;
    // Pure numbers are one to UDUNITS: "mm/m" (millimetres a month, to some) would become "0.001".
    const auto isNumber = [](const UnitRow& row) { return row.code >= 2000 && row.code < 2100; };
    for (const UnitRow& row : UnitTable())
        if (!isNumber(row) && Library().IsSame(text, row.text))
            return row.code;
    return kUnitUndefined;
}

int UnitRegistry::CodeOf(std::string_view text) {
    if (text.empty())
        return kUnitUndefined;
    const std::lock_guard lock(mutex);
    if (const auto known = codes.find(text); known != codes.end())
        return known->second;
    // Both outcomes are remembered, since asking UDUNITS costs a hundred comparisons of units.
    int code = SameUnitInTable(text);
    if (code == kUnitUndefined) {
        code = kFirstInternedUnit + static_cast<int>(interned.size());
        interned.emplace_back(text);
    }
    codes.emplace(text, code);
    return code;
}

bool UnitRegistry::LibraryKnows(int code) {
    const std::lock_guard lock(mutex);
    const std::string_view text = TextUnlocked(code);
    return !text.empty() && Library().Knows(text);
}

const UnitConverter* UnitRegistry::ConverterFor(int from, int to) {
    const auto [place, isNew] = converters.try_emplace({from, to});
    if (isNew)
        // That two units do not convert is remembered as well.
        place->second = Library().Converter(TextUnlocked(from), TextUnlocked(to));
    return place->second ? &*place->second : nullptr;
}

std::optional<double> UnitRegistry::Convert(int from, int to, double value) {
    const std::lock_guard lock(mutex);
    // An empty text is UDUNITS' "1", and a code without a text would convert as such.
    if (TextUnlocked(from).empty() || TextUnlocked(to).empty())
        return std::nullopt;
    const UnitConverter* const converter = ConverterFor(from, to);
    return converter != nullptr ? std::optional(converter->Convert(value)) : std::nullopt;
}

Status UnitRegistry::LibraryLoaded() {
    const std::lock_guard lock(mutex);
    return Library().Loaded();
}

} // namespace ryn
