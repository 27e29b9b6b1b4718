#include <array>
#include <cmath>

#include "units/unit_registry.h"
#include "units/unit_table.h"
#include "units/units.h"

namespace ryn {

namespace {

// Seconds in a time unit, by code - kUnitSecond, as UDUNITS has them: its year is the tropical one,
// and its month a twelfth of that. Readers convert each step's time, and a look-up in UDUNITS costs
// a hundred times as much.
constexpr double kSecondsInYear = 365.242198781 * 86400.0;
constexpr std::array kSecondsInTimeUnit = {
    1.0, 60.0, 3600.0, 86400.0, 604800.0, kSecondsInYear / 12.0, kSecondsInYear, 1e-3};

double SecondsInTimeUnit(int code) {
    const int index = code - kUnitSecond;
    return index >= 0 && index < static_cast<int>(kSecondsInTimeUnit.size())
               ? kSecondsInTimeUnit[static_cast<std::size_t>(index)]
               : 0.0;
}

bool IsKnown(int code) {
    return FindUnitRow(code) != nullptr || !UnitRegistry::Instance().TextOf(code).empty();
}

} // namespace

int qtyConvertUnit(int fromUnit, double value, int toUnit, double* result) {
    const double from = SecondsInTimeUnit(fromUnit);
    const double to = SecondsInTimeUnit(toUnit);
    if (from > 0.0 && to > 0.0) {
        // The quotient of the larger by the smaller is mostly a whole number, and so exact.
        *result = from >= to ? value * (from / to) : value / (to / from);
        return 0;
    }
    if (fromUnit == toUnit && IsKnown(fromUnit)) {
        *result = value;
        return 0;
    }
    const auto converted = UnitRegistry::Instance().Convert(fromUnit, toUnit, value);
    if (!converted)
        return 1;
    *result = *converted;
    return 0;
}

bool UnitConversion(int fromUnit, int toUnit, double* factor, double* offset) {
    // A long stretch keeps an offset of hundreds (temperatures) from eating the factor's digits;
    // its middle tells a logarithmic unit from a linear one.
    constexpr double kStretch = 1048576.0;
    double zero = 0.0;
    double middle = 0.0;
    double end = 0.0;
    if (qtyConvertUnit(fromUnit, 0.0, toUnit, &zero) != 0 ||
        qtyConvertUnit(fromUnit, kStretch / 2.0, toUnit, &middle) != 0 ||
        qtyConvertUnit(fromUnit, kStretch, toUnit, &end) != 0)
        return false;
    if (!(std::abs((zero + end) / 2.0 - middle) <= 1e-12 * (std::abs(zero) + std::abs(end))))
        return false;
    *factor = (end - zero) / kStretch;
    *offset = zero;
    return true;
}

std::string UnitText(int code) {
    return UnitRegistry::Instance().TextOf(code);
}

int UnitOfText(std::string_view text) {
    return UnitRegistry::Instance().CodeOf(text);
}

bool IsTableUnit(int code) {
    return FindUnitRow(code) != nullptr;
}

bool IsKnownUnit(int code) {
    return IsTableUnit(code) || UnitRegistry::Instance().LibraryKnows(code);
}

Status UnitDatabaseStatus() {
    return UnitRegistry::Instance().LibraryLoaded();
}

} // namespace ryn
