// How often the interval of one reported standard deviation about the estimated 100-year event
// holds the true one: Monte Carlo uncertainty of L-moment fits to simulated series of 50 values.
// Exit code 1 when a family leaves its limits.

#include "stats/fit.h"
#include "stats/monte_carlo.h"
#include "stats/resampling_draws.h"
#include "stats/return_period.h"

#include <algorithm>
#include <array>
#include <cmath>
#include <cstdint>
#include <cstdio>
#include <optional>
#include <string>
#include <vector>

#include <fmt/format.h>

namespace ryn::stats::bench {

namespace {

constexpr std::size_t kSeries = 2000;
constexpr double kYears = 50;
constexpr std::array kPeriod = {100.0};
constexpr std::array kShapes = {-0.2, -0.1, 0.0, 0.1};
// Not the seed of the resamples: no series may be made of their numbers.
constexpr std::uint64_t kSeed = 20240229;

// An estimate that is normal and has the deviation it says is covered 68.3 times in 100.
constexpr double kLeast = 60;
constexpr double kMost = 76;

/// What series are drawn from and what is fitted to them. Location and scale are 0 and 1, which
/// stand for all others, since the estimates go along with them.
struct Subject {
    std::string family;
    double kappa = 0;
    Distribution parent;
    Combination combination;
    SeriesFrame frame;
    /// Of a simulated series: 50 values, or as many as 50 years bring.
    EventCount count = EventCount::Fixed;

    /// The true 100-year event.
    double Truth() const {
        return QuantileOfPeriod(parent, kPeriod.front(), frame, PeriodMeaning::OfEvent);
    }
    /// Heavier tails have none: the quantile estimated from 50 values is too far from normal.
    bool HasLimits() const { return std::abs(kappa) <= 0.1; }
};

/// Of the intervals of many series.
struct Coverage {
    std::size_t covered = 0;
    std::size_t above = 0;           ///< the true event is higher than the interval
    std::size_t withoutInterval = 0; ///< not fitted, or no deviation; counts as not covered

    double Percent() const { return PercentOf(covered); }
    double PercentAbove() const { return PercentOf(above); }
    double StandardError() const { return std::sqrt(Percent() * (100 - Percent()) / kSeries); }
    bool Within() const { return Percent() >= kLeast && Percent() <= kMost; }

    void Note(const std::optional<ResampledQuantile>& reported, double truth) {
        if (!reported || !std::isfinite(reported->standardDeviation)) {
            ++withoutInterval;
        } else if (truth > reported->estimate + reported->standardDeviation) {
            ++above;
        } else if (truth >= reported->estimate - reported->standardDeviation) {
            ++covered;
        }
    }

  private:
    static double PercentOf(std::size_t count) {
        return 100.0 * static_cast<double>(count) / kSeries;
    }
};

Combination LMomentsOf(DistributionType distribution) {
    Combination combination;
    combination.distribution = distribution;
    combination.method = EstimationMethod::LMoments;
    return combination;
}

void AddAnnualMaxima(std::vector<Subject>& subjects) {
    const SeriesFrame frame;
    subjects.push_back(
        {"Gumbel", 0, Gumbel::Make({0, 1}).value(), LMomentsOf(DistributionType::Gumbel), frame});
    for (const double kappa : kShapes) {
        subjects.push_back({"GEV", kappa, Gev::Make({0, 1, kappa}).value(),
                            LMomentsOf(DistributionType::Gev), frame});
    }
}

void AddPartialDurations(std::vector<Subject>& subjects, EventCount count) {
    const SeriesFrame frame{SeriesKind::PartialDuration, 0, 1};
    const std::string peaks = count == EventCount::Fixed ? ", 50 peaks" : ", 50 years";
    subjects.push_back({"exponential" + peaks, 0,
                        Exponential::Make({0, 1}, LocationType::Fixed).value(),
                        LMomentsOf(DistributionType::Exponential), frame, count});
    for (const double kappa : kShapes) {
        subjects.push_back({"generalised Pareto" + peaks, kappa,
                            GeneralisedPareto::Make({0, 1, kappa}, LocationType::Fixed).value(),
                            LMomentsOf(DistributionType::GeneralisedPareto), frame, count});
    }
}

struct Series {
    std::vector<double> values;
    SeriesFrame frame;
};

Series Simulated(const Subject& subject, UniformDraws& draws) {
    Series series{{}, subject.frame};
    auto count = static_cast<std::size_t>(kYears);
    if (subject.count == EventCount::Poisson) {
        count = PoissonCount(kYears, draws.Next());
        series.frame.rate = static_cast<double>(count) / kYears;
    }
    series.values.resize(count);
    std::generate(series.values.begin(), series.values.end(),
                  [&] { return Quantile(subject.parent, draws.Next()); });
    return series;
}

/// The 100-year event with its deviation, as a run of the program reports them.
std::optional<ResampledQuantile> Reported(const Combination& combination, const Series& series) {
    const FitResult fit = Fit(combination, {series.values, series.frame});
    if (!fit) {
        return std::nullopt;
    }
    const ResampledQuantiles quantiles = MonteCarlo(
        {combination, fit->distribution, series.values.size(), series.frame}, {.periods = kPeriod});
    return quantiles.atPeriods.front();
}

Coverage CoverageOf(const Subject& subject) {
    UniformDraws draws(kSeed);
    const double truth = subject.Truth();
    Coverage coverage;
    for (std::size_t i = 0; i < kSeries; ++i) {
        coverage.Note(Reported(subject.combination, Simulated(subject, draws)), truth);
    }
    return coverage;
}

void PrintHeader() {
    fmt::print("{:<30} {:>5} {:>10} {:>10} {:>10} {:>11}   {}\n", "family", "kappa", "coverage %",
               "std. error", "true above", "no interval", "required %");
}

void PrintRow(const Subject& subject, const Coverage& coverage) {
    std::string required = "-";
    if (subject.HasLimits()) {
        required =
            fmt::format("{:g} to {:g}{}", kLeast, kMost, coverage.Within() ? "" : "  MISSED");
    }
    fmt::print("{:<30} {:>5.1f} {:>10.1f} {:>10.1f} {:>10.1f} {:>11}   {}\n", subject.family,
               subject.kappa, coverage.Percent(), coverage.StandardError(), coverage.PercentAbove(),
               coverage.withoutInterval, required);
    std::fflush(stdout);
}

int Run() {
    std::vector<Subject> subjects;
    AddAnnualMaxima(subjects);
    AddPartialDurations(subjects, EventCount::Fixed);
    AddPartialDurations(subjects, EventCount::Poisson);
    bool missed = false;
    PrintHeader();
    for (const Subject& subject : subjects) {
        const Coverage coverage = CoverageOf(subject);
        PrintRow(subject, coverage);
        missed = missed || (subject.HasLimits() && !coverage.Within());
    }
    return missed ? 1 : 0;
}

} // namespace

} // namespace ryn::stats::bench

int main() {
    return ryn::stats::bench::Run();
}
