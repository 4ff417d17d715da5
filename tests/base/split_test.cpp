#include "base/split.h"

#include <gtest/gtest.h>

namespace kdx {
namespace {

using Pieces = std::vector<std::string_view>;

TEST(SplitTest, GivesThePiecesBetweenTheSeparatorsEmptyOnesToo) {
    EXPECT_EQ(split("0A,2A,,", ","), (Pieces{"0A", "2A", "", ""}));
    EXPECT_EQ(split("TCPIP::a:b:::INSTR", "::"), (Pieces{"TCPIP", "a:b", ":INSTR"}));
}

TEST(SplitTest, GivesOnePieceWithoutASeparator) {
    EXPECT_EQ(split("0A", ","), Pieces{"0A"});
    EXPECT_EQ(split("", ","), Pieces{""});
    EXPECT_EQ(split(":", "::"), Pieces{":"});
}

}  // namespace
}  // namespace kdx
