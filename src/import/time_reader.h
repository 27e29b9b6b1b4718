#pragma once

#include <span>
#include <string>
#include <string_view>

#include "import/table_layout.h"

namespace ryn {

/// Reads the time of rows by a layout's columns; the layout has to outlive it.
class TimeReader {
  public:
    explicit TimeReader(const TimeLayout& timeLayout) : layout(timeLayout) {}

    /// Ok with *moment set; FirstOfMonth with it set for a date without its day among whole ones;
    /// Incomplete for one without its month; Bad for no time, a missing field included. Not for a
    /// layout with StartAndStep.
    TimeResult Read(std::span<const std::string_view> fields, Millis* moment);

    /// Whether the row read last carried an offset from UTC.
    bool HadOffset() const { return parts.offsetMinutes.has_value(); }
    /// Whether the row read last had a time of day.
    bool HadClock() const { return parts.hour >= 0; }
    /// Whether the row read last was written with hour 24.
    bool HadHour24() const { return parts.hour == 24; }
    /// The texts of the time columns of a row, joined, for messages.
    std::string TextOf(std::span<const std::string_view> fields) const;

  private:
    TimeResult ReadColumn(const TimeColumn& column, std::string_view field);
    TimeResult ReadWithoutDay(Millis* moment);

    const TimeLayout& layout;
    TimeParts parts;
    std::string joined;
};

} // namespace ryn
