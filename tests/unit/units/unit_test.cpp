#include <clocale>
#include <cmath>
#include <cstdio>
#include <cstdlib>
#include <filesystem>
#include <string>

#include <gtest/gtest.h>
#include <rapidcheck/gtest.h>

#include "support/scratch_directory.h"
#include "units/unit_table.h"
#include "units/units.h"

namespace ryn {
namespace {

double Converted(const char* from, double value, const char* to) {
    double result = -999.0;
    EXPECT_EQ(qtyConvertUnit(UnitOfText(from), value, UnitOfText(to), &result), 0)
        << from << " to " << to;
    return result;
}

// Expected values from the definitions: international foot 0.3048 m, acre 43560 ft2 of survey feet
// left out, nautical mile 1852 m, degree Fahrenheit 5/9 K with 32 at the freezing point.
TEST(Units, ConvertsTheFieldsUnits) {
    struct Case {
        const char* from;
        double value;
        const char* to;
        double expected;
    };
    const Case cases[] = {
        {"ft", 10.0, "m", 3.048},
        {"inch", 1.0, "mm", 25.4},
        {"0.1 mm", 253.0, "mm", 25.3},
        {"ft3/s", 1000.0, "m3/s", 28.316846592},
        {"l/s", 1500.0, "m3/s", 1.5},
        {"km/h", 36.0, "m/s", 10.0},
        {"knot", 1.0, "m/s", 1852.0 / 3600.0},
        {"degC", 25.0, "K", 298.15},
        {"degF", 212.0, "degC", 100.0},
        {"hPa", 1013.25, "Pa", 101325.0},
        {"bar", 1.0, "hPa", 1000.0},
        {"mm/h", 1.0, "mm/day", 24.0},
        {"%", 50.0, "1", 0.5},
        {"hectare", 1.0, "m2", 10000.0},
        {"MJ/m2", 1.0, "J/m2", 1e6},
    };
    for (const Case& c : cases)
        EXPECT_NEAR(Converted(c.from, c.value, c.to), c.expected, 1e-12 * std::abs(c.expected))
            << c.from;
}

TEST(Units, ConvertsTimesExactly) {
    EXPECT_EQ(Converted("h", 1.5, "s"), 5400.0);
    EXPECT_EQ(Converted("s", 5400.0, "h"), 1.5);
    EXPECT_EQ(Converted("s", 3600.0 * 7, "h"), 7.0);
    EXPECT_EQ(Converted("day", 0.1, "h"), 0.1 * 24.0);
    EXPECT_EQ(Converted("week", 2.0, "day"), 14.0);
    EXPECT_EQ(Converted("ms", 250.0, "s"), 0.25);
    EXPECT_EQ(Converted("year", 1.0, "month"), 12.0);
    EXPECT_DOUBLE_EQ(Converted("year", 1.0, "day"), 365.242198781);
}

TEST(Units, RefusesWhatDoesNotConvertAndLeavesTheResult) {
    double result = 7.0;
    EXPECT_NE(qtyConvertUnit(UnitOfText("m"), 1.0, kUnitSecond, &result), 0);
    EXPECT_NE(qtyConvertUnit(kUnitUndefined, 1.0, kUnitUndefined, &result), 0);
    EXPECT_NE(qtyConvertUnit(kUnitUndefined, 1.0, UnitOfText("1"), &result), 0);
    EXPECT_NE(qtyConvertUnit(987654321, 1.0, 987654321, &result), 0);
    EXPECT_NE(qtyConvertUnit(-5, 1.0, kUnitHour, &result), 0);
    EXPECT_NE(qtyConvertUnit(UnitOfText("barrels of tea"), 1.0, UnitOfText("m3"), &result), 0);
    double factor = 1.0;
    double offset = 2.0;
    EXPECT_FALSE(UnitConversion(UnitOfText("m"), UnitOfText("K"), &factor, &offset));
    EXPECT_FALSE(UnitConversion(UnitOfText("lg(re 1 mW)"), UnitOfText("W"), &factor, &offset));
    EXPECT_EQ(result, 7.0);
    EXPECT_EQ(factor, 1.0);
    EXPECT_EQ(offset, 2.0);
}

TEST(Units, FactorAndOffsetGiveTheSameAsConverting) {
    double factor = 0.0;
    double offset = 0.0;
    ASSERT_TRUE(UnitConversion(UnitOfText("degF"), UnitOfText("degC"), &factor, &offset));
    EXPECT_NEAR(factor, 5.0 / 9.0, 1e-15);
    EXPECT_NEAR(offset, -32.0 * 5.0 / 9.0, 1e-12);
    ASSERT_TRUE(UnitConversion(UnitOfText("h"), UnitOfText("s"), &factor, &offset));
    EXPECT_EQ(factor, 3600.0);
    EXPECT_EQ(offset, 0.0);
}

RC_GTEST_PROP(Units, ConversionsInvert, ()) {
    const auto table = UnitTable();
    const auto& from = table[*rc::gen::inRange<std::size_t>(0, table.size())];
    const auto& to = table[*rc::gen::inRange<std::size_t>(0, table.size())];
    const double value = *rc::gen::inRange(-100000, 100000) / 16.0;
    double there = 0.0;
    if (qtyConvertUnit(from.code, value, to.code, &there) != 0)
        return;
    double back = 0.0;
    RC_ASSERT(qtyConvertUnit(to.code, there, from.code, &back) == 0);
    // Degrees Fahrenheit in kelvin carry an offset of hundreds into the rounding.
    RC_ASSERT(std::abs(back - value) <= 1e-11 * (std::abs(value) + 1000.0));
}

TEST(Units, FixedCodesStandForTheirTexts) {
    EXPECT_EQ(UnitText(kUnitSecond), "s");
    EXPECT_EQ(UnitText(kUnitHour), "h");
    EXPECT_EQ(UnitText(kUnitUndefined), "");
    EXPECT_EQ(UnitText(-1), "");
    EXPECT_EQ(UnitText(999999999), "");
    EXPECT_EQ(UnitOfText(""), kUnitUndefined);
    EXPECT_EQ(UnitOfText("hours"), kUnitHour);
    EXPECT_EQ(UnitOfText("second"), kUnitSecond);
}

TEST(Units, UdunitsKnowsEveryTextOfTheTable) {
    for (const UnitRow& row : UnitTable()) {
        EXPECT_EQ(UnitOfText(row.text), row.code) << row.text;
        EXPECT_EQ(UnitText(row.code), row.text);
        // A scaled unit of the same kind tells that UDUNITS parses the text.
        double result = 0.0;
        const int other = UnitOfText("7.25 (" + std::string(row.text) + ")");
        EXPECT_EQ(qtyConvertUnit(other, 1.0, row.code, &result), 0) << row.text;
    }
}

TEST(Units, KnowsWhatTheTableOrUdunitsUnderstands) {
    for (const char* known : {"m3/s", "furlong", "m s-1"})
        EXPECT_TRUE(IsKnownUnit(UnitOfText(known))) << known;
    for (const char* unknown : {"blah", "m3/blah", ""})
        EXPECT_FALSE(IsKnownUnit(UnitOfText(unknown))) << unknown;
}

TEST(Units, OtherWritingsOfAUnitGetItsCode) {
    const int speed = UnitOfText("m/s");
    for (const char* text : {"m s-1", "m s**-1", "m.s^-1", "meter second-1", "metre/second"})
        EXPECT_EQ(UnitOfText(text), speed) << text;
    EXPECT_EQ(UnitOfText("m³/s"), UnitOfText("m3/s"));
    EXPECT_EQ(UnitOfText("°C"), UnitOfText("degC"));
    EXPECT_EQ(UnitOfText("millibar"), UnitOfText("hPa"));
    EXPECT_NE(UnitOfText("degC"), UnitOfText("K"));
    EXPECT_EQ(UnitText(UnitOfText("degrees_east")), "degrees_east");
}

TEST(Units, AnUnknownTextKeepsACodeOfItsOwn) {
    testing::internal::CaptureStderr();
    const int first = UnitOfText("Scoville/\"scoop\"");
    const int second = UnitOfText("流量");
    EXPECT_EQ(testing::internal::GetCapturedStderr(), "");
    EXPECT_NE(first, second);
    EXPECT_EQ(UnitOfText("Scoville/\"scoop\""), first);
    EXPECT_EQ(UnitText(first), "Scoville/\"scoop\"");
    EXPECT_EQ(UnitText(second), "流量");
    EXPECT_FALSE(IsTableUnit(first));
    EXPECT_TRUE(IsTableUnit(kUnitHour));
    EXPECT_NE(UnitOfText(std::string_view("m\0s", 3)), UnitOfText("m"));
    EXPECT_EQ(UnitText(UnitOfText("mm/m")), "mm/m"); // and not "0.001"
}

TEST(UnitsDeathTest, AMissingDatabaseIsAFailureThatNamesItsPlace) {
    testing::FLAGS_gtest_death_test_style = "threadsafe"; // a fresh process: nothing is loaded yet
    const auto withoutDatabase = [] {
        ::setenv("UDUNITS2_XML_PATH", "/nowhere/udunits2.xml", 1);
        double result = 0.0;
        const bool refused = qtyConvertUnit(UnitOfText("ft"), 1.0, UnitOfText("m"), &result) != 0;
        const bool timesGoOn = qtyConvertUnit(kUnitHour, 1.0, kUnitSecond, &result) == 0;
        const Status status = UnitDatabaseStatus();
        std::fputs(status.Text().c_str(), stderr);
        std::exit(refused && timesGoOn && !status ? 0 : 1);
    };
    EXPECT_EXIT(withoutDatabase(), testing::ExitedWithCode(0), "/nowhere/udunits2.xml");
}

TEST(UnitsDeathTest, ADecimalCommaDoesNotReachTheDatabase) {
    const std::string locales = test::ScratchDirectory() + "units_locale";
    std::filesystem::create_directories(locales);
    const std::string make = "localedef -i de_DE -f UTF-8 " + locales + "/de_DE.UTF-8 2>/dev/null";
    if (std::system(make.c_str()) != 0 && !std::filesystem::exists(locales + "/de_DE.UTF-8"))
        GTEST_SKIP() << "no localedef";
    testing::FLAGS_gtest_death_test_style = "threadsafe";
    const auto underComma = [&] {
        ::setenv("LOCPATH", locales.c_str(), 1);
        if (std::setlocale(LC_ALL, "de_DE.UTF-8") == nullptr || std::strtod("0,5", nullptr) != 0.5)
            std::exit(2);
        double result = 0.0;
        const bool converted =
            qtyConvertUnit(UnitOfText("0.1 mm"), 253.0, UnitOfText("inch"), &result) == 0;
        std::exit(converted && std::abs(result - 25.3 / 25.4) < 1e-12 ? 0 : 1);
    };
    EXPECT_EXIT(underComma(), testing::ExitedWithCode(0), "");
}

TEST(ItemTypes, HaveTextsAndFollowFromClearUnits) {
    EXPECT_EQ(ItemTypeText(ItemTypeOfUnit(UnitOfText("m3/s"))), "Discharge");
    EXPECT_EQ(ItemTypeText(ItemTypeOfUnit(UnitOfText("mm"))), "Rainfall");
    EXPECT_EQ(ItemTypeText(ItemTypeOfUnit(UnitOfText("degC"))), "Temperature");
    EXPECT_EQ(ItemTypeOfUnit(UnitOfText("m")), kItemTypeUndefined);
    EXPECT_EQ(ItemTypeOfUnit(kUnitUndefined), kItemTypeUndefined);
    EXPECT_EQ(ItemTypeText(kItemTypeUndefined), "Undefined");
    EXPECT_EQ(ItemTypeText(-3), "Undefined");
}

} // namespace
} // namespace ryn
