#include "simserver/vxi11server.h"

#include "simserver/vxi11fixture.h"

#include <unistd.h>

#include <csignal>
#include <system_error>

namespace kdx::simserver {
namespace {

using Lines = std::vector<std::string>;
using Vxi11ServerTest = Vxi11Test;

struct NameCase {
    const char* title;
    const char* device;
    long error;
};
void PrintTo(const NameCase& value, std::ostream* out) {
    *out << '"' << value.device << '"';
}
class Vxi11DeviceName : public Vxi11Test, public ::testing::WithParamInterface<NameCase> {};

TEST_P(Vxi11DeviceName, IsAcceptedOrNot) {
    CoreClient client(port());
    const Create_LinkResp link = client.createLink(GetParam().device);
    EXPECT_EQ(link.error, GetParam().error);
    if (link.error == 0) {
        EXPECT_EQ(client.write(link.lid, "NAME?").error, 0);
        EXPECT_EQ(client.read(link.lid).data, "NAME\n");
    }
}

INSTANTIATE_TEST_SUITE_P(Names, Vxi11DeviceName,
                         ::testing::Values(NameCase{"Usual", "inst0", 0}, NameCase{"UpperCase", "INST0", 0},
                                           NameCase{"LowestGpib", "gpib0,0", 0}, NameCase{"Gpib", "gpib0,28", 0},
                                           NameCase{"HighestGpib", "GPIB0,30", 0}, NameCase{"TooHigh", "gpib0,31", 3},
                                           NameCase{"NoAddress", "gpib0,", 3}, NameCase{"BusItself", "gpib0", 3},
                                           NameCase{"OtherBus", "gpib1,28", 3}, NameCase{"Negative", "gpib0,-1", 3},
                                           NameCase{"SecondaryAddress", "gpib0,28,1", 3},
                                           NameCase{"OtherInstrument", "inst1", 3}, NameCase{"Empty", "", 3}),
                         [](const auto& tested) { return tested.param.title; });

TEST_F(Vxi11ServerTest, ADeviceNameDoesNotEndAtANul) {
    CoreClient client(port());
    EXPECT_EQ(client.createLink(std::string("inst0\0x", 7)).error, 3);
    EXPECT_EQ(client.createLink(std::string("inst0\0", 6)).error, 3);
}

TEST_F(Vxi11ServerTest, TheGeneratedClientCallsWork) {
    sockaddr_in name{};
    name.sin_family = AF_INET;
    name.sin_port = htons(port());  // known, so that no port mapper is asked
    int socket = connectTo(port());
    CLIENT* client = clnttcp_create(&name, DEVICE_CORE, DEVICE_CORE_VERSION, &socket, 0, 0);
    ASSERT_NE(client, nullptr);
    std::string device = "inst0";
    const Create_LinkResp* link = create_link_1({1, FALSE, 0, device.data()}, client);
    ASSERT_NE(link, nullptr);
    EXPECT_EQ(link->error, 0);
    EXPECT_EQ(link->abortPort, m_server->abortPort());
    EXPECT_EQ(link->maxRecvSize, 1024U);
    const long lid = link->lid;
    std::string question = "NAME?";
    const Device_WriteResp* write = device_write_1({lid, 1000, 0, 8, {5, question.data()}}, client);
    ASSERT_NE(write, nullptr);
    EXPECT_EQ(write->error, 0);
    EXPECT_EQ(write->size, 5U);
    Device_ReadResp* read = device_read_1({lid, 100, 1000, 0, 0, 0}, client);
    ASSERT_NE(read, nullptr);
    EXPECT_EQ(std::string(read->data.data_val, read->data.data_len), "NAME\n");
    xdr_free(reinterpret_cast<xdrproc_t>(reinterpret_cast<void (*)()>(xdr_Device_ReadResp)), read);
    const Device_Error* destroyed = destroy_link_1(lid, client);
    ASSERT_NE(destroyed, nullptr);
    EXPECT_EQ(destroyed->error, 0);
    clnt_destroy(client);
    ::close(socket);
}

TEST_F(Vxi11ServerTest, AWriteOfMoreThanTheAnnouncedSizeIsAParameterError) {
    CoreClient client(port());
    const long link = client.open();
    EXPECT_EQ(client.write(link, std::string(1024, 'x')).error, 0);
    EXPECT_EQ(client.write(link, std::string(1025, 'x')).error, 5);
    EXPECT_EQ(m_device.got(), Lines{std::string(1024, 'x')});
}

TEST_F(Vxi11ServerTest, AReadSaysWhyItStopped) {
    CoreClient client(port());
    const long link = client.open();
    const auto answer = [&] { client.write(link, "AB,CD?"); };  // brings "AB,CD" and a line feed
    answer();
    EXPECT_EQ(client.read(link, 100), (ReadResult{0, 4, "AB,CD\n"})) << "END";
    answer();
    EXPECT_EQ(client.read(link, 4), (ReadResult{0, 1, "AB,C"})) << "requested count";
    EXPECT_EQ(client.read(link, 2), (ReadResult{0, 1 | 4, "D\n"})) << "count and END";
    answer();
    EXPECT_EQ(client.read(link, 100, 1000, CoreClient::kTermChar, ','), (ReadResult{0, 2, "AB,"})) << "character";
    EXPECT_EQ(client.read(link, 3, 1000, CoreClient::kTermChar, '\n'), (ReadResult{0, 1 | 2 | 4, "CD\n"})) << "all";
    answer();
    EXPECT_EQ(client.read(link, 2, 1000, CoreClient::kTermChar, ','), (ReadResult{0, 1, "AB"}));
    EXPECT_EQ(client.read(link, 100, 1000, 0, 'C'), (ReadResult{0, 4, ",CD\n"})) << "character without its flag";
}

TEST_F(Vxi11ServerTest, AnAnswerMayBeFetchedInPieces) {
    CoreClient client(port());
    const long link = client.open();
    client.write(link, "LONG?");
    std::string got;
    ReadResult piece;
    do {
        piece = client.read(link, 60);
        ASSERT_EQ(piece.error, 0);
        got += piece.data;
    } while ((piece.reason & 4) == 0);
    EXPECT_EQ(got, std::string(499, 'x') + "\n");
}

TEST_F(Vxi11ServerTest, AReadOfNothingComesBackAtOnce) {
    CoreClient client(port());
    EXPECT_EQ(client.read(client.open(), 0, 100000), (ReadResult{0, 1, ""}));
}

TEST_F(Vxi11ServerTest, AReadWaitsForAnAnswerThatComesLater) {
    CoreClient client(port());
    const long link = client.open();
    const auto read = client.send(device_read, CoreClient::readArguments(link, 100, 0xFFFFFFFF));
    EXPECT_FALSE(client.receive(20)) << "parked";
    const auto write = client.send(device_write, CoreClient::writeArguments(link, "NAME?"));
    const auto first = client.receive();
    const auto second = client.receive();
    ASSERT_TRUE(first && second);
    EXPECT_EQ(first->xid, write);
    EXPECT_EQ(second->xid, read);
    EXPECT_EQ(CoreClient::readResult(second->rest), (ReadResult{0, 4, "NAME\n"}));
}

TEST_F(Vxi11ServerTest, AClientThatWaitsDoesNotHoldUpAnother) {
    CoreClient waiting(port());
    waiting.send(device_read, CoreClient::readArguments(waiting.open(), 100, 100000));
    CoreClient half(port());
    half.sendBytes(std::string_view("\x80\x00", 2));  // and then nothing
    CoreClient other(port());
    const long link = other.open();
    other.write(link, "NAME?");
    EXPECT_EQ(other.read(link).data, "NAME\n");
}

TEST_F(Vxi11ServerTest, TheStatusByteTellsOfAMessageToFetch) {
    CoreClient client(port());
    const long link = client.open();
    const auto status = [&] {
        const std::string bytes = client.results(device_readstb, CoreClient::genericArguments(link));
        const XdrDecoded<Device_ReadStbResp> read(bytes, xdr_Device_ReadStbResp);
        EXPECT_EQ(read->error, 0);
        return static_cast<int>(read->stb);
    };
    EXPECT_EQ(status(), 0x24);
    client.write(link, "NAME?");
    EXPECT_EQ(status(), 0x34);
    client.read(link);
    EXPECT_EQ(status(), 0x24);
}

TEST_F(Vxi11ServerTest, ADeviceClearEmptiesBothBuffersAndReachesTheDevice) {
    CoreClient client(port());
    const long link = client.open();
    client.write(link, "NAME?");
    client.write(link, "HALF", 0);
    EXPECT_EQ(client.error(device_clear, CoreClient::genericArguments(link)), 0);
    EXPECT_EQ(m_device.clears, 1);
    EXPECT_EQ(client.read(link, 100, 10).error, 15);
    client.write(link, "NEXT?");
    EXPECT_EQ(client.read(link).data, "NEXT\n");
    EXPECT_EQ(m_device.got(), (Lines{"NAME?", "NEXT?"}));
}

TEST_F(Vxi11ServerTest, ADeviceClearLeavesOtherLinksAlone) {
    CoreClient one(port());
    CoreClient two(port());
    const long linkOne = one.open();
    const long linkTwo = two.open();
    one.write(linkOne, "NAME?");
    two.error(device_clear, CoreClient::genericArguments(linkTwo));
    EXPECT_EQ(one.read(linkOne).data, "NAME\n");
}

TEST_F(Vxi11ServerTest, RemoteAndLocalAreAccepted) {
    CoreClient client(port());
    const long link = client.open();
    EXPECT_EQ(client.error(device_remote, CoreClient::genericArguments(link)), 0);
    EXPECT_EQ(client.error(device_local, CoreClient::genericArguments(link)), 0);
    EXPECT_EQ(m_device.got(), Lines{});
}

TEST_F(Vxi11ServerTest, ServiceRequestsMayBeEnabledThoughNoneCome) {
    CoreClient client(port());
    const long link = client.open();
    for (const std::uint32_t enable : {1U, 0U}) {
        EXPECT_EQ(client.error(device_enable_srq, CoreClient::linkNumber(link) + word(enable) + word(0)), 0);
        EXPECT_EQ(client.error(device_enable_srq, CoreClient::linkNumber(link + 1) + word(enable) + word(0)), 4);
    }
    client.send(device_enable_srq, CoreClient::linkNumber(link) + word(1) + word(0xFFFFFFFF));
    EXPECT_EQ(client.receive().value_or(Reply{}).status, static_cast<std::uint32_t>(GARBAGE_ARGS));
}

TEST_F(Vxi11ServerTest, WhatTheInstrumentCannotDoIsNotSupported) {
    CoreClient client(port());
    const long number = client.open();
    EXPECT_EQ(client.error(device_trigger, CoreClient::genericArguments(number)), 8);
    EXPECT_EQ(m_device.got(), Lines{}) << "nothing that would queue an error";
    const std::string link = CoreClient::linkNumber(number);
    EXPECT_EQ(client.error(create_intr_chan, word(1) + word(2) + word(3) + word(1) + word(0)), 8);
    EXPECT_EQ(client.error(destroy_intr_chan, {}), 8);
    const std::string answer =
        client.results(device_docmd, link + word(0) + word(0) + word(0) + word(0x20000) + word(1) + word(1) + word(0));
    EXPECT_EQ(answer, word(8) + word(0)) << "the error, and no data";
}

TEST_F(Vxi11ServerTest, ALinkThatIsNotThereIsInvalidForEveryProcedure) {
    CoreClient client(port());
    const long closed = client.open();
    EXPECT_EQ(client.error(destroy_link, CoreClient::linkNumber(closed)), 0);
    for (const long link : {closed, 0L, 99L, -1L}) {
        EXPECT_EQ(client.write(link, "A").error, 4);
        EXPECT_EQ(client.write(link, std::string(2000, 'x')).error, 4);
        EXPECT_EQ(client.read(link).error, 4);
        for (const auto procedure : {device_readstb, device_trigger, device_clear, device_remote, device_local}) {
            EXPECT_EQ(client.error(procedure, CoreClient::genericArguments(link)), 4) << procedure;
        }
        EXPECT_EQ(client.error(device_lock, CoreClient::lockArguments(link)), 4);
        EXPECT_EQ(client.error(device_unlock, CoreClient::linkNumber(link)), 4);
        EXPECT_EQ(client.error(destroy_link, CoreClient::linkNumber(link)), 4);
    }
    EXPECT_EQ(m_device.got(), Lines{});
}

TEST_F(Vxi11ServerTest, ALinkOfAnotherConnectionIsInvalid) {
    CoreClient owner(port());
    CoreClient stranger(port());
    const long link = owner.open();
    EXPECT_EQ(stranger.write(link, "A").error, 4);
    EXPECT_EQ(stranger.error(destroy_link, CoreClient::linkNumber(link)), 4);
    EXPECT_EQ(owner.write(link, "A").error, 0);
}

TEST_F(Vxi11ServerTest, LinksAreLimitedAndFreedAgain) {
    CoreClient client(port());
    const long first = client.open();
    client.open();
    client.open();
    EXPECT_EQ(client.createLink("inst0").error, 9);
    client.error(destroy_link, CoreClient::linkNumber(first));
    EXPECT_EQ(client.createLink("inst0").error, 0);
}

TEST_F(Vxi11ServerTest, TheTraceTellsWhatHappensOnALink) {
    CoreClient client(port());
    const long link = client.open();
    client.write(link, "A\x01?");
    client.error(device_clear, CoreClient::genericArguments(link));
    client.error(destroy_link, CoreClient::linkNumber(link));
    EXPECT_EQ(trace(), (Lines{"link 1 opened: inst0", "link 1 < A\\x01?", "link 1 > A\\x01\\n", "link 1 clear",
                              "link 1 closed"}));
}

TEST_F(Vxi11ServerTest, AThousandClientsInTurnLeaveNothingBehind) {
    for (int i = 0; i < 1000; ++i) {
        CoreClient client(port());
        const long link = client.open();
        ASSERT_NE(link, 0);
        client.error(destroy_link, CoreClient::linkNumber(link));
    }
}

TEST_F(Vxi11ServerTest, MoreClientsThanTheLimitWaitForTheirTurn) {
    std::vector<std::unique_ptr<CoreClient>> clients;
    for (int i = 0; i < 128; ++i) {
        clients.push_back(i < 96 ? std::make_unique<CoreClient>(port()) : CoreClient::elsewhere(port()));
        clients.back()->results(NULLPROC, {});
    }
    const auto late = CoreClient::elsewhere(port());
    const auto xid = late->send(NULLPROC, {});
    EXPECT_FALSE(late->receive(20));
    clients.pop_back();
    const auto reply = late->receive();
    ASSERT_TRUE(reply);
    EXPECT_EQ(reply->xid, xid);
}

TEST(Vxi11Server, StopBeforeRunEndsItAtOnce) {
    FakeDevice device;
    Vxi11Server server(device);
    server.stop();
    server.run();
}

TEST(Vxi11Server, CanBeStoppedByASignalHandler) {
    static Vxi11Server* toStop = nullptr;
    FakeDevice device;
    Vxi11Server server(device);
    toStop = &server;
    struct sigaction action {};
    struct sigaction former {};
    action.sa_handler = [](int) { toStop->stop(); };
    ::sigaction(SIGUSR1, &action, &former);
    const auto runner = ::pthread_self();
    std::thread killer([runner] { ::pthread_kill(runner, SIGUSR1); });
    server.run();
    killer.join();
    ::sigaction(SIGUSR1, &former, nullptr);
    toStop = nullptr;
}

TEST(Vxi11Server, AnAddressOrPortThatCannotBeHadIsAnError) {
    FakeDevice device;
    EXPECT_THROW(Vxi11Server(device, {.bindAddress = "not an address"}), std::system_error);
    EXPECT_THROW(Vxi11Server(device, {.bindAddress = "192.0.2.1"}), std::system_error);
    const Vxi11Server first(device);
    EXPECT_THROW(Vxi11Server(device, {.port = first.corePort()}), std::system_error);
}

TEST(Vxi11Server, ARestartGetsTheSamePortAtOnce) {
    FakeDevice device;
    unsigned short port = 0;
    {
        Vxi11Server server(device);
        port = server.corePort();
        std::thread thread([&] { server.run(); });
        CoreClient client(port);
        client.open();
        server.stop();
        thread.join();
    }
    EXPECT_EQ(Vxi11Server(device, {.port = port}).corePort(), port);
}

}  // namespace
}  // namespace kdx::simserver
