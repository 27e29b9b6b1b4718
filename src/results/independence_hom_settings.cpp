#include "results/independence_hom_settings.h"

#include <string_view>

#include "results/number_rule.h"
#include "results/output_settings.h"
#include "strings/catalogue.h"

namespace ryn {

namespace {

using Page = CIndependenceHomSettings;

constexpr DisplayFlag<Page> kFlags[] = {
    {"RunTest", &Page::RunTest},
    {"TestTrend", &Page::TestTrend},
    {"TestShift", &Page::TestShift},
};

/// A test's section in the results, which its flag is named after, and where it goes.
struct Test {
    const char* section;
    STestOutcome Page::*outcome;
    bool Page::*shown;
};

constexpr Test kTests[] = {
    {"RunTest", &Page::Run, &Page::RunTest},
    {"TestForTrend", &Page::Trend, &Page::TestTrend},
    {"TestForShiftInMean", &Page::Shift, &Page::TestShift},
};

/// Heading, statistic and level. "Accepted" stands for every test: the page draws no conclusion of
/// its own.
std::string TestLines(std::string_view heading, const STestOutcome& outcome) {
    return std::string(heading) + '\n' +
           FormatText(kTextTestStatistic, WithoutNanSign(outcome.TestStatistic)) + '\n' +
           FormatText(kTextAcceptedAtLevel, WithoutNanSign(outcome.SignificanceLevel * 100.0)) +
           '\n';
}

} // namespace

void CIndependenceHomSettings::SaveSettings(KvfTree* file, const std::string& /*baseDirectory*/) {
    kvfAddSection(file, "IndependenceHomogeneitySettings");
    SaveFlags(file, *this, kFlags);
    SaveFont(file, Font);
    kvfEndSection(file);
}

void CIndependenceHomSettings::LoadSettings(const KvfSection* settings,
                                            const std::string& /*baseDirectory*/) {
    Clear();
    const KvfSection* const section =
        kvfSectionByNameNum(settings, "IndependenceHomogeneitySettings", 1);
    LoadFlags(section, *this, kFlags);
    LoadFont(section, &Font);
}

void CIndependenceHomSettings::LoadOutput(const KvfSection* target,
                                          const std::string& /*baseDirectory*/) {
    const KvfSection* const tests = kvfSectionByNameNum(target, "IndependenceHomogeneityTest", 1);
    for (const Test& test : kTests) {
        const KvfSection* const section = kvfSectionByNameNum(tests, test.section, 1);
        STestOutcome& outcome = this->*test.outcome;
        kvfGetParam(section, test.section, &outcome.Made, 1, 1);
        kvfGetParam(section, "TestStatistic", &outcome.TestStatistic, 1, 1);
        kvfGetParam(section, "SignificanceLevel", &outcome.SignificanceLevel, 1, 1);
        this->*test.shown = outcome.Made;
    }
}

void CIndependenceHomSettings::SaveOutput(KvfTree* file) const {
    kvfAddSection(file, "IndependenceHomogeneityTest");
    for (const Test& test : kTests) {
        const STestOutcome& outcome = this->*test.outcome;
        kvfAddSection(file, test.section);
        kvfPutParam(file, test.section, outcome.Made);
        kvfPutParam(file, "TestStatistic", outcome.TestStatistic);
        kvfPutParam(file, "SignificanceLevel", outcome.SignificanceLevel);
        kvfEndSection(file);
    }
    kvfEndSection(file);
}

void CIndependenceHomSettings::FillText(CQxTextOcxPlot& control) const {
    std::string text = GetParent()->Title + '\n' + GetParent()->Subtitle + "\n\n";
    // The first two headings are English in every language, and the last test ends the page.
    const bool hasOutput = GetParent()->HasOutput(); // else there is nothing but the headings
    if (hasOutput && RunTest)
        text += TestLines("Run test:", Run) + '\n';
    if (hasOutput && TestTrend)
        text += TestLines("Test for trend:", Trend) + '\n';
    if (hasOutput && TestShift)
        text += TestLines(Text(kTextShiftInMean), Shift);
    control.SetText(std::move(text));
}

} // namespace ryn
