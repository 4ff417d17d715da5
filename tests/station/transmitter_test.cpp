#include "station/transmitter.h"

#include <gtest/gtest.h>

#include "station/session.h"
#include "station/station.h"
#include "support/linkfixture.h"

namespace kdx::test {
namespace {

/// Writes down what it hears, in one list with what is sent.
class Recorder final : public StepWatcher {
public:
    explicit Recorder(FakeVisa& visa) : m_visa(visa) {}
    void stepGoesOut(const Step& step, std::size_t number, std::size_t total) override {
        const std::string name = step.kind == Step::Kind::Refused ? "refused " + step.key : step.key;
        heard.push_back(name + " " + std::to_string(number) + "/" + std::to_string(total) + " after " +
                        std::to_string(m_visa.written.size()));
        if (onStep) onStep(step);
    }
    void stepLeftOut(const Step& step) override { heard.push_back("left out " + step.key); }
    void stepAnswered(const Step& /*step*/, const std::string& answer) override {
        heard.push_back("answer " + answer.substr(0, answer.find('\n')));
    }
    void stepsEnded() override { heard.emplace_back("end"); }

    Lines heard;
    std::function<void(const Step&)> onStep;

private:
    FakeVisa& m_visa;
};

class TransmitterTest : public ::testing::Test, protected LinkFixture {
protected:
    TransmitterTest() {
        state.InstrumentOnline = true;
        transmitter.setWatcher(&recorder);
    }

