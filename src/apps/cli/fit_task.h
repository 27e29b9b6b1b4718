#pragma once

#include <optional>
#include <string>
#include <vector>

#include "apps/cli/console.h"
#include "base/status.h"
#include "stats/combination.h"
#include "stats/plotting_position.h"
#include "stats/return_period.h"

namespace ryn::cli {

/// How the uncertainty of the quantiles is found.
enum class FitUncertainty { None, MonteCarlo, Jackknife };

/// `ryn fit` as it was typed.
struct FitOptions {
    std::string names;                  ///< of combinations: "GEV/LMOM,GUM/ML", or "all"
    std::string values;                 ///< a text, a data file, or "-" for standard input
    std::optional<int> item;            ///< of a data file, from 1; none: the first
    std::optional<std::string> periods; ///< "2,10,100" in years
    bool partialDurations = false;      ///< with rate and threshold; else annual maxima
    std::optional<double> rate;         ///< events a year
    std::optional<double> threshold;    ///< in the unit of the values
    stats::PeriodMeaning meaning = stats::PeriodMeaning::OfEvent; ///< of partial durations' periods
    FitUncertainty uncertainty = FitUncertainty::None;
    stats::PlottingMethod plotting = stats::PlottingMethod::Weibull;
    bool sampleCorrection = false; ///< of the combinations that know it
    OutputForm form = OutputForm::Text;
};

/// A combination under its name.
struct NamedFit {
    std::string name;
    stats::Combination combination;
};

/// What is to be fitted, and what is to be found of each fit.
struct FitTask {
    std::vector<NamedFit> combinations; ///< at least one, no two the same
    stats::SeriesFrame frame;
    std::vector<double> periods; ///< years; each has an event
    stats::PeriodMeaning meaning = stats::PeriodMeaning::OfEvent;
    FitUncertainty uncertainty = FitUncertainty::None;
    stats::PlottingMethod plotting = stats::PlottingMethod::Weibull;
    std::string source;            ///< name of what the values came from
    std::vector<double> values;    ///< as they were read
    std::vector<double> ascending; ///< the same, sorted
    std::string unit;              ///< of the values, where a data file tells it
};

/// Tests the options and reads the values. What is taken for granted is noted on the console.
Status MakeFitTask(const FitOptions& options, Console& console, FitTask* task);

} // namespace ryn::cli
