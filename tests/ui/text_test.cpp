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

}  // namespace
}  // namespace kdx
