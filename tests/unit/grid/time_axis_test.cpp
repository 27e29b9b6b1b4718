#include "unit/grid/grid_fixture.h"

namespace ryn {
namespace {

using test::OpenGrid;
using test::SampleGrid;
using testing::ElementsAre;
using testing::HasSubstr;

TEST(GridTimes, FollowTheUnitAndTheCalendar) {
    struct Case {
        const char* units;
        const char* calendar;
        std::vector<double> times;
        std::vector<std::string> dates;
        bool areEqual;
        double step;
    };
    // The dates of 360_day are those of the same fraction of the real year.
    const Case cases[] = {
        {"hours since 1900-01-01 00:00:00.0",
         "gregorian",
         {1, 4},
         {"1900-01-01 01:00:00", "1900-01-01 04:00:00"},
         true,
         10800},
        {"months since 1958-1-1",
         "standard",
         {0, 1, 2},
         {"1958-01-01 00:00:00", "1958-02-01 00:00:00", "1958-03-01 00:00:00"},
         false,
         59.0 / 2 * 86400},
        {"days since 2000-02-27T00:00:00Z",
         "noleap",
         {0, 1, 2},
         {"2000-02-27 00:00:00", "2000-02-28 00:00:00", "2000-03-01 00:00:00"},
         false,
         1.5 * 86400},
        {"days since 2001-02-27",
         "365_day",
         {0, 1, 2},
         {"2001-02-27 00:00:00", "2001-02-28 00:00:00", "2001-03-01 00:00:00"},
         true,
         86400},
        {"days since 2001-01-01",
         "360_day",
         {0, 180, 359},
         {"2001-01-01 00:00:00", "2001-07-03 00:00:00", "2001-12-31 00:00:00"},
         false,
         182.0 * 86400},
        {"days since 1582-10-04",
         "standard",
         {0, 1},
         {"1582-10-14 00:00:00", "1582-10-15 00:00:00"},
         true,
         86400},
    };
    for (const Case& c : cases) {
        SampleGrid sample;
        sample.units = c.units;
        sample.calendar = c.calendar;
        sample.times = c.times;
        OpenGrid grid(sample.Write("times"));
        EXPECT_EQ(grid.Dates(), c.dates) << c.units;
        EXPECT_EQ(grid.header.EqualTimeSteps(), c.areEqual) << c.units;
        EXPECT_DOUBLE_EQ(grid.header.TimeStep(), c.step) << c.units;
        EXPECT_EQ(grid.header.GetStartTime(), grid.header.TimeOfStep(0));
    }
}

TEST(GridTimes, SayThatDaysOfAYearOf360WereMoved) {
    SampleGrid sample;
    sample.calendar = "360_day";
    OpenGrid grid(sample.Write("days360"));
    EXPECT_THAT(grid.header.Notes(), ElementsAre(HasSubstr("360 days")));
    EXPECT_EQ(grid.engine.Describe().calendar, "360_day");
}

TEST(GridTimes, CountDaysSince1899) {
    SampleGrid sample;
    sample.units = "hours since 1990-01-01";
    sample.times = {6, 12};
    OpenGrid grid(sample.Write("count"));
    EXPECT_EQ(static_cast<double>(grid.header.GetStartTime()), 32874.25);
    EXPECT_FALSE(grid.header.TimeOfStep(2).IsValid());
    EXPECT_FALSE(grid.header.TimeOfStep(-1).IsValid());
}

TEST(GridTimes, OfAThirdOfASecondAreEqualToTheMillisecond) {
    SampleGrid sample;
    sample.units = "seconds since 2000-01-01";
    sample.times = {0, 1.0 / 3, 2.0 / 3, 1};
    EXPECT_TRUE(OpenGrid(sample.Write("thirds")).header.EqualTimeSteps());
    sample.times = {0, 0.333, 0.67, 1};
    EXPECT_FALSE(OpenGrid(sample.Write("thirds")).header.EqualTimeSteps());
}

TEST(GridTimes, OfOneStepHaveADay) {
    SampleGrid sample;
    sample.times = {3};
    OpenGrid grid(sample.Write("one_step"));
    EXPECT_EQ(grid.header.TimeStepFirst(), 0);
    EXPECT_EQ(grid.header.TimeStepPast(), 1);
    EXPECT_TRUE(grid.header.EqualTimeSteps());
    EXPECT_EQ(grid.header.TimeStep(), 86400.0);
}

} // namespace
} // namespace ryn
