#include "vxi11/xdr.h"

#include <gtest/gtest.h>

#include <string>

namespace kdx {
namespace {

using namespace std::string_literals;

TEST(Xdr, WordsHaveTheirHighestByteFirst) {
    EXPECT_EQ(XdrWriter().word(std::uint32_t{0x01020304}).word(-2).bytes(), "\x01\x02\x03\x04\xFF\xFF\xFF\xFE"s);
}

TEST(Xdr, BytesAreFilledUpToWholeWords) {
    EXPECT_EQ(XdrWriter().counted("").bytes(), "\0\0\0\0"s);
    EXPECT_EQ(XdrWriter().counted("abc").bytes(), "\0\0\0\3abc\0"s);
    EXPECT_EQ(XdrWriter().counted("abcd").bytes(), "\0\0\0\4abcd"s);
    EXPECT_EQ(XdrWriter().counted("abcde").bytes(), "\0\0\0\5abcde\0\0\0"s);
}

TEST(Xdr, WhatWasWrittenIsRead) {
    for (std::size_t count = 0; count < 9; ++count) {
        const std::string text(count, 'x');
        const std::string bytes = XdrWriter().word(7).counted(text).word(-5).bytes();
        XdrReader reader(bytes);
        EXPECT_EQ(reader.word(), 7U);
        EXPECT_EQ(reader.counted(8), text);
        EXPECT_EQ(reader.signedWord(), -5);
        EXPECT_TRUE(reader);
        EXPECT_EQ(reader.rest(), "");
    }
}

TEST(Xdr, WhatIsNotThereReadsAsNothingAndSoDoesWhatFollows) {
    const std::string bytes = "\0\0\0\1\0\0"s;
    XdrReader reader(bytes);
    EXPECT_EQ(reader.word(), 1U);
    EXPECT_TRUE(reader);
    EXPECT_EQ(reader.word(), 0U);
    EXPECT_FALSE(reader);
    EXPECT_EQ(reader.counted(100), "");
    EXPECT_EQ(reader.signedWord(), 0);
    EXPECT_FALSE(reader);
}

TEST(Xdr, ACountThatLiesReadsAsNothing) {
    for (const std::string& bytes : {"\0\0\0\5abcd"s, "\xFF\xFF\xFF\xFF"s + "abcd", "\0\0\0\3abc"s, "\0\0\0"s}) {
        XdrReader reader(bytes);
        EXPECT_EQ(reader.counted(0xFFFFFFFF), "");
        EXPECT_FALSE(reader);
    }
    const std::string bytes = "\0\0\0\4abcd"s;
    XdrReader reader(bytes);
    EXPECT_EQ(reader.counted(3), "");
    EXPECT_FALSE(reader);
}

}  // namespace
}  // namespace kdx
