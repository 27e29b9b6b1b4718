#pragma once

#include "selfcheck/comparison.h"

namespace ryn::selfcheck {

/// Computes all published values anew and compares: fits of annual maxima (A) and of partial
/// durations (P), periods of the annual maximum (Y), results of the literature (C, B), goodness of
/// fit (G), tests of independence and homogeneity (T), jackknife (U), Monte Carlo (M), sample
/// statistics (S), plotting positions (Q), distributions and random numbers (F). Always the same
/// values in the same order. Takes a fraction of a second.
Comparisons RunSelfCheck();

} // namespace ryn::selfcheck
