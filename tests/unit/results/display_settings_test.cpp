#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "ports/ports.h"
#include "results/output_settings.h"
#include "unit/results/sample_results.h"

namespace ryn {
namespace {

using test::SettingsText;
using test::TargetOf;
using test::TreeOf;
using ::testing::ElementsAre;
using ::testing::IsEmpty;

// Every section, key and default, in order. The platform's message font is not set here.
constexpr const char* kDefaults = R"(OutputSettings {
    OutputSettings {
        EstimateQuantilesSettings {
            Calculations = true
            KolmogorovSmirnov = false
            ChiSquared = false
            LeastSquares = false
            LogLikelihood = false
            PPCC = false
            PPCC2 = false
            Precision = 3
            FontHeight = 0
            FontName = ""
            FontFamily = 0
            FontCharSet = 0
            SelectedItems =
        }
        FrequencySettings {
            SelectedItems =
        }
        GoodnessOfFitSettings {
            ChiSquared = false
            KolmogorovSmirnov = false
            SLSC = false
            PPCC = false
            PPCC2 = false
            LogLikelihood = false
            Precision = 3
            FontHeight = 0
            FontName = ""
            FontFamily = 0
            FontCharSet = 0
            SelectedItems =
        }
        HistogramSettings {
            Precision = 3
            FontHeight = 10
            FontName = "Arial"
            FontFamily = 0
            FontCharSet = 0
            SelectedItems =
        }
        IndependenceHomogeneitySettings {
            RunTest = false
            TestTrend = false
            TestShift = false
            FontHeight = 10
            FontName = "Arial"
            FontFamily = 0
            FontCharSet = 0
        }
        SampleStatsSettings {
            FontHeight = 10
            FontName = "Arial"
            FontFamily = 0
            FontCharSet = 0
            SelectedItems =
        }
        ProbabilitySettings {
            PlottingPosition = 0
            ProbabilityPaper = 0
            DisplayError = true
            FrequencyFactor = 1.0f
            LeftAxisType = 1
            RightAxisType = 0
            SelectedItems =
        }
        PlottingPositionSettings {
            Weibull = true
            Hazen = true
            Gringorten = true
            Blom = true
            Cunnane = true
            Precision = 3
            FontHeight = 10
            FontName = "Arial"
            FontFamily = 0
            FontCharSet = 0
        }
    }
}
)";

void LoadFrom(COutputSettings& results, const std::string& text) {
    const KvfHandle tree = TreeOf(text);
    ASSERT_NE(tree, nullptr);
    results.LoadSettings(TargetOf(tree, "OutputSettings"), "");
}

TEST(DisplaySettings, AreWrittenWholeAndInOrder) {
    COutputSettings results;
    EXPECT_EQ(SettingsText(results), kDefaults);
}

TEST(DisplaySettings, EveryKeySurvivesARoundTrip) {
    std::string changed = kDefaults;
    const char* const changes[][2] = {{" = true", " = flip"},
                                      {" = false", " = true"},
                                      {" = flip", " = false"},
                                      {"Precision = 3", "Precision = 8"},
                                      {"FontHeight = 10", "FontHeight = -13"},
                                      {"\"Arial\"", "\"明朝\""},
                                      {"CharSet = 0", "CharSet = 128"},
                                      {"Family = 0", "Family = 17"},
                                      {"Position = 0", "Position = 4"},
                                      {"Paper = 0", "Paper = 2"},
                                      {"1.0f", "2.5f"},
                                      {"LeftAxisType = 1", "LeftAxisType = 2"},
                                      {"RightAxisType = 0", "RightAxisType = 1"},
                                      {"SelectedItems =", "SelectedItems = true, false"}};
    for (const auto& [from, to] : changes) {
        ASSERT_NE(changed.find(from), std::string::npos) << from;
        for (std::size_t at = 0; (at = changed.find(from, at)) != std::string::npos;
             at += std::string(to).size())
            changed.replace(at, std::string(from).size(), to);
    }
    COutputSettings results;
    LoadFrom(results, changed);
    EXPECT_EQ(SettingsText(results), changed);
}

TEST(DisplaySettings, WhatIsMissingStaysAsItIs) {
    COutputSettings results;
    results.Quantiles.Precision = 6;
    results.Probability.FrequencyFactor = 2.0F;
    LoadFrom(results, "OutputSettings { OutputSettings { HistogramSettings { Precision = 1 } } }");
    EXPECT_EQ(results.Histogram.Precision, 1);
    EXPECT_EQ(results.Quantiles.Precision, 6);
    EXPECT_EQ(results.Probability.FrequencyFactor, 2.0F);
    EXPECT_EQ(results.SampleStats.Font, PlainPageFont());
}

TEST(DisplaySettings, SelectedItemsAreReadFlagByFlag) {
    COutputSettings results;
    LoadFrom(results, "OutputSettings { OutputSettings {"
                      " FrequencySettings { SelectedItems = true, 1, \"true\", false, true } } }");
    EXPECT_THAT(results.Frequency.SelectedItems, ElementsAre(true, false, false, false, true));
}

TEST(DisplaySettings, SelectedItemsGrowByWhatTheResultsAdd) {
    const std::string stored = "OutputSettings { OutputSettings {"
                               " FrequencySettings { SelectedItems = false }"
                               " HistogramSettings { SelectedItems = false, true, false } } }";
    COutputSettings results;
    LoadFrom(results, stored);
    test::LoadSampleOutput(results); // two combinations
    EXPECT_THAT(results.Frequency.SelectedItems, ElementsAre(false, true));
    EXPECT_THAT(results.Histogram.SelectedItems, ElementsAre(false, true, false));
    EXPECT_THAT(results.Quantiles.SelectedItems, ElementsAre(true, true));
    LoadFrom(results, stored); // reading again starts anew
    EXPECT_THAT(results.Histogram.SelectedItems, ElementsAre(false, true, false));
    EXPECT_THAT(results.ItemNames, IsEmpty());
}

TEST(DisplaySettings, FontsAreCutToWhatAFontRecordHolds) {
    std::string name;
    for (int i = 0; i < 40; ++i)
        name += "明";
    COutputSettings results;
    LoadFrom(results, "OutputSettings { OutputSettings { SampleStatsSettings { FontName = \"" +
                          name + "\"\n FontFamily = 290\n FontCharSet = -128 } } }");
    EXPECT_EQ(results.SampleStats.Font.faceName, name.substr(0, 31 * std::string("明").size()));
    EXPECT_EQ(results.SampleStats.Font.pitchAndFamily, 34);
    EXPECT_EQ(results.SampleStats.Font.charSet, 128);
}

TEST(DisplaySettings, TwoPagesTakeThePlatformsFont) {
    COutputSettings results;
    const FontRecord font = SilentPorts().platformFont->MessageFont();
    results.UseMessageFont(font);
    EXPECT_EQ(results.Quantiles.Font, font);
    EXPECT_EQ(results.GoodnessOfFit.Font, font);
    EXPECT_EQ(results.Histogram.Font, PlainPageFont());
}

} // namespace
} // namespace ryn
