#include <gtest/gtest.h>

#include <QListWidget>

#include <filesystem>
#include <map>
#include <thread>

#include "support/kdxsimtest.h"

namespace kdx::test {
namespace {

const QString kLost = QStringLiteral("Fehler: %1").arg(visa::kConnectionLost);
const QString kTimedOut = QStringLiteral("Fehler: %1").arg(visa::kTimeout);

/// Short, but long enough for an instrument that does answer on a machine with much to do.
LanOptions shortTimes() {
    LanOptions options;
    options.ioTimeout = std::chrono::milliseconds(200);
    options.answerMargin = std::chrono::milliseconds(50);
    return options;
}

/// An instrument that goes away, or falls silent, while the program works with it.
class BrokenLinkTest : public KdxSimTest {
protected:
    /// The instrument loses its power before the n-th command from now goes out.
    void killBeforeCommand(int n) {
        watched->beforeWrite = [this, n](const std::string&) mutable {
            if (--n == 0) sim.kill();
        };
    }
    void killBeforeTheNextRead() {
        watched->beforeRead = [this] { sim.kill(); };
    }
    /// Any count of boxes may show while it is done; gives those that did.
    std::vector<ScriptedDialogs::Shown> boxesOf(const std::function<void()>& action) {
        dialogs.shown.clear();
        dialogs.expectedMessages = 1000;
        action();
        dialogs.expectedMessages = 0;
        return std::exchange(dialogs.shown, {});
    }
    static void expectInterfaceErrors(const std::vector<ScriptedDialogs::Shown>& boxes, const QString& boxText,
                                      bool offersStop) {
        for (const auto& box : boxes) {
            EXPECT_EQ(box.icon, Dialogs::Icon::Critical);
            EXPECT_EQ(box.title, QStringLiteral("Interface Error"));
            EXPECT_EQ(box.text, boxText);
            EXPECT_EQ(box.offersStop, offersStop);
        }
    }
    /// What the user does when the instrument is back. Every command must reach it, without any box.
    void restartAndOpenAgain() {
        watched->beforeWrite = nullptr;
        watched->beforeRead = nullptr;
        click("GTL_Taste");
        EXPECT_FALSE(find("SSTab1")->isEnabled());
        EXPECT_TRUE(find("INIT_Taste")->isEnabled());
        sim.kill();
        sim.start();
        takeTraffic();
        openSession();
        EXPECT_TRUE(find("SSTab1")->isEnabled());
        EXPECT_EQ(window->windowTitle().left(11), QStringLiteral("KDX,KDX-X4,"));
        const auto passed = takeTraffic();
        EXPECT_EQ(failures(passed), 0);
        EXPECT_EQ(commands(passed).size(), m_commandsOfAnOpening);
        expectTheInstrumentHasTheDataSet();
    }
    /// The instrument asked against the file.
    void expectTheInstrumentHasTheDataSet() {
        const auto stored = [this](const char* key) { return data.ReadIni("RDS", key, dataSetFile("1")); };
        EXPECT_EQ(ask("PS").substr(0, stored("PS").size()), stored("PS"));
        EXPECT_EQ(ask("PI"), stored("PI"));
        EXPECT_EQ(ask("RT"), stored("RTA"));
        EXPECT_EQ(ask("MS"), stored("MS"));
        EXPECT_EQ(ask("GS") + ',', stored("GR_FOLGE"));
    }
    /// Starts both, opens the session and counts what that takes.
    void startAndOpen(LanOptions options = {}) {
        startBoth({}, options);
        openSession();
        const auto passed = takeTraffic();
        ASSERT_EQ(failures(passed), 0);
        m_commandsOfAnOpening = commands(passed).size();
        ASSERT_GT(m_commandsOfAnOpening, 30U);
        expectTheInstrumentHasTheDataSet();
    }
    /// Every file of the data folder but the log, with its content.
    [[nodiscard]] std::map<std::string, std::string> files() const {
        std::map<std::string, std::string> found;
        for (const auto& entry : std::filesystem::directory_iterator(folder.data())) {
            const std::string name = entry.path().filename().string();
            if (entry.is_regular_file() && name != kCommandLog) found[name] = folder.read(name);
        }
        return found;
    }
    void startCycling() {
        for (int i = 0; i < 3; ++i) addMessage(i, i, i, 0, i, false);
        click("optMultiMessage");
        click("TMC_Senden_Taste");
        time->advance(std::chrono::milliseconds(1500));
        ASSERT_EQ(ask("8A-N"), "1");
        takeTraffic();
    }

private:
    std::size_t m_commandsOfAnOpening = 0;
};

TEST_F(BrokenLinkTest, ALossInTheMiddleOfADataSetShowsABoxWithAWayOutForEachFailure) {
    startAndOpen();
    const auto before = files();
    killBeforeCommand(10);
    const auto boxes = boxesOf([this] { click("Btn_SetRdsStereo"); });
    const auto passed = takeTraffic();
    EXPECT_EQ(boxes.size(), static_cast<std::size_t>(failures(passed)));
    // Nine commands went through; all others, and the one question, fail.
    EXPECT_EQ(boxes.size(), commands(passed).size() - 9 + 1);
    EXPECT_GT(boxes.size(), 15U);
    expectInterfaceErrors(boxes, kLost, true);
    EXPECT_EQ(files(), before);
    restartAndOpenAgain();
    EXPECT_EQ(files(), before);
}

TEST_F(BrokenLinkTest, TheWayOutStopsTheRestOfADataSet) {
    startAndOpen();
    const auto before = files();
    const std::size_t logged = folder.read(kCommandLog).size();
    killBeforeCommand(10);
    dialogs.stopAtFailure = true;
    const auto boxes = boxesOf([this] { click("Btn_SetRdsStereo"); });
    expectInterfaceErrors(boxes, kLost, true);
    EXPECT_EQ(boxes.size(), 1U);
    const auto passed = takeTraffic();
    EXPECT_EQ(commands(passed).size(), 10U);
    EXPECT_EQ(passed.back().kind, Traffic::Kind::Written) << "nothing is logged or asked after it";
    EXPECT_GT(folder.read(kCommandLog).size(), logged) << "what was tried is in the log";
    EXPECT_EQ(files(), before);
    dialogs.stopAtFailure = false;
    restartAndOpenAgain();
}

TEST_F(BrokenLinkTest, ALossWhileTheSessionOpensCanBeEndedAtTheFirstBox) {
    startAndOpen();
    click("GTL_Taste");
    killBeforeCommand(20);
    dialogs.stopAtFailure = true;
    const auto boxes = boxesOf([this] { openSession(); });
    EXPECT_EQ(boxes.size(), 1U);
    expectInterfaceErrors(boxes, kLost, true);
    EXPECT_EQ(commands(takeTraffic()).size(), 20U);
    EXPECT_TRUE(find("SSTab1")->isEnabled()) << "the session counts as open: Local closes it";
    dialogs.stopAtFailure = false;
    restartAndOpenAgain();
}

TEST_F(BrokenLinkTest, AfterStoppingASequenceTheNextCommandIsTriedAgain) {
    startAndOpen();
    killBeforeCommand(1);
    dialogs.stopAtFailure = true;
    EXPECT_EQ(boxesOf([this] { click("Btn_SetRdsStereo"); }).size(), 1U);
    const auto boxes = boxesOf([this] { click("Store_Taste_0"); });
    EXPECT_EQ(boxes.size(), 1U);
    expectInterfaceErrors(boxes, kLost, false);
}

TEST_F(BrokenLinkTest, ALossBetweenAQuestionAndItsAnswerFailsTheRead) {
    startAndOpen();
    killBeforeTheNextRead();
    const auto boxes = boxesOf([this] { click("Command5"); });
    EXPECT_EQ(boxes.size(), 1U);
    expectInterfaceErrors(boxes, kLost, false);
    const auto passed = takeTraffic();
    EXPECT_EQ(failures(passed), 1);
    EXPECT_EQ(passed.back().kind, Traffic::Kind::Logged);
    restartAndOpenAgain();
    click("Command5");
    EXPECT_EQ(failures(takeTraffic()), 0);
}

TEST_F(BrokenLinkTest, ALossWhileAnAnswerIsWaitedForEndsTheWait) {
    startAndOpen();  // the usual time-outs: they must not have to pass
    std::jthread powerSwitch;
    watched->beforeRead = [&] {
        sim.hang();
        powerSwitch = std::jthread([this] { sim.killFromOutside(); });
    };
    const auto boxes = boxesOf([this] { click("Command5"); });
    EXPECT_EQ(boxes.size(), 1U);
    expectInterfaceErrors(boxes, kLost, false);
    restartAndOpenAgain();
}

TEST_F(BrokenLinkTest, TheQuestionsOfOneButtonCanBeStopped) {
    startAndOpen();
    sim.kill();
    dialogs.stopAtFailure = true;
    for (const char* button : {"Command1", "Command4", "Command19"}) {
        EXPECT_EQ(boxesOf([&] { click(button); }).size(), 1U) << button;
    }
}

TEST_F(BrokenLinkTest, ALossWhileMessagesCycleFailsEveryTickUntilItIsStopped) {
    startAndOpen();
    startCycling();
    sim.kill();
    for (int tick = 0; tick < 3; ++tick) {
        const auto boxes = boxesOf([this] { time->advance(std::chrono::seconds(1)); });
        EXPECT_EQ(boxes.size(), 2U) << "the announcement and the message";
        expectInterfaceErrors(boxes, kLost, true);
    }
    EXPECT_EQ(find<QListWidget>("TMC_List")->currentRow(), 1) << "the cycle goes on";
    const std::string stored = data.ReadIni("RDS", "TMC", dataSetFile("1"));
    EXPECT_EQ(stored, "02," + find<QListWidget>("TMC_List")->currentItem()->text().right(10).toStdString());
    click("Stop_Timer");
    EXPECT_TRUE(boxesOf([this] { time->advance(std::chrono::seconds(10)); }).empty());
    restartAndOpenAgain();
    EXPECT_EQ(find<QListWidget>("TMC_List")->count(), 3);
    EXPECT_EQ(data.ReadIni("RDS", "TMC", dataSetFile("1")), stored);
    click("TMC_Senden_Taste");
    time->advance(std::chrono::milliseconds(1500));
    EXPECT_EQ(find<QListWidget>("TMC_List")->currentRow(), 2);
    EXPECT_EQ(ask("8A"), data.ReadIni("RDS", "TMC", dataSetFile("1")));
    EXPECT_EQ(ask("8A-N"), "1") << "of the instrument that was started anew";
}

TEST_F(BrokenLinkTest, MessagesThatCycleOnReachTheInstrumentAfterTheNextOpening) {
    startAndOpen();
    startCycling();
    sim.kill();
    EXPECT_EQ(boxesOf([this] { time->advance(std::chrono::seconds(1)); }).size(), 2U);
    click("GTL_Taste");
    EXPECT_TRUE(boxesOf([this] { time->advance(std::chrono::seconds(10)); }).empty())
        << "nothing goes to a closed link";
    restartAndOpenAgain();
    time->advance(std::chrono::seconds(2));
    EXPECT_EQ(ask("8A"), data.ReadIni("RDS", "TMC", dataSetFile("1")));
    EXPECT_EQ(failures(takeTraffic()), 0);
}

TEST_F(BrokenLinkTest, NoTimerTicksWhileTheBoxIsOpen) {
    class LookingDialogs final : public Dialogs {
    public:
        void message(Icon, const QString&, const QString&, const QString&) override { look(); }
        bool messageOrStop(const QString&, const QString&, const QString&, const QString&, Icon) override {
            look();
            return true;
        }
        bool confirm(const QString&, const QString&) override { return false; }
        QString input(const QString&, const QString&, const QString&) override { return {}; }
        std::function<void()> look;
    };
    startAndOpen();
    LookingDialogs box;
    Session otherSession(*watched, state, data, captions, clock, [] {});
    TickerGroup otherTickers;
    HMenue other({otherSession, state, data, captions, clock, box, otherTickers, claim, QString(), QString(), [] {}});
    other.startUp();
    other.INIT_Taste_Click();
    std::vector<int> active;
    box.look = [&] {
        const auto timers = other.findChildren<Ticker*>();
        active.push_back(static_cast<int>(
            std::count_if(timers.begin(), timers.end(), [](const Ticker* ticker) { return ticker->isActive(); })));
    };
    const auto running = [&] {
        box.look();
        return std::exchange(active, {}).front();
    };
    EXPECT_GE(running(), 2) << "dynamic PS and TA";
    sim.kill();
    other.SetRdsStereo();
    EXPECT_EQ(active, std::vector<int>{0});
    active.clear();
    EXPECT_GE(running(), 2) << "they go on";
}

TEST_F(BrokenLinkTest, WhatIsSetWhileTheInstrumentIsAwayIsStoredAndSentAtTheNextOpening) {
    startAndOpen();
    sim.kill();
    const auto boxes = boxesOf([this] {
        type("PS_T", "FERN-OST");
        click("PS_Taste");
        type("PI_T", "A1B2");
        click("Command3");
    });
    EXPECT_EQ(boxes.size(), 2U);
    expectInterfaceErrors(boxes, kLost, false);
    EXPECT_EQ(data.ReadIni("RDS", "PS", dataSetFile("1")), "FERN-OST");
    EXPECT_EQ(data.ReadIni("RDS", "PI", dataSetFile("1")), "A1B2");
    restartAndOpenAgain();
    EXPECT_EQ(ask("PS"), "FERN-OST");
    EXPECT_EQ(ask("PI"), "A1B2");
}

TEST_F(BrokenLinkTest, AnInstrumentThatIsBackWithoutANewOpeningStaysLost) {
    startAndOpen();
    sim.kill();
    EXPECT_EQ(boxesOf([this] { click("Store_Taste_0"); }).size(), 1U);
    sim.start();
    const auto boxes = boxesOf([this] { click("Store_Taste_0"); });
    EXPECT_EQ(boxes.size(), 1U);
    expectInterfaceErrors(boxes, kLost, false);
    restartAndOpenAgain();
    EXPECT_EQ(ask("STORE"), "") << "nothing of it reached the instrument";
}

TEST_F(BrokenLinkTest, OpeningWithNobodyThereIsToldAndCanBeTriedAgain) {
    startAndOpen();
    click("GTL_Taste");
    sim.kill();
    const auto boxes = boxesOf([this] { openSession(); });
    ASSERT_EQ(boxes.size(), 1U);
    EXPECT_EQ(boxes[0].text, QStringLiteral("Please Check Device! %1").arg(visa::kResourceNotFound));
    EXPECT_FALSE(boxes[0].offersStop);
    EXPECT_FALSE(find("SSTab1")->isEnabled());
    sim.start();
    openSession();
    EXPECT_EQ(failures(takeTraffic()), 0);
    expectTheInstrumentHasTheDataSet();
}

TEST_F(BrokenLinkTest, AnInstrumentThatNeverAnswersTimesOutWithAWayOut) {
    startAndOpen(shortTimes());
    watched->beforeWrite = [this, n = 26](const std::string&) mutable {
        if (--n == 0) sim.hang();
    };
    const auto boxes = boxesOf([this] { click("Btn_SetRdsStereo"); });
    EXPECT_EQ(boxes.size(), static_cast<std::size_t>(failures(takeTraffic())));
    EXPECT_GT(boxes.size(), 2U);
    expectInterfaceErrors(boxes, kTimedOut, true);
    dialogs.stopAtFailure = true;
    EXPECT_EQ(boxesOf([this] { click("Btn_SetRdsStereo"); }).size(), 1U);
    dialogs.stopAtFailure = false;
    restartAndOpenAgain();
}

TEST_F(BrokenLinkTest, AnInstrumentThatAnswersAgainIsUsedOnWithoutANewOpening) {
    startAndOpen(shortTimes());
    sim.hang();
    EXPECT_EQ(boxesOf([this] { click("Store_Taste_0"); }).size(), 1U);
    // Write and read fail both; the late answers must not be taken for those of later questions.
    EXPECT_EQ(boxesOf([this] { click("Command5"); }).size(), 2U);
    sim.goOn();
    EXPECT_EQ(ask("STORE"), "1") << "late, but not lost";
    expectTheInstrumentHasTheDataSet();
    click("Btn_SetRdsStereo");
    EXPECT_EQ(ask("PI"), data.ReadIni("RDS", "PI", dataSetFile("1")));
}

TEST_F(BrokenLinkTest, OpeningAnInstrumentThatNeverAnswersIsToldAfterTheTimeOut) {
    startAndOpen(shortTimes());
    click("GTL_Taste");
    sim.hang();
    const auto boxes = boxesOf([this] { openSession(); });
    ASSERT_EQ(boxes.size(), 1U);
    EXPECT_EQ(boxes[0].text, QStringLiteral("Please Check Device! %1").arg(visa::kTimeout));
    EXPECT_FALSE(find("SSTab1")->isEnabled());
    restartAndOpenAgain();
}

TEST_F(BrokenLinkTest, LocalStaysSilentWhenTheInstrumentIsGoneOrMute) {
    startAndOpen(shortTimes());
    sim.kill();
    EXPECT_TRUE(boxesOf([this] { click("GTL_Taste"); }).empty());
    restartAndOpenAgain();
    sim.hang();
    EXPECT_TRUE(boxesOf([this] { click("GTL_Taste"); }).empty());
    restartAndOpenAgain();
}

}  // namespace
}  // namespace kdx::test
