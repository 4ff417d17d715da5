#include "link/lanvisatest.h"

#include <dlfcn.h>
#include <netdb.h>

#include <atomic>
#include <cstring>
#include <thread>

namespace kdx::test {

/// While set, the name service keeps silent about the host below, as servers that are down do.
std::atomic<bool> nameServiceIsSilent = false;
std::atomic<int> lookupsUnderWay = 0;
std::atomic<int> questions = 0;  ///< that went to the name service
constexpr const char* kSlowHost = "slow.invalid";

namespace {

using namespace std::chrono_literals;

class NameServiceTest : public LanVisaTest {
protected:
    // No thread of the test may outlive it.
    ~NameServiceTest() override {
        nameServiceIsSilent = false;
        while (lookupsUnderWay > 0) std::this_thread::sleep_for(1ms);
    }
};

TEST_F(NameServiceTest, ASilentQuestionCanBeAborted) {
    nameServiceIsSilent = true;
    useTimes(60s, 2s);
    std::thread other([this, before = questions.load()] {
        while (questions == before) std::this_thread::yield();
        visa->setAborting(true);
    });
    const auto start = std::chrono::steady_clock::now();
    EXPECT_EQ(open("TCPIP::slow.invalid::INSTR"), visa::kAborted);
    EXPECT_LT(std::chrono::steady_clock::now() - start, kBounded);
    other.join();
    visa->setAborting(false);
    EXPECT_EQ(open(), visa::kSuccess);
}

TEST_F(NameServiceTest, SilenceIsGivenUpAfterTheConnectTimeOut) {
    nameServiceIsSilent = true;
    useShortTimes();
    const auto start = std::chrono::steady_clock::now();
    EXPECT_EQ(open("TCPIP::slow.invalid::INSTR"), visa::kResourceNotFound);
    const auto taken = std::chrono::steady_clock::now() - start;
    EXPECT_GE(taken, 150ms);
    EXPECT_LT(taken, kBounded);
    EXPECT_EQ(open(), visa::kSuccess) << "the next session does not wait for the old question";
}

TEST_F(NameServiceTest, ANameThatIsKnownLeadsToTheDevice) {
    EXPECT_EQ(open("TCPIP::localhost::INSTR"), visa::kSuccess);
}

TEST_F(NameServiceTest, AnAddressInFiguresAsksNobody) {
    questions = 0;
    EXPECT_EQ(open("TCPIP::127.0.0.1::INSTR"), visa::kSuccess);
    EXPECT_EQ(questions, 0);
    EXPECT_EQ(open("TCPIP::localhost::INSTR"), visa::kSuccess);
    EXPECT_EQ(questions, 1);
}

}  // namespace
}  // namespace kdx::test

/// Takes the place of the system's own, which it asks for everything but the silent host.
extern "C" int getaddrinfo(const char* host, const char* service, const addrinfo* hints, addrinfo** result) {
    using namespace kdx::test;
    const bool numeric = hints != nullptr && (hints->ai_flags & AI_NUMERICHOST) != 0;
    if (!numeric) ++questions;
    if (!numeric && host != nullptr && std::strcmp(host, kSlowHost) == 0) {
        ++lookupsUnderWay;
        // Ten seconds at most: the test fails by then.
        for (int i = 0; i < 1000 && nameServiceIsSilent; ++i)
            std::this_thread::sleep_for(std::chrono::milliseconds(10));
        --lookupsUnderWay;
        return EAI_AGAIN;
    }
    static const auto theSystems = reinterpret_cast<decltype(&getaddrinfo)>(dlsym(RTLD_NEXT, "getaddrinfo"));
    return theSystems(host, service, hints, result);
}
