#include "scenario/stepnumber.h"

#include <gtest/gtest.h>

#include "scenario/reader.h"

namespace kdx::scenario {
namespace {

StepNumber number(const char* text) {
    return readStepNumber(text).value();
}

TEST(StepNumberTest, ReadsBackAsItIsWritten) {
    for (const char* text : {"1", "12", "4.2", "4#3.2", "4#3", "1.2.3#4"}) EXPECT_EQ(number(text).text(), text);
    for (const char* text : {"", "0", "a", "1.", ".1", "1..2", "4#", "4#0", "4#a", "1 ", "-1", "12345678"})
        EXPECT_EQ(readStepNumber(text), std::nullopt) << text;
}

TEST(StepNumberTest, IsHeldAgainstTheScenario) {
    const Scenario whole =
        readScenario("steps: [note: a, {repeat: 3, steps: [note: b, {sweep: PTY, points: [1, 2], dwell: 1 s}]}]")
            .scenario;
    for (const char* there : {"1", "2", "2#3", "2.1", "2#3.2", "2.2#2"})
        EXPECT_TRUE(isStepOf(whole, number(there))) << there;
    for (const char* missing : {"3", "1.1", "1#1", "2#4", "2.3", "2.2#3", "2.2.1"})
        EXPECT_FALSE(isStepOf(whole, number(missing))) << missing;
}

TEST(StepNumberTest, OneIsBeforeAnotherWhenItIsDoneByThen) {
    for (const auto& [first, second] :
         {std::pair("1", "2"), {"4.1", "4.2"}, {"4#2", "4#3"}, {"3", "4.1"}, {"4#2.9", "4#3.1"}})
        EXPECT_TRUE(isBefore(number(first), number(second))) << first << " " << second;
    for (const auto& [first, second] :
         {std::pair("2", "1"), {"4", "4.2"}, {"4.2", "4"}, {"4", "4#3"}, {"4#3", "4#3"}, {"4", "4"}})
        EXPECT_FALSE(isBefore(number(first), number(second))) << first << " " << second;
}

TEST(StepNumberTest, AStepIsReachedInAnyPassThatIsNotNamed) {
    EXPECT_TRUE(isReached(number("4#1.2"), number("4.2")));
    EXPECT_TRUE(isReached(number("4#3.2"), number("4#3.2")));
    EXPECT_FALSE(isReached(number("4#1.2"), number("4#3.2")));
    EXPECT_FALSE(isReached(number("4#1"), number("4")));  // all of its passes belong to step 4
    EXPECT_FALSE(isReached(number("4.1"), number("4")));
    EXPECT_TRUE(isReached(number("4"), number("4")));
}

}  // namespace
}  // namespace kdx::scenario
