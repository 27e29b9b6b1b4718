#include "selfcheck/reference_series.h"

#include <array>

namespace ryn::selfcheck {

namespace {

constexpr auto kPortPirie = std::to_array<double>(
    {4.03, 3.83, 3.65, 3.88, 4.01, 4.08, 4.18, 3.8,  4.36, 3.96, 3.98, 4.69, 3.85,
     3.96, 3.85, 3.93, 3.75, 3.63, 3.57, 4.25, 3.97, 4.05, 4.24, 4.22, 3.73, 4.37,
     4.06, 3.71, 3.96, 4.06, 4.55, 3.79, 3.89, 4.11, 3.85, 3.86, 3.86, 4.21, 4.01,
     4.11, 4.24, 3.96, 4.21, 3.74, 3.85, 3.88, 3.66, 4.11, 3.71, 4.18, 3.9,  3.78,
     3.91, 3.72, 4,    3.66, 3.62, 4.33, 4.55, 3.75, 4.08, 3.9,  3.88, 3.94, 4.33});

constexpr auto kFloyd = std::to_array<double>(
    {1460, 4050,  3570, 2060, 1300,  1390,  1720, 6280, 1360,  7440, 5320,  1400, 3240,
     2710, 4520,  4840, 8320, 13900, 71500, 6250, 2260, 318,   1330, 970,   1920, 15100,
     2870, 20600, 3810, 726,  7500,  7170,  2000, 829,  17300, 4740, 13400, 2940, 5660});

constexpr auto kFishkill =
    std::to_array<double>({2290, 1470, 2220, 2970, 3020, 1210, 2490, 3170, 3220, 1760, 8800, 8280,
                           1310, 2500, 1960, 2140, 4340, 3060, 1780, 1380, 980,  1040, 1580, 3630});

constexpr auto kNile = std::to_array<double>(
    {1120, 1160, 963, 1210, 1160, 1160, 813,  1230, 1370, 1140, 995,  935,  1110, 994,  1020,
     960,  1180, 799, 958,  1140, 1100, 1210, 1150, 1250, 1260, 1220, 1030, 1100, 774,  840,
     874,  694,  940, 833,  701,  916,  692,  1020, 1050, 969,  831,  726,  456,  824,  702,
     1120, 1100, 832, 764,  821,  768,  845,  864,  862,  698,  845,  744,  796,  1040, 759});

constexpr auto kRain40 = std::to_array<double>(
    {44.5, 43.2, 48.5, 40.6, 45.7, 76.7, 45.7, 86.6, 47.8, 47.5, 48.5, 43.4, 59.4, 53.3, 40.9,
     42.7, 83.3, 54.9, 59.2, 67.3, 47,   72.4, 40.9, 47,   55.9, 51.3, 85.3, 41.9, 55.9, 44.2,
     45.2, 44.5, 51.6, 59.4, 47.8, 42.9, 55.4, 42.4, 40.1, 47,   48.8, 41.9, 51.3, 45.7});

constexpr auto kRain30 = std::to_array<double>(
    {31.8, 32.5, 31.8, 44.5, 30.5, 43.2, 35.6, 38.1, 32,   31.8, 33,   39.1, 30.5, 31.8, 32.3, 33,
     30.5, 32.5, 48.5, 35.3, 40.6, 30.5, 34.3, 32.8, 30.5, 45.7, 31.8, 33.5, 33.5, 31.8, 34.8, 35.3,
     37.8, 76.7, 32.3, 34,   33.8, 36.6, 30.5, 45.7, 86.6, 35.6, 47.8, 47.5, 34.3, 48.5, 30.7, 43.4,
     59.4, 35.1, 53.3, 33.5, 30.5, 30.2, 40.9, 42.7, 83.3, 54.9, 59.2, 31.8, 37.3, 32.5, 34,   67.3,
     31.2, 30.2, 36.1, 36.8, 38.4, 31,   33.3, 47,   32,   33,   38.1, 30.5, 72.4, 34.3, 37.1, 33,
     40.9, 39.9, 47,   36.3, 30.5, 30.5, 55.9, 31.8, 51.3, 85.3, 41.9, 30.5, 33,   35.6, 55.9, 44.2,
     38.1, 34.3, 31.8, 32,   31.8, 35.6, 45.2, 30.5, 39.4, 30.2, 44.5, 31.8, 33.8, 51.6, 35.3, 59.4,
     33.5, 35.3, 30.5, 36.8, 47.8, 42.9, 37.6, 55.4, 35.3, 42.4, 33,   33,   40.1, 34.8, 38.1, 39.4,
     34,   35.6, 34.3, 33.5, 31,   36.6, 36.3, 38.4, 38.1, 47,   31,   30.5, 31.2, 35.6, 48.8, 41.9,
     31.7, 31.2, 51.3, 33.5, 37.6, 39.4, 39.4, 45.7});

constexpr auto kPeaks38 = std::to_array<double>(
    {4.03, 3.83, 3.88, 4.01, 4.08, 4.18, 4.36, 3.96, 3.98, 4.69, 3.85, 3.96, 3.85,
     3.93, 4.25, 3.97, 4.05, 4.24, 4.22, 4.37, 4.06, 3.96, 4.06, 4.55, 3.89, 4.11,
     3.85, 3.86, 3.86, 4.21, 4.01, 4.11, 4.24, 3.96, 4.21, 3.85, 3.88, 4.11, 4.18,
     3.9,  3.91, 4,    4.33, 4.55, 4.08, 3.9,  3.88, 3.94, 4.33});

constexpr stats::SeriesFrame PeaksAbove(double threshold, double rate) {
    return {stats::SeriesKind::PartialDuration, threshold, rate};
}

// In the order of SeriesId.
constexpr auto kSeries = std::to_array<ReferenceSeries>({
    {"portpirie",
     "annual maximum sea level, m, Port Pirie, 1923-1987; Coles (2001)",
     {},
     kPortPirie},
    {"floyd",
     "annual peak flow, ft3/s, Floyd River at James, 1935-1973; Bulletin 17B (1982)",
     {},
     kFloyd},
    {"fishkill",
     "annual peak flow, ft3/s, Fishkill Creek at Beacon, 1945-1968; Bulletin 17B (1982)",
     {},
     kFishkill},
    {"nile60", "annual flow, 10^8 m3, Nile at Aswan, 1871-1930; data set Nile of R", {}, kNile},
    {"rain40", "daily rainfall above 40 mm in 48 years, south-west England; Coles (2001)",
     PeaksAbove(40, 44.0 / 48), kRain40},
    {"rain30", "daily rainfall above 30 mm in 48 years, south-west England; Coles (2001)",
     PeaksAbove(30, 152.0 / 48), kRain30},
    {"pp38", "the values of portpirie above 3.8 m, taken as one event a year", PeaksAbove(3.8, 1),
     kPeaks38},
});

} // namespace

std::span<const ReferenceSeries> AllSeries() {
    return kSeries;
}

const ReferenceSeries& SeriesOf(SeriesId id) {
    return kSeries.at(static_cast<std::size_t>(id));
}

} // namespace ryn::selfcheck
