#include "window/waysouttest.h"

#include <gmock/gmock.h>

#include "ui/text.h"
#include "window/failurehint.h"

namespace kdx::test {
namespace {

using ::testing::IsEmpty;

// Closing

TEST_F(WaysOutTest, ClosingWithAnOpenSessionDoesWhatLocalDoes) {
    startAndOpen();
    EXPECT_TRUE(window->close());
    EXPECT_EQ(closings(), 1);
    EXPECT_FALSE(find("SSTab1")->isEnabled());
    EXPECT_THAT(sent(), IsEmpty());
}

TEST_F(WaysOutTest, ClosingWithoutASessionAsksNothing) {
    startAndOpen();
    click("GTL_Taste");
    cycleMessages();
    EXPECT_TRUE(window->close());
    EXPECT_EQ(closings(), 1) << "by Local";
}

TEST_F(WaysOutTest, ClosingWhileSomethingRunsByItselfAsksOnceAndStopsIt) {
    startAndOpen();
    cycleMessages();
    announceAutomatically();
    sent();
    dialogs.confirmations = {false};
    EXPECT_FALSE(window->close());
    EXPECT_TRUE(window->isVisible());
    EXPECT_EQ(closings(), 0);
    EXPECT_TRUE(find<QTimer>("TMC_Sende_Timer")->isActive());
    dialogs.confirmations = {true};
    EXPECT_TRUE(window->close());
    EXPECT_EQ(closings(), 1);
    EXPECT_FALSE(find<Ticker>("TMC_Sende_Timer")->isEnabled());
    EXPECT_TRUE(checked("TA_Option_0"));
    EXPECT_THAT(sent(), IsEmpty());
    ASSERT_EQ(dialogs.shown.size(), 2U);
    EXPECT_EQ(dialogs.shown[0].text, QStringLiteral("Es läuft noch: TA, TMC. Anhalten und das Programm beenden?"));
}

TEST_F(WaysOutTest, ClosingAsksBeforeTheDynamicPsEnds) {
    startAndOpen();
    click("Taste_PS_Auto");
    expectClosingAsksAbout(QStringLiteral("PS dyn."));
    EXPECT_FALSE(checked("Taste_PS_Auto"));
    EXPECT_FALSE(tick("PS_Timer"));
}

TEST_F(WaysOutTest, ClosingAsksBeforeAnAnnouncementOfTheOtherNetworkEnds) {
    startAndOpen();
    announceOnTheOtherNetwork();
    expectClosingAsksAbout(QStringLiteral("EON TA"));
    EXPECT_FALSE(checked("EON_TA_Schalter"));
    EXPECT_FALSE(tick("EON_TA_Zeit"));
}

TEST_F(WaysOutTest, TheClockThatIsSentDoesNotCountAsRunning) {
    startAndOpen();
    ASSERT_TRUE(checked("Zeit_Taste"));
    EXPECT_FALSE(find("Panik_Taste")->isVisible());
    EXPECT_TRUE(window->close());
}

// Panic

TEST_F(WaysOutTest, PanicStandsThereOnEveryPageWhileSomethingRuns) {
    startAndOpen();
    EXPECT_FALSE(find("Panik_Taste")->isVisible());
    cycleMessages();
    for (int page = 0; page < 9; ++page) {
        showPage(page);
        EXPECT_TRUE(find("Panik_Taste")->isVisible());
    }
    click("Stop_Timer");
    EXPECT_FALSE(find("Panik_Taste")->isVisible());
    for (const char* control : {"Taste_PS_Auto", "TA_Option_1"}) {
        if (std::string(control) == "TA_Option_1") announceAutomatically();
        if (std::string(control) == "Taste_PS_Auto") click(control);
        EXPECT_TRUE(find("Panik_Taste")->isVisible()) << control;
        click("Panik_Taste");
        EXPECT_FALSE(find("Panik_Taste")->isVisible()) << control;
    }
}

TEST_F(WaysOutTest, PanicSendsNothingWhenNoTrafficIsAnnounced) {
    startAndOpen();
    cycleMessages();
    click("Taste_PS_Auto");
    sent();
    click("Panik_Taste");
    EXPECT_THAT(sent(), IsEmpty());
    EXPECT_FALSE(tick("TMC_Sende_Timer"));
    EXPECT_FALSE(tick("PS_Timer"));
    EXPECT_TRUE(enabled("TMC_Gr8_apply"));
}

TEST_F(WaysOutTest, PanicSwitchesTheDynamicPsOffAlsoBesideAutomaticAnnouncements) {
    startAndOpen();
    announceAutomatically();
    click("Taste_PS_Auto");
    click("Panik_Taste");
    EXPECT_FALSE(checked("Taste_PS_Auto"));
    EXPECT_FALSE(tick("PS_Timer"));
}

TEST_F(WaysOutTest, PanicEndsAnAnnouncementOnTheAir) {
    startAndOpen();
    announceAutomatically();
    tick("TA_Timer");
    sent();
    click("Panik_Taste");
    EXPECT_EQ(sent(), Lines{direct("TA=0")});
    EXPECT_EQ(text("Status_0"), "aus");
    EXPECT_TRUE(checked("TA_Option_0"));
    EXPECT_TRUE(enabled("TA_Option_0"));
    EXPECT_FALSE(tick("TA_Timer"));
}

TEST_F(WaysOutTest, PanicAndStopReachATimerThatWaitsForASlowInstrument) {
    using namespace std::chrono_literals;
    startAndOpen();
    for (const char* way : {"Panik_Taste", "Stop_Timer"}) {
        cycleMessages();
        sent();
        hangAnd([&] {
            QTimer::singleShot(250ms, window.get(), [&] {  // by then it is waited for
                mouse(way);
                if (way == std::string("Stop_Timer")) slow->goOn();
            });
        });
        tick("TMC_Sende_Timer");
        QCoreApplication::processEvents();
        slow->goOn();
        EXPECT_FALSE(tick("TMC_Sende_Timer")) << way;
        EXPECT_FALSE(find("Panik_Taste")->isVisible()) << way;
        EXPECT_EQ(sent().size(), way == std::string("Panik_Taste") ? 1U : 2U) << "panic ends the tick, too";
        click("TMC_Gr8_Remove");
    }
}

TEST_F(WaysOutTest, PanicEndsAnAnnouncementByHandAndOneOfTheOtherNetwork) {
    startAndOpen();
    announceOnTheOtherNetwork();
    sent();
    click("Panik_Taste");
    const Lines lines = sent();
    ASSERT_EQ(lines.size(), 2U);
    EXPECT_EQ(lines[0], direct("TA=0"));
    EXPECT_TRUE(lines[1].starts_with(":STEREO:DIRECT \"EON-TA=") && lines[1].ends_with(",0\"")) << lines[1];
    EXPECT_FALSE(checked("TA_Check"));
    EXPECT_FALSE(tick("EON_TA_Zeit"));
}

// Boxes of timers

class TimerBoxTest : public WaysOutTest {
protected:
    /// What the link says from now on.
    void breakLink() { slow->script().writeStatus = visa::kConnectionLost; }
    void expectOneClickIsEnough(const char* timer, const QString& button) {
        sent();
        breakLink();
        dialogs.stopAtFailure = true;
        dialogs.expectedMessages = 1;
        ASSERT_TRUE(tick(timer));
        ASSERT_EQ(dialogs.shown.size(), 1U);
        EXPECT_EQ(dialogs.shown[0].stop, button);
        EXPECT_EQ(dialogs.shown[0].text, QStringLiteral("Fehler: %1").arg(visa::kConnectionLost));
        EXPECT_EQ(sent().size(), 1U) << "nothing more goes out";
    }
    void expectItIsOff(const char* timer) {
        tick(timer);
        EXPECT_THAT(sent(), IsEmpty());
    }
};

TEST_F(TimerBoxTest, TheCycleOfMessages) {
    startAndOpen();
    cycleMessages();
    expectOneClickIsEnough("TMC_Sende_Timer", QStringLiteral("TMC &stoppen"));
    expectItIsOff("TMC_Sende_Timer");
    EXPECT_TRUE(enabled("TMC_Gr8_apply"));
}

TEST_F(TimerBoxTest, TheAnnouncements) {
    startAndOpen();
    announceAutomatically();
    expectOneClickIsEnough("TA_Timer", QStringLiteral("TA &stoppen"));
    expectItIsOff("TA_Timer");
    EXPECT_TRUE(checked("TA_Option_0"));
    EXPECT_TRUE(enabled("TA_Option_0"));
    EXPECT_TRUE(enabled("TA_Check"));
}

TEST_F(TimerBoxTest, TheClock) {
    startAndOpen();
    ASSERT_TRUE(checked("Zeit_Taste"));
    expectOneClickIsEnough("Timer1", QStringLiteral("Uhr &stoppen"));
    expectItIsOff("Timer1");
    EXPECT_FALSE(checked("Zeit_Taste"));
}

TEST_F(TimerBoxTest, TheDynamicPs) {
    startAndOpen();
    click("Taste_PS_Auto");
    expectOneClickIsEnough("PS_Timer", QStringLiteral("PS dyn. &stoppen"));
    expectItIsOff("PS_Timer");
    EXPECT_FALSE(checked("Taste_PS_Auto"));
    EXPECT_FALSE(find("Panik_Taste")->isVisible());
}

TEST_F(TimerBoxTest, TheAnnouncementOfTheOtherNetwork) {
    startAndOpen();
    announceOnTheOtherNetwork();
    expectOneClickIsEnough("EON_TA_Zeit", QStringLiteral("EON TA &stoppen"));
    expectItIsOff("EON_TA_Zeit");
    EXPECT_FALSE(checked("EON_TA_Schalter"));
}

TEST_F(TimerBoxTest, ARefusalOfTheOtherNetworkCanBeEndedToo) {
    startAndOpen();
    announceOnTheOtherNetwork();
    click("Check1");
    sent();
    dialogs.stopAtFailure = true;
    dialogs.expectedMessages = 1;
    ASSERT_TRUE(tick("EON_TA_Zeit"));
    ASSERT_EQ(dialogs.shown.size(), 1U);
    EXPECT_EQ(dialogs.shown[0].icon, Dialogs::Icon::Exclamation);
    EXPECT_EQ(dialogs.shown[0].stop, QStringLiteral("EON TA &stoppen"));
    expectItIsOff("EON_TA_Zeit");
    EXPECT_EQ(profile(kSet1, "RDS", "EON_TA"), "0");
}

TEST_F(TimerBoxTest, OkLetsTheTimerGoOn) {
    startAndOpen();
    cycleMessages();
    sent();
    breakLink();
    dialogs.expectedMessages = 2;
    EXPECT_TRUE(tick("TMC_Sende_Timer"));
    EXPECT_EQ(sent().size(), 2U);
    slow->script().writeStatus = 0;
    EXPECT_TRUE(tick("TMC_Sende_Timer"));
    EXPECT_EQ(sent().size(), 2U);
}

// What a failure means

struct Meaning {
    const char* name;
    VisaStatus status;
    const char* german;
    const char* english;
};

class FailureMeaningTest : public WaysOutTest, public ::testing::WithParamInterface<Meaning> {};

TEST_P(FailureMeaningTest, StandsUnderThePrescribedLineInBothLanguages) {
    startAndOpen();
    for (const bool german : {true, false}) {
        if (!german) action("Mnu_Info_Sprache_E")->trigger();
        slow->script().writeStatuses = {GetParam().status};
        dialogs.expectedMessages = 1;
        click("Store_Taste_0");
        EXPECT_EQ(dialogs.shown.back().text, QStringLiteral("Fehler: %1").arg(GetParam().status));
        EXPECT_EQ(dialogs.shown.back().preset.toStdString(), german ? GetParam().german : GetParam().english);
        EXPECT_FALSE(dialogs.shown.back().offersStop) << "a single command";
    }
}

TEST_F(WaysOutTest, ATimeIsWrittenAsTheLanguageDoes) {
    const auto hint = [&](const char* language) {
        return failureHint(visa::kTimeout, std::chrono::milliseconds(500), captions, numberLocale(language));
    };
    EXPECT_TRUE(hint("deutsch").contains(QStringLiteral(" 0,5 s")));
    EXPECT_TRUE(hint("english").contains(QStringLiteral(" 0.5 s")));
}

INSTANTIATE_TEST_SUITE_P(
    Statuses, FailureMeaningTest,
    ::testing::Values(
        Meaning{"Silence", visa::kTimeout,
                "Keine Antwort innerhalb von 2 s: Ist das Gerät eingeschaltet und stimmt die Adresse?",
                "No answer within 2 s: is the instrument switched on and the address right?"},
        Meaning{"Loss", visa::kConnectionLost,
                "Die Verbindung ist abgerissen: Kabel prüfen, dann \"Local\" und neu öffnen.",
                "The connection was lost: check the cable, then press \"Local\" and open again."},
        Meaning{"Lock", visa::kResourceLocked,
                "Ein anderes Programm hält das Gerät belegt: dort freigeben, dann noch einmal versuchen.",
                "Another program has locked the instrument: release it there, then try again."},
        Meaning{"Address", visa::kInvalidResourceName, "Die Adresse lässt sich nicht lesen: bitte ändern.",
                "The address cannot be read: please change it."},
        Meaning{"Stopped", visa::kAborted, "Der Vorgang wurde abgebrochen: bei Bedarf noch einmal senden.",
                "The operation was aborted: send again if need be."},
        Meaning{"NoSession", visa::kInvalidObject, "Es ist keine Verbindung offen: \"Local\" und neu öffnen.",
                "No session is open: press \"Local\" and open again."},
        Meaning{"NoLibrary", visa::kLibraryNotFound,
                "Für diese Schnittstelle fehlt die VISA-Bibliothek: installieren oder TCPIP wählen.",
                "This interface needs a VISA library: install one or choose TCPIP."},
        Meaning{"Other", -42, "Die Übertragung ist fehlgeschlagen: Verbindung prüfen und noch einmal versuchen.",
                "The transfer failed: check the connection and try again."}),
    [](const auto& one) { return one.param.name; });

TEST_F(WaysOutTest, AnAddressWhereNobodyAnswersIsExplained) {
    startShipped();
    slow->script().openStatus = visa::kResourceNotFound;
    dialogs.expectedMessages = 1;
    openSession();
    ASSERT_EQ(dialogs.shown.size(), 1U);
    EXPECT_EQ(dialogs.shown[0].text, QStringLiteral("Please Check Device! %1").arg(visa::kResourceNotFound));
    EXPECT_TRUE(dialogs.shown[0].preset.startsWith(QStringLiteral("Unter der Adresse antwortet niemand:")));
}

}  // namespace
}  // namespace kdx::test
