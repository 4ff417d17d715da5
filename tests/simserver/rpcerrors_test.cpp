#include "simserver/vxi11fixture.h"
#include "vxi11/rpcrecord.h"

namespace kdx::simserver {
namespace {

using namespace std::string_literals;
using RpcErrorTest = Vxi11Test;

Reply replyTo(RpcClient& client, const std::string& message) {
    client.sendBytes(framed(message));
    auto reply = client.receive();
    EXPECT_TRUE(reply);
    return reply.value_or(Reply{});
}

// A call message with an empty credential and verifier.
std::string message(std::uint32_t rpcVersion, std::uint32_t program, std::uint32_t version, std::uint32_t procedure) {
    std::string bytes = word(77) + word(0) + word(rpcVersion) + word(program) + word(version) + word(procedure);
    for (int i = 0; i < 4; ++i) bytes += word(0);
    return bytes;
}

TEST_F(RpcErrorTest, TheNullProcedureAnswersNothing) {
    CoreClient client(port());
    EXPECT_EQ(client.results(NULLPROC, {}), "");
}

TEST_F(RpcErrorTest, AnotherProgramIsUnavailable) {
    CoreClient client(port());
    const Reply reply = replyTo(client, message(2, DEVICE_ASYNC, 1, 1));
    EXPECT_TRUE(reply.accepted);
    EXPECT_EQ(reply.xid, 77U);
    EXPECT_EQ(reply.status, static_cast<std::uint32_t>(PROG_UNAVAIL));
}

TEST_F(RpcErrorTest, AnotherVersionIsTurnedDownWithTheOneThereIs) {
    CoreClient client(port());
    const Reply reply = replyTo(client, message(2, DEVICE_CORE, 2, 10));
    EXPECT_TRUE(reply.accepted);
    EXPECT_EQ(reply.status, static_cast<std::uint32_t>(PROG_MISMATCH));
    EXPECT_EQ(reply.rest, word(1) + word(1));
}

TEST_F(RpcErrorTest, UnknownProceduresAreUnavailable) {
    CoreClient client(port());
    for (const std::uint32_t procedure : {1U, 9U, 21U, 24U, 27U, 0xFFFFFFFFU}) {
        const Reply reply = replyTo(client, message(2, DEVICE_CORE, 1, procedure));
        EXPECT_TRUE(reply.accepted);
        EXPECT_EQ(reply.status, static_cast<std::uint32_t>(PROC_UNAVAIL)) << procedure;
    }
}

TEST_F(RpcErrorTest, AnotherRpcVersionIsDenied) {
    CoreClient client(port());
    const Reply reply = replyTo(client, message(3, DEVICE_CORE, 1, 10));
    EXPECT_FALSE(reply.accepted);
    EXPECT_EQ(reply.status, static_cast<std::uint32_t>(RPC_MISMATCH));
    EXPECT_EQ(reply.rest, word(2) + word(2));
}

TEST_F(RpcErrorTest, ArgumentsThatAreCutOffAreGarbage) {
    CoreClient client(port());
    const long link = client.open();
    const std::vector<std::pair<std::uint32_t, std::string>> calls{
        {create_link, CoreClient::linkArguments("inst0")},  {device_write, CoreClient::writeArguments(link, "ABC")},
        {device_read, CoreClient::readArguments(link)},     {device_readstb, CoreClient::genericArguments(link)},
        {device_clear, CoreClient::genericArguments(link)}, {device_lock, CoreClient::lockArguments(link)},
        {device_unlock, CoreClient::linkNumber(link)},      {destroy_link, CoreClient::linkNumber(link)},
    };
    for (const auto& [procedure, arguments] : calls) {
        for (std::size_t length = 0; length + 4 <= arguments.size(); length += 4) {
            client.send(procedure, arguments.substr(0, length));
            const auto reply = client.receive();
            ASSERT_TRUE(reply);
            EXPECT_TRUE(reply->accepted);
            EXPECT_EQ(reply->status, static_cast<std::uint32_t>(GARBAGE_ARGS)) << procedure << ", " << length;
        }
    }
    EXPECT_EQ(m_device.got(), std::vector<std::string>{});
    EXPECT_EQ(client.write(link, "A").error, 0) << "the connection and the link go on";
}

TEST_F(RpcErrorTest, ALengthThatPointsPastTheEndIsGarbage) {
    CoreClient client(port());
    const long link = client.open();
    for (const std::uint32_t length : {4U, 0x7FFFFFFFU, 0xFFFFFFFEU, 0xFFFFFFFFU}) {
        client.send(create_link, word(1) + word(0) + word(0) + word(length));
        EXPECT_EQ(client.receive().value_or(Reply{}).status, static_cast<std::uint32_t>(GARBAGE_ARGS)) << length;
        client.send(device_write, CoreClient::linkNumber(link) + word(0) + word(0) + word(8) + word(length));
        EXPECT_EQ(client.receive().value_or(Reply{}).status, static_cast<std::uint32_t>(GARBAGE_ARGS)) << length;
    }
}

TEST_F(RpcErrorTest, CredentialsAreReadOverAndNotAskedFor) {
    CoreClient client(port());
    std::string call = word(5) + word(0) + word(2) + word(DEVICE_CORE) + word(1) + word(create_link);
    call += word(1) + word(8) + "identity" + word(0) + word(0);
    const Reply reply = replyTo(client, call + CoreClient::linkArguments("inst0"));
    EXPECT_EQ(reply.status, static_cast<std::uint32_t>(SUCCESS));
    EXPECT_EQ(reply.word(0), 0U);
}

TEST_F(RpcErrorTest, WhatIsNoCallEndsTheConnection) {
    const std::vector<std::string> nonsense{
        "",
        "abc",
        word(1),
        word(1) + word(1) + word(0),                   // a reply
        word(1) + word(0),                             // a call without a version
        message(2, DEVICE_CORE, 1, 10).substr(0, 24),  // without credentials
        word(1) + word(0) + word(2) + word(DEVICE_CORE) + word(1) + word(10) + word(0) + word(0xFFFFFFFF) + word(0) +
            word(0),  // credentials longer than the message
        "GET / HTTP/1.1\r\n\r\n",
    };
    for (const std::string& bytes : nonsense) {
        CoreClient client(port());
        client.sendBytes(framed(bytes));
        EXPECT_TRUE(client.isClosedByServer()) << ::testing::PrintToString(bytes);
    }
    CoreClient good(port());
    EXPECT_NE(good.open(), 0);
}

TEST_F(RpcErrorTest, ACallMayComeInManyFragmentsAndBytesOneByOne) {
    CoreClient client(port());
    const std::string call = client.callMessage(create_link, CoreClient::linkArguments("inst0"));
    for (std::size_t at = 0; at < call.size(); at += 3) {
        const std::string part = call.substr(at, 3);
        std::string fragment = framed(part);
        if (at + 3 < call.size()) fragment[0] = 0;  // not the last one
        for (const char byte : fragment) client.sendBytes({&byte, 1});
    }
    const auto reply = client.receive();
    ASSERT_TRUE(reply);
    EXPECT_EQ(reply->word(0), 0U);
}

TEST_F(RpcErrorTest, SeveralCallsInOnePieceAreAllAnswered) {
    CoreClient client(port());
    std::string bytes;
    for (int i = 0; i < 50; ++i) bytes += framed(client.callMessage(NULLPROC, {}));
    client.sendBytes(bytes);
    for (std::uint32_t xid = 1; xid <= 50; ++xid) EXPECT_EQ(client.receive().value_or(Reply{}).xid, xid);
}

TEST_F(RpcErrorTest, AnOversizeRecordEndsTheConnectionAtOnce) {
    CoreClient client(port());
    client.sendBytes("\x80\x10\x00\x01"s);  // one byte more than a MiB; none of it needs to come
    EXPECT_TRUE(client.isClosedByServer());
    CoreClient endless(port());
    std::string fragment = framed(std::string(65536, 'x'));
    fragment[0] = 0;
    for (int i = 0; i < 17; ++i) endless.sendBytes(fragment);
    EXPECT_TRUE(endless.isClosedByServer());
}

TEST_F(RpcErrorTest, AClientThatOnlyEndsItsSendingStillGetsItsReplies) {
    CoreClient client(port());
    const auto xid = client.send(create_link, CoreClient::linkArguments("inst0"));
    client.endSending();
    EXPECT_EQ(client.receive().value_or(Reply{}).xid, xid);
    EXPECT_TRUE(client.isClosedByServer());
    CoreClient others(port());
    for (int i = 0; i < 3; ++i) EXPECT_EQ(others.createLink("inst0").error, 0) << "its link is gone";
}

TEST_F(RpcErrorTest, AClientThatNeverFetchesItsRepliesHoldsUpNobody) {
    CoreClient deaf(port());
    const long link = deaf.open();
    std::thread sender([&] {  // blocks as soon as the server takes no more
        std::string calls;
        for (int i = 0; i < 100; ++i) {
            calls += framed(deaf.callMessage(device_write, CoreClient::writeArguments(link, "LONG?")));
            calls += framed(deaf.callMessage(device_read, CoreClient::readArguments(link)));
        }
        for (int i = 0; i < 300; ++i) deaf.sendBytes(calls);
    });
    CoreClient other(port());
    const long otherLink = other.open();
    for (int i = 0; i < 20; ++i) {
        other.write(otherLink, "NAME?");
        EXPECT_EQ(other.read(otherLink).data, "NAME\n");
    }
    m_server->stop();
    m_thread.join();
    m_server.reset();  // ends the connection, and with it the sender
    sender.join();
    m_server = std::make_unique<Vxi11Server>(m_device);
    m_thread = std::thread([this] { m_server->run(); });
}

}  // namespace
}  // namespace kdx::simserver
