#include "scenariotest.h"
#include "support/watchedvisa.h"

namespace kdx::test {
namespace {

using ::testing::Contains;
using ::testing::HasSubstr;
using ::testing::Not;

class ScenarioStopTest : public ScenarioTest {
protected:
    ~ScenarioStopTest() override { end(); }
    Visa& instrumentLink() override { return cable; }

    /// Lets that run for ten seconds.
    void begin(const std::string& scenario) {
        openView();
        load(scenario);
        click("Ablauf_Start");
        pass(10s);
    }

    WatchedVisa cable{link};
};

TEST_F(ScenarioStopTest, StopBringsBackWhatStoodBefore) {
    begin("restore: true\nsteps: [send: {PS: EINS}, wait: 1 h, send: {PS: ZWEI}]");
    EXPECT_EQ(taken(), Lines{direct("PS=EINS    ")});
    ASSERT_TRUE(enabled("Ablauf_Stop"));
    click("Ablauf_Stop");
    pass(200ms);
    EXPECT_FALSE(view->isRunning());
    EXPECT_EQ(taken(), Lines{direct("PS=MESSTURM")});
    EXPECT_EQ(text("Ablauf_Stand"), "abgebrochen; wie zuvor");
    EXPECT_EQ(value("PS"), "MESSTURM");
    EXPECT_EQ(result(3), "\u2713");  // the row of what comes back
    EXPECT_FALSE(enabled("Ablauf_Stop"));
    EXPECT_TRUE(enabled("Ablauf_Start"));
}

TEST_F(ScenarioStopTest, StopEndsARunThatIsHeld) {
    openView();
    load("steps: [wait: 1 h, send: {PS: ZWEI}]");
    click("Ablauf_Start");
    pass(1s);
    click("Ablauf_Pause");
    pass(1s);
    click("Ablauf_Stop");
    pass(200ms);
    EXPECT_FALSE(view->isRunning());
    EXPECT_FALSE(checked("Ablauf_Pause"));
    EXPECT_EQ(taken(), Lines{});
    EXPECT_EQ(text("Ablauf_Stand"), "abgebrochen") << "nothing was to be brought back";
}

TEST_F(ScenarioStopTest, LocalBringsBackWhatStoodBeforeAndThenCloses) {
    begin("restore: true\nsteps: [send: {PS: EINS}, wait: 1 h]");
    taken();
    click("GTL_Taste");
    EXPECT_FALSE(view->isRunning());
    EXPECT_EQ(taken(), Lines{direct("PS=MESSTURM")});
    EXPECT_FALSE(enabled("Ablauf_Start"));
}

TEST_F(ScenarioStopTest, TheEndOfTheProgramBringsBackWhatStoodBefore) {
    begin("restore: true\nsteps: [send: {PS: EINS}, wait: 1 h]");
    taken();
    end();
    EXPECT_EQ(taken(), Lines{direct("PS=MESSTURM")});
}

TEST_F(ScenarioStopTest, ALostLinkEndsTheRunWithOneBox) {
    begin("restore: true\nsteps: [send: {PS: EINS}, wait: 20 s, send: {PS: ZWEI}, wait: 5 s, send: {PS: DREI}]");
    cable.cut = true;
    dialogs.expectedMessages = 1;
    passAll();
    EXPECT_EQ(dialogs.shown.back().title, QStringLiteral("Interface Error"));
    EXPECT_TRUE(text("Ablauf_Stand").starts_with("abgebrochen; nicht wie zuvor: PS")) << text("Ablauf_Stand");
    EXPECT_EQ(result(2), "\u2717 -1073807194");
}

TEST_F(ScenarioStopTest, ThatItBringsBackIsToldAndStopGivesThatUp) {
    begin("restore: true\nsteps: [send: {PS: EINS}, wait: 1 h]");
    cable.cut = true;
    dialogs.expectedMessages = 1;
    click("Ablauf_Stop");
    pass(1s);
    ASSERT_TRUE(view->isRunning());
    EXPECT_EQ(text("Ablauf_Stand"), "was vorher war, wird wiederhergestellt");
    click("Ablauf_Stop");
    EXPECT_FALSE(view->isRunning());
    EXPECT_TRUE(text("Ablauf_Stand").starts_with("abgebrochen; nicht wie zuvor: PS")) << text("Ablauf_Stand");
}

TEST_F(ScenarioStopTest, WhoStopsWhatGoesOutStopsTheRun) {
    openView();
    load("data_set: 2\nsteps: [send: {PS: ZWEI}, send: {RT: NIE}]");
    cable.beforeWrite = [this, left = 8](const std::string&) mutable {
        if (--left == 0) click("Stop_Taste");
    };
    click("Ablauf_Start");
    passAll();
    cable.beforeWrite = nullptr;
    const Lines sent = taken();
    EXPECT_GT(sent.size(), 4U);
    EXPECT_LT(sent.size(), 9U);
    EXPECT_THAT(sent, Not(Contains(HasSubstr("ZWEI"))));
    EXPECT_EQ(text("Ablauf_Stand"), "abgebrochen");
    EXPECT_EQ(result(0), "") << "the set is not whole";
}

TEST_F(ScenarioStopTest, EscapeDoesNotCloseTheViewOfARun) {
    openView();
    load("steps: [wait: 1 h]");
    click("Ablauf_Start");
    const auto escape = [this] {
        QKeyEvent press(QEvent::KeyPress, Qt::Key_Escape, Qt::NoModifier);
        QApplication::sendEvent(view, &press);
    };
    escape();
    EXPECT_TRUE(view->isVisible());
    click("Ablauf_Stop");
    passAll();
    escape();
    EXPECT_FALSE(view->isVisible());
}

TEST_F(ScenarioStopTest, WhileItRunsTheStatusRowIsInDoubt) {
    openView();
    const auto shownState = [this] { return find("Status_3")->property("zustand").toString().toStdString(); };
    EXPECT_EQ(shownState(), "");
    load("restore: true\nsteps: [send: {PS: EINS}, wait: 1 h]");
    click("Ablauf_Start");
    pass(1s);
    EXPECT_EQ(shownState(), "ungesendet");
    EXPECT_EQ(find("Status_3")->toolTip().section(QLatin1Char('\n'), 0, 0),
              QStringLiteral("Ein Ablauf sendet: Auf Sendung kann anderes sein."));
    click("Ablauf_Stop");
    passAll();
    EXPECT_EQ(shownState(), "") << "all is as before";
    load("steps: [send: {PS: EINS}]");
    click("Ablauf_Start");
    passAll();
    EXPECT_EQ(shownState(), "ungesendet") << "what it sent stays on the air";
    click("PS_Taste");
    EXPECT_EQ(shownState(), "");
}

TEST_F(ScenarioStopTest, TheEndOfTheProgramDoesNotWaitForAnInstrumentThatHasGone) {
    begin("restore: true\nsteps: [send: {PS: EINS}, wait: 1 h]");
    cable.cut = true;
    dialogs.expectedMessages = 1;
    clock.sleeps.clear();
    end();
    EXPECT_LT(clock.sleptMs(), 500);
}

TEST_F(ScenarioStopTest, ACommandOfTheWindowThatFailsDoesNotEndTheRun) {
    openView();
    load("steps: [wait: 1 h]");
    click("Ablauf_Start");
    pass(1s);
    cable.cut = true;
    dialogs.expectedMessages = 1;
    click("PS_Taste");
    cable.cut = false;
    pass(1s);
    EXPECT_TRUE(view->isRunning());
}

TEST_F(ScenarioStopTest, TheOtherNetworkOfTheWindowIsTheOldOneAfterwards) {
    openView();
    const std::string before = state.eonIdentifier;
    load("steps: [send: {EON_PI: ABCD, EON_TA: 1}]");
    click("Ablauf_Start");
    passAll();
    EXPECT_EQ(state.eonIdentifier, before);
}

TEST_F(ScenarioStopTest, PanicEndsTheRunAndBringsBackWhatStoodBefore) {
    begin("restore: true\nsteps: [send: {PS: EINS}, wait: 1 h, send: {PS: ZWEI}]");
    taken();
    ASSERT_TRUE(find("Panik_Taste")->isVisible());
    click("Panik_Taste");
    pass(200ms);
    EXPECT_FALSE(view->isRunning());
    EXPECT_EQ(taken(), Lines{direct("PS=MESSTURM")});
    EXPECT_EQ(text("Ablauf_Stand"), "abgebrochen; wie zuvor");
    EXPECT_FALSE(find("Panik_Taste")->isVisible());
    pass(2h);
    EXPECT_EQ(taken(), Lines{});
}

TEST_F(ScenarioStopTest, PanicEndsAnAnnouncementThatTheScenarioMadeOrBringsBack) {
    openView();
    for (const char* restore : {"false", "true"}) {
        load(std::string("restore: ") + restore + "\nsteps: [send: {TP: 1, TA: 1}, wait: 1 h]");
        click("Ablauf_Start");
        pass(10s);
        ASSERT_EQ(value("TA"), "1");
        click("Panik_Taste");
        pass(200ms);
        EXPECT_FALSE(view->isRunning());
        EXPECT_EQ(value("TA"), "0") << restore;
    }
    click("Check1");
    click("TA_Check");
    load("restore: true\nsteps: [send: {TA: 0}, wait: 1 h]");
    click("Ablauf_Start");
    pass(10s);
    click("Panik_Taste");
    pass(200ms);
    EXPECT_EQ(value("TA"), "0") << "on before, but panic is the last word";
    EXPECT_EQ(text("Ablauf_Stand"), "abgebrochen; nicht wie zuvor: TA");
}

TEST_F(ScenarioStopTest, ClosingTheWindowAsksAndNoLetsTheRunGoOn) {
    begin("restore: true\nsteps: [send: {PS: EINS}, wait: 20 s, send: {PS: ZWEI}, wait: 1 h]");
    taken();
    dialogs.confirmations = {false};
    EXPECT_FALSE(window->close());
    EXPECT_EQ(dialogs.shown.back().text, QStringLiteral("Es läuft noch: Ablauf. Anhalten und das Programm beenden?"));
    pass(20s);
    EXPECT_TRUE(view->isRunning());
    EXPECT_EQ(taken(), Lines{direct("PS=ZWEI    ")});
    dialogs.confirmations = {true};
    EXPECT_TRUE(window->close());
    EXPECT_FALSE(view->isRunning());
    EXPECT_EQ(taken(), Lines{direct("PS=MESSTURM")}) << "before the session is closed";
    EXPECT_FALSE(find("SSTab1")->isEnabled());
}

}  // namespace
}  // namespace kdx::test
