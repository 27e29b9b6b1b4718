#pragma once

#include <string>
#include <string_view>

/// Unit codes and item type codes of data files, and conversion between units.
namespace ryn {

inline constexpr int kUnitUndefined = 0;
inline constexpr int kUnitSecond = 1400;
inline constexpr int kUnitHour = 1402;
inline constexpr int kItemTypeUndefined = 999;

/// Converts a value between two unit codes. Returns 0 on success; another value, with `result`
/// unchanged, when a code is unknown or the units do not convert into each other.
int qtyConvertUnit(int fromUnit, double value, int toUnit, double* result);

/// The factor and offset of a conversion (to = from * factor + offset), for use over many values;
/// false when there is none.
bool UnitConversion(int fromUnit, int toUnit, double* factor, double* offset);

/// The text of a unit code; empty for kUnitUndefined and for an unknown code.
std::string UnitText(int code);
/// The code of a unit text. A text that is not in the table of units gets a code of its own for the
/// life of the process (files store the text beside the code, and the text decides on reading), so
/// that no unit is lost on its way from file to file. Empty gives kUnitUndefined.
int UnitOfText(std::string_view text);

/// The text of an item type ("Discharge", "Water level", ...); "Undefined" for an unknown code.
std::string ItemTypeText(int code);
/// The item type that a unit suggests; kItemTypeUndefined where it says nothing.
int ItemTypeOfUnit(int unitCode);

} // namespace ryn
