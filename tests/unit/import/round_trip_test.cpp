#include <cmath>
#include <string>
#include <vector>

#include <gtest/gtest.h>
#include <rapidcheck/gtest.h>

#include "unit/import/import_fixture.h"

namespace ryn {
namespace {

using test::Imported;

struct Series {
    std::vector<Millis> times;
    std::vector<float> values;
};

/// Rising times on whole seconds from the year 1300 on, and values of every size.
Series AnySeries() {
    Series series;
    const int count = *rc::gen::inRange(2, 60);
    Millis time = *rc::gen::inRange<Millis>(-21000000000, 4000000000) * kMillisPerSecond;
    for (int i = 0; i < count; ++i) {
        series.times.push_back(time);
        time += *rc::gen::inRange<Millis>(1, 40 * 86400) * kMillisPerSecond;
        const float mantissa = static_cast<float>(*rc::gen::inRange(-999999, 999999)) / 7.0F;
        series.values.push_back(std::ldexp(mantissa, *rc::gen::inRange(-60, 60)));
    }
    return series;
}

/// Ways to write a moment to the second that are told apart without help.
std::string TimeText(Millis time, int style, char delimiter) {
    const std::string date = DateText(time);
    const std::string clock = ClockText(time);
    const std::string year = date.substr(0, 4);
    const std::string month = date.substr(5, 2);
    const std::string day = date.substr(8, 2);
    switch (style) {
    case 0:
        return date + "T" + clock + "Z";
    case 1:
        return date + (delimiter == ' ' ? "T" : " ") + clock;
    case 2:
        return year + month + day + clock.substr(0, 2) + clock.substr(3, 2) + clock.substr(6, 2);
    case 3: // in two columns
        return day + "." + month + "." + year + delimiter + clock;
    default: // in six columns, which the header names
        return year + delimiter + month + delimiter + day + delimiter + clock.substr(0, 2) +
               delimiter + clock.substr(3, 2) + delimiter + clock.substr(6, 2);
    }
}

std::string Header(int style, char delimiter) {
    std::string header = style < 3    ? "time"
                         : style == 3 ? "date,time"
                                      : "year,month,day,hour,minute,second";
    header += ",value\n";
    for (char& c : header)
        c = c == ',' ? delimiter : c;
    return header;
}

std::string ValueText(float value, char decimal) {
    std::string text = ShortestText(value);
    for (char& c : text)
        c = c == '.' ? decimal : c;
    return text;
}

RC_GTEST_PROP(TableRoundTrip, GivesBackEverySampleToTheBit, ()) {
    const Series series = AnySeries();
    const char delimiter = *rc::gen::element(',', ';', '\t', '|', ' ');
    const char decimal = delimiter == ',' ? '.' : *rc::gen::element('.', ',');
    const int style = *rc::gen::inRange(0, 5);
    const std::string end =
        *rc::gen::element(std::string("\n"), std::string("\r\n"), std::string("\r"));
    std::string text = Header(style, delimiter);
    for (std::size_t i = 0; i < series.times.size(); ++i)
        text += TimeText(series.times[i], style, delimiter) + delimiter +
                ValueText(series.values[i], decimal) + "\n";
    std::string lines;
    for (const char c : text)
        lines += c == '\n' ? end : std::string(1, c);
    RC_LOG() << lines;

    ImportOptions options;
    options.missing = {"none"};
    options.decimal = std::string(1, decimal);
    const Imported imported(lines, options);
    RC_ASSERT(imported.status.Text() == "");
    RC_ASSERT(imported.samples.times == series.times);
    RC_ASSERT(imported.samples.values[0] == series.values);
}

} // namespace
} // namespace ryn
