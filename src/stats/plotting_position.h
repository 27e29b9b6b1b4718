#pragma once

#include <array>
#include <cstddef>
#include <vector>

namespace ryn::stats {

/// Plotting position formulas; the numbers are those of the setup file, and results list the five
/// in this order.
enum class PlottingMethod { Weibull = 0, Hazen = 1, Gringorten = 2, Blom = 3, Cunnane = 4 };

constexpr std::array<PlottingMethod, 5> kPlottingMethods = {
    PlottingMethod::Weibull, PlottingMethod::Hazen, PlottingMethod::Gringorten,
    PlottingMethod::Blom, PlottingMethod::Cunnane};

/// p = (i - a)/(n + 1 - 2a) with the a of the formula (Cunnane 1978): 0, 0.5, 0.44, 0.375, 0.4.
/// It is the exceedance probability of the i-th largest of n values, and since p of rank i and p
/// of rank n + 1 - i add up to 1, also the non-exceedance probability of the i-th smallest.
/// `rank` counts from 1 to `count`. A method that is none of the five counts as Weibull.
double PlottingPosition(PlottingMethod method, std::size_t rank, std::size_t count);

/// Those of ranks 1 to `count`, ascending.
std::vector<double> PlottingPositions(PlottingMethod method, std::size_t count);

} // namespace ryn::stats
