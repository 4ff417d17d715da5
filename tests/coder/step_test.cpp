#include "coder/step.h"

#include <gtest/gtest.h>

#include "coder/sendparam.h"

namespace kdx {
namespace {

TEST(StepTest, AKeyOfTheDispatcherBecomesAStepWithItsValueAsItIs) {
    Steps steps;
    appendStep(steps, "PS", "LANGER NAME");
    appendStep(steps, "STEREO_MODE", "0");  // no choice of its row, and a step all the same
    EXPECT_EQ(steps,
              (Steps{{Step::Kind::Parameter, "PS", "LANGER NAME"}, {Step::Kind::Parameter, "STEREO_MODE", "0"}}));
}

TEST(StepTest, AKeyThatTheDispatcherDoesNotKnowIsNone) {
    Steps steps;
    for (const char* key : {"NFShape Sinus", "ARI_HUB", "ARI_ID", "AR_BK", "ps", "", "DS"}) {
        appendStep(steps, key, "1");
        EXPECT_FALSE(isParameter(key)) << key;
    }
    EXPECT_TRUE(steps.empty());
}

}  // namespace
}  // namespace kdx
