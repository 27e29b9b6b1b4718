#pragma once

#include "selfcheck/comparison.h"

/// The groups of cases; each computes its values and adds them.
namespace ryn::selfcheck {

void CompareFits(Comparisons& list);
void CompareGoodnessOfFit(Comparisons& list);
void CompareHomogeneityTests(Comparisons& list);
void CompareResampling(Comparisons& list);
void CompareSampleStatistics(Comparisons& list); ///< and plotting positions
void CompareFunctions(Comparisons& list);        ///< distributions and random numbers

} // namespace ryn::selfcheck
