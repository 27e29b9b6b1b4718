#pragma once

#include <string>
#include <string_view>
#include <vector>

#include "import/civil_time.h"

namespace ryn {

/// A time format as --time-format gives it: %Y %y %m %d %j %H %I %M %S %f %p %b %B %z %%, the short
/// forms %F (%Y-%m-%d), %T (%H:%M:%S), %R (%H:%M), and plain characters. A blank stands for any
/// run of blanks, also none. Of several years the first holds. Numbers may lack leading zeros where
/// a sign that is no digit follows. Independent of the locale; months' names are those of
/// MonthOfName.
class TimePattern {
  public:
    /// False for an unknown letter behind %, and for a format without any field; *reason tells.
    static bool Compile(std::string_view format, TimePattern* pattern, std::string* reason);

    /// Reads the whole of a text. A month or day of 0 is Incomplete.
    TimeResult Parse(std::string_view text, TimeParts* parts) const;

    /// Whether the format has one of these letters.
    bool Has(std::string_view letters) const;
    /// As given.
    const std::string& Text() const { return source; }

  private:
    std::string source;
    std::string expanded; // short forms written out
};

} // namespace ryn
