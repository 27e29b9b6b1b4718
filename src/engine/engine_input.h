#pragma once

#include <cstddef>
#include <string>
#include <vector>

#include "engine/section_reader.h"
#include "stats/combination.h"
#include "stats/plotting_position.h"
#include "stats/return_period.h"

namespace ryn {

/// How the uncertainty of the quantiles is found; the first two have the numbers of the setup file.
enum class UncertaintyMethod { MonteCarlo = 0, Jackknife = 1, None };

/// Texts that results carry on unchanged; any bytes.
struct SeriesLabels {
    std::string title;
    std::string subtitle;
    std::string itemName; ///< of the analysed data item
    std::string unit;
};

/// Which tests of independence and homogeneity are asked for.
struct SeriesTestRequests {
    bool run = false;
    bool trend = false;
    bool shift = false;
};

/// Which measures of the goodness of fit are asked for.
struct FitMeasureRequests {
    bool chiSquared = false;
    bool kolmogorovSmirnov = false;
    bool leastSquares = false;       ///< SLSC
    bool correlation = false;        ///< PPCC I
    bool reducedCorrelation = false; ///< PPCC II
    bool logLikelihood = false;
};

/// A distribution with a method of estimation, as the user calls it.
struct NamedCombination {
    std::string name; ///< any bytes, empty too
    stats::Combination combination;
};

/// What one analysis is asked to do, every number checked for type and range; the series itself is
/// checked by SeriesFaults.
struct EngineInput {
    SeriesLabels labels;
    stats::SeriesFrame frame;       ///< as the statistics want it: rate 1 for annual maxima
    double threshold = 0;           ///< as stored, whatever the kind of series
    double averageNumber = 0;       ///< as stored: events a year
    std::vector<double> values;     ///< in time order
    std::vector<int> sampleNumbers; ///< subsample of each value; 0 for none
    SeriesTestRequests tests;
    FitMeasureRequests measures;
    UncertaintyMethod uncertainty = UncertaintyMethod::MonteCarlo;
    stats::PlottingMethod plotting = stats::PlottingMethod::Weibull;
    stats::PeriodMeaning meaning = stats::PeriodMeaning::OfEvent;
    std::vector<double> periods; ///< return periods in years, any doubles
    std::vector<NamedCombination> combinations;
};

/// More than anyone analyses at once: a file from elsewhere must not take all memory or years of
/// work. Up to them, time and memory grow in proportion.
constexpr std::size_t kMostValues = 1'000'000;
constexpr std::size_t kMostReturnPeriods = 10'000;
constexpr std::size_t kMostCombinations = 1'000;

struct InputReading {
    EngineInput input;
    Sentences faults;   ///< the set-up is of no use for any series
    Sentences warnings; ///< something is not as it should be, and what was taken instead
};

/// Reads target "RynEditor" of the tree of a parameter file; a null tree and anything missing,
/// ill-typed or out of range is a fault. Keywords that older files lack have the defaults of a new
/// analysis.
InputReading ReadEngineInput(const KvfTree* tree);

/// Why this one series cannot be analysed; empty when it can: fewer than five values, one that is
/// not finite, all equal, or a partial duration series with one below its threshold (by more than
/// the rounding of a 32-bit float).
Sentences SeriesFaults(const EngineInput& input);

} // namespace ryn
