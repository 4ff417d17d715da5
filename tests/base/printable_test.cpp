#include "base/printable.h"

#include <gtest/gtest.h>

namespace kdx {
namespace {

using namespace std::string_literals;

TEST(PrintableTest, EscapesWhatATerminalMightNotShow) {
    EXPECT_EQ(printable("*IDN?\r\n"), "*IDN?\\r\\n");
    EXPECT_EQ(printable("a\0b\tc\x1F"s), "a\\x00b\\x09c\\x1F");
    EXPECT_EQ(printable(" ~\x7F\x80\xE4\xFF"), " ~\\x7F\\x80\\xE4\\xFF");
    EXPECT_EQ(printable(""), "");
}

TEST(PrintableTest, ReplacesControlCharactersOnlyWhereASubstituteIsGiven) {
    EXPECT_EQ(printable("a\0b\r\n\x1F"s, '.'), "a.b...");
    EXPECT_EQ(printable(" ~\x7F\x80\xE4\xFF\n", '\xB7'), " ~\x7F\x80\xE4\xFF\xB7");
}

}  // namespace
}  // namespace kdx
