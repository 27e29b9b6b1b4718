#pragma once

#include <memory>
#include <optional>
#include <string_view>

#include "base/status.h"

union cv_converter;
struct ut_system;
union ut_unit;

namespace ryn {

/// How one unit becomes another.
class UnitConverter {
  public:
    double Convert(double value) const;

  private:
    friend class UnitLibrary;
    struct Free {
        void operator()(cv_converter* freed) const;
    };
    std::unique_ptr<cv_converter, Free> converter;
};

/// UDUNITS and its database of units, which is loaded at the first use (some milliseconds) and kept
/// for the life of the process. UDUNITS finds the database by itself: the file that the environment
/// variable UDUNITS2_XML_PATH names, else the installed one. It is not made for several threads:
/// the caller holds UnitRegistry's lock.
class UnitLibrary {
  public:
    UnitLibrary();
    ~UnitLibrary();
    UnitLibrary(const UnitLibrary&) = delete;
    UnitLibrary& operator=(const UnitLibrary&) = delete;

    /// Why the database could not be loaded; nothing is known then, and nothing converts.
    const Status& Loaded() const { return loaded; }
    bool Knows(std::string_view text) const;
    /// True when both texts are known and mean the same unit ("m s-1" and "m/s").
    bool IsSame(std::string_view a, std::string_view b) const;
    /// Nothing when a text is unknown or the units do not convert into each other.
    std::optional<UnitConverter> Converter(std::string_view from, std::string_view to) const;

  private:
    struct FreeSystem {
        void operator()(ut_system* freed) const;
    };
    struct FreeUnit {
        void operator()(ut_unit* freed) const;
    };
    using Unit = std::unique_ptr<ut_unit, FreeUnit>;

    Unit Parse(std::string_view text) const;

    std::unique_ptr<ut_system, FreeSystem> system;
    Status loaded;
};

} // namespace ryn
