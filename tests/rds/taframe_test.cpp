#include <QGroupBox>

#include "rdspagetest.h"

namespace kdx::test {
namespace {

const std::string kOn = direct("TA=1");
const std::string kOff = direct("TA=0");
constexpr double kNoon = 12 * 3600.0;

/// The frame on its page, with the traffic programme on and an announcement of 10 s every 60 s.
class TaFrameTest : public RdsPageTest {
protected:
    TaFrameTest() {
        setProfile(kGeneralSettings, "RDS", "TA_ON", "10");
        setProfile(kGeneralSettings, "RDS", "TA_REP", "60");
        load();
        click("Check1");
        sent();
    }

    /// The timers' ticks of the seconds `from` to `to` after the clock read `start`.
    void runSeconds(int from, int to, double start = kNoon) {
        for (int second = from; second <= to; ++second) {
            clock.set(start + second - 0.5);
            tick("TA_Rep_Timer");
            clock.set(start + second);
            tick("TA_Timer");
        }
    }
    void startAutomatic(double start = kNoon) {
        clock.set(start);
        click("TA_Option_1");
    }
    QColor indicator() {
        return statusRow.findChild<QLabel*>(QStringLiteral("Status_0"))->palette().color(QPalette::Window);
    }
    QColor buttonFace() { return statusRow.palette().color(QPalette::Button); }
    int interval(const char* timer) { return find<QTimer>(timer)->interval(); }
};

TEST_F(TaFrameTest, TickingTheBoxStartsAnAnnouncementByHand) {
    click("TA_Check");
    EXPECT_EQ(sent(), Lines{kOn});
    EXPECT_EQ(status(StatusSlot::Ta), "ein");
    EXPECT_EQ(indicator(), QColor(0, 255, 0));
    EXPECT_EQ(programme.announcement, "1");
    EXPECT_FALSE(enabled("TA_Option_1"));
}

TEST_F(TaFrameTest, UntickingTheBoxEndsIt) {
    click("TA_Check");
    click("TA_Check");
    EXPECT_EQ(sent(), (Lines{kOn, kOff}));
    EXPECT_EQ(status(StatusSlot::Ta), "aus");
    EXPECT_EQ(indicator(), buttonFace());
    EXPECT_EQ(programme.announcement, "0");
    EXPECT_TRUE(enabled("TA_Option_1"));
}

TEST_F(TaFrameTest, TimersStartAsDesigned) {
    EXPECT_TRUE(find<QTimer>("TA_Timer")->isActive());
    EXPECT_EQ(interval("TA_Timer"), 333);
    EXPECT_FALSE(find<QTimer>("TA_Rep_Timer")->isActive());
    tick("TA_Timer");
    EXPECT_EQ(sent(), Lines{});
}

TEST_F(TaFrameTest, AutomaticLocksTheBoxAndTicksEverySecond) {
    startAutomatic();
    EXPECT_FALSE(enabled("TA_Check"));
    EXPECT_EQ(interval("TA_Timer"), 1000);
    EXPECT_TRUE(find<QTimer>("TA_Timer")->isActive());
    EXPECT_EQ(sent(), Lines{});
}

TEST_F(TaFrameTest, ManualFreesTheBoxAndStopsTheTimer) {
    startAutomatic();
    click("TA_Option_0");
    EXPECT_TRUE(enabled("TA_Check"));
    EXPECT_FALSE(tick("TA_Timer"));
    EXPECT_EQ(sent(), Lines{});
}

TEST_F(TaFrameTest, AnAnnouncementIsSentEverySecondAndItsEndOnce) {
    startAutomatic();
    runSeconds(1, 10);
    EXPECT_EQ(sent(), Lines(10, kOn));
    EXPECT_EQ(status(StatusSlot::Ta), "ein");
    EXPECT_EQ(indicator(), QColor(0, 255, 0));
    EXPECT_EQ(programme.announcement, "0");  // a data set that is sent meanwhile ends it: the box is not ticked
    EXPECT_FALSE(enabled("TA_Option_0"));
    EXPECT_FALSE(find<QTimer>("TA_Rep_Timer")->isActive());

    runSeconds(11, 60);
    EXPECT_EQ(sent(), Lines{kOff});
    EXPECT_EQ(status(StatusSlot::Ta), "aus");
    EXPECT_EQ(indicator(), buttonFace());
    EXPECT_TRUE(enabled("TA_Option_0"));
    EXPECT_TRUE(find<QTimer>("TA_Rep_Timer")->isActive());
}

TEST_F(TaFrameTest, TheAnnouncementComesAgainAfterThePeriod) {
    startAutomatic();
    runSeconds(1, 60);
    sent();
    runSeconds(61, 70);
    EXPECT_EQ(sent(), Lines(10, kOn));
    EXPECT_FALSE(find<QTimer>("TA_Rep_Timer")->isActive());  // it waits for the pause
    runSeconds(71, 100);
    EXPECT_EQ(sent(), Lines{kOff});
}

TEST_F(TaFrameTest, ThePeriodIsOverOnlyPastItsLastMoment) {
    startAutomatic();
    runSeconds(1, 59);
    sent();
    clock.set(kNoon + 60);
    tick("TA_Rep_Timer");
    tick("TA_Timer");
    EXPECT_EQ(sent(), Lines{});
    clock.set(kNoon + 60.1);
    tick("TA_Rep_Timer");
    tick("TA_Timer");
    EXPECT_EQ(sent(), Lines{kOn});
}

TEST_F(TaFrameTest, TicksThatComeInAfterTheOptionWasLeftDoNothing) {
    startAutomatic();
    runSeconds(1, 20);
    sent();
    find<QRadioButton>("TA_Option_0")->setChecked(true);  // its click has not been handled yet
    runSeconds(21, 23);
    EXPECT_FALSE(find<QTimer>("TA_Rep_Timer")->isActive());
    EXPECT_EQ(sent(), Lines{});
}

TEST_F(TaFrameTest, ManualInThePauseLeavesNothingToComeAgain) {
    startAutomatic();
    runSeconds(1, 20);
    sent();
    click("TA_Option_0");
    runSeconds(21, 200);
    EXPECT_EQ(sent(), Lines{});
    EXPECT_TRUE(enabled("TA_Check"));
}

TEST_F(TaFrameTest, EveryAnnouncementEndsWithOneOff) {
    startAutomatic();
    runSeconds(1, 200);
    const Lines all = sent();
    EXPECT_EQ(std::count(all.begin(), all.end(), kOff), 4);  // of those that began at 0, 60.5, 121.5 and 182.5 s
}

TEST_F(TaFrameTest, SwitchingTheTrafficProgrammeOffEndsTheAutomaticWithTheAnnouncement) {
    startAutomatic();
    runSeconds(1, 3);
    click("Check1");
    sent();
    runSeconds(4, 10);
    EXPECT_EQ(sent(), Lines(7, kOn));
    EXPECT_TRUE(checked("TA_Option_1"));
    runSeconds(11, 11);
    EXPECT_EQ(sent(), Lines{kOff});
    EXPECT_TRUE(checked("TA_Option_0"));
    EXPECT_FALSE(tick("TA_Timer"));
    runSeconds(12, 200);
    EXPECT_EQ(sent(), Lines{});
}

TEST_F(TaFrameTest, SwitchingTheTrafficProgrammeOffInThePauseEndsTheAutomaticAtOnce) {
    startAutomatic();
    runSeconds(1, 20);
    click("Check1");
    sent();
    runSeconds(21, 21);
    EXPECT_TRUE(checked("TA_Option_0"));
    EXPECT_EQ(sent(), Lines{});
}

TEST_F(TaFrameTest, AnAnnouncementAtMidnightStaysOnForAboutADay) {
    startAutomatic(86395);
    runSeconds(1, 4, 86395);
    EXPECT_EQ(sent(), Lines(4, kOn));
    for (const double time : {0.0, 6.0, 3600.0, 86394.0, 86399.0}) {
        clock.set(time);
        tick("TA_Timer");
        EXPECT_EQ(sent(), Lines{kOn}) << time;  // its end, 86405, is never reached
    }
}

TEST_F(TaFrameTest, AnAnnouncementThatRanIntoMidnightEndsAtItsTimeOfDay) {
    startAutomatic(86380);  // would end at 86390
    runSeconds(1, 2, 86380);
    clock.set(5);  // the PC slept over midnight
    tick("TA_Timer");
    clock.set(86390);
    tick("TA_Timer");
    EXPECT_EQ(sent(), Lines(4, kOn));
    clock.set(86391);
    tick("TA_Timer");
    EXPECT_EQ(sent(), Lines{kOff});
}

TEST_F(TaFrameTest, ThePeriodIsNotCorrectedAtMidnight) {
    startAutomatic(86370);  // the next announcement would be due at 86430
    runSeconds(1, 20, 86370);
    clock.set(120);
    tick("TA_Rep_Timer");
    clock.set(86381);  // about a day later: had 120 been taken for the start, the pause would last to 86381 as well
    sent();
    tick("TA_Timer");
    clock.set(86399);
    tick("TA_Rep_Timer");
    tick("TA_Timer");
    EXPECT_EQ(sent(), Lines{});
}

TEST_F(TaFrameTest, AfterMidnightAPauseLooksLikeAnAnnouncementAgain) {
    // Any time of the new day lies before the old announcement's end; it is kept so on purpose.
    startAutomatic(86370);
    runSeconds(1, 20, 86370);
    sent();
    clock.set(1);
    tick("TA_Timer");
    EXPECT_EQ(sent(), Lines{kOn});
}

TEST_F(TaFrameTest, TimesAreComparedInSinglePrecision) {
    scroll("TA_HScroll", 1);
    startAutomatic(80000.002);  // 80000 in single precision
    clock.set(80001.003);       // 80001: not past the end, although 1.001 s have passed
    tick("TA_Timer");
    EXPECT_EQ(sent(), Lines{kOn});
    clock.set(80001.005);  // 80001.0078
    tick("TA_Timer");
    EXPECT_EQ(sent(), Lines{kOff});
}

TEST_F(TaFrameTest, TheDurationIsKeptFromExceedingThePeriod) {
    scroll("TA_HScroll", 100);
    EXPECT_EQ(find<QScrollBar>("TA_HScroll")->value(), 60);
    EXPECT_EQ(text("TA_Zeit_Label"), " 60 s");
    EXPECT_EQ(profile(kGeneralSettings, "RDS", "TA_ON"), "60");
    EXPECT_EQ(find<QScrollBar>("TA_Rep_HScroll")->value(), 60);
    EXPECT_EQ(sent(), Lines{});
}

TEST_F(TaFrameTest, ThePeriodAlwaysStaysAboveTheDuration) {
    scroll("TA_Rep_HScroll", 10);  // equal is too short already
    EXPECT_EQ(find<QScrollBar>("TA_Rep_HScroll")->value(), 11);
    EXPECT_EQ(text("TA_Rep_Label"), "11 s");
    EXPECT_EQ(profile(kGeneralSettings, "RDS", "TA_REP"), "11");
    scroll("TA_Rep_HScroll", 5);
    EXPECT_EQ(find<QScrollBar>("TA_Rep_HScroll")->value(), 11);
    scroll("TA_Rep_HScroll", 3600);
    EXPECT_EQ(text("TA_Rep_Label"), "3600 s");
}

TEST_F(TaFrameTest, TheDurationIsShownWithABlankBeforeIt) {
    scroll("TA_HScroll", 25);
    EXPECT_EQ(text("TA_Zeit_Label"), " 25 s");
    EXPECT_EQ(profile(kGeneralSettings, "RDS", "TA_ON"), "25");
    EXPECT_EQ(text("TA_Rep_Label"), "60 s");
}

TEST_F(TaFrameTest, ADraggedBarIsShownOnTheWayAndActsWhereItComesToRest) {
    auto* bar = find<QScrollBar>("TA_HScroll");
    bar->setSliderDown(true);
    bar->setSliderPosition(30);
    EXPECT_EQ(text("TA_Zeit_Label"), " 30 s");
    EXPECT_EQ(profile(kGeneralSettings, "RDS", "TA_ON"), "10");
    bar->setSliderDown(false);
    EXPECT_EQ(profile(kGeneralSettings, "RDS", "TA_ON"), "30");
}

TEST_F(TaFrameTest, ADurationStoredAboveThePeriodComesDownToIt) {
    setProfile(kGeneralSettings, "RDS", "TA_ON", "90");
    load();
    EXPECT_EQ(text("TA_Zeit_Label"), " 60 s");
    EXPECT_EQ(text("TA_Rep_Label"), "60 s");
    EXPECT_EQ(profile(kGeneralSettings, "RDS", "TA_ON"), "90");  // start-up stores nothing
}

TEST_F(TaFrameTest, MissingOrAbsurdTimesStayWithinTheBars) {
    setProfile(kGeneralSettings, "RDS", "TA_ON", "");
    setProfile(kGeneralSettings, "RDS", "TA_REP", "");
    load();
    EXPECT_EQ(text("TA_Zeit_Label"), " 1 s");
    EXPECT_EQ(text("TA_Rep_Label"), "2 s");
    setProfile(kGeneralSettings, "RDS", "TA_ON", "1e300");
    setProfile(kGeneralSettings, "RDS", "TA_REP", "99999999999");
    load();
    EXPECT_EQ(text("TA_Zeit_Label"), " 600 s");
    EXPECT_EQ(text("TA_Rep_Label"), "3600 s");
}

TEST_F(TaFrameTest, HelpTellsWhenEonTrafficAnnouncementsMayBeGiven) {
    dialogs.expectedMessages = 1;
    click("TA_EON_Hilfe");
    EXPECT_EQ(dialogs.shown[0].icon, Dialogs::Icon::Information);
    EXPECT_EQ(dialogs.shown[0].title, QStringLiteral("EON TA"));
    EXPECT_EQ(dialogs.shown[0].text.toStdString(),
              "EON TA l\xC3\xA4sst sich nur geben, solange TP aus und TA ein ist und EON TP angekreuzt ist.");
    EXPECT_EQ(sent(), Lines{});
}

TEST_F(TaFrameTest, AnotherLanguageKeepsTimesAndStateAndChangesTheWords) {
    startAutomatic();
    runSeconds(1, 1);
    sent();
    useLanguage("english");
    page.label();
    EXPECT_EQ(status(StatusSlot::Ta), "on");
    EXPECT_EQ(indicator(), QColor(0, 255, 0));
    EXPECT_EQ(text("TA_Zeit_Label"), " 10 s");
    EXPECT_EQ(text("TA_Rep_Label"), "60 s");
    EXPECT_EQ(text("TA_Option_1"), "&Automatic");
    EXPECT_EQ(find<QGroupBox>("Frame1")->title(), QStringLiteral("TA function"));
    EXPECT_TRUE(checked("TA_Option_1"));
    EXPECT_FALSE(enabled("TA_Check"));
    EXPECT_EQ(sent(), Lines{});
    runSeconds(2, 10);
    EXPECT_EQ(sent(), Lines(9, kOn));
}

TEST_F(TaFrameTest, DesignTextsStandInGerman) {
    EXPECT_EQ(find<QGroupBox>("Frame1")->title(), QStringLiteral("TA Funktion"));
    EXPECT_EQ(text("TA_Check"), "TA on / off");
    EXPECT_EQ(text("TA_Option_0"), "&Manual");
    EXPECT_EQ(text("TA_Option_1"), "&Automatisch");
    EXPECT_EQ(find("TA_Option_0")->toolTip(), QStringLiteral("TA Single"));
    EXPECT_EQ(find("TA_Option_1")->toolTip(), QStringLiteral("TA Repetition"));
    EXPECT_EQ(text("TA_EON_Hilfe"), "EON ?");
}

}  // namespace
}  // namespace kdx::test
