#include "link/workervisa.h"

#include <gtest/gtest.h>

#include <condition_variable>
#include <memory>
#include <mutex>
#include <stdexcept>
#include <string_view>
#include <thread>

#include "support/hangingvisa.h"

namespace kdx::test {
namespace {

using Calls = std::vector<std::string>;

/// Waits like somebody who gives up when told to.
class Waiter final : public CallWaiter {
public:
    void waitUntil(const std::function<bool()>& over) override {
        ++waits;
        if (beforeWait) beforeWait();
        while (!givesUp && !over()) {
            std::unique_lock lock(m_mutex);
            m_changed.wait(lock, [this] { return m_woken; });
            m_woken = false;
        }
    }
    void wake() override {
        const std::lock_guard guard(m_mutex);
        m_woken = true;
        m_changed.notify_all();
    }
    std::function<void()> beforeWait;
    bool givesUp = false;
    int waits = 0;

private:
    std::mutex m_mutex;
    std::condition_variable m_changed;
    bool m_woken = false;
};

class WorkerVisaTest : public ::testing::Test {
protected:
    WorkerVisaTest() { visa.setWaiter(&waiter); }
    ~WorkerVisaTest() override {
        slow->goOn();
        visa.setWaiter(nullptr);
    }
    VisaStatus write(std::string_view text) {
        std::int32_t written = 0;
        return visa.viWrite(1, text, written);
    }
    /// The user loses patience as soon as the call hangs.
    void giveUpWhileItHangs(bool abortable) {
        slow->hang(abortable);
        waiter.givesUp = true;
        waiter.beforeWait = [this] { slow->waitForCall(); };
    }
    void bePatientAgain() {
        waiter.givesUp = false;
        waiter.beforeWait = nullptr;
    }

