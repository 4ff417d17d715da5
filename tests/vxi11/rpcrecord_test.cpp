#include "vxi11/rpcrecord.h"

#include <gtest/gtest.h>

#include <string>

namespace kdx {
namespace {

using namespace std::string_literals;

TEST(RpcRecord, ARecordGetsItsLengthAndTheLastFragmentBitInFront) {
    EXPECT_EQ(framed("abcde"), "\x80\x00\x00\x05"s + "abcde");
    EXPECT_EQ(framed(""), "\x80\x00\x00\x00"s);
}

TEST(RpcRecord, RecordsComeOutInOrderHoweverTheBytesWereCut) {
    const std::string bytes = framed("first") + framed("") + framed("second");
    for (std::size_t piece = 1; piece <= bytes.size(); ++piece) {
        RecordReader reader(100);
        std::string got;
        for (std::size_t at = 0; at < bytes.size(); at += piece) {
            reader.feed(std::string_view(bytes).substr(at, piece));
            while (const auto record = reader.next()) got += "[" + *record + "]";
        }
        EXPECT_EQ(got, "[first][][second]") << "pieces of " << piece;
    }
}

TEST(RpcRecord, FragmentsOfARecordArePutTogether) {
    RecordReader reader(100);
    reader.feed("\x00\x00\x00\x03"s + "abc" + "\x00\x00\x00\x00"s + framed("de"));
    EXPECT_EQ(reader.next(), "abcde");
    EXPECT_FALSE(reader.tooLong());
}

TEST(RpcRecord, ALongerRecordIsRefusedAsSoonAsItIsAnnounced) {
    RecordReader reader(5);
    reader.feed(framed("12345"));
    EXPECT_EQ(reader.next(), "12345");
    reader.feed("\x80\x00\x00\x06"s);
    EXPECT_EQ(reader.next(), std::nullopt);
    EXPECT_TRUE(reader.tooLong());
}

TEST(RpcRecord, FragmentsCountTogetherForTheLimit) {
    RecordReader reader(5);
    reader.feed("\x00\x00\x00\x03"s + "abc" + "\x7f\xff\xff\xff"s);
    EXPECT_EQ(reader.next(), std::nullopt);
    EXPECT_TRUE(reader.tooLong());
}

}  // namespace
}  // namespace kdx
