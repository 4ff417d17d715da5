#include "link/discovery.h"

#include "base/filedescriptor.h"
#include "link/lanvisa.h"
#include "vxi11/xdr.h"

#include "support/loopbackport.h"
#include "support/scriptedvxi11.h"

#include <gmock/gmock.h>

#include <arpa/inet.h>
#include <netinet/in.h>
#include <poll.h>
#include <sys/socket.h>

#include <array>
#include <atomic>
#include <functional>
#include <thread>

namespace kdx::test {
namespace {

using namespace std::chrono_literals;
using ::testing::ElementsAre;
using ::testing::IsEmpty;

std::string words(std::initializer_list<std::uint32_t> values) {
    std::string bytes;
    for (const std::uint32_t value : values) {
        for (unsigned shift = 32; shift > 0; shift -= 8) bytes += static_cast<char>(value >> (shift - 8));
    }
    return bytes;
}

/// Port mappers at some addresses of this machine, all at one port: each sends what the script makes of a question.
class Mappers {
public:
    using Script = std::function<std::vector<std::string>(const std::string& address, std::uint32_t question)>;

    Mappers(const std::vector<std::string>& addresses, Script script)
        : m_script(std::move(script)), m_thread([this] { serve(); }) {
        for (const std::string& address : addresses) bind(address);
        m_ready = true;
    }
    ~Mappers() {
        m_over = true;
        m_thread.join();
    }
    Mappers(const Mappers&) = delete;
    Mappers& operator=(const Mappers&) = delete;

    [[nodiscard]] std::vector<std::string> found(std::chrono::milliseconds wait = 150ms) const {
        Discovery how;
        how.wait = wait;
        how.portMapperPort = m_port;
        return discoverLanInstruments(how);
    }
    [[nodiscard]] std::string lastQuestion() const { return m_question; }

private:
    struct Socket {
        std::string address;
        FileDescriptor descriptor;
    };

    void bind(const std::string& address) {
        sockaddr_in name{};
        name.sin_family = AF_INET;
        name.sin_port = htons(m_port);
        inet_pton(AF_INET, address.c_str(), &name.sin_addr);
        FileDescriptor socket(::socket(AF_INET, SOCK_DGRAM | SOCK_CLOEXEC | SOCK_NONBLOCK, 0));
        ASSERT_EQ(::bind(socket.number(), reinterpret_cast<const sockaddr*>(&name), sizeof name), 0) << address;
        socklen_t size = sizeof name;
        ::getsockname(socket.number(), reinterpret_cast<sockaddr*>(&name), &size);
        m_port = ntohs(name.sin_port);
        m_sockets.push_back({address, std::move(socket)});
    }
    void serve() {
        while (!m_ready) std::this_thread::yield();
        while (!m_over) {
            for (const Socket& socket : m_sockets) {
                pollfd waited{socket.descriptor.number(), POLLIN, 0};
                if (::poll(&waited, 1, 2) == 1) answer(socket);
            }
        }
    }
    void answer(const Socket& socket) {
        std::array<char, 1000> bytes;
        sockaddr_in client{};
        socklen_t size = sizeof client;
        const ssize_t got = ::recvfrom(socket.descriptor.number(), bytes.data(), bytes.size(), 0,
                                       reinterpret_cast<sockaddr*>(&client), &size);
        if (got < 4) return;
        m_question.assign(bytes.data(), static_cast<std::size_t>(got));
        for (const std::string& datagram : m_script(socket.address, xdrWord(m_question))) {
            ::sendto(socket.descriptor.number(), datagram.data(), datagram.size(), 0,
                     reinterpret_cast<const sockaddr*>(&client), sizeof client);
        }
    }

