#include "units/unit_table.h"

#include <algorithm>
#include <array>

namespace ryn {

namespace {

constexpr std::array kTable = std::to_array<UnitRow>({
    {1000, "m", "meter|metre|meters|metres"},
    {1001, "km", "kilometer|kilometre|kilometers|kilometres"},
    {1002, "cm", "centimeter|centimetre|centimeters|centimetres"},
    {1003, "mm", "millimeter|millimetre|millimeters|millimetres"},
    {1004, "ft", "foot|feet"},
    {1005, "inch", "in|inches"},
    {1006, "yard", "yd"},
    {1007, "mile", "mi|miles"},
    {1008, "nautical_mile", "nmile"},
    {1009, "0.1 mm", ""},
    {1010, "dm", ""},
    {1011, "um", "µm|micrometer"},
    {1012, "0.01 inch", ""},

    {1100, "m2", "m^2|m**2|m²"},
    {1101, "km2", "km^2|km**2|km²"},
    {1102, "hectare", "ha"},
    {1103, "ft2", "ft^2"},
    {1104, "acre", ""},

    {1200, "m3", "m^3|m**3|m³"},
    {1201, "l", "L|liter|litre"},
    {1202, "km3", "km^3"},
    {1203, "ft3", "ft^3"},
    {1204, "1e6 m3", "hm3|Mm3"},
    {1205, "acre_feet", "acre-feet"},

    {1300, "kg", "kilogram"},
    {1301, "g", "gram"},
    {1302, "t", "tonne"},

    {1400, "s", "second|seconds|sec|secs"},
    {1401, "min", "minute|minutes|mins"},
    {1402, "h", "hour|hours|hr|hrs"},
    {1403, "day", "d|days"},
    {1404, "week", "weeks"},
    {1405, "month", "months|mon"},
    {1406, "year", "years|yr|yrs"},
    {1407, "ms", "millisecond|milliseconds|msec"},

    {1500, "m/s", "m s-1|m s**-1|m s^-1|m.s-1"},
    {1501, "km/h", "km h-1|kph"},
    {1502, "knot", "knots|kts"},
    {1503, "cm/s", "cm s-1"},
    {1504, "ft/s", "ft s-1"},
    {1505, "mile/h", "mph"},
    {1506, "m/s2", "m s-2"},
    {1507, "Pa/s", "Pa s-1|Pa s**-1"},

    {1600, "mm/h", "mm h-1|mm/hr"},
    {1601, "mm/day", "mm d-1|mm/d|mm day-1"},
    {1602, "mm/s", "mm s-1"},
    {1603, "inch/h", "in/h"},
    {1604, "kg m-2 s-1", "kg/m2/s|kg/(m2 s)|kg m**-2 s**-1"},
    {1605, "mm/month", ""},
    {1606, "mm/year", ""},
    {1607, "inch/day", "in/d"},
    {1608, "m/day", "m d-1"},

    {1700, "m3/s", "m3 s-1|m^3/s|m**3 s**-1|m³/s|cumec|cumecs"},
    {1701, "l/s", "L/s|l s-1"},
    {1702, "ft3/s", "ft3 s-1|ft^3/s|cfs"},
    {1703, "m3/h", "m3 h-1"},
    {1704, "m3/day", "m3 d-1"},
    {1705, "m2/s", "m2 s-1"},
    {1706, "l/s/km2", "l s-1 km-2"},
    {1707, "m3/s/km2", ""},
    {1708, "1e6 m3/day", ""},

    {1800, "K", "kelvin|Kelvin"},
    {1801, "degC", "Celsius|celsius|°C|deg_C|degree_C|degrees_C|degree_Celsius|degrees_Celsius"},
    {1802, "degF", "Fahrenheit|fahrenheit|°F|deg_F|degree_F|degrees_F"},
    {1803, "0.1 degC", ""},

    {1900, "Pa", "pascal|Pascal|N/m2"},
    {1901, "hPa", "mbar|mb|millibar|millibars|hectopascal"},
    {1902, "kPa", ""},
    {1903, "bar", ""},
    {1904, "atm", ""},
    {1905, "mmHg", ""},
    {1906, "dbar", "decibar"},

    {2000, "1", "-|dimensionless|unitless"},
    {2001, "%", "percent"},
    {2002, "0.001", "per_mille|psu|PSU"},
    {2003, "m/m", ""},
    {2004, "mm/km", ""},
    {2005, "kg/kg", "kg kg-1|kg kg**-1"},
    {2006, "g/kg", "g kg-1"},
    {2007, "m3/m3", "m3 m-3|m**3 m**-3"},

    {2100, "degree", "degrees|deg|°"},
    {2101, "radian", "rad|radians"},
    {2102, "degrees_north", "degree_north|degree_N|degrees_N|degreeN|degreesN"},
    {2103, "degrees_east", "degree_east|degree_E|degrees_E|degreeE|degreesE"},

    {2200, "W/m2", "W m-2|W m**-2|W m^-2"},
    {2201, "J/m2", "J m-2|J m**-2"},
    {2202, "MJ/m2", "MJ m-2"},
    {2203, "kJ/m2", ""},
    {2204, "J/cm2", ""},
    {2205, "W", "watt"},
    {2206, "kW/m", ""},
    {2207, "J", "joule"},
    {2208, "m2 s-2", "m2/s2|m**2 s**-2"},

    {2300, "kg/m3", "kg m-3"},
    {2301, "mg/l", "mg/L|mg l-1"},
    {2302, "g/m3", "g m-3"},
    {2303, "kg/m2", "kg m-2|kg m**-2"},
    {2304, "kg/s", "kg s-1"},
    {2305, "t/day", ""},
    {2306, "ug/l", "ug/L"},

    {2400, "Hz", "hertz|s-1|s**-1|1/s"},
    {2401, "m2/Hz", "m2 Hz-1"},
    {2402, "N", "newton"},
    {2403, "N/m", ""},
    {2404, "mS/cm", ""},
    {2405, "S/m", "S m-1"},
    {2406, "1/day", "day-1"},
    {2407, "1/year", "year-1"},
    {2408, "hour/day", ""},
});

static_assert(std::ranges::is_sorted(kTable, {}, &UnitRow::code));
static_assert(kTable.back().code < kFirstInternedUnit);

} // namespace

std::span<const UnitRow> UnitTable() {
    return kTable;
}

const UnitRow* FindUnitRow(int code) {
    const auto* const row = std::ranges::lower_bound(kTable, code, {}, &UnitRow::code);
    return row != kTable.end() && row->code == code ? row : nullptr;
}

} // namespace ryn
