#include "air/deviationbudget.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "sim/setup.h"

namespace kdx::air {
namespace {

using ::testing::ElementsAre;
using ::testing::IsEmpty;

/// 40 kHz in all, 6.75 kHz of it for the pilot, 2 kHz for RDS; ARI of 3.5 kHz is off.
sim::Setup budgetCoder() {
    sim::Setup setup;
    setup.stereoOn = setup.pilotOn = setup.rdsOn = true;
    return setup;
}

TEST(DeviationBudget, HoldsEachPartAgainstTheTotalAndTheHighest) {
    const DeviationBudget budget = deviationBudgetOf(budgetCoder());
    ASSERT_EQ(budget.rows.size(), 5U);
    EXPECT_STREQ(budget.rows[0].name, "audio");
    EXPECT_DOUBLE_EQ(budget.rows[0].hertz, 31250);
    EXPECT_DOUBLE_EQ(budget.rows[0].ofTotal, 0.78125);  // 31.25 of 40
    EXPECT_DOUBLE_EQ(budget.rows[1].ofHighest, 0.09);   // 6.75 of 75
    EXPECT_DOUBLE_EQ(budget.rows[2].ofTotal, 0.05);     // 2 of 40
    EXPECT_DOUBLE_EQ(budget.rows[3].hertz, 0);
    EXPECT_STREQ(budget.rows[4].name, "all");
    EXPECT_DOUBLE_EQ(budget.rows[4].ofTotal, 1);
    EXPECT_THAT(budget.warnings, IsEmpty());
}

/// With both of its tones ARI peaks at 1.9 times 3.5 kHz: 6.75 + 2 + 6.65 kHz.
TEST(DeviationBudget, WarnsWhenTheSubcarriersEatTheTotal) {
    sim::Setup setup = budgetCoder();
    setup.ariOn = setup.ariTypeOn = true;
    setup.ariType = 3;
    setup.mpxHertz = 15410;
    EXPECT_THAT(deviationBudgetOf(setup).warnings, IsEmpty());
    setup.mpxHertz = 15400;
    EXPECT_THAT(deviationBudgetOf(setup).warnings,
                ElementsAre("pilot, RDS and ARI take 15.40 kHz of 15.40 kHz: nothing is left for the audio"));
    setup.mpxHertz = 0;
    EXPECT_EQ(deviationBudgetOf(setup).rows[1].ofTotal, 0);
}

TEST(DeviationBudget, WarnsOfMoreThan75Kilohertz) {
    sim::Setup setup = budgetCoder();
    setup.mpxHertz = 75000;
    EXPECT_THAT(deviationBudgetOf(setup).warnings, IsEmpty());
    setup.mpxHertz = 80000;
    EXPECT_THAT(deviationBudgetOf(setup).warnings, ElementsAre("the multiplex peaks at 80.00 kHz: 75 kHz is the most"));
}

TEST(DeviationBudget, WarnsOfWhatRadiosMayMiss) {
    sim::Setup setup = budgetCoder();
    setup.pilotHertz = 5950;
    setup.rdsHertz = 950;
    EXPECT_THAT(deviationBudgetOf(setup).warnings, ElementsAre("the pilot has 5.95 kHz: radios await 6.00 to 7.50 kHz",
                                                               "RDS has 0.95 kHz: radios await 1.00 kHz at least"));
    setup.pilotOn = setup.rdsOn = false;
    EXPECT_THAT(deviationBudgetOf(setup).warnings, IsEmpty());
}

TEST(DeviationBudget, OfACoderThatIsOffSaysSo) {
    sim::Setup setup = budgetCoder();
    setup.stereoOn = false;
    EXPECT_THAT(deviationBudgetOf(setup).warnings, ElementsAre("the stereo coder is off: no multiplex goes out"));
}

}  // namespace
}  // namespace kdx::air
