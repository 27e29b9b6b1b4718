#include "stats/plotting_position.h"

namespace ryn::stats {

namespace {

// The a of each formula makes its positions fit one distribution best: 0 the ranks of any, 0.44 the
// Gumbel's, 0.375 the normal's; 0.4 is Cunnane's compromise and 0.5 the oldest.
double Offset(PlottingMethod method) {
    switch (method) {
    case PlottingMethod::Hazen:
        return 0.5;
    case PlottingMethod::Gringorten:
        return 0.44;
    case PlottingMethod::Blom:
        return 0.375;
    case PlottingMethod::Cunnane:
        return 0.4;
    case PlottingMethod::Weibull:
        break;
    }
    return 0;
}

} // namespace

double PlottingPosition(PlottingMethod method, std::size_t rank, std::size_t count) {
    const double a = Offset(method);
    return (static_cast<double>(rank) - a) / (static_cast<double>(count) + 1 - 2 * a);
}

std::vector<double> PlottingPositions(PlottingMethod method, std::size_t count) {
    std::vector<double> positions(count);
    for (std::size_t i = 0; i < count; ++i) {
        positions[i] = PlottingPosition(method, i + 1, count);
    }
    return positions;
}

} // namespace ryn::stats
