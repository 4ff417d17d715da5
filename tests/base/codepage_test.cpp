#include "base/codepage.h"

#include <gtest/gtest.h>

namespace kdx {
namespace {

TEST(CodePageTest, EveryByteSurvivesTheWayThereAndBack) {
    for (int byte = 0; byte < 256; ++byte) {
        const char16_t codePoint = fromCodePage(static_cast<unsigned char>(byte));
        EXPECT_TRUE(inCodePage(codePoint)) << byte;
        EXPECT_EQ(static_cast<unsigned char>(toCodePage(codePoint)), byte);
    }
}

TEST(CodePageTest, KnowsTheCharactersThatDifferFromLatin1) {
    EXPECT_EQ(fromCodePage(0x80), u'\u20AC');
    EXPECT_EQ(fromCodePage(0xB5), u'\u00B5');
    EXPECT_EQ(toCodePage(u'\u201E'), '\x84');
}

TEST(CodePageTest, ACharacterItDoesNotHaveBecomesAQuestionMark) {
    EXPECT_EQ(toCodePage(u'\u4E2D'), '?');
    EXPECT_FALSE(inCodePage(u'\u4E2D'));
}

TEST(CodePageTest, NamesCompareWithoutRegardToCase) {
    EXPECT_TRUE(equalNoCase("RDS_Allg.INI", "rds_allg.ini"));
    EXPECT_TRUE(
        equalNoCase("Gr\xF6\xDF"
                    "e",
                    "GR\xD6\xDF"
                    "E"));
    EXPECT_FALSE(equalNoCase("a", "ab"));
    EXPECT_EQ(upperCase("auto\xE4\xF7\xFF"), "AUTO\xC4\xF7\x9F");
}

}  // namespace
}  // namespace kdx
