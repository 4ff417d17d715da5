#include "settings/shownpath.h"

#include <gtest/gtest.h>

namespace kdx {
namespace {

TEST(ShownPathTest, OrdinaryNamesAppearAsTheyAre) {
    EXPECT_EQ(shownPath("/home/someone/Daten"), "/home/someone/Daten");
    EXPECT_EQ(shownPath(""), "");
    EXPECT_EQ(shownPath("/B\xC3\xBCro/\xE2\x82\xAC/\xF0\x9F\x93\xBB"), "/B\xC3\xBCro/\xE2\x82\xAC/\xF0\x9F\x93\xBB");
    EXPECT_EQ(shownPath("a\\b c"), "a\\b c");
}

TEST(ShownPathTest, BytesThatAreNoUtf8AppearAsEscapes) {
    EXPECT_EQ(shownPath("/B\xFCro/Daten"), "/B\\xFCro/Daten") << "a name from the code page";
    EXPECT_EQ(shownPath("a\x80z"), "a\\x80z") << "a continuation without its lead";
    EXPECT_EQ(shownPath("a\xE2\x82"), "a\\xE2\\x82") << "the end is missing";
    EXPECT_EQ(shownPath("a\xE2z\x82"), "a\\xE2z\\x82");
    EXPECT_EQ(shownPath("\xC0\xAF"), "\\xC0\\xAF") << "longer than need be";
    EXPECT_EQ(shownPath("\xE0\x80\xAF"), "\\xE0\\x80\\xAF") << "longer than need be";
    EXPECT_EQ(shownPath("\xED\xA0\x80"), "\\xED\\xA0\\x80") << "half a surrogate pair";
    EXPECT_EQ(shownPath("\xF4\x90\x80\x80"), "\\xF4\\x90\\x80\\x80") << "beyond the last code point";
    EXPECT_EQ(shownPath("\xFF\xFE"), "\\xFF\\xFE");
}

TEST(ShownPathTest, ControlCharactersDoNotBreakTheLine) {
    EXPECT_EQ(shownPath("a\nb\x7F\x1B[2J"), "a\\x0Ab\\x7F\\x1B[2J");
}

}  // namespace
}  // namespace kdx
