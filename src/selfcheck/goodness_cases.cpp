#include <algorithm>
#include <array>
#include <limits>
#include <vector>

#include "selfcheck/case_groups.h"
#include "selfcheck/named_combination.h"
#include "selfcheck/reference_series.h"
#include "selfcheck/sources.h"
#include "stats/fit.h"
#include "stats/goodness_of_fit.h"
#include "stats/probability_plot.h"

namespace ryn::selfcheck {

namespace {

using enum SeriesId;

constexpr std::string_view kR =
    "R 4.2.2: ks.test, cut, cor, densities of evd 2.3-6.1; an independent program";

// In the order of the columns below; levels in percent.
constexpr std::array<const char*, 10> kQuantities = {
    "chi2", "classes", "df", "chi2 level %", "D", "D level %", "SLSC", "PPCC I", "PPCC II", "ln L"};

struct GoodnessCase {
    std::string_view number;
    SeriesId series;
    NamedCombination subject;
    stats::PlottingMethod positions;
    std::array<std::string_view, 10> values;
    std::string_view source;
};

constexpr auto kCases = [] {
    using enum stats::PlottingMethod;
    return std::to_array<GoodnessCase>({
        {"G1",
         PortPirie,
         Named("GEV/LMOM"),
         Cunnane,
         {"2.86154", "11", "7", "89.751", "0.0646524", "94.156", "0.0156744", "0.9971300",
          "0.9968724", "4.294953"},
         kR},
        {"G2",
         PortPirie,
         Named("GUM/LMOM"),
         Cunnane,
         {"2.52308", "11", "8", "96.065", "0.0713762", "88.351", "0.0184273", "0.9958665",
          "0.9958665", "4.216710"},
         kR},
        {"G3",
         Fishkill,
         Named("LN2/ML"),
         Cunnane,
         {"1.00000", "4", "1", "31.731", "0.114222", "89.456", "0.0489687", "0.9476242",
          "0.9739349", "-206.0066"},
         kR},
        {"G4",
         Rain40,
         Named("GP2/LMOM"),
         Cunnane,
         {"4.00000", "8", "5", "54.942", "0.0790566", "93.690", "0.0416106", "0.9791420",
          "0.9819002", "-153.1540"},
         kR},
        {"G5",
         Rain40,
         Named("EXP1/MOM"),
         Cunnane,
         {"4.72727", "8", "6", "57.924", "0.0922689", "83.007", "0.0448075", "0.9804969",
          "0.9804969", "-153.1271"},
         kR},
        {"G6",
         PortPirie,
         Named("GEV/LMOM"),
         Weibull,
         {"2.86154", "11", "7", "89.751", "0.0646524", "94.156", "0.0178265", "0.9972112",
          "0.9969279", "4.294953"},
         kProgram},
        {"G7",
         Fishkill,
         Named("LP3/MOM/LOG"),
         Cunnane,
         {"1.41667", "5", "1", "23.395", "0.0902205", "98.583", "0.0353049", "0.9654884",
          "0.9862501", "-204.8356"},
         kProgram},
        {"G8",
         Fishkill,
         Named("SQE/ML"),
         Cunnane,
         {"1.66667", "4", "1", "19.671", "0.0896801", "98.674", "0.104425", "0.9510302",
          "0.9634375", "-205.7020"},
         kProgram},
        {"G9",
         PortPirie,
         Named("P3/LMOM"),
         Gringorten,
         {"2.86154", "11", "7", "89.751", "0.0688313", "90.792", "0.0157401", "0.9972486",
          "0.9972486", "4.571610"},
         kProgram},
        {"G10",
         PortPirie,
         Named("LN3/ML"),
         Hazen,
         {"3.20000", "11", "7", "86.590", "0.0648028", "94.050", "0.0160947", "0.9964918",
          "0.9972166", "4.409851"},
         kProgram},
        {"G11",
         Rain40,
         Named("WEI2/ML"),
         Blom,
         {"4.72727", "8", "5", "45.006", "0.0953093", "79.936", "0.0461904", "0.9806312",
          "0.9911969", "-153.1221"},
         kProgram},
        {"G12",
         Peaks38,
         Named("TGUM/ML"),
         Cunnane,
         {"6.28571", "9", "6", "39.196", "0.0724636", "95.196", "0.0237736", "0.9944645",
          "0.9944645", "17.80146"},
         kProgram},
        {"G13",
         Fishkill,
         Named("FRE/MOM"),
         Cunnane,
         {"2.33333", "4", "1", "12.663", "0.172566", "43.548", "0.0832544", "0.9650588",
          "0.9859769", "-210.8366"},
         kProgram},
    });
}();

std::array<double, 10> Measures(const GoodnessCase& row) {
    const ReferenceSeries& series = SeriesOf(row.series);
    const stats::FitResult fit = stats::Fit(row.subject.combination, {series.values, series.frame});
    std::array<double, 10> values{};
    values.fill(std::numeric_limits<double>::quiet_NaN());
    if (!fit)
        return values;
    std::vector<double> ascending(series.values.begin(), series.values.end());
    std::sort(ascending.begin(), ascending.end());
    const stats::Distribution& fitted = fit->distribution;
    const stats::ChiSquaredTest chiSquared = stats::ChiSquaredTestOf(fitted, ascending);
    const stats::KolmogorovSmirnovTest ks = stats::KolmogorovSmirnovTestOf(fitted, ascending);
    const stats::ProbabilityPlot plot = stats::ProbabilityPlotOf(fitted, ascending, row.positions);
    return {chiSquared.statistic,
            static_cast<double>(chiSquared.classes.size()),
            static_cast<double>(chiSquared.degreesOfFreedom),
            chiSquared.level,
            ks.statistic,
            ks.level,
            stats::LeastSquaresCriterionOf(fitted, plot).criterion,
            stats::PlotCorrelation(plot),
            stats::ReducedPlotCorrelation(fitted, plot),
            fit->logLikelihood};
}

} // namespace

void CompareGoodnessOfFit(Comparisons& list) {
    for (const GoodnessCase& row : kCases) {
        const CaseLabel label{row.number, SeriesOf(row.series).name, row.subject.name, row.source};
        const std::array<double, 10> found = Measures(row);
        for (std::size_t i = 0; i < found.size(); ++i)
            Compare(list, label, kQuantities[i], row.values[i], found[i]);
    }
}

} // namespace ryn::selfcheck
