#pragma once

#include "stats/sample_statistics.h"

#include <algorithm>
#include <array>
#include <cmath>
#include <functional>
#include <limits>
#include <optional>
#include <span>
#include <string>
#include <vector>

// Slow searches for the maximum of a likelihood, by other means than those of the estimators: dense
// grids with golden sections, and Nelder and Mead's simplex. Each gives the log-likelihood reached,
// or nothing where it ends outside the domain.
namespace ryn::stats::testing {

using Profile = std::function<double(double)>;
using Values = std::span<const double>;

inline double MeanOf(Values values, const std::function<double(double)>& f) {
    double sum = 0;
    for (const double x : values) {
        sum += f(x);
    }
    return sum / static_cast<double>(values.size());
}

inline double GoldenSection(const Profile& f, double lower, double upper) {
    const double ratio = (std::sqrt(5.0) - 1) / 2;
    double a = upper - ratio * (upper - lower);
    double b = lower + ratio * (upper - lower);
    double fa = f(a);
    double fb = f(b);
    for (int i = 0; i < 100; ++i) {
        if (fa > fb) {
            upper = b;
            b = a;
            fb = fa;
            fa = f(a = upper - ratio * (upper - lower));
        } else {
            lower = a;
            a = b;
            fa = fb;
            fb = f(b = lower + ratio * (upper - lower));
        }
    }
    return std::max(fa, fb);
}

/// Which points of a grid may be the maximum.
enum class GridRule { HighestOfAll, HighestInteriorPeak };

/// `grid` ascending; points where `f` is minus infinity are not admissible.
inline std::optional<double> SearchGrid(const Profile& f, const std::vector<double>& grid,
                                        GridRule rule) {
    std::vector<double> places;
    std::vector<double> heights;
    for (const double place : grid) {
        const double height = f(place);
        if (std::isfinite(height)) {
            places.push_back(place);
            heights.push_back(height);
        }
    }
    std::optional<std::size_t> best;
    for (std::size_t i = 0; i < places.size(); ++i) {
        const bool end = i == 0 || i + 1 == places.size();
        const bool peak = !end && heights[i] > heights[i - 1] && heights[i] > heights[i + 1];
        if ((peak || rule == GridRule::HighestOfAll) && (!best || heights[i] > heights[*best])) {
            best = i;
        }
    }
    if (!best || *best == 0 || *best + 1 == places.size()) {
        return std::nullopt;
    }
    return GoldenSection(f, places[*best - 1], places[*best + 1]);
}

inline std::vector<double> Equidistant(double from, double to, int count) {
    std::vector<double> grid(static_cast<std::size_t>(count), from);
    for (int i = 0; i < count; ++i) {
        grid[static_cast<std::size_t>(i)] += (to - from) * i / (count - 1);
    }
    return grid;
}

/// Generalised Pareto, in theta = kappa/alpha up to where kappa is 1; `y` are exceedances.
inline std::optional<double> SearchPareto(Values y) {
    const double mean = MeanOf(y, [](double v) { return v; });
    const double largest = *std::max_element(y.begin(), y.end());
    const auto n = static_cast<double>(y.size());
    const auto kappa = [&](double theta) {
        return -MeanOf(y, [=](double v) { return std::log1p(-theta * v); });
    };
    const auto height = [&](double theta) {
        if (std::abs(theta) * mean < 1e-6) {
            return n * (-std::log(mean) - 1);
        }
        const double k = kappa(theta);
        return n * (-std::log(k / theta) - 1 + k);
    };
    double end = 0.999999 / largest;
    if (kappa(end) > 1) {
        double inside = 0;
        for (int i = 0; i < 60; ++i) {
            const double middle = (inside + end) / 2;
            (kappa(middle) < 1 ? inside : end) = middle;
        }
    }
    std::vector<double> grid;
    for (const double j : Equidistant(3, -6, 400)) {
        grid.push_back(-std::pow(10, j) / mean);
    }
    grid.push_back(0);
    for (const double j : Equidistant(-6, std::log10(end * mean), 400)) {
        grid.push_back(std::pow(10, j) / mean);
    }
    return SearchGrid(height, grid, GridRule::HighestOfAll);
}

/// Log-normal, three parameters, in t = ln((smallest - xi)/s).
inline std::optional<double> SearchLogNormal(Values x) {
    const double smallest = *std::min_element(x.begin(), x.end());
    const double s = CentralMomentsOf(x).StandardDeviation();
    const auto n = static_cast<double>(x.size());
    const auto height = [&](double t) {
        std::vector<double> logs(x.begin(), x.end());
        for (double& v : logs) {
            v = std::log(v - smallest + s * std::exp(t));
        }
        const CentralMoments m = CentralMomentsOf(logs);
        return -n / 2 * (std::log(2 * std::acos(-1.0) * m.m2) + 1) - n * m.mean;
    };
    return SearchGrid(height, Equidistant(std::log(1e-4), std::log(1e3), 561),
                      GridRule::HighestInteriorPeak);
}

/// Square-root exponential, in ln(b mean).
inline std::optional<double> SearchSquareRootExponential(Values x) {
    const double mean = MeanOf(x, [](double v) { return v; });
    const auto n = static_cast<double>(x.size());
    const auto height = [&](double t) {
        const double b = std::exp(t) / mean;
        const double a = 1 / MeanOf(x, [=](double v) {
                             return (1 + std::sqrt(b * v)) * std::exp(-std::sqrt(b * v));
                         });
        return n *
               (std::log(a * b / 2) - 1 - MeanOf(x, [=](double v) { return std::sqrt(b * v); }));
    };
    return SearchGrid(height, Equidistant(std::log(1e-3), std::log(1e5), 400),
                      GridRule::HighestOfAll);
}

/// Truncated Gumbel, in ln alpha; for each the best ln c by golden section, if c is below 700.
inline std::optional<double> SearchTruncatedGumbel(Values y) {
    const double mean = MeanOf(y, [](double v) { return v; });
    const auto n = static_cast<double>(y.size());
    const auto height = [&](double logAlpha) {
        const double alpha = std::exp(logAlpha);
        const double a = MeanOf(y, [=](double v) { return std::exp(-v / alpha); });
        const auto inC = [=](double logC) {
            const double c = std::exp(logC);
            return n * (-std::log(alpha) - mean / alpha - c * a + std::log(-c / std::expm1(-c)));
        };
        return a > 1.0 / 700 ? GoldenSection(inC, -20, std::log(700.0))
                             : -std::numeric_limits<double>::infinity();
    };
    return SearchGrid(height, Equidistant(std::log(0.05 * mean), std::log(20 * mean), 200),
                      GridRule::HighestOfAll);
}

using Point = std::array<double, 3>;

/// Nelder and Mead (1965), downhill from `start`.
inline Point Simplex(const std::function<double(const Point&)>& f, const Point& start,
                     const Point& steps) {
    struct Vertex {
        Point place;
        double height;
    };
    const auto at = [&](const Point& place) { return Vertex{place, f(place)}; };
    const auto along = [](const Point& from, const Point& to, double share) {
        Point p{};
        for (std::size_t i = 0; i < 3; ++i) {
            p[i] = from[i] + share * (to[i] - from[i]);
        }
        return p;
    };
    std::vector<Vertex> v(4, at(start));
    for (std::size_t i = 0; i < 3; ++i) {
        Point corner = start;
        corner[i] += steps[i];
        v[i + 1] = at(corner);
    }
    for (int turn = 0; turn < 500; ++turn) {
        std::sort(v.begin(), v.end(),
                  [](const Vertex& a, const Vertex& b) { return a.height < b.height; });
        const Point half = along(v[0].place, v[1].place, 0.5);
        const Point center = along(half, v[2].place, 1.0 / 3);
        const Vertex reflected = at(along(v[3].place, center, 2));
        if (reflected.height < v[0].height) {
            const Vertex expanded = at(along(v[3].place, center, 3));
            v[3] = expanded.height < reflected.height ? expanded : reflected;
            continue;
        }
        if (reflected.height < v[2].height) {
            v[3] = reflected;
            continue;
        }
        const Vertex& better = reflected.height < v[3].height ? reflected : v[3];
        const Vertex contracted = at(along(better.place, center, 0.5));
        if (contracted.height < better.height) {
            v[3] = contracted;
            continue;
        }
        for (std::size_t i = 1; i < 4; ++i) {
            v[i] = at(along(v[i].place, v[0].place, 0.5));
        }
    }
    return v[0].place;
}

/// GEV, from (xi, alpha, kappa) at `start`; |kappa| > 0.98 at the end is outside the domain.
inline std::optional<double> SearchGev(Values x, const Point& start) {
    const auto depth = [&](const Point& p) {
        const double alpha = start[1] * std::exp(p[1]);
        const double xi = start[0] + start[1] * p[0];
        double sum = 0;
        for (const double v : x) {
            const double q = 1 - p[2] * (v - xi) / alpha;
            if (!(q > 0) || std::abs(p[2]) >= 1) {
                return 1e10;
            }
            const double y = -std::log(q) / p[2];
            sum += std::log(alpha) + (1 - p[2]) * y + std::exp(-y);
        }
        return sum;
    };
    Point best{0, 0, std::clamp(start[2], -0.5, 0.5)};
    for (const double size : {1.0, 0.1, 0.01}) {
        best = Simplex(depth, best, {0.1 * size, 0.1 * size, 0.05 * size});
    }
    return std::abs(best[2]) > 0.98 ? std::nullopt : std::optional<double>(-depth(best));
}

} // namespace ryn::stats::testing
