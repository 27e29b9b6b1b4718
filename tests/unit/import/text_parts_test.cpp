#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "import/clock_text.h"
#include "import/date_text.h"
#include "import/line_reader.h"
#include "import/number_field.h"
#include "import/text_decoder.h"
#include "import/unit_text.h"
#include "unit/import/import_fixture.h"

namespace ryn {
namespace {

TEST(LineReader, GivesTheSameLinesWhateverTheirEndsAndTheBlocks) {
    std::string text;
    std::vector<std::string> expected;
    const char* const ends[] = {"\n", "\r\n", "\r"};
    for (int i = 0; i < 60000; ++i) { // more than one block
        expected.push_back(std::string(static_cast<std::size_t>(i % 17), 'a') + std::to_string(i));
        text += expected.back() + ends[i % 7 % 3];
    }
    text += "last";
    expected.emplace_back("last");
    MemorySource source("x", text);
    LineReader reader(source, TextEncoding::Utf8);
    std::vector<std::string> lines;
    std::string_view line;
    while (reader.Read(&line) == ReadResult::Found)
        lines.emplace_back(line);
    EXPECT_TRUE(reader.Error());
    EXPECT_EQ(lines, expected);
    EXPECT_EQ(reader.LineNumber(), 60001);
}

TEST(TextEncoding, IsGuessedFromTheFirstBytes) {
    struct Case {
        const char* start;
        TextEncoding encoding;
    };
    const Case cases[] = {
        {"plain", TextEncoding::Utf8},
        {"H\xC3\xB6he", TextEncoding::Utf8},
        {"cut \xE2\x88", TextEncoding::Utf8},
        {"H\xF6he", TextEncoding::Windows1252},
        {"\xC0\xAF", TextEncoding::Windows1252},
        {"M\xE4rz 20 \xB0\x43, m\xB3/s, \xC5ngstr\xF6m, gr\xF6\xDF\x65, \xE9",
         TextEncoding::Windows1252},
        {"it\x92s the \x93river\x92s\x94 level \x96 5 \x80", TextEncoding::Windows1252},
        {"a\xE9\xE8\x62", TextEncoding::Windows1252},
        {"\x94N,\x8C\x8E,\x93\xFA,\x92l", TextEncoding::ShiftJis},
        {"\x90\x85\x88\xCA\x83\x66\x81[\x83^,\xBD\xB2\xB2", TextEncoding::ShiftJis},
        {"\x97\xAC\x97\xCA\x95", TextEncoding::ShiftJis},
        {"\xB4\xD1\xC2\xAC\xBD\xEA,\x8E\xBD\x8E\xB2\x8E\xB2,\xBF\xE5\xB0\xCC", TextEncoding::EucJp},
    };
    for (const Case& one : cases)
        EXPECT_EQ(GuessEncoding(one.start), one.encoding) << one.start;
    EXPECT_EQ(ToUtf8("20 \x80, \xB0", TextEncoding::Windows1252), "20 \xE2\x82\xAC, \xC2\xB0");
    Utf16Decoder decoder(TextEncoding::Utf16LittleEndian);
    std::string text;
    for (const char byte : std::string("A\0\x3D\xD8\x00\xDE\x00\xDCz\0", 10))
        decoder.Decode(std::string_view(&byte, 1), &text); // byte by byte: nothing is lost at cuts
    EXPECT_EQ(text, "A\xF0\x9F\x98\x80\xEF\xBF\xBDz");
    std::unique_ptr<TextDecoder> japanese;
    ASSERT_TRUE(MakeDecoder(TextEncoding::ShiftJis, &japanese));
    text.clear();
    for (const char byte : std::string("\\|\x83|\xFF."))
        japanese->Decode(std::string_view(&byte, 1), &text);
    EXPECT_EQ(text, "\\|ポ\xEF\xBF\xBD.");
}

std::string MomentOf(const std::string& text, DateForm form) {
    TimeParts parts;
    Millis moment = 0;
    TimeResult result = ParseDate(text, form, &parts);
    if (result == TimeResult::Ok)
        result = ryn::MomentOf(parts, {}, &moment);
    if (result != TimeResult::Ok)
        return result == TimeResult::Bad ? "bad" : "incomplete";
    return MomentText(moment);
}

TEST(DateText, IsReadInManyForms) {
    struct Case {
        const char* text;
        DateForm form;
        const char* moment;
    };
    const Case cases[] = {
        {"2001-2-3", DateForm::YearMonthDay, "2001-02-03 00:00:00"},
        {"2001/02/03 4:05", DateForm::YearMonthDay, "2001-02-03 04:05:00"},
        {"2001-02-03T04:05:06.789+0130", DateForm::YearMonthDay, "2001-02-03 02:35:06.789"},
        {"2001-02-03 24:00", DateForm::YearMonthDay, "2001-02-04 00:00:00"},
        {"2001-02-03 24:01", DateForm::YearMonthDay, "bad"},
        {"2001-02-03 12:60", DateForm::YearMonthDay, "bad"},
        {"2001-02-29", DateForm::YearMonthDay, "bad"},
        {"2000-02-29 CET", DateForm::YearMonthDay, "bad"},
        {"2001-02/03", DateForm::YearMonthDay, "bad"},
        {"2001-02-03 04:05 CET", DateForm::YearMonthDay, "2001-02-03 03:05:00"},
        {"01-02-03", DateForm::YearMonthDay, "bad"},
        {"2001-13-00", DateForm::YearMonthDay, "bad"},
        {"2001-00-00", DateForm::YearMonthDay, "incomplete"},
        {"1070.00", DateForm::YearMonthDay, "bad"},
        {"3.2.2001 04:05:06", DateForm::DayMonthYear, "2001-02-03 04:05:06"},
        {"3. Februar 2001", DateForm::DayMonthYear, "2001-02-03 00:00:00"},
        {"03-mrt-29", DateForm::DayMonthYear, "2029-03-03 00:00:00"},
        {"03/02/30", DateForm::DayMonthYear, "1930-02-03 00:00:00"},
        {"Feb 3, 2001", DateForm::MonthDayYear, "2001-02-03 00:00:00"},
        {"99-12-31", DateForm::ShortYearMonthDay, "1999-12-31 00:00:00"},
        {"20010203_0405", DateForm::Compact, "2001-02-03 04:05:00"},
        {"20010203T040506Z", DateForm::Compact, "2001-02-03 04:05:06"},
        {"200102030", DateForm::Compact, "bad"},
        {"03022001", DateForm::CompactDayFirst, "2001-02-03 00:00:00"},
        {"juin 2001", DateForm::YearMonth, "2001-06-01 00:00:00"},
        {"7/2001", DateForm::YearMonth, "2001-07-01 00:00:00"},
        {"200113", DateForm::CompactYearMonth, "bad"},
        {"1923.0", DateForm::Year, "1923-01-01 00:00:00"},
        {"1969.84296613394", DateForm::DecimalYear, "1969-11-04 16:23:00"},
        {"99.5", DateForm::DecimalYear, "bad"},
        {"1e300", DateForm::UnixSeconds, "bad"},
        {"nan", DateForm::ExcelSerial, "bad"},
        {"0.25", DateForm::ExcelSerial, "1899-12-30 06:00:00"},
        {"", DateForm::YearMonthDay, "bad"},
    };
    for (const Case& one : cases)
        EXPECT_EQ(MomentOf(one.text, one.form), one.moment) << one.text;
}

TEST(DateText, KnowsMonthsOfSevenLanguages) {
    const std::vector<std::vector<const char*>> months = {
        {"Jan", "januari", "Januar", "janvier", "enero", "gennaio", "janeiro"},
        {"Feb", "februari", "f\xC3\xA9vrier", "febrero", "fevereiro"},
        {"Mar", "maart", "M\xC3\xA4rz", "mrt", "mars", "marzo"},
        {"Apr", "avril", "abril", "aprile"},
        {"May", "mei", "Mai", "mayo", "maggio", "maio"},
        {"Jun", "juni", "juin", "junio", "giugno", "junho"},
        {"Jul", "juli", "juillet", "julio", "luglio", "julho"},
        {"Aug", "ao\xC3\xBBt", "agosto"},
        {"Sep", "september", "septiembre", "settembre", "setembro"},
        {"Oct", "Okt", "oktober", "ottobre", "outubro"},
        {"Nov", "november"},
        {"Dec", "Dez", "dezembro", "décembre", "diciembre", "dicembre"},
    };
    for (std::size_t i = 0; i < months.size(); ++i)
        for (const char* name : months[i])
            EXPECT_EQ(MonthOfName(name), static_cast<int>(i) + 1) << name;
    EXPECT_EQ(MonthOfName("ma"), 0);
    EXPECT_EQ(MonthOfName("Station"), 0);
}

TEST(Duration, IsReadWithAndWithoutDays) {
    const auto seconds = [](std::string_view text) {
        const std::optional<Millis> length = ParseDuration(text);
        return length ? static_cast<double>(*length) / 1000.0 : -1.0;
    };
    EXPECT_EQ(seconds("0 days 00:10:00"), 600.0);
    EXPECT_EQ(seconds("2 days, 1:00:00.5"), 2 * 86400 + 3600.5);
    EXPECT_EQ(seconds("3 d"), 3 * 86400.0);
    EXPECT_EQ(seconds("26:10:00"), 26 * 3600 + 600.0);
    for (const char* text : {"", "3", "days", "1 days 00:61:00", "00:10", "1 day 2", "5 m"})
        EXPECT_EQ(seconds(text), -1.0) << text;
}

TEST(NumberField, IsValueMarkOrNone) {
    struct Case {
        const char* text;
        char decimal;
        NumberKind kind;
        float value;
    };
    const Case cases[] = {
        {"12.5", '.', NumberKind::Value, 12.5F},
        {"+.5", '.', NumberKind::Value, 0.5F},
        {"-5.", '.', NumberKind::Value, -5.0F},
        {"\xE2\x88\x92"
         "7",
         '.', NumberKind::Value, -7.0F},
        {"1,5e-3", ',', NumberKind::Value, 1.5e-3F},
        {"1e-999", '.', NumberKind::Value, 0.0F},
        {"1e-60", '.', NumberKind::Value, 0.0F},
        {"3.4028235e38", '.', NumberKind::Value, 3.4028235e38F},
        {"3.5e38", '.', NumberKind::TooLarge, 0.0F},
        {"1,5", '.', NumberKind::NoNumber, 0.0F},
        {"1.5", ',', NumberKind::NoNumber, 0.0F},
        {"1.234,5", ',', NumberKind::Grouped, 0.0F},
        {"1'234'567", '.', NumberKind::Grouped, 0.0F},
        {"1,234", '.', NumberKind::Grouped, 0.0F},
        {"0,234", '.', NumberKind::NoNumber, 0.0F},
        {"1234,567", '.', NumberKind::NoNumber, 0.0F},
        {"0x1A", '.', NumberKind::NoNumber, 0.0F},
        {"1.5D+03", '.', NumberKind::NoNumber, 0.0F},
        {"5 A e", '.', NumberKind::NoNumber, 0.0F},
        {"5[1]", '.', NumberKind::NoNumber, 0.0F},
        {"12.5 A:e", '.', NumberKind::NoNumber, 0.0F},
        {"12.5*", '.', NumberKind::Marked, 12.5F},
        {"> 5,5", ',', NumberKind::Censored, 5.5F},
        {"<", '.', NumberKind::NoNumber, 0.0F},
        {"+inf", '.', NumberKind::NotFinite, 0.0F},
        {"-nan", '.', NumberKind::NoNumber, 0.0F},
        {"--:--", '.', NumberKind::Missing, 0.0F},
    };
    for (const Case& one : cases) {
        const NumberField field = ReadNumber(one.text, one.decimal);
        EXPECT_EQ(field.kind, one.kind) << one.text;
        EXPECT_EQ(field.value, one.value) << one.text;
    }
    EXPECT_EQ(ReadNumber(std::string(5000, '1'), '.').kind, NumberKind::NoNumber);
}

TEST(TimeStep, AdvancesWithinTheCalendar) {
    const auto after = [](const char* start, const char* step, std::int64_t count) {
        TimeParts parts;
        Millis moment = 0;
        ParseDate(start, DateForm::YearMonthDay, &parts);
        ryn::MomentOf(parts, {}, &moment);
        const std::optional<TimeStep> parsed = ParseTimeStep(step);
        const std::optional<Millis> later = parsed ? Advance(moment, *parsed, count) : std::nullopt;
        return later ? MomentText(*later) : "none";
    };
    EXPECT_EQ(after("2000-01-31", "1mo", 13), "2001-02-28 00:00:00");
    EXPECT_EQ(after("2000-02-29 06:00", "1y", 4), "2004-02-29 06:00:00");
    EXPECT_EQ(after("2000-01-01", "0.5 h", 3), "2000-01-01 01:30:00");
    EXPECT_EQ(after("2000-01-01", "90", 2), "2000-01-01 00:03:00");
    EXPECT_EQ(after("2000-01-01", "1 week", 1), "2000-01-08 00:00:00");
    EXPECT_EQ(after("9999-12-31", "1d", 1), "none");
    EXPECT_EQ(after("2000-01-01", "1y", 9000000000000000000), "none");
    EXPECT_EQ(after("2000-01-01", "1d", 9000000000000000000), "none");
    for (const char* step : {"", "d", "0d", "-1d", "1 fortnight", "0.5mo", "1e9 d", "0.0001"})
        EXPECT_FALSE(ParseTimeStep(step)) << step;
}

TEST(ColumnTitle, IsPartedIntoNameAndUnit) {
    struct Case {
        const char* title;
        const char* name;
        const char* unit;
    };
    const Case cases[] = {
        {"wave height (m)", "wave height", "m"},
        {"Q [m\xC2\xB3/s]", "Q", "m\xC2\xB3/s"},
        {"Temp (max)", "Temp (max)", ""},
        {"stage [mNAP]", "stage", "mNAP"},
        {"Rain, mm", "Rain", "mm"},
        {"Rain, total", "Rain, total", ""},
        {"level_cm_NAP", "level_cm_NAP", ""},
        {"Rainfall amount (millimetres)", "Rainfall amount", "millimetres"},
        {"T (\xC2\xB0"
         "C)",
         "T",
         "\xC2\xB0"
         "C"},
        {"RD (0.1 mm)", "RD", "0.1 mm"},
    };
    for (const Case& one : cases) {
        std::string name;
        std::string unit;
        SplitNameAndUnit(one.title, &name, &unit);
        EXPECT_EQ(name, one.name);
        EXPECT_EQ(unit, one.unit) << one.title;
    }
    EXPECT_EQ(PlainUnit("cfs"), "ft3/s");
    EXPECT_EQ(PlainUnit("m3/s"), "m3/s");
    EXPECT_EQ(PlainUnit("-"), "");
}

} // namespace
} // namespace ryn