    std::shared_ptr<HangingVisa> slow = std::make_shared<HangingVisa>();
    Waiter waiter;
    WorkerVisa visa{slow};
};

TEST_F(WorkerVisaTest, EveryOperationGivesWhatTheOtherThreadGot) {
    slow->script().answersTo["*IDN?"] = "KDX\n";
    VisaHandle manager = 0;
    VisaHandle session = 0;
    EXPECT_EQ(visa.viOpenDefaultRM(manager), 0);
    EXPECT_GT(manager, 0);
    std::string words;
    EXPECT_EQ(visa.viStatusDesc(manager, 0, words), 0);
    EXPECT_EQ(words, "described");
    EXPECT_EQ(visa.viOpen(manager, "TCPIP::host::INSTR", 0, 0, session), 0);
    EXPECT_GT(session, manager);
    std::int32_t count = 0;
    EXPECT_EQ(visa.viWrite(session, std::string_view("*IDN?"), count), 0);
    EXPECT_EQ(count, 5);
    std::string buffer(10, '.');
    EXPECT_EQ(visa.viRead(session, buffer, count), 0);
    EXPECT_EQ(count, 4);
    EXPECT_EQ(buffer, "KDX\n......") << "what lies behind the answer stays";
    slow->script().closeStatus = visa::kInvalidObject;
    EXPECT_EQ(visa.viClose(session), visa::kInvalidObject);
    EXPECT_EQ(waiter.waits, 6) << "the waiter had every one of them";
}

TEST_F(WorkerVisaTest, TheCallersThreadDoesNotTouchTheInstrument) {
    class NotingVisa final : public Visa {
    public:
        VisaStatus viOpenDefaultRM(VisaHandle&) override { return note(); }
        VisaStatus viStatusDesc(VisaHandle, VisaStatus, std::string&) override { return note(); }
        VisaStatus viOpen(VisaHandle, const std::string&, std::uint32_t, std::uint32_t, VisaHandle&) override {
            return note();
        }
        VisaStatus viWrite(VisaHandle, std::span<const char>, std::int32_t&) override { return note(); }
        VisaStatus viRead(VisaHandle, std::span<char>, std::int32_t&) override { return note(); }
        VisaStatus viClose(VisaHandle) override { return note(); }
        VisaStatus note() {
            threads.push_back(std::this_thread::get_id());
            return visa::kSuccess;
        }
        std::vector<std::thread::id> threads;
    };
    const auto noting = std::make_shared<NotingVisa>();
    {
        WorkerVisa worker(noting);
        std::int32_t count = 0;
        VisaHandle handle = 0;
        worker.viOpenDefaultRM(handle);
        worker.viWrite(1, std::string_view("A"), count);
        worker.viClose(1);
    }
    ASSERT_EQ(noting->threads.size(), 3U);
    EXPECT_EQ(noting->threads[0], noting->threads[1]);
    EXPECT_EQ(noting->threads[1], noting->threads[2]);
    EXPECT_NE(noting->threads[0], std::this_thread::get_id());
}

TEST_F(WorkerVisaTest, ACallThatIsGivenUpIsAbortedAndTheNextOneWorks) {
    giveUpWhileItHangs(true);
    EXPECT_EQ(write("PS"), visa::kAborted);
    slow->goOn();
    bePatientAgain();
    EXPECT_EQ(write("PI"), visa::kSuccess);
    EXPECT_EQ(slow->calls(), (Calls{"write PS", "write PI"}));
}

TEST_F(WorkerVisaTest, ACallThatCannotBeAbortedIsLeftBehindAndTheNextOneWaitsItsTurn) {
    giveUpWhileItHangs(false);
    EXPECT_EQ(write("PS"), visa::kAborted);
    waiter.beforeWait = nullptr;
    EXPECT_EQ(write("PI"), visa::kAborted) << "it can be given up as well";
    EXPECT_EQ(slow->calls(), Calls{"write PS"});
    bePatientAgain();
    waiter.beforeWait = [this] { slow->goOn(); };
    EXPECT_EQ(write("RT"), visa::kSuccess);
    EXPECT_EQ(slow->calls(), (Calls{"write PS", "write RT"})) << "what was given up before it began is not sent";
    EXPECT_EQ(slow->mostAtOnce(), 1);
}

TEST_F(WorkerVisaTest, AnAnswerThatComesTooLateDoesNotReachTheCallersBuffer) {
    slow->script().answers.push_back("late\n");
    giveUpWhileItHangs(false);
    std::string buffer(10, '.');
    std::int32_t count = 7;
    EXPECT_EQ(visa.viRead(1, buffer, count), visa::kAborted);
    bePatientAgain();
    slow->goOn();
    EXPECT_EQ(write("PS"), visa::kSuccess);
    EXPECT_EQ(buffer, "..........");
    EXPECT_EQ(count, 0);
}

TEST_F(WorkerVisaTest, ASessionThatOpensTooLateIsClosedAgain) {
    giveUpWhileItHangs(false);
    VisaHandle session = 0;
    EXPECT_EQ(visa.viOpen(1, "GPIB0::28::INSTR", 0, 0, session), visa::kAborted);
    EXPECT_EQ(session, 0);
    bePatientAgain();
    slow->goOn();
    write("PS");
    EXPECT_EQ(slow->calls(), (Calls{"open GPIB0::28::INSTR", "close", "write PS"}));
}

TEST_F(WorkerVisaTest, ASessionIsClosedAlsoWhenNobodyWaitsForThat) {
    giveUpWhileItHangs(false);
    write("PS");
    waiter.beforeWait = nullptr;
    EXPECT_EQ(visa.viClose(1), visa::kAborted);
    bePatientAgain();
    slow->goOn();
    write("PI");
    EXPECT_EQ(slow->calls(), (Calls{"write PS", "close", "write PI"}));
}

TEST_F(WorkerVisaTest, AtTheEndWhatHangsIsAbortedForTheClosing) {
    giveUpWhileItHangs(false);
    write("PS");
    slow->hang(true);
    visa.setWaiter(nullptr);
    EXPECT_EQ(visa.viClose(1), visa::kSuccess);
    EXPECT_EQ(slow->calls(), (Calls{"write PS", "close"}));
}

TEST_F(WorkerVisaTest, AnExceptionReachesTheCaller) {
    class ThrowingVisa final : public Visa {
    public:
        VisaStatus viOpenDefaultRM(VisaHandle&) override { throw std::runtime_error("no memory"); }
        VisaStatus viStatusDesc(VisaHandle, VisaStatus, std::string&) override { return 0; }
        VisaStatus viOpen(VisaHandle, const std::string&, std::uint32_t, std::uint32_t, VisaHandle&) override {
            return 0;
        }
        VisaStatus viWrite(VisaHandle, std::span<const char>, std::int32_t&) override { return 0; }
        VisaStatus viRead(VisaHandle, std::span<char>, std::int32_t&) override { return 0; }
        VisaStatus viClose(VisaHandle) override { return 0; }
    };
    WorkerVisa worker(std::make_shared<ThrowingVisa>());
    VisaHandle handle = 0;
    EXPECT_THROW(worker.viOpenDefaultRM(handle), std::runtime_error);
    EXPECT_EQ(worker.viClose(1), 0) << "it goes on";
}

}  // namespace
}  // namespace kdx::test
