#include "scenario/decimal.h"

#include <gtest/gtest.h>

namespace kdx::scenario {
namespace {

using Points = std::vector<std::string>;

Points points(const char* from, const char* to, const char* step) {
    return sweepPoints(readDecimal(from).value(), readDecimal(to).value(), readDecimal(step).value());
}

TEST(DecimalTest, ReadsWhatIsWrittenAndNothingElse) {
    EXPECT_EQ(readDecimal("98.5")->millionths, 98'500'000);
    EXPECT_EQ(readDecimal("-0.1")->millionths, -100'000);
    EXPECT_EQ(readDecimal("0.000001")->millionths, 1);
    EXPECT_EQ(readDecimal("999999999.999999")->millionths, 999'999'999'999'999);
    for (const char* text :
         {"", "-", ".5", "5.", "1e3", "98,5", "+1", " 1", "1 ", "0x10", "1.0000001", "1234567890", "--1"})
        EXPECT_EQ(readDecimal(text), std::nullopt) << text;
}

TEST(DecimalTest, TheShortestTextStandsForIt) {
    for (const char* text : {"0", "60", "59.9", "-0.5", "-180", "0.000001", "98.25"})
        EXPECT_EQ(decimalText(readDecimal(text).value()), text);
    EXPECT_EQ(decimalText(readDecimal("60.500").value()), "60.5");
    EXPECT_EQ(decimalText(readDecimal("-0").value()), "0");
}

TEST(DecimalTest, ASweepCountsInWholeTenths) {
    const Points all = points("60", "10", "-0.1");
    ASSERT_EQ(all.size(), 501U);
    EXPECT_EQ(all.front(), "60");
    EXPECT_EQ(all[1], "59.9");
    EXPECT_EQ(all[10], "59");
    EXPECT_EQ(all[333], "26.7");
    EXPECT_EQ(all.back(), "10");
    for (const std::string& point : all) EXPECT_LE(point.size(), 4U) << point;
}

TEST(DecimalTest, BothEndsBelongToASweep) {
    EXPECT_EQ(points("1", "3", "1"), (Points{"1", "2", "3"}));
    EXPECT_EQ(points("5", "5", "1"), Points{"5"});
    EXPECT_EQ(points("0", "1", "0.3"), (Points{"0", "0.3", "0.6", "0.9", "1"}));
    EXPECT_EQ(points("-10", "10", "15"), (Points{"-10", "5", "10"}));
    EXPECT_EQ(points("10", "0", "-20"), (Points{"10", "0"}));
}

TEST(DecimalTest, ThePointsAreCountedWithoutBeingMade) {
    EXPECT_EQ(countPoints({0}, {999'999'999'000'000}, {1}), 999'999'999'000'001U);
    EXPECT_EQ(countPoints({60'000'000}, {10'000'000}, {-100'000}), 501U);
}

}  // namespace
}  // namespace kdx::scenario
