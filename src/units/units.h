#pragma once

#include <string>
#include <string_view>

#include "base/status.h"

/// Unit codes and item type codes of data files, and conversion between units.
namespace ryn {

inline constexpr int kUnitUndefined = 0;
inline constexpr int kUnitSecond = 1400;
inline constexpr int kUnitHour = 1402;
inline constexpr int kItemTypeUndefined = 999;

/// Converts a value between two unit codes. Time units convert at the cost of a multiplication, a
/// month counting as a twelfth of a tropical year; the others go through UDUNITS, whose database is
/// loaded at the first use. Returns 0 on success; another value, with `result` unchanged, when a
/// code is unknown or the units do not convert into each other.
int qtyConvertUnit(int fromUnit, double value, int toUnit, double* result);

/// The factor and offset of a conversion (to = from * factor + offset), for use over many values;
/// false when there is none or it is not linear. Outputs are unchanged then.
bool UnitConversion(int fromUnit, int toUnit, double* factor, double* offset);

/// The text of a unit code; empty for kUnitUndefined and for an unknown code.
std::string UnitText(int code);
/// The code of a unit text. A text that is not in the table of units gets a code of its own for the
/// life of the process (files store the text beside the code, and the text decides on reading), so
/// that no unit is lost on its way from file to file. Another writing of a unit of the table ("m
/// s-1" for "m/s") gives the table's code. Empty gives kUnitUndefined.
int UnitOfText(std::string_view text);
/// True for a code of the table, which means the same in every process.
bool IsTableUnit(int code);
/// True for a unit of the table and for any text that UDUNITS understands; a code that only keeps
/// a text is none, and converts into nothing.
bool IsKnownUnit(int code);
/// Ok when UDUNITS found its database of units (UDUNITS2_XML_PATH in the environment, else the
/// installed file); else why not. Without it only time units and equal codes convert, and only the
/// writings that the table lists are recognised.
Status UnitDatabaseStatus();

/// The text of an item type ("Discharge", "Water level", ...); "Undefined" for an unknown code.
std::string ItemTypeText(int code);
/// The item type that a unit suggests; kItemTypeUndefined where it says nothing.
int ItemTypeOfUnit(int unitCode);

} // namespace ryn
