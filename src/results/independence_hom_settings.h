#pragma once

#include "controls/text_plot.h"
#include "results/display_keywords.h"
#include "results/settings_template.h"

namespace ryn {

/// What the engine says of one test of the extreme value series.
struct STestOutcome {
    bool Made = false;
    double TestStatistic = 0;
    double SignificanceLevel = 0; ///< a fraction
};

/// Page 12, "Independence and homogenity tests".
class CIndependenceHomSettings : public CSettingsTemplate {
  public:
    void SaveSettings(KvfTree* file, const std::string& baseDirectory) override;
    void LoadSettings(const KvfSection* settings, const std::string& baseDirectory) override;
    /// The page then shows every test that was made: a stored choice does not survive a load.
    void LoadOutput(const KvfSection* target, const std::string& baseDirectory) override;
    /// Writes the section IndependenceHomogeneityTest, with the tests that were made.
    void SaveOutput(KvfTree* file) const;
    /// There are no lists to empty.
    void Clear() {}

    void FillText(CQxTextOcxPlot& control) const;

    STestOutcome Run;
    STestOutcome Trend;
    STestOutcome Shift;
    bool RunTest = false;   ///< the page shows the run test
    bool TestTrend = false; ///< the page shows the test for trend
    bool TestShift = false; ///< the page shows the test for shift in mean
    FontRecord Font = PlainPageFont();
};

} // namespace ryn
