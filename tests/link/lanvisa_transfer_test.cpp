#include "link/lanvisatest.h"

namespace kdx::test {
namespace {

using ::testing::ElementsAre;

// A call says that it waits for a lock of somebody else, and how long.
constexpr long kWaitLock = 1;
constexpr long kEnd = 8;

TEST_F(LanVisaTest, AWriteIsOneCallWithTheEndMark) {
    ASSERT_EQ(open(), visa::kSuccess);
    EXPECT_EQ(write(":STEREO:DIRECT \"PS=ABCDEFGH\""), visa::kSuccess);
    EXPECT_EQ(count, 28);
    ASSERT_EQ(device.writes().size(), 1U);
    EXPECT_EQ(device.writes()[0].data, ":STEREO:DIRECT \"PS=ABCDEFGH\"");
    EXPECT_EQ(device.writes()[0].flags, kWaitLock | kEnd);
    EXPECT_LE(device.writes()[0].ioTimeout, 2000U);
    EXPECT_GE(device.writes()[0].ioTimeout, 1000U);
    EXPECT_EQ(device.writes()[0].lockTimeout, device.writes()[0].ioTimeout);
}

TEST_F(LanVisaTest, AllByteValuesAreWrittenAsTheyStand) {
    ASSERT_EQ(open(), visa::kSuccess);
    std::string all;
    for (int c = 0; c < 256; ++c) all += static_cast<char>(c);
    EXPECT_EQ(write(all), visa::kSuccess);
    EXPECT_EQ(device.writes()[0].data, all);
}

TEST_F(LanVisaTest, ALongWriteIsSplitAndOnlyTheLastPartBearsTheEndMark) {
    device.setMaxReceive(1024);
    ASSERT_EQ(open(), visa::kSuccess);
    const std::string text = bytesOf(2500);
    EXPECT_EQ(write(text), visa::kSuccess);
    EXPECT_EQ(count, 2500);
    const auto writes = device.writes();
    ASSERT_EQ(writes.size(), 3U);
    EXPECT_EQ(writes[0].data + writes[1].data + writes[2].data, text);
    EXPECT_EQ(writes[0].data.size(), 1024U);
    EXPECT_EQ(writes[0].flags, kWaitLock);
    EXPECT_EQ(writes[1].flags, kWaitLock);
    EXPECT_EQ(writes[2].flags, kWaitLock | kEnd);
}

TEST_F(LanVisaTest, AWriteOfExactlyTheLargestSizeIsOneCall) {
    device.setMaxReceive(1024);
    ASSERT_EQ(open(), visa::kSuccess);
    EXPECT_EQ(write(bytesOf(1024)), visa::kSuccess);
    ASSERT_EQ(device.writes().size(), 1U);
    EXPECT_EQ(device.writes()[0].flags, kWaitLock | kEnd);
}

TEST_F(LanVisaTest, ADeviceThatStatesNoLargestSizeGetsWhatEveryDeviceMustTake) {
    device.setMaxReceive(0);
    ASSERT_EQ(open(), visa::kSuccess);
    EXPECT_EQ(write(bytesOf(1025)), visa::kSuccess);
    EXPECT_EQ(device.writes().size(), 2U);
}

TEST_F(LanVisaTest, AVeryLongWriteArrivesWhole) {
    device.setMaxReceive(0xFFFFFFFF);
    std::string seen;
    device.answerWith([&seen](long, const std::string& command) { return seen = command; });
    ASSERT_EQ(open(), visa::kSuccess);
    const std::string text = bytesOf(1000000);
    EXPECT_EQ(write(text), visa::kSuccess);
    EXPECT_EQ(count, 1000000);
    EXPECT_EQ(read(1000000), visa::kSuccess);
    EXPECT_TRUE(got == text);
}

TEST_F(LanVisaTest, WhatADeviceTookOnlyInPartIsContinued) {
    ASSERT_EQ(open(), visa::kSuccess);
    device.on(ScriptedVxi11::kWrite, {.number = 3});
    EXPECT_EQ(write("*RST;*CLS"), visa::kSuccess);
    EXPECT_EQ(count, 9);
    ASSERT_EQ(device.writes().size(), 2U);
    EXPECT_EQ(device.writes()[1].data, "T;*CLS");
}

TEST_F(LanVisaTest, ADeviceThatClaimsToHaveTakenNothingOrTooMuchIsATransferError) {
    ASSERT_EQ(open(), visa::kSuccess);
    device.on(ScriptedVxi11::kWrite, {.number = 0});
    EXPECT_EQ(write("*RST"), visa::kInputOutput);
    device.on(ScriptedVxi11::kWrite, {.number = 5});
    EXPECT_EQ(write("*RST"), visa::kInputOutput);
}

TEST_F(LanVisaTest, WritingNothingSendsNothing) {
    ASSERT_EQ(open(), visa::kSuccess);
    EXPECT_EQ(write(""), visa::kSuccess);
    EXPECT_TRUE(device.writes().empty());
}

TEST_F(LanVisaTest, AQueryIsOneWriteCallAndOneReadCall) {
    ASSERT_EQ(open(), visa::kSuccess);
    device.answer("KDX,GEN,1,2\n");
    write("*IDN?");
    EXPECT_EQ(read(), visa::kSuccess);
    EXPECT_EQ(got, "KDX,GEN,1,2\n");
    EXPECT_EQ(rest, std::string(48, ' '));
    EXPECT_THAT(device.calls(), ElementsAre(ScriptedVxi11::kGetPort, ScriptedVxi11::kCreateLink, ScriptedVxi11::kWrite,
                                            ScriptedVxi11::kRead));
    EXPECT_THAT(device.readSizes(), ElementsAre(60U));
    EXPECT_EQ(device.reads()[0].flags, kWaitLock);
    EXPECT_GE(device.reads()[0].lockTimeout, 1000U);
    EXPECT_EQ(device.reads()[0].lockTimeout, device.reads()[0].ioTimeout);
}

class LanVisaAnswer : public LanVisaTest, public ::testing::WithParamInterface<std::size_t> {};

TEST_P(LanVisaAnswer, IsReadInPiecesOfTheBufferAndEndsWithPlainSuccess) {
    ASSERT_EQ(open(), visa::kSuccess);
    std::string answer;
    for (std::size_t i = 0; i < GetParam(); ++i) answer += static_cast<char>(i * 7);
    device.answer(answer);
    std::string whole;
    while (whole.size() + 60 < answer.size()) {
        ASSERT_EQ(read(), visa::kMaxCountReached);
        ASSERT_EQ(count, 60);
        whole += got;
    }
    EXPECT_EQ(read(), visa::kSuccess);
    whole += got;
    EXPECT_EQ(whole, answer);
    EXPECT_EQ(device.readSizes().size(), std::max<std::size_t>(1, (answer.size() + 59) / 60));
}

INSTANTIATE_TEST_SUITE_P(Lengths, LanVisaAnswer, ::testing::Values(0, 1, 5, 59, 60, 61, 120, 121, 500));

TEST_F(LanVisaTest, AnAnswerThatIsNotReadToItsEndIsContinuedAfterAnotherCommand) {
    ASSERT_EQ(open(), visa::kSuccess);
    device.answer(bytesOf(70));
    EXPECT_EQ(read(), 1073676294);
    write("*RST");
    EXPECT_EQ(read(), visa::kSuccess);
    EXPECT_EQ(got, bytesOf(70).substr(60));
}

TEST_F(LanVisaTest, ATerminationCharacterEndsTheRead) {
    ASSERT_EQ(open(), visa::kSuccess);
    device.answer("12\n");
    device.on(ScriptedVxi11::kRead, {.reason = 2});
    EXPECT_EQ(read(), 1073676293);
    EXPECT_EQ(got, "12\n");
}

TEST_F(LanVisaTest, TheEndMarkOutweighsTheOtherReasons) {
    ASSERT_EQ(open(), visa::kSuccess);
    device.answer("12\n");
    device.on(ScriptedVxi11::kRead, {.reason = 7});
    EXPECT_EQ(read(3), visa::kSuccess);
}

TEST_F(LanVisaTest, PartsThatADeviceGivesWithoutAReasonAreReadTogether) {
    ASSERT_EQ(open(), visa::kSuccess);
    device.on(ScriptedVxi11::kRead, {.reason = 0, .raw = "KDX,"});
    device.on(ScriptedVxi11::kRead, {.reason = 0, .raw = "GEN"});
    device.answer(",1\n");
    EXPECT_EQ(read(), visa::kSuccess);
    EXPECT_EQ(got, "KDX,GEN,1\n");
    EXPECT_THAT(device.readSizes(), ElementsAre(60U, 56U, 53U));
}

TEST_F(LanVisaTest, ALineFeedAtTheEndOfTheBytesEndsAnAnswerWithoutTheEndMark) {
    ASSERT_EQ(open(), visa::kSuccess);
    device.on(ScriptedVxi11::kRead, {.reason = 0, .raw = "KDX,"});
    device.on(ScriptedVxi11::kRead, {.reason = 0, .raw = "GEN\n"});
    EXPECT_EQ(read(), visa::kSuccess);
    EXPECT_EQ(got, "KDX,GEN\n");
    EXPECT_EQ(device.readSizes().size(), 2U) << "and none that would wait in vain";
}

TEST_F(LanVisaTest, ALineFeedInTheMiddleEndsNothing) {
    ASSERT_EQ(open(), visa::kSuccess);
    device.answer("1\n2\n");
    EXPECT_EQ(read(2), visa::kMaxCountReached);
    EXPECT_EQ(read(), visa::kSuccess);
    EXPECT_EQ(got, "2\n");
}

TEST_F(LanVisaTest, NeitherBytesNorAnEndIsATransferError) {
    ASSERT_EQ(open(), visa::kSuccess);
    device.on(ScriptedVxi11::kRead, {.reason = 0, .raw = ""});
    EXPECT_EQ(read(), visa::kInputOutput);
    EXPECT_EQ(count, 0);
}

TEST_F(LanVisaTest, MoreBytesThanAskedForAreRefused) {
    ASSERT_EQ(open(), visa::kSuccess);
    device.on(ScriptedVxi11::kRead, {.reason = 4, .raw = bytesOf(61)});
    EXPECT_EQ(read(), visa::kInputOutput);
    EXPECT_EQ(count, 0);
}

TEST_F(LanVisaTest, AReplyMayArriveByteByByteOrInManyFragments) {
    ASSERT_EQ(open(), visa::kSuccess);
    device.answer(bytesOf(59) + "\n");
    device.on(ScriptedVxi11::kRead, {.kind = Reaction::Kind::AnswerInPieces});
    EXPECT_EQ(read(), visa::kSuccess);
    EXPECT_EQ(got, bytesOf(59) + "\n");
    device.answer(bytesOf(33));
    device.on(ScriptedVxi11::kRead, {.kind = Reaction::Kind::AnswerInFragments});
    EXPECT_EQ(read(), visa::kSuccess);
    EXPECT_EQ(got, bytesOf(33));
}

TEST_F(LanVisaTest, NothingToReadIsTheDevicesTimeOutAndTheSessionGoesOn) {
    ASSERT_EQ(open(), visa::kSuccess);
    EXPECT_EQ(read(), -1073807339);
    device.answer("1\n");
    EXPECT_EQ(read(), visa::kSuccess);
    EXPECT_EQ(got, "1\n");
}

TEST_F(LanVisaTest, ASilentDeviceIsATimeOutAndTheSessionGoesOn) {
    useShortTimes();
    ASSERT_EQ(open(), visa::kSuccess);
    device.on(ScriptedVxi11::kRead, {.kind = Reaction::Kind::Silence});
    const auto start = std::chrono::steady_clock::now();
    EXPECT_EQ(read(), visa::kTimeout);
    const auto taken = std::chrono::steady_clock::now() - start;
    EXPECT_GE(taken, 100ms);
    EXPECT_LT(taken, kBounded);
    device.on(ScriptedVxi11::kWrite, {.kind = Reaction::Kind::Silence});
    EXPECT_EQ(write("*RST"), visa::kTimeout);

    device.answer("1\n");
    EXPECT_EQ(read(), visa::kSuccess);
    EXPECT_EQ(got, "1\n");
}

TEST_F(LanVisaTest, TheLateAnswerToAGivenUpCallIsPassedOver) {
    ASSERT_EQ(open(), visa::kSuccess);
    write("*RST");
    device.answer("1\n");
    device.on(ScriptedVxi11::kRead, {.kind = Reaction::Kind::AnswerTwice});
    EXPECT_EQ(read(), visa::kSuccess);
    EXPECT_EQ(got, "1\n");
}

TEST_F(LanVisaTest, AReadWithoutRoomTouchesNothing) {
    ASSERT_EQ(open(), visa::kSuccess);
    EXPECT_EQ(read(0), visa::kMaxCountReached);
    EXPECT_TRUE(device.readSizes().empty());
}

}  // namespace
}  // namespace kdx::test
