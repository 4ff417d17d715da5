#include "settings/shownpath.h"

#include <gtest/gtest.h>

#include "base/paths.h"

namespace kdx {
namespace {

TEST(ShownTextTest, OrdinaryNamesAppearAsTheyAre) {
    for (const std::string name : {"", "a\\b c", "B\xC3\xBCro \xE2\x82\xAC \xF0\x9F\x93\xBB"}) {
        EXPECT_EQ(shownText(name), name);
        EXPECT_EQ(shownPath(pathFromUtf8(name)), name);
    }
}

TEST(ShownTextTest, BytesThatAreNoUtf8AndControlCharactersAppearAsEscapes) {
    EXPECT_EQ(shownText("/B\xFCro/Daten"), "/B\\xFCro/Daten") << "a name from the code page";
    EXPECT_EQ(shownText("a\xE2\x82"), "a\\xE2\\x82") << "the end is missing";
    EXPECT_EQ(shownText("a\nb\x7F\x1B[2J"), "a\\x0Ab\\x7F\\x1B[2J");
}

}  // namespace
}  // namespace kdx
