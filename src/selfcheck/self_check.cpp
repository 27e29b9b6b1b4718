#include "selfcheck/self_check.h"

#include "selfcheck/case_groups.h"

namespace ryn::selfcheck {

Comparisons RunSelfCheck() {
    Comparisons list;
    CompareFits(list);
    CompareGoodnessOfFit(list);
    CompareHomogeneityTests(list);
    CompareResampling(list);
    CompareSampleStatistics(list);
    CompareFunctions(list);
    return list;
}

} // namespace ryn::selfcheck