    Transmitter transmitter{instrument, params};
    Recorder recorder{visa};
};

TEST_F(TransmitterTest, ReportsEachStepBeforeItIsSentAndCountsWhatSends) {
    const Steps steps = {parameter("PS", "EINS"), {Step::Kind::Refused, "AF2", "x"}, parameter("TA", "1")};
    EXPECT_TRUE(transmitter.run(steps));
    EXPECT_EQ(recorder.heard, (Lines{"PS 1/2 after 0", "refused AF2 0/0 after 1", "TA 2/2 after 1", "end"}));
    EXPECT_EQ(sent(), (Lines{direct("PS=EINS    "), direct("TA=1")}));
}

TEST_F(TransmitterTest, IdentifyGivesTheAnswerAsItWasRead) {
    visa.answersTo["*IDN?"] = "KDX,TEST\n";
    EXPECT_TRUE(transmitter.run({{Step::Kind::Identify}}));
    EXPECT_EQ(recorder.heard, (Lines{" 1/1 after 0", "answer KDX,TEST", "end"}));
    EXPECT_TRUE(clock.sleeps.empty());
}

TEST_F(TransmitterTest, TheRemovalIsRepeatedForEachNetworkThatTheCoderHolds) {
    visa.answersTo[coder("EON PI?")] = "\"1234,5678,9ABC\"\n";
    transmitter.run({{Step::Kind::AskNetworks}, parameter("EON_DEL", ""), parameter("EON_PI", "D3C2")});
    EXPECT_EQ(sent(), (Lines{coder("EON PI?"), direct("EON-DEL=1234"), direct("EON-DEL=5678"), direct("EON-DEL=9ABC"),
                             direct("EON-PI=D3C2")}));
    EXPECT_EQ(recorder.heard.front(), " 1/3 after 0");
    EXPECT_EQ(recorder.heard.back(), "end");
    EXPECT_EQ(recorder.heard[recorder.heard.size() - 2], "EON_PI 5/5 after 4");
}

TEST_F(TransmitterTest, AFailedQuestionStillRemovesOneWithoutAName) {
    visa.readStatus = visa::kTimeout;
    transmitter.run({{Step::Kind::AskNetworks}, parameter("EON_DEL", "")});
    EXPECT_EQ(sent(), (Lines{coder("EON PI?"), direct("EON-DEL=")}));
    EXPECT_EQ(failures.size(), 1U);
}

TEST_F(TransmitterTest, AFailureGoesOnUnlessTheUserStopsIt) {
    visa.writeStatus = visa::kConnectionLost;
    const Steps steps = {parameter("TA", "1"), parameter("TA", "0")};
    EXPECT_TRUE(transmitter.run(steps));
    EXPECT_EQ(failures.size(), 2U);
    stopAtFailure = true;
    sent();
    EXPECT_FALSE(transmitter.run(steps));
    EXPECT_EQ(sent().size(), 1U);
    EXPECT_EQ(failures.size(), 3U);
    EXPECT_FALSE(instrument.isSequenceStopped());  // the next sequence begins anew
}

TEST_F(TransmitterTest, CanBeStoppedFromOutside) {
    recorder.onStep = [this](const Step& step) {
        if (step.value == "2") transmitter.stop();
    };
    EXPECT_FALSE(transmitter.run({parameter("TA", "1"), parameter("TA", "2"), parameter("TA", "3")}));
    EXPECT_EQ(sent(), Lines{direct("TA=1")});
    EXPECT_EQ(recorder.heard.back(), "end");
}

TEST_F(TransmitterTest, ReportsWhatAStopLeavesOut) {
    const Steps steps = {parameter("TA", "1"), parameter("TP", "1"), parameter("MS", "M")};
    recorder.onStep = [this](const Step& step) {
        if (step.key == "TP") transmitter.stop();
    };
    EXPECT_FALSE(transmitter.run(steps));
    EXPECT_EQ(recorder.heard, (Lines{"TA 1/3 after 0", "TP 2/3 after 1", "left out TP", "left out MS", "end"}));
    recorder.heard.clear();
    recorder.onStep = nullptr;
    visa.writeStatus = visa::kTimeout;
    stopAtFailure = true;
    EXPECT_FALSE(transmitter.run(steps));
    EXPECT_EQ(recorder.heard, (Lines{"TA 1/3 after 1", "left out TP", "left out MS", "end"}));
}

TEST_F(TransmitterTest, ClosingClosesTheSessionAndCountsAsNoCommand) {
    EXPECT_TRUE(transmitter.run(closingSteps()));
    EXPECT_EQ(visa.calls, Lines{"viClose 0"});
    EXPECT_EQ(recorder.heard, (Lines{" 0/0 after 0", "end"}));
}

TEST_F(TransmitterTest, ASequenceWithinAnotherEndsWithTheOuterOne) {
    recorder.onStep = [this](const Step& step) {
        if (step.value == "1") transmitter.run({parameter("PTY", "5")});
    };
    transmitter.run({parameter("TA", "1"), parameter("TA", "0")});
    EXPECT_EQ(sent(), (Lines{direct("PTY=05"), direct("TA=1"), direct("TA=0")}));
    EXPECT_EQ(std::count(recorder.heard.begin(), recorder.heard.end(), "end"), 1);
    EXPECT_EQ(recorder.heard.back(), "end");
}

TEST_F(TransmitterTest, AnExceptionEndsTheSequenceToo) {
    recorder.onStep = [](const Step&) { throw std::runtime_error("no"); };
    EXPECT_THROW(transmitter.run({parameter("TA", "1")}), std::runtime_error);
    EXPECT_EQ(recorder.heard.back(), "end");
}

TEST_F(TransmitterTest, RunsWithoutAnybodyListening) {
    transmitter.setWatcher(nullptr);
    EXPECT_TRUE(transmitter.run({parameter("TA", "1")}));
    EXPECT_EQ(sent(), Lines{direct("TA=1")});
}

TEST(SessionTest, SendsADataSetWithoutAWindow) {
    Bench bench;
    bench.folder.copyShipped();
    bench.visa.answersTo["*IDN?"] = "KDX,TEST\n";
    Session session(bench.visa, bench.state, bench.data, bench.captions, bench.clock, [] {});
    bench.state.CurrentDataSet = "2";
    session.load();
    EXPECT_EQ(session.open("TCPIP", "10.0.0.1"), 0);
    EXPECT_TRUE(session.sendOpening());
    session.close();
    EXPECT_EQ(bench.visa.calls[2], "viOpen TCPIP::10.0.0.1::INSTR 0 0");
    EXPECT_EQ(bench.visa.written.front(), "*IDN?");
    EXPECT_GT(bench.visa.written.size(), 30U);
    const std::string network = session.station.otherNetwork.pi;
    EXPECT_EQ(std::count(bench.visa.written.begin(), bench.visa.written.end(), direct("EON-TP=" + network + ",1")), 1);
    EXPECT_EQ(bench.visa.calls.back(), "viClose " + std::to_string(session.instrument.InstrSession));
}

/// The calls of a session that is opened with this status and then ends, closed before or not.
Lines callsAtTheEnd(VisaStatus openStatus, bool closed) {
    Bench bench;
    bench.visa.openStatus = openStatus;
    {
        Session session(bench.visa, bench.state, bench.data, bench.captions, bench.clock, [] {});
        session.open("TCPIP", "10.0.0.1");
        if (closed) session.close();
        bench.visa.calls.erase(bench.visa.calls.begin(), bench.visa.calls.begin() + 3);
    }
    return bench.visa.calls;
}

TEST(SessionTest, ItsEndClosesWhatIsOpenOnce) {
    EXPECT_EQ(callsAtTheEnd(0, false), Lines{"viClose 102"});
    EXPECT_EQ(callsAtTheEnd(0, true), Lines{"viClose 102"});
    EXPECT_EQ(callsAtTheEnd(visa::kTimeout, false), Lines{});
    EXPECT_EQ(callsAtTheEnd(0x3FFF007D, false), Lines{"viClose 102"}) << "closed when it was opened with a warning";
}

TEST(SessionTest, ThatWasNeverOpenedClosesNothing) {
    Bench bench;
    {
        const Session session(bench.visa, bench.state, bench.data, bench.captions, bench.clock, [] {});
    }
    EXPECT_EQ(bench.visa.calls, Lines{});
}

}  // namespace
}  // namespace kdx::test
