#pragma once

#include <map>
#include <mutex>
#include <optional>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

#include "base/status.h"
#include "units/unit_library.h"

namespace ryn {

/// The units of this process: the table, the texts outside it that were met, and UDUNITS behind
/// both. For use by any thread.
class UnitRegistry {
  public:
    static UnitRegistry& Instance();

    std::string TextOf(int code);
    int CodeOf(std::string_view text);
    /// Whether UDUNITS understands the unit's text.
    bool LibraryKnows(int code);
    /// Converts by UDUNITS; nothing when there is no conversion.
    std::optional<double> Convert(int from, int to, double value);
    Status LibraryLoaded();

  private:
    UnitRegistry();

    UnitLibrary& Library();
    std::string_view TextUnlocked(int code) const;
    int SameUnitInTable(std::string_view text);
    const UnitConverter* ConverterFor(int from, int to);

    std::mutex mutex;
    std::optional<UnitLibrary> library;
    std::map<std::string, int, std::less<>> codes; // by text and alias
    std::vector<std::string> interned;             // by code - kFirstInternedUnit
    std::map<std::pair<int, int>, std::optional<UnitConverter>> converters;
};

} // namespace ryn
