#include <QCheckBox>

#include "rdspagetest.h"
#include "ui/application.h"

namespace kdx::test {
namespace {

std::string ps(const std::string& eight) {
    return direct("PS=" + eight);
}

class DynamicPsTest : public RdsPageTest {
protected:
    DynamicPsTest() {
        setProfile("Datenset1.INI", "RDS", "PS", "RADIO");
        setProfile("Datenset1.INI", "RDS", "RTA", "ABC");
        setProfile(kGeneralSettings, "RDS", "PS_Dyn", "1500");
        load();
    }
    ~DynamicPsTest() override { application().onFailure({}); }

    static Application& application() { return *static_cast<Application*>(QCoreApplication::instance()); }
    void setMode(Qt::CheckState mode) { find<QCheckBox>("PS_dyn_Check")->setCheckState(mode); }
    /// The first tick after the start is over, the switch is on.
    void startRunning() {
        tick("PS_Timer");
        click("Taste_PS_Auto");
        sent();
    }
    Lines ticks(int count) {
        for (int i = 0; i < count; ++i) tick("PS_Timer");
        return sent();
    }
};

TEST_F(DynamicPsTest, TheFirstTickAfterTheStartMakesOneStepAndPutsTheNameBack) {
    EXPECT_EQ(find<QTimer>("PS_Timer")->interval(), 2500);
    EXPECT_EQ(ticks(1), (Lines{ps(">--<>--<"), ps("RADIO   ")}));
    EXPECT_EQ(status(StatusSlot::Ps), "RADIO");
    EXPECT_EQ(ticks(3), Lines{});
}

TEST_F(DynamicPsTest, TheFirstTickFollowsTheMode) {
    setMode(Qt::Checked);
    EXPECT_EQ(ticks(2), (Lines{ps("ABC     "), ps("RADIO   ")}));
}

TEST_F(DynamicPsTest, TheSwitchStartsWithTheStoredInterval) {
    tick("PS_Timer");
    EXPECT_FALSE(checked("Taste_PS_Auto"));
    click("Taste_PS_Auto");
    EXPECT_TRUE(checked("Taste_PS_Auto"));
    EXPECT_EQ(find<QTimer>("PS_Timer")->interval(), 1500);
}

TEST_F(DynamicPsTest, TheIntervalIsRoundedToWholeMilliseconds) {
    setProfile(kGeneralSettings, "RDS", "PS_Dyn", "1499.7 ms");
    click("Taste_PS_Auto");
    EXPECT_EQ(find<QTimer>("PS_Timer")->interval(), 1500);
}

TEST_F(DynamicPsTest, ToggleModeShowsMarkerAndNameInTurn) {
    tick("PS_Timer");  // shows the marker, so the name is next
    click("Taste_PS_Auto");
    sent();
    tick("PS_Timer");
    EXPECT_EQ(status(StatusSlot::Ps), "RADIO");
    tick("PS_Timer");
    EXPECT_EQ(status(StatusSlot::Ps), ">--<>--<");
    tick("PS_Timer");
    EXPECT_EQ(sent(), (Lines{ps("RADIO   "), ps(">--<>--<"), ps("RADIO   ")}));
}

TEST_F(DynamicPsTest, ToggleModeShowsTheNameAsItIsTypedNow) {
    startRunning();
    type("PS_T", "OTHER NAME");
    EXPECT_EQ(ticks(1), Lines{ps("OTHER NA")});
}

TEST_F(DynamicPsTest, ScrollModeMovesTheRadiotextThroughTheField) {
    startRunning();
    setMode(Qt::Checked);
    EXPECT_EQ(ticks(5), (Lines{ps("ABC     "), ps("BC      "), ps("C       "), ps("        "), ps("ABC     ")}));
    EXPECT_EQ(status(StatusSlot::Ps), "ABC     ");
}

TEST_F(DynamicPsTest, ScrollModeWithoutRadiotextSendsBlanks) {
    type("RT_Text1", "");
    startRunning();
    setMode(Qt::Checked);
    EXPECT_EQ(ticks(3), Lines(3, ps("        ")));
}

TEST_F(DynamicPsTest, ScrollModeFollowsAShortenedRadiotext) {
    type("RT_Text1", "ABCDEFGHIJKLMNOPQRSTUVWXYZ");
    startRunning();
    setMode(Qt::Checked);
    ticks(20);
    type("RT_Text1", "AB");
    EXPECT_EQ(ticks(3), (Lines{ps("        "), ps("AB      "), ps("B       ")}));
}

TEST_F(DynamicPsTest, ScrollStepsDoNotChangeWhoseTurnItIs) {
    startRunning();  // the marker was shown last
    setMode(Qt::Checked);
    ticks(2);
    setMode(Qt::Unchecked);
    EXPECT_EQ(ticks(1), Lines{ps("RADIO   ")});
}

TEST_F(DynamicPsTest, PageModeBlanksTheNameAndLeavesTheIndicator) {
    startRunning();
    setMode(Qt::PartiallyChecked);
    const std::string before = status(StatusSlot::Ps);
    EXPECT_EQ(ticks(3), Lines(3, ps("        ")));
    EXPECT_EQ(status(StatusSlot::Ps), before);
}

class TooLongRadiotext : public DynamicPsTest {
protected:
    TooLongRadiotext() {
        application().onFailure([this](const QString&, const QString& error) {
            failures.push_back(error.toStdString());
            // While the box waits for its OK the timers go on.
            tick("PS_Timer");
        });
        type("RT_Text1", std::string(72, 'x').c_str());
    }
    ~TooLongRadiotext() override { application().onFailure({}); }
    void failInPageMode() {
        startRunning();
        setMode(Qt::PartiallyChecked);
        EXPECT_EQ(ticks(10), Lines{});
        EXPECT_EQ(failures.size(), 1U);
    }
};

TEST_F(TooLongRadiotext, IsToldOnceHoweverOftenTheTimerTicks) {
    failInPageMode();
    EXPECT_EQ(failures, Lines{"Subscript out of range: the pages of a radiotext of 72 characters or more"});
    EXPECT_TRUE(checked("Taste_PS_Auto"));
}

TEST_F(TooLongRadiotext, StepsGoOnByThemselvesOnceItIsShorter) {
    failInPageMode();
    type("RT_Text1", std::string(71, 'x').c_str());
    EXPECT_EQ(ticks(2), Lines(2, ps("        ")));
    EXPECT_EQ(failures.size(), 1U);
    type("RT_Text1", std::string(72, 'x').c_str());
    EXPECT_EQ(ticks(5), Lines{});
    EXPECT_EQ(failures.size(), 2U);  // too long anew, told anew
}

TEST_F(TooLongRadiotext, StepsGoOnByThemselvesInAnotherMode) {
    failInPageMode();
    setMode(Qt::Unchecked);
    EXPECT_EQ(ticks(1), Lines{ps("RADIO   ")});
    setMode(Qt::Checked);
    EXPECT_EQ(ticks(1), Lines{ps("xxxxxxxx")});
    EXPECT_EQ(failures.size(), 1U);
}

TEST_F(TooLongRadiotext, TheSwitchStopsAndStartsAsEver) {
    failInPageMode();
    click("Taste_PS_Auto");
    EXPECT_EQ(sent(), Lines{ps("RADIO   ")});
    EXPECT_FALSE(tick("PS_Timer"));
    click("Taste_PS_Auto");
    EXPECT_EQ(ticks(5), Lines{});
    EXPECT_EQ(failures.size(), 2U);  // started anew, told anew
    type("RT_Text1", "ABC");
    EXPECT_EQ(ticks(2), Lines(2, ps("        ")));
}

TEST_F(TooLongRadiotext, AtTheFirstTickItIsToldOnceAndTheNameIsPutBackLater) {
    setMode(Qt::PartiallyChecked);
    EXPECT_EQ(ticks(5), Lines{});
    EXPECT_EQ(failures.size(), 1U);
    type("RT_Text1", "ABC");
    EXPECT_EQ(ticks(3), (Lines{ps("        "), ps("RADIO   ")}));
}

TEST_F(DynamicPsTest, ClicksOnTheBoxGoThroughToggleScrollAndPages) {
    auto* box = find<QCheckBox>("PS_dyn_Check");
    EXPECT_EQ(box->checkState(), Qt::Unchecked);
    click("PS_dyn_Check");
    EXPECT_EQ(box->checkState(), Qt::Checked);
    click("PS_dyn_Check");
    EXPECT_EQ(box->checkState(), Qt::PartiallyChecked);
    click("PS_dyn_Check");
    EXPECT_EQ(box->checkState(), Qt::Unchecked);
}

TEST_F(DynamicPsTest, StoppingSendsTheTypedNameAfterASecond) {
    startRunning();
    setMode(Qt::Checked);
    ticks(4);  // the last frame is blank
    EXPECT_EQ(status(StatusSlot::Ps), "        ");
    const double before = clock.secondsSinceMidnight();
    click("Taste_PS_Auto");
    EXPECT_EQ(sent(), Lines{ps("RADIO   ")});
    EXPECT_EQ(status(StatusSlot::Ps), "RADIO");
    EXPECT_FALSE(checked("Taste_PS_Auto"));
    EXPECT_FALSE(tick("PS_Timer"));
    EXPECT_NEAR(clock.secondsSinceMidnight() - before, 1.05, 0.01);  // and the pause before the command
}

/// Notes how much time had been slept away whenever the switch was painted in its off state.
class PaintedOff : public QObject {
public:
    PaintedOff(QAbstractButton& watched, const FakeClock& clock) : m_watched(watched), m_clock(clock) {
        watched.installEventFilter(this);
    }
    bool eventFilter(QObject*, QEvent* event) override {
        if (event->type() == QEvent::Paint && !m_watched.isChecked()) sleptMs.push_back(m_clock.sleptMs());
        return false;
    }
    std::vector<double> sleptMs;

private:
    QAbstractButton& m_watched;
    const FakeClock& m_clock;
};

TEST_F(DynamicPsTest, TheSwitchShowsItsOffPictureBeforeThePause) {
    page.show();
    startRunning();
    QCoreApplication::processEvents();
    PaintedOff painted(*find<QAbstractButton>("Taste_PS_Auto"), clock);
    const double before = clock.sleptMs();
    find<QAbstractButton>("Taste_PS_Auto")->setChecked(false);  // as a click leaves it
    QMetaObject::invokeMethod(find("Taste_PS_Auto"), "clicked");
    ASSERT_FALSE(painted.sleptMs.empty());
    EXPECT_EQ(painted.sleptMs.front(), before);
    EXPECT_FALSE(checked("Taste_PS_Auto"));
}

TEST_F(DynamicPsTest, AnEmptyIntervalShowsTheSwitchOnButNeverTicks) {
    for (const char* interval : {"", "abc", "0"}) {
        setProfile(kGeneralSettings, "RDS", "PS_Dyn", interval);
        click("Taste_PS_Auto");
        EXPECT_TRUE(checked("Taste_PS_Auto"));
        EXPECT_FALSE(tick("PS_Timer"));
        click("Taste_PS_Auto");
        sent();
    }
}

TEST_F(DynamicPsTest, AnIntervalThatNoTimerTakesIsBroughtIntoItsRange) {
    const auto intervalFor = [this](const char* stored) {
        setProfile(kGeneralSettings, "RDS", "PS_Dyn", stored);
        click("Taste_PS_Auto");
        const auto* timer = find<QTimer>("PS_Timer");
        const int interval = timer->isActive() ? timer->interval() : 0;
        click("Taste_PS_Auto");
        return interval;
    };
    EXPECT_EQ(intervalFor("-1"), 0);
    EXPECT_EQ(intervalFor("65535"), 65535);
    EXPECT_EQ(intervalFor("65536"), 65535);
    EXPECT_EQ(intervalFor("1e300"), 65535);
}

TEST_F(DynamicPsTest, ChoosingATrafficOptionStopsItWithoutChangingThePicture) {
    startRunning();
    click("Check1");
    sent();
    click("TA_Option_1");
    EXPECT_TRUE(checked("Taste_PS_Auto"));
    EXPECT_EQ(ticks(3), Lines{});  // the name was put back once already, so it is not again
    click("Taste_PS_Auto");        // starts anew
    EXPECT_EQ(ticks(1), Lines{ps("RADIO   ")});
}

TEST_F(DynamicPsTest, AnEarlyStopByATrafficOptionMakesOneMoreStepAndRestores) {
    click("Taste_PS_Auto");  // before the first tick
    click("Check1");
    sent();
    click("TA_Option_0");
    EXPECT_EQ(ticks(4), (Lines{ps(">--<>--<"), ps("RADIO   ")}));
}

TEST_F(DynamicPsTest, AStopThatComesInDuringAStepIsHeard) {
    startRunning();
    QMetaObject::invokeMethod(find("Taste_PS_Auto"), "click", Qt::QueuedConnection);
    EXPECT_EQ(ticks(1), (Lines{ps("RADIO   "), ps("RADIO   "), ps("RADIO   ")}));  // step, stop, end of the step
}

TEST_F(DynamicPsTest, AShortIntervalDoesNotLetATickIntoATick) {
    setProfile(kGeneralSettings, "RDS", "PS_Dyn", "1");
    startRunning();
    // The tick that comes due while the first one lets events run.
    auto* timer = find<QTimer>("PS_Timer");
    QCoreApplication::postEvent(timer, new QTimerEvent(timer->timerId()));
    tick("PS_Timer");
    EXPECT_EQ(sent(), Lines{ps("RADIO   ")});
}

TEST_F(DynamicPsTest, AnotherLanguageKeepsTheMode) {
    startRunning();
    setMode(Qt::Checked);
    useLanguage("english");
    page.label();
    EXPECT_TRUE(checked("Taste_PS_Auto"));
    EXPECT_EQ(text("PS_A_Label"), "Dyn. PS");
    EXPECT_EQ(find("PS_dyn_Check")->toolTip(), QStringLiteral("unchecked:  PS toggles. / checked: PS scrolls"));
    EXPECT_EQ(ticks(2), (Lines{ps("ABC     "), ps("BC      ")}));
}

}  // namespace
}  // namespace kdx::test
