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

TEST(CodePage, KnowsWholeCharactersOfUtf8) {
    for (const char* text :
         {"", "plain", "K\u00E4se", "\u20AC", "\U0001F4FB", "\u007F\u0080\u07FF\u0800\uFFFF\U0010FFFF"}) {
        EXPECT_TRUE(isUtf8(text)) << text;
    }
    EXPECT_TRUE(isUtf8(std::string_view("\0", 1)));
    for (const char* text :
         {"\xFC", "a\x80", "\xC3", "\xC3(", "\xC0\x80", "\xC1\xBF", "\xE0\x9F\xBF", "\xED\xA0\x80", "\xF0\x8F\xBF\xBF",
          "\xF4\x90\x80\x80", "\xF5\x80\x80\x80", "\xFF", "\xE2\x82", "\xF8\x88\x80\x80\x80"}) {
        EXPECT_FALSE(isUtf8(text)) << text;
    }
}

TEST(CodePage, TheFirstCharacterOutsideItIsFound) {
    EXPECT_EQ(firstOutsideCodePage(""), "");
    EXPECT_EQ(firstOutsideCodePage("What? Käse für 5 €"), "");
    EXPECT_EQ(firstOutsideCodePage("Käse 日本"), "日");
    EXPECT_EQ(firstOutsideCodePage("\U0001F4FB"), "\U0001F4FB");
    EXPECT_EQ(firstOutsideCodePage("ä\xFF\xE6"), "\xFF");
    EXPECT_EQ(firstOutsideCodePage("\xE6\x97"), "\xE6");
}

}  // namespace
}  // namespace kdx