    Script m_script;
    std::vector<Socket> m_sockets;
    std::uint16_t m_port = 0;
    std::string m_question;
    std::atomic<bool> m_ready = false;
    std::atomic<bool> m_over = false;
    std::thread m_thread;
};

std::string portAnswer(std::uint32_t question, std::uint32_t port) {
    return words({question, 1, 0, 0, 0, 0, port});
}

TEST(Discovery, FindsWhoServesInstruments) {
    const Mappers mappers({"127.0.0.1"}, [](const std::string&, std::uint32_t question) {
        return std::vector{portAnswer(question, 4711), portAnswer(question, 4711)};
    });
    EXPECT_THAT(mappers.found(), ElementsAre("127.0.0.1"));
    const std::string question = mappers.lastQuestion();
    EXPECT_EQ(question.substr(4), words({0, 2, 100000, 2, 3, 0, 0, 0, 0, 0x0607AF, 1, IPPROTO_TCP, 0}));
}

TEST(Discovery, HearsWhoAnswersWhatIsAskedOfEverybody) {
    const Mappers mappers({"127.255.255.255"}, [](const std::string&, std::uint32_t question) {
        return std::vector{portAnswer(question, 4711)};
    });
    EXPECT_EQ(mappers.found().size(), 1U);
}

TEST(Discovery, AnswersThatAreNoneAreNoInstruments) {
    const std::vector<std::function<std::string(std::uint32_t)>> garbage = {
        [](std::uint32_t) { return std::string(); },
        [](std::uint32_t) { return std::string("x"); },
        [](std::uint32_t) { return std::string(1024, '\xFF'); },
        [](std::uint32_t question) { return words({question}); },
        [](std::uint32_t question) { return portAnswer(question + 1, 4711); },
        [](std::uint32_t question) { return portAnswer(question, 0); },
        [](std::uint32_t question) { return portAnswer(question, 65536); },
        [](std::uint32_t question) { return portAnswer(question, 4711).substr(0, 27); },
        [](std::uint32_t question) {
            return words({question, 0, 2, 100000, 2, 3, 0, 0, 0, 0});
        },
        [](std::uint32_t question) {
            return words({question, 1, 1, 0, 0, 0, 4711});
        },
        [](std::uint32_t question) {
            return words({question, 1, 0, 0, 0, 1, 4711});
        },
        [](std::uint32_t question) {
            return words({question, 1, 0, 0, 0xFFFFFFFF, 0, 4711});
        },
    };
    const Mappers mappers({"127.0.0.1"}, [&](const std::string&, std::uint32_t question) {
        std::vector<std::string> datagrams;
        datagrams.reserve(garbage.size());
        for (const auto& make : garbage) datagrams.push_back(make(question));
        return datagrams;
    });
    EXPECT_THAT(mappers.found(), IsEmpty());
}

TEST(Discovery, GarbageHidesNoInstrument) {
    const Mappers mappers({"127.0.0.1"}, [](const std::string&, std::uint32_t question) {
        return std::vector{std::string(1024, '\xFF'), std::string(), portAnswer(question, 1)};
    });
    EXPECT_THAT(mappers.found(), ElementsAre("127.0.0.1"));
}

TEST(Discovery, WaitsAsLongAsItIsToldWhoeverIsThere) {
    Discovery how;
    how.portMapperPort = closedPort();
    how.wait = 300ms;
    const auto begin = std::chrono::steady_clock::now();
    EXPECT_THAT(discoverLanInstruments(how), IsEmpty());
    const auto took = std::chrono::steady_clock::now() - begin;
    EXPECT_GE(took, 300ms);
    EXPECT_LT(took, 2s);
}

TEST(Discovery, EndsWhenItIsToldTo) {
    Discovery how;
    how.portMapperPort = closedPort();
    how.wait = 60s;
    how.stopped = [] { return true; };
    const auto begin = std::chrono::steady_clock::now();
    EXPECT_THAT(discoverLanInstruments(how), IsEmpty());
    EXPECT_LT(std::chrono::steady_clock::now() - begin, 2s);
}

class Identifying : public ::testing::Test {
protected:
    Identification ask() {
        LanOptions options;
        options.portMapperPort = m_device.port();
        options.ioTimeout = 200ms;
        options.answerMargin = 40ms;
        LanVisa visa(options);
        return identify(visa, "TCPIP::127.0.0.1::INSTR");
    }
    ScriptedVxi11 m_device;
};

TEST_F(Identifying, TellsWhatTheInstrumentSays) {
    m_device.answer("MAKER,KDX-X4,1,2.0 \r\n");
    const Identification said = ask();
    EXPECT_EQ(said.text, "MAKER,KDX-X4,1,2.0");
    EXPECT_GE(said.status, 0);
    EXPECT_EQ(m_device.writes().at(0).data, "*IDN?");
    EXPECT_EQ(m_device.destroyed().size(), 1U) << "the instrument is let go";
}

TEST_F(Identifying, ASilentInstrumentIsGivenUp) {
    m_device.on(ScriptedVxi11::kRead, {.kind = Reaction::Kind::Silence});
    const Identification said = ask();
    EXPECT_EQ(said.text, "");
    EXPECT_EQ(said.status, visa::kTimeout);
}

}  // namespace
}  // namespace kdx::test
