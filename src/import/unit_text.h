#pragma once

#include <string>
#include <string_view>

namespace ryn {

/// True for a text made of the usual unit symbols and names ("m3/s", "0.1 mm", "degC", "cm", "%").
bool LooksLikeUnit(std::string_view text);

/// Parts a column's title into name and unit: "Q [m3/s]", "wave height (m)", "Discharge, m3/s".
/// What stands in round brackets or behind a comma is a unit only where it looks like one.
void SplitNameAndUnit(std::string_view title, std::string* name, std::string* unit);

/// The usual names of units that the unit library does not know, in its own notation: "cfs" is
/// "ft3/s", "cumecs" is "m3/s". Other texts come back as they are; "-" and "none" as empty.
std::string PlainUnit(std::string_view text);

} // namespace ryn
