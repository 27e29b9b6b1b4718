#pragma once

#include <string>

#include "kvf/kvf.h"
#include "results/output_settings.h"

namespace ryn::test {

/// Results of two combinations over three observations, two return periods and two intervals, as
/// they stand in a file. Probabilities are eighths, so that one minus them is exact.
inline constexpr const char* kSampleOutput = R"(RYNoutput {
    Settings {
        ItemName = "Discharge"
        Unit = "m3/s"
        Title = "Sample"
        Subtitle = "Three years"
    }
    IndependenceHomogeneityTest {
        RunTest {
            RunTest = true
            TestStatistic = -1.25
            SignificanceLevel = 0.0625
        }
        TestForTrend {
            TestForTrend = false
            TestStatistic = 0.0
            SignificanceLevel = 0.0
        }
        TestForShiftInMean {
            TestForShiftInMean = true
            TestStatistic = 0.5
            SignificanceLevel = 0.625
        }
    }
    SampleStatistics {
        SampleSize = 3
        bPDS = true
        Threshold = 4.0
        AvgAnNum = 1.5
        OrdinaryMoments {
            Mean = 6.0
            Variance = 4.0
            Skewness = nan
            Kurtosis = 3.25
        }
        ProbabilityWeightedMoments {
            Beta_0 = 6.0
            Beta_1 = 3.5
            Beta_2 = 2.5
            Beta_3 = 2.0
        }
        LMoments {
            L_1 = 6.0
            L_2 = 1.0
            L_skewness = 0.125
            L_Kurtosis = -0.0625
        }
    }
    Histogram {
        NoIntHistogram = 2
        XstartHistogram = 4.0
        XstepHistogram = 2.0
        FrequencyHistogram = 0.25, 0.125
    }
    ProbabilityPlotObs {
        Nobs = 3
        XobsSort = 8.0, 6.0, 4.0
        Item1 {
            PlottingMethod = 0
            ExceedanceProbability = 0.25, 0.5, 0.75
        }
        Item2 {
            PlottingMethod = 1
            ExceedanceProbability = 0.125, 0.5, 0.875
        }
    }
    DistributionAnalysis {
        NoItemPDFPlot = 2
        XvaluePDFPlot = 4.0, 8.0
        NoItemProbabilityPlot = 2
        ProbabilityPlot = 0.125, 0.875
        NoReturnPeriods = 2
        ReturnPeriods = 2.0, 100.0
        Item1 {
            ItemName = "GUM/LMOM"
            ParameterEstimates {
                bParEst1 = true
                strParEst1 = "xi"
                ParEst1 = 5.5
                bParEst2 = true
                strParEst2 = "alpha"
                ParEst2 = 1.25
                bParEst3 = false
                strParEst3 = ""
                ParEst3 = 0.0
            }
            GoodnessOfFitStatistics {
                ChiSquaredTest = true
                ChiSquaredStatistic = 2.5
                ChiSquaredLevel = 28.5
                KolmogorovSmirnovTest = false
                KolmogorovSmirnovStatistic = 0.0
                KolmogorovSmirnovLevel = 0.0
                SLSCTest = true
                SLSCStatistic = 0.025
                PPCCTest = false
                PPCCStatistic = 0.0
                PPCC2Test = false
                PPCC2Statistic = 0.0
                LogLikelihood = true
                LogLikelihoodStatistic = -5.75
            }
            PDFTable {
                PDF = 0.2, 0.15
            }
            PDFPlot {
                PDF = 0.1, 0.05
            }
            TyearEventTable {
                TyearEvent = 6.0, 9.5
                AvgTyearEvent = 6.25, 9.75
                StdTyearEvent = 0.5, 1.5
            }
            TyearEventPlot {
                TyearEvent = 4.5, 8.5
                AvgTyearEvent = 4.625, 8.625
                StdTyearEvent = 0.25, 0.75
            }
        }
        Item2 {
            ItemName = "GEV/ML"
            ParameterEstimates {
                bParEst1 = false
                strParEst1 = "xi"
                ParEst1 = nan
                bParEst2 = false
                strParEst2 = "alpha"
                ParEst2 = nan
                bParEst3 = false
                strParEst3 = "kappa"
                ParEst3 = nan
            }
            GoodnessOfFitStatistics {
                ChiSquaredTest = false
                ChiSquaredStatistic = 0.0
                ChiSquaredLevel = 0.0
                KolmogorovSmirnovTest = true
                KolmogorovSmirnovStatistic = nan
                KolmogorovSmirnovLevel = nan
                SLSCTest = true
                SLSCStatistic = nan
                PPCCTest = false
                PPCCStatistic = 0.0
                PPCC2Test = false
                PPCC2Statistic = 0.0
                LogLikelihood = false
                LogLikelihoodStatistic = 0.0
            }
            PDFTable {
                PDF = nan, nan
            }
            PDFPlot {
                PDF = nan, nan
            }
            TyearEventTable {
                TyearEvent = nan, nan
                AvgTyearEvent = nan, nan
                StdTyearEvent = nan, nan
            }
            TyearEventPlot {
                TyearEvent = nan, nan
                AvgTyearEvent = nan, nan
                StdTyearEvent = nan, nan
            }
        }
    }
}
)";

/// The tree of a text that has no fault.
inline KvfHandle TreeOf(const std::string& text) {
    KvfHandle tree = kvfLoadText(text, "text");
    (void)kvfGetErrorGlb();
    return tree;
}

inline const KvfSection* TargetOf(const KvfHandle& tree, const char* name = "RYNoutput") {
    return kvfTargetByNameNum(tree.get(), name, 1);
}

inline void LoadSampleOutput(COutputSettings& results) {
    const KvfHandle tree = TreeOf(kSampleOutput);
    results.LoadOutput(TargetOf(tree), "");
}

/// The results of a model as the text of a file.
inline std::string OutputText(const COutputSettings& results) {
    const KvfHandle tree = kvfCreate();
    kvfAddTarget(tree.get(), "RYNoutput");
    results.SaveOutput(tree.get());
    kvfEndSection(tree.get());
    return kvfText(tree.get());
}

/// The display settings of a model as the text of a file.
inline std::string SettingsText(COutputSettings& results) {
    const KvfHandle tree = kvfCreate();
    kvfAddTarget(tree.get(), "OutputSettings");
    results.SaveSettings(tree.get(), "");
    kvfEndSection(tree.get());
    return kvfText(tree.get());
}

} // namespace ryn::test
