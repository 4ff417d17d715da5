#include "ui/text.h"

#include <gtest/gtest.h>

namespace kdx {
namespace {

TEST(TextTest, EveryByteSurvivesTheWindow) {
    std::string bytes;
    for (int byte = 0; byte < 256; ++byte) bytes.push_back(static_cast<char>(byte));
    EXPECT_EQ(toBytes(toText(bytes)), bytes);
}

TEST(TextTest, WhatTheCodePageLacksBecomesOneQuestionMark) {
    EXPECT_EQ(toBytes(QString::fromUtf8("a\xE4\xB8\xAD"
                                        "b\xF0\x9F\x98\x80"
                                        "c")),
              "a?b?c");
}

TEST(TextTest, UmlautsAreOneByte) {
    EXPECT_EQ(toBytes(QString::fromUtf8("\xC3\xBC\xE2\x82\xAC")), "\xFC\x80");
}

TEST(TextTest, EnteredControlCharactersBecomeBlanksAndThoseAtTheEndsNothing) {
    const auto plain = [](const char* text) { return withoutControls(QString::fromLatin1(text)).toStdString(); };
    EXPECT_EQ(plain(""), "");
    EXPECT_EQ(plain("\r\n\t"), "");
    EXPECT_EQ(plain("A\r\nB"), "A B");
    EXPECT_EQ(plain("A\n\rB\tC\x7F"
                    "D"),
              "A  B C D");
    EXPECT_EQ(plain("\x01\r\nA\r\n"), "A");
    EXPECT_EQ(plain(" A  B "), " A  B ");
    EXPECT_EQ(plain(" \nA\n "), "  A  ") << "inside the blanks that were typed";
    for (const char* kept : {"\xC3\xBC\xE2\x82\xAC", "\xEF\xBB\xBFX"})
        EXPECT_EQ(withoutControls(QString::fromUtf8(kept)), QString::fromUtf8(kept));
}

}  // namespace
}  // namespace kdx
