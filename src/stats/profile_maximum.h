#pragma once

#include "stats/root.h"

#include <algorithm>
#include <cmath>
#include <limits>
#include <optional>
#include <utility>

namespace ryn::stats {

/// A log-likelihood for each value of a sample as a function of one unknown, all others being at
/// their best for it, at one place. The slope is NaN where the function has no value.
struct ProfilePoint {
    double value = 0;
    double slope = 0;
    double curvature = 0;
};

/// Stands for a place without value.
inline constexpr ProfilePoint kNoProfile{-std::numeric_limits<double>::infinity(),
                                         std::numeric_limits<double>::quiet_NaN(),
                                         std::numeric_limits<double>::quiet_NaN()};

/// A local maximum.
struct Peak {
    double place = 0;
    double value = -std::numeric_limits<double>::infinity();
};

/// The maximum of `profile` inside `bracket`, at whose lower end it rises and at whose upper end it
/// falls, by Newton's method on the slope. A step that leaves the bracket, goes down or does not
/// halve the one before gives way to a bisection, so that the bracket always closes. The unknown
/// must be free of units and of the order of 1: the end is a step below 1e-9, which is still taken
/// and leaves an error of the order of its square; with a `precision` that is coarser the end is a
/// step below that. Nothing when the slope is NaN on the way, or after 100 evaluations.
template <class F>
std::optional<Peak> MaximumBetween(F&& profile, Bracket bracket, double start,
                                   double precision = 1e-9) {
    double place = start;
    double lastMove = bracket.upper - bracket.lower;
    for (int evaluation = 0; evaluation < 100; ++evaluation) {
        const ProfilePoint at = profile(place);
        if (std::isnan(at.slope)) {
            return std::nullopt;
        }
        (at.slope > 0 ? bracket.lower : bracket.upper) = place;
        const double step = -at.slope / at.curvature;
        const double next = place + step;
        const bool uphill = at.curvature < 0;
        if ((uphill && std::abs(step) < precision) || at.slope == 0) {
            return Peak{at.slope == 0 ? place : next, at.value};
        }
        const bool useful = uphill && next > bracket.lower && next < bracket.upper &&
                            std::abs(step) < 0.5 * lastMove;
        const double taken = useful ? next : bracket.lower + (bracket.upper - bracket.lower) / 2;
        lastMove = std::abs(taken - place);
        place = taken;
        if (!(bracket.upper - bracket.lower > 1e-15 * (1 + std::abs(place)))) {
            return Peak{place, at.value};
        }
    }
    return std::nullopt;
}

/// MaximumBetween for a profile with one maximum of which nobody knows whether it lies inside
/// `bracket`: nothing when it does not. `start` may lie outside.
template <class F>
std::optional<Peak> PeakInside(F&& profile, Bracket bracket, double start) {
    constexpr double kMargin = 1e-8;
    const bool usable = start > bracket.lower && start < bracket.upper;
    const double middle = bracket.lower + (bracket.upper - bracket.lower) / 2;
    const auto peak = MaximumBetween(profile, bracket, usable ? start : middle);
    const bool inside =
        peak && peak->place > bracket.lower + kMargin && peak->place < bracket.upper - kMargin;
    return inside ? peak : std::nullopt;
}

/// Walks a profile and keeps the highest local maximum that it meets. Profiles of likelihoods are
/// smooth: over a step that is short against their features, a maximum shows as a change of sign of
/// the slope. Where slopes and curvatures say that the slope may bend through 0 and back between
/// two stations, the step is halved, so that a maximum with its minimum close by is not passed
/// over.
class PeakSearch {
  public:
    /// `placePrecision` as in MaximumBetween.
    explicit PeakSearch(double placePrecision = 1e-9) : precision(placePrecision) {}

    /// The highest so far; nothing when none was met.
    const std::optional<Peak>& Highest() const { return highest; }
    /// The highest value at an end of a walk. Minus infinity before the first.
    double HighestEnd() const { return highestEnd; }

    /// A maximum that is known from elsewhere.
    void Note(const Peak& peak) {
        if (!highest || peak.value > highest->value) {
            highest = peak;
        }
    }

    /// From `from` to `to`, which may lie on either side, in equal steps. Ends early where the
    /// profile ends. A profile that follows the best values of the other unknowns along the walk
    /// is asked for neighbouring places one after the other. Gives what was found at `from`.
    template <class F>
    ProfilePoint Walk(F&& profile, double from, double to, int steps) {
        Station here{from, profile(from)};
        const ProfilePoint first = here.at;
        NoteEnd(here);
        for (int i = 1; i <= steps && !std::isnan(here.at.slope); ++i) {
            const double place = i == steps ? to : from + (to - from) * i / steps;
            const Station next{place, profile(place)};
            Look(profile, here, next, kMostHalvings);
            here = next;
        }
        NoteEnd(here);
        return first;
    }

  private:
    struct Station {
        double place;
        ProfilePoint at;
    };

    static constexpr int kMostHalvings = 5;

    void NoteEnd(const Station& end) { highestEnd = std::max(highestEnd, end.at.value); }

    // Whether Newton's method finds a maximum or a minimum from `a` before half the way to `b`.
    static bool TurnsSoon(const Station& a, const Station& b) {
        const double share = -a.at.slope / a.at.curvature / (b.place - a.place);
        return share > 0 && share < 0.5;
    }

    // Whether the cubic through both ends, whose slope in shares s of the way is
    //     q(s) = d0 + (d1 - d0 + 6 e) s - 6 e s^2,
    // comes down to a fifth of the smaller slope at the ends.
    static bool CubicBendsBack(const Station& a, const Station& b) {
        const double sign = a.at.slope > 0 ? 1 : -1;
        const double d0 = sign * a.at.slope;
        const double d1 = sign * b.at.slope;
        const double mean = sign * (b.at.value - a.at.value) / (b.place - a.place);
        const double e = mean - (d0 + d1) / 2;
        const double s = (d1 - d0 + 6 * e) / (12 * e);
        return e < 0 && s > 0 && s < 1 &&
               d0 + (d1 - d0 + 6 * e) * s - 6 * e * s * s < 0.2 * std::min(d0, d1);
    }

    template <class F>
    void Look(F& profile, Station a, Station b, int halvings) {
        if (a.place > b.place) {
            std::swap(a, b);
        }
        if (a.at.slope > 0 && b.at.slope <= 0) {
            Climb(profile, a, b);
        } else if (a.at.slope * b.at.slope > 0 && halvings > 0 &&
                   (CubicBendsBack(a, b) || TurnsSoon(a, b) || TurnsSoon(b, a))) {
            const double place = a.place + (b.place - a.place) / 2;
            const Station middle{place, profile(place)};
            Look(profile, a, middle, halvings - 1);
            Look(profile, middle, b, halvings - 1);
        }
    }

    // The secant of the slopes is a better start than either end.
    template <class F>
    void Climb(F& profile, const Station& a, const Station& b) {
        const double share = a.at.slope / (a.at.slope - b.at.slope);
        const double start = a.place + share * (b.place - a.place);
        if (const auto peak = MaximumBetween(profile, {a.place, b.place}, start, precision)) {
            Note(*peak);
        }
    }

    double precision;
    std::optional<Peak> highest;
    double highestEnd = -std::numeric_limits<double>::infinity();
};

} // namespace ryn::stats
