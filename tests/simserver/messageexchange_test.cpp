#include "simserver/vxi11fixture.h"

namespace kdx::simserver {
namespace {

using Lines = std::vector<std::string>;
using Errors = std::vector<int>;
using MessageExchangeTest = Vxi11Test;

TEST_F(MessageExchangeTest, AMessageIsCarriedOutWhenItsEndHasCome) {
    CoreClient client(port());
    const long link = client.open();
    EXPECT_EQ(client.write(link, "NA", 0).size, 2U);
    EXPECT_EQ(m_device.got(), Lines{});
    EXPECT_EQ(client.write(link, "ME").size, 2U);
    EXPECT_EQ(m_device.got(), Lines{"NAME"});
}

TEST_F(MessageExchangeTest, ALineFeedIsAnEndToo) {
    CoreClient client(port());
    const long link = client.open();
    EXPECT_EQ(client.write(link, "NA", 0).size, 2U);
    EXPECT_EQ(client.write(link, "ME?\n", 0).size, 4U);
    EXPECT_EQ(m_device.got(), Lines{"NAME?\n"});
    EXPECT_EQ(client.read(link), (ReadResult{0, 4, "NAME\n"}));
}

TEST_F(MessageExchangeTest, ALineFeedInsideQuotesIsText) {
    CoreClient client(port());
    const long link = client.open();
    for (const char* message : {"A \"x\ny\"", "A 'x\ny'", "A \"it's\ny\"", "A '\"\n'"}) {
        client.write(link, message, 0);
        EXPECT_EQ(m_device.got().size(), 0U) << message;
        client.error(device_clear, CoreClient::genericArguments(link));
    }
}

TEST_F(MessageExchangeTest, TwoLinesInOneWriteGiveTwoResponses) {
    CoreClient client(port());
    const long link = client.open();
    client.write(link, "ONE?\nTWO?\n");
    EXPECT_EQ(m_device.got(), (Lines{"ONE?\n", "TWO?\n"}));
    EXPECT_EQ(client.read(link, 2), (ReadResult{0, 1, "ON"}));
    EXPECT_EQ(client.read(link), (ReadResult{0, 4, "E\n"}));
    EXPECT_EQ(client.read(link), (ReadResult{0, 4, "TWO\n"}));
    EXPECT_EQ(m_device.errors(), Errors{});
}

TEST_F(MessageExchangeTest, TheSecondOfTwoLinesMayBeTornApart) {
    CoreClient client(port());
    const long link = client.open();
    client.write(link, "ONE?\nTW", 0);
    client.write(link, "O?");
    EXPECT_EQ(client.read(link).data, "ONE\n");
    EXPECT_EQ(client.read(link).data, "TWO\n");
    EXPECT_EQ(m_device.errors(), Errors{});
}

TEST_F(MessageExchangeTest, AnEmptyWriteDoesNothingButMayBringTheEnd) {
    CoreClient client(port());
    const long link = client.open();
    EXPECT_EQ(client.write(link, "").error, 0);
    EXPECT_EQ(m_device.got(), Lines{});
    client.write(link, "A", 0);
    EXPECT_EQ(client.write(link, "").error, 0);
    EXPECT_EQ(m_device.got(), Lines{"A"});
}

TEST_F(MessageExchangeTest, AMessageThatIsTooLongIsDroppedToItsEndAndOneError) {
    CoreClient client(port());
    const long link = client.open();
    for (int i = 0; i < 64; ++i) ASSERT_EQ(client.write(link, std::string(1024, 'x'), 0).error, 0);
    EXPECT_EQ(m_device.errors(), Errors{});
    EXPECT_EQ(client.write(link, "x", 0).error, 0) << "taken, so that the client sends the rest and agrees again";
    EXPECT_EQ(client.write(link, "*RST", 0).error, 0);
    EXPECT_EQ(client.write(link, "TAIL?").error, 0);
    EXPECT_EQ(m_device.errors(), Errors{-363});
    EXPECT_EQ(m_device.got(), Lines{});
    client.write(link, "NAME?");
    EXPECT_EQ(client.read(link).data, "NAME\n");
    EXPECT_EQ(m_device.errors(), Errors{-363});
}

TEST_F(MessageExchangeTest, ALineFeedInsideAMessageThatIsTooLongDoesNotEndIt) {
    CoreClient client(port());
    const long link = client.open();
    for (int i = 0; i < 64; ++i) client.write(link, std::string(1024, 'x'), 0);
    client.write(link, "x\n*RST\n", 0);
    client.write(link, "TAIL?\n");
    EXPECT_EQ(m_device.got(), Lines{});
    EXPECT_EQ(m_device.errors(), Errors{-363});
    client.write(link, "NAME?");
    EXPECT_EQ(client.read(link).data, "NAME\n");
}

TEST_F(MessageExchangeTest, AMessageOfTheLongestLengthIsCarriedOut) {
    CoreClient client(port());
    const long link = client.open();
    for (int i = 0; i < 63; ++i) client.write(link, std::string(1024, 'x'), 0);
    client.write(link, std::string(1024, 'x'));
    ASSERT_EQ(m_device.got().size(), 1U);
    EXPECT_EQ(m_device.got()[0].size(), 65536U);
    EXPECT_EQ(m_device.errors(), Errors{});
}

TEST_F(MessageExchangeTest, AMessageOfOneByteMoreIsDropped) {
    CoreClient client(port());
    const long link = client.open();
    for (int i = 0; i < 64; ++i) client.write(link, std::string(1024, 'x'), 0);
    client.write(link, "x");
    EXPECT_EQ(m_device.got(), Lines{});
    EXPECT_EQ(m_device.errors(), Errors{-363});
}

TEST_F(MessageExchangeTest, AnswersOf64KibibytesAreKeptAndNoMore) {
    CoreClient client(port());
    const long link = client.open();
    const auto ask = [&](std::size_t lastAnswer) {  // after 131 answers of 500 bytes
        std::string messages;
        for (int i = 0; i < 131; ++i) messages += "LONG?\n";
        client.write(link, messages + std::string(lastAnswer - 1, 'x') + "?");
    };
    ask(36);
    ASSERT_EQ(m_device.errors(), Errors{});
    for (int i = 0; i < 131; ++i) EXPECT_EQ(client.read(link).data.size(), 500U);
    EXPECT_EQ(client.read(link).data.size(), 36U);
    ask(37);
    EXPECT_EQ(m_device.errors(), Errors{-430});
    EXPECT_EQ(client.read(link, 100, 10).error, 15);
}

TEST_F(MessageExchangeTest, ADeviceClearEndsAMessageThatIsTooLong) {
    CoreClient client(port());
    const long link = client.open();
    for (int i = 0; i < 65; ++i) client.write(link, std::string(1024, 'x'), 0);
    client.error(device_clear, CoreClient::genericArguments(link));
    client.write(link, "NAME?");
    EXPECT_EQ(client.read(link).data, "NAME\n");
}

TEST_F(MessageExchangeTest, ANewMessageDiscardsAnAnswerThatNobodyFetched) {
    CoreClient client(port());
    const long link = client.open();
    client.write(link, "OLD?\nOLDER?");
    client.write(link, "\n");
    EXPECT_EQ(m_device.errors(), Errors{}) << "an empty line is no message";
    client.write(link, "NEW?");
    EXPECT_EQ(m_device.errors(), Errors{-410});
    EXPECT_EQ(client.read(link), (ReadResult{0, 4, "NEW\n"}));
    client.write(link, "OLD?");
    client.write(link, "COMMAND");
    EXPECT_EQ(client.read(link, 100, 10).error, 15);
    EXPECT_EQ(m_device.errors(), (Errors{-410, -410, -420}));
}

TEST_F(MessageExchangeTest, ANewMessageInPiecesDiscardsAnAnswerThatNobodyFetched) {
    CoreClient client(port());
    const long link = client.open();
    client.write(link, "OLD?");
    client.write(link, "N", 0);
    client.write(link, "E", 0);
    EXPECT_EQ(m_device.errors(), Errors{}) << "it may still be fetched";
    client.write(link, "W?");
    EXPECT_EQ(m_device.errors(), Errors{-410});
    EXPECT_EQ(client.read(link), (ReadResult{0, 4, "NEW\n"}));
}

TEST_F(MessageExchangeTest, AnAnswerFetchedBetweenThePiecesOfTheNextMessageIsNotInterrupted) {
    CoreClient client(port());
    const long link = client.open();
    client.write(link, "OLD?");
    client.write(link, "NE", 0);
    EXPECT_EQ(client.read(link).data, "OLD\n");
    client.write(link, "W?");
    EXPECT_EQ(client.read(link).data, "NEW\n");
    EXPECT_EQ(m_device.errors(), Errors{});
}

TEST_F(MessageExchangeTest, AMessageThatIsTooLongDiscardsAnAnswerThatNobodyFetched) {
    CoreClient client(port());
    const long link = client.open();
    client.write(link, "OLD?");
    for (int i = 0; i < 64; ++i) client.write(link, std::string(1024, 'x'), 0);
    client.write(link, "x?");
    EXPECT_EQ(m_device.errors(), (Errors{-410, -363}));
    EXPECT_EQ(client.read(link, 100, 10).error, 15);
}

TEST_F(MessageExchangeTest, MoreAnswersThanCanBeKeptAreAllDropped) {
    CoreClient client(port());
    const long link = client.open();
    std::string questions;
    for (int i = 0; i < 170; ++i) questions += "LONG?\n";  // of 500 bytes each
    EXPECT_EQ(client.write(link, questions).error, 0);
    EXPECT_EQ(m_device.got().size(), 170U) << "carried out all the same";
    EXPECT_EQ(m_device.errors(), Errors{-430});
    EXPECT_EQ(client.read(link, 100, 10).error, 15);
    client.write(link, "NAME?");
    EXPECT_EQ(client.read(link).data, "NAME\n");
}

TEST_F(MessageExchangeTest, EveryLinkHasItsOwnAnswersAndHalfMessages) {
    CoreClient one(port());
    CoreClient two(port());
    const long linkOne = one.open();
    const long linkTwo = two.open();
    one.write(linkOne, "ON", 0);
    two.write(linkTwo, "TWO?");
    one.write(linkOne, "E?");
    EXPECT_EQ(two.read(linkTwo).data, "TWO\n");
    EXPECT_EQ(one.read(linkOne).data, "ONE\n");
}

TEST_F(MessageExchangeTest, AReadWithNothingToSayTimesOutAndTheDeviceIsTold) {
    CoreClient client(port());
    const long link = client.open();
    EXPECT_EQ(client.read(link, 100, 20), (ReadResult{15, 0, ""}));
    EXPECT_EQ(client.read(link, 100, 0), (ReadResult{15, 0, ""})) << "a time-out of 0 does not wait at all";
    EXPECT_EQ(m_device.errors(), (Errors{-420, -420}));
    client.write(link, "NAME?");
    EXPECT_EQ(client.read(link).data, "NAME\n") << "the link is as good as before";
}

TEST_F(MessageExchangeTest, WhenMemoryRunsOutTheConnectionIsClosedAndOthersGoOn) {
    CoreClient greedy(port());
    CoreClient other(port());
    const long link = other.open();
    greedy.send(device_write, CoreClient::writeArguments(greedy.open(), "HUGE"));
    EXPECT_TRUE(greedy.isClosedByServer());
    other.write(link, "NAME?");
    EXPECT_EQ(other.read(link).data, "NAME\n");
}

TEST_F(MessageExchangeTest, WhenMemoryRunsOutOverACallThatHasWaitedOnlyThatOneFails) {
    CoreClient greedy(port());
    CoreClient other(port());
    const long link = other.open();
    const long greedyLink = greedy.open();
    other.error(device_lock, CoreClient::lockArguments(link));
    greedy.send(device_write,
                CoreClient::writeArguments(greedyLink, "HUGE", CoreClient::kEnd | CoreClient::kWaitLock, 100000));
    EXPECT_FALSE(greedy.receive(20));
    EXPECT_EQ(other.error(device_unlock, CoreClient::linkNumber(link)), 0);
    const auto reply = greedy.receive();
    ASSERT_TRUE(reply);
    EXPECT_EQ(reply->word(0), 9U);
    other.write(link, "NAME?");
    EXPECT_EQ(other.read(link).data, "NAME\n");
}

}  // namespace
}  // namespace kdx::simserver
