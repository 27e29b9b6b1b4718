#include "params/combination_name.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace ryn {
namespace {

using ::testing::ElementsAreArray;

constexpr int kAms = 0;
constexpr int kPds = 1;

TEST(CombinationNames, AreThoseOfTheAnnualDialog) {
    const std::vector<std::string> expected = {
        "GEV/MOM",       "GEV/ML",  "GEV/LMOM",   "GUM/MOM",     "GUM/ML",
        "GUM/LMOM",      "WEI/MOM", "WEI/LMOM",   "FRE/MOM",     "GP/MOM",
        "GP/LMOM",       "P3/MOM",  "P3/LMOM",    "LP3/MOM/LOG", "LP3/MOM/REAL",
        "LP3/LMOM",      "LN2/MOM", "LN3/MOM/BI", "LN3/MOM/BII", "LN3/MOM/LBQI",
        "LN3/MOM/LBQII", "LN2/ML",  "LN3/ML",     "LN2/LMOM",    "SQE/ML"};
    EXPECT_THAT(GeneratedNames(kAms), ElementsAreArray(expected));
}

TEST(CombinationNames, AreThoseOfThePartialDurationDialog) {
    const std::vector<std::string> expected = {
        "WEI2/MOM",  "WEI3/MOM",   "WEI2/ML",     "WEI2/LMOM",    "WEI3/LMOM",     "GP2/MOM",
        "GP3/MOM",   "GP2/ML",     "GP2/LMOM",    "GP3/LMOM",     "GAM/MOM",       "P3/MOM",
        "GAM/ML",    "GAM/LMOM",   "P3/LMOM",     "LP3/MOM/LOG",  "LP3/MOM/REAL",  "LP3/LMOM",
        "LN2/MOM",   "LN3/MOM/BI", "LN3/MOM/BII", "LN3/MOM/LBQI", "LN3/MOM/LBQII", "LN2/ML",
        "LN3/ML",    "LN2/LMOM",   "EXP1/MOM",    "EXP2/MOM",     "EXP1/ML",       "EXP1/LMOM",
        "EXP2/LMOM", "TGUM/ML"};
    EXPECT_THAT(GeneratedNames(kPds), ElementsAreArray(expected));
}

TEST(CombinationNames, LeadToTheFieldsAndBack) {
    for (const int kind : {kAms, kPds}) {
        for (const std::string& name : GeneratedNames(kind)) {
            const auto combination = CombinationOfName(name, kind);
            ASSERT_TRUE(combination) << name;
            EXPECT_EQ(GeneratedName(*combination, kind), name);
            EXPECT_FALSE(combination->IsDefaultName);
        }
    }
    const auto lower = CombinationOfName("ln3/mom/lbqi", kAms);
    ASSERT_TRUE(lower);
    EXPECT_EQ(lower->DistributionType, kLogNormal);
    EXPECT_EQ(lower->EstimateLocationType, 1);
    EXPECT_EQ(lower->LogNormalType, 2);
    EXPECT_EQ(lower->ItemName, "LN3/MOM/LBQI");
}

TEST(CombinationNames, OfTheOtherKindOrOfNoneAreRefused) {
    for (const char* name : {"GP2/MOM", "EXP1/ML", "TGUM/ML", "GEV", "GEV/", "", "GEV/MOM/LOG"})
        EXPECT_FALSE(CombinationOfName(name, kAms)) << name;
    for (const char* name : {"GEV/MOM", "GP/MOM", "SQE/ML", "LN3/LMOM", "WEI3/ML"})
        EXPECT_FALSE(CombinationOfName(name, kPds)) << name;
}

TEST(CombinationNames, IgnoreAnAnnualLocationOptionThatLMomentsDoNotHave) {
    DieCombination logNormal;
    logNormal.DistributionType = kLogNormal;
    logNormal.EstimationMethod = kLMoments;
    logNormal.EstimateLocationType = 1;
    EXPECT_EQ(GeneratedName(logNormal, kAms), "LN2/LMOM");
    logNormal.DistributionType = kTruncatedGumbel;
    EXPECT_EQ(GeneratedName(logNormal, kAms), "");
}

} // namespace
} // namespace ryn
