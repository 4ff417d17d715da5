#include "vxi11/rpcrecord.h"

#include <gtest/gtest.h>

#include <chrono>
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
    reader.feed("\x00\x00\x00\x03"s + "abc" + framed("de"));
    EXPECT_EQ(reader.next(), "abcde");
    EXPECT_FALSE(reader.broken());
}

TEST(RpcRecord, AnEmptyFragmentIsTheLastOneOrNone) {
    RecordReader reader(100);
    reader.feed("\x00\x00\x00\x03"s + "abc" + framed(""));
    EXPECT_EQ(reader.next(), "abc");
    reader.feed("\x00\x00\x00\x03"s + "abc" + "\x00\x00\x00\x00"s + framed("de"));
    EXPECT_EQ(reader.next(), std::nullopt);
    EXPECT_TRUE(reader.broken());
}

TEST(RpcRecord, HasBegunWithItsFirstByteUntilItIsComplete) {
    RecordReader reader(100);
    EXPECT_FALSE(reader.hasBegun());
    const std::string bytes = "\x00\x00\x00\x01"s + "a" + framed("b");
    for (const char byte : bytes) {
        EXPECT_EQ(reader.next(), std::nullopt);
        reader.feed({&byte, 1});
        EXPECT_TRUE(reader.hasBegun());
    }
    EXPECT_EQ(reader.next(), "ab");
    EXPECT_FALSE(reader.hasBegun());
}

TEST(RpcRecord, ManySmallFragmentsCostNoMoreThanTheirBytes) {
    constexpr int kFragments = 200000;
    std::string bytes;
    for (int i = 0; i < kFragments; ++i) bytes += "\x00\x00\x00\x01x"s;
    RecordReader reader(std::size_t{2} * kFragments);
    const auto start = std::chrono::steady_clock::now();
    reader.feed(bytes + framed(""));
    EXPECT_EQ(reader.next().value_or("").size(), static_cast<std::size_t>(kFragments));
    EXPECT_LT(std::chrono::steady_clock::now() - start, std::chrono::seconds(1))
        << "the rest must not be moved each time";
}

TEST(RpcRecord, ALongerRecordIsRefusedAsSoonAsItIsAnnounced) {
    RecordReader reader(5);
    reader.feed(framed("12345"));
    EXPECT_EQ(reader.next(), "12345");
    reader.feed("\x80\x00\x00\x06"s);
    EXPECT_EQ(reader.next(), std::nullopt);
    EXPECT_TRUE(reader.broken());
}

TEST(RpcRecord, FragmentsCountTogetherForTheLimit) {
    RecordReader reader(5);
    reader.feed("\x00\x00\x00\x03"s + "abc" + "\x7f\xff\xff\xff"s);
    EXPECT_EQ(reader.next(), std::nullopt);
    EXPECT_TRUE(reader.broken());
}

}  // namespace
}  // namespace kdx
