// What users come for, each task done as they do it.
#include <gmock/gmock.h>

#include <QListWidget>
#include <QTableWidget>

#include <semaphore>
#include <set>

#include "support/realkey.h"
#include "window/taskstest.h"

namespace kdx::test {
namespace {

using namespace std::chrono_literals;
using ::testing::Contains;
using ::testing::ElementsAre;
using ::testing::HasSubstr;
using ::testing::IsEmpty;
using ::testing::StartsWith;

using Tasks = TasksTest;

TEST_F(Tasks, OpenTheSessionAndSendEverything) {
    EXPECT_EQ(text("Verbindung_Anzeige"), "nicht verbunden");
    openSession();
    EXPECT_EQ(text("Verbindung_Anzeige"), "verbunden: 127.0.0.1");
    EXPECT_EQ(has("PI"), "D7A1");
    EXPECT_EQ(has("PS"), "MESSTURM");
    EXPECT_EQ(has("PTY"), "10");
    EXPECT_EQ(has("GS"), "0A,2A,0A,8A");
    EXPECT_EQ(has("RT"), "Messturm - Musik und Verkehr aus dem Labor");
    EXPECT_EQ(has("AF1"), "98.5,89.3,94.7,101.2");
    EXPECT_EQ(has("EON PI?"), " D7A2,");
    EXPECT_EQ(ask("FREQ?;:POW?;:OUTPUT:STAT?"), "98.5;80;1");
    EXPECT_EQ(text("Status_3"), "MESSTURM");
    EXPECT_EQ(text("HF_Anzeige"), "ein");
}

TEST_F(Tasks, LoadSet3AndSendIt) {
    openSession();
    dialogs.confirmations = {true};
    choose("Mnu_Datensatz_3");
    EXPECT_EQ(dialogs.shown.back().text.toStdString(), "Datensatz 3 jetzt an das Gerät senden?");
    EXPECT_EQ(has("PS"), "KLANGHOF");
    EXPECT_EQ(has("PI"), "D7A3");
    EXPECT_EQ(has("EON PI?"), " D7A4,");
    EXPECT_EQ(text("Datensatz_Anzeige"), "3");
    EXPECT_EQ(text("Status_3"), "KLANGHOF");
    EXPECT_EQ(stateOf("Status_3"), "");
}

TEST_F(Tasks, ChangeThePsAndSendIt) {
    workOn(kRdsPage);
    type("PS_T", "Grün 1");
    EXPECT_EQ(stateOf("PS_T"), "ungesendet");
    EXPECT_EQ(has("PS"), "MESSTURM");
    click("PS_Taste");
    EXPECT_EQ(has("PS"), "Gr\xFCn 1  ");
    EXPECT_EQ(stateOf("PS_T"), "");
    EXPECT_EQ(text("Status_3"), "Grün 1");
    EXPECT_EQ(profile(kSet1, "RDS", "PS"), "Gr\xFCn 1");
}

TEST_F(Tasks, FindAWrongPi) {
    workOn(kRdsPage);
    type("PI_T", "12XY");
    click("Command3");
    EXPECT_EQ(has("PI"), "D7A1") << "the coder has refused it";
    EXPECT_EQ(stateOf("PI_T"), "abgelehnt");
    EXPECT_EQ(stateOf("Status_2"), "abgelehnt");
    EXPECT_THAT(find("Status_2")->toolTip().toStdString(), StartsWith("Die PI muss"));
    type("PI_T", "12AB");
    click("Command3");
    EXPECT_EQ(has("PI"), "12AB");
    EXPECT_EQ(stateOf("PI_T"), "");
    EXPECT_EQ(stateOf("Status_2"), "");
}

TEST_F(Tasks, StopHalfWay) {
    workOn(kStereoPage);
    click("Btn_SetRdsStereo");
    const Lines all = got();
    const std::size_t half = all.size() / 2;
    ASSERT_GT(half, 10U);
    std::size_t messages = 0;
    cable->beforeWrite = [&](const std::string& message) {
        if (message.find('?') != std::string::npos || ++messages != half) return;
        std::binary_semaphore pressed{0};
        QMetaObject::invokeMethod(
            window.get(),
            [&] {
                click("Stop_Taste");
                pressed.release();
            },
            Qt::QueuedConnection);
        pressed.acquire();
    };
    click("Btn_SetRdsStereo");
    EXPECT_EQ(messages, half) << "the rest is not sent";
    EXPECT_THAT(dialogs.shown, IsEmpty()) << "who pressed it knows";
    EXPECT_FALSE(find("Stop_Taste")->isVisible());
    EXPECT_TRUE(find("SSTab1")->isEnabled()) << "the session stays open";
    EXPECT_EQ(text("Verbindung_Anzeige"), "verbunden: 127.0.0.1") << "who stops it has lost nothing";
    cable->beforeWrite = nullptr;
    got();
    click("Btn_SetRdsStereo");
    EXPECT_EQ(got(), all);
}

TEST_F(Tasks, ReconnectAfterALostLink) {
    workOn(kRdsPage);
    cable->cut = true;
    type("PS_T", "WIEDER");
    dialogs.expectedMessages = 1;
    click("PS_Taste");
    EXPECT_EQ(text("Verbindung_Anzeige"), "Verbindung verloren");
    EXPECT_THAT(dialogs.shown.back().preset.toStdString(), HasSubstr("\"Local\""));
    click("GTL_Taste");
    dialogs.expectedMessages = 1;
    click("INIT_Taste");
    EXPECT_EQ(text("Verbindung_Anzeige"), "nicht verbunden");
    cable->cut = false;
    openSession();
    EXPECT_EQ(text("Verbindung_Anzeige"), "verbunden: 127.0.0.1");
    EXPECT_EQ(has("PS"), "WIEDER  ");
}

TEST_F(Tasks, SaveAsSet4AndLoadItAgain) {
    workOn(kRdsPage);
    type("PS_T", "EIGENES");
    dialogs.confirmations = {true, true, true};
    choose("Mnu_Datensatz_Sichern_4");
    choose("Mnu_Datensatz_2");
    EXPECT_NE(has("PS"), "EIGENES ");
    choose("Mnu_Datensatz_4");
    EXPECT_EQ(text("PS_T"), "EIGENES");
    EXPECT_EQ(has("PS"), "EIGENES ");
    EXPECT_EQ(has("PI"), "D7A1");
    EXPECT_EQ(text("Datensatz_Anzeige"), "4");
    EXPECT_EQ(profile("Datenset4.INI", "RDS", "PS"), "EIGENES");
}

TEST_F(Tasks, SwitchTheTrafficAnnouncementOnAndOff) {
    workOn(kRdsPage);
    click("Check1");
    EXPECT_EQ(has("TP"), "1");
    click("TA_Check");
    EXPECT_EQ(has("TA"), "1");
    EXPECT_EQ(text("Status_0"), "ein");
    click("TA_Check");
    EXPECT_EQ(has("TA"), "0");
    EXPECT_EQ(text("Status_0"), "aus");
}

TEST_F(Tasks, RunTheTrafficAnnouncementByItself) {
    workOn(kRdsPage);
    click("Check1");
    scroll("TA_HScroll", 5);
    scroll("TA_Rep_HScroll", 20);
    click("TA_Option_1");
    std::string onAir;
    const double start = clock.secondsSinceMidnight();
    for (int second = 1; second <= 30; ++second) {
        clock.set(start + second - 0.5);
        tick("TA_Rep_Timer");
        clock.set(start + second);
        tick("TA_Timer");
        onAir += has("TA");
    }
    EXPECT_EQ(onAir, "111110000000000000001111100000") << "five seconds, every twenty";
    click("TA_Option_0");
    EXPECT_FALSE(tick("TA_Timer"));
}

TEST_F(Tasks, EnterAnAfListAndSendIt) {
    workOn(kAfPage);
    QTimer::singleShot(0, window.get(), [this] {
        auto* editor = QApplication::activeModalWidget();
        ASSERT_NE(editor, nullptr);
        auto* entry = editor->findChild<QLineEdit*>(QStringLiteral("Text2"));
        click(*entry);
        type(*entry, QStringLiteral("88.1\n107.1\n"));
        click(*editor->findChild<QWidget*>(QStringLiteral("Uebernahme_Knopf")));
    });
    click("AF_Bearbeiten");
    EXPECT_EQ(find<QListWidget>("AF_List1")->count(), 5);
    EXPECT_EQ(has("AF1"), "98.5,89.3,94.7,101.2") << "stored, not sent";
    click("Taste_AF_Senden");
    EXPECT_EQ(has("AF1"), "98.5,89.3,94.7,101.2,88.1,107.1");
    EXPECT_EQ(has("AF2"), "98.5,90.1,103.4");
}

TEST_F(Tasks, BuildAGroupSequenceAndSendIt) {
    workOn(kGroupPage);
    click("newList");
    for (const char* group : {"Gruppe0", "Gruppe2", "Gruppe15", "Gruppe_Zurueck", "Gruppe8", "Gruppe0"}) click(group);
    EXPECT_EQ(text("Label10"), "Gruppenfolge:0A,2A,8A,0A,");
    EXPECT_EQ(has("GS"), "0A,2A,0A,8A");
    click("GS_Senden");
    EXPECT_EQ(has("GS"), "0A,2A,8A,0A");
    EXPECT_EQ(profile(kSet1, "RDS", "GR_FOLGE"), "0A,2A,8A,0A,");
}

TEST_F(Tasks, SendARadiotext) {
    workOn(kRdsPage);
    type("RT_Text1", "Heute: Probe, ganz ohne Pause");
    click("RT_Taste1");
    EXPECT_EQ(has("RT"), "Heute: Probe, ganz ohne Pause");
    EXPECT_EQ(stateOf("RT_Text1"), "");
    EXPECT_EQ(profile(kSet1, "RDS", "RTA"), "Heute: Probe, ganz ohne Pause");
}

TEST_F(Tasks, SendTheClock) {
    workOn(kRdsPage);
    clock.set(8 * 3600 + 15 * 60 + 30);
    ASSERT_TRUE(tick("Timer1"));
    EXPECT_EQ(has("CT").substr(0, 6), "08:15:");
    EXPECT_EQ(has("CT").substr(8), ",05.03.09");
    EXPECT_EQ(text("Uhr_Zeit"), "08:15:30");
    got();
    click("Zeit_Taste");
    tick("Timer1");
    EXPECT_THAT(got(), IsEmpty()) << "switched off";
}

TEST_F(Tasks, AnnounceOnTheOtherNetwork) {
    workOn(kRdsPage);
    for (const char* box : {"Check1", "TA_Check", "Check1"}) click(box);  // TP off and TA on here: the others' turn
    showPage(kEonPage);
    click("EON_TA_Schalter");
    EXPECT_EQ(has("EON-TA,D7A2"), "1");
    EXPECT_TRUE(checked("EON_TA_Schalter"));
    ASSERT_TRUE(tick("EON_TA_Zeit"));
    EXPECT_EQ(has("EON-TA,D7A2"), "0");
    EXPECT_FALSE(checked("EON_TA_Schalter"));
}

TEST_F(Tasks, CycleTmcMessagesAndStop) {
    workOn(kTmcPage);
    select("TMC_Event_Combo", 0);
    for (const int place : {0, 1}) {
        select("TMC_Loc_Combo", place);
        click("TMC_Gr8_apply");
    }
    click("optMultiMessage");
    type("txtCycleTime", "2.5");
    click("TMC_Senden_Taste");
    EXPECT_THAT(text("TMC_Lauf"), StartsWith("Sendet alle 2,5 s eine Meldung"));
    got();
    Lines messages;
    for (int i = 0; i < 3; ++i) {
        ASSERT_TRUE(tick("TMC_Sende_Timer"));
        messages.push_back(got().back());
        EXPECT_THAT(messages.back(), StartsWith(R"(:STEREO:DIRECT "8A=02,)"));
    }
    EXPECT_NE(messages[0], messages[1]);
    EXPECT_EQ(messages[0], messages[2]);
    click("Stop_Timer");
    EXPECT_FALSE(tick("TMC_Sende_Timer"));
    EXPECT_THAT(text("TMC_Lauf"), StartsWith("Gesendet: 3-mal"));
}

TEST_F(Tasks, ReadEverythingBack) {
    workOn(kStereoPage);
    ask(direct("PS=FREMD"));
    pressKey(*window, Qt::Key_F5);
    EXPECT_TRUE(find("gelesen")->isVisible());
    for (const char* value : {"FREMD", "D7A1", "98.5 MHz", "0A,2A,0A,8A", "FM Hub: 75000 Hz", "TALWELLE"})
        EXPECT_THAT(text("gelesen"), HasSubstr(value));
    EXPECT_THAT(got(), IsEmpty()) << "asking changes nothing";
}

TEST_F(Tasks, ComparePanelAndInstrumentAndTakeOver) {
    workOn(kRdsPage);
    ask(direct("PS=FREMD"));
    choose("Mnu_Ansicht_Vergleich");
    click("Vergleich_Lesen");
    EXPECT_THAT(text("Vergleich_Stand"), StartsWith("1 von "));
    auto* table = find<QTableWidget>("Vergleich_Tabelle");
    for (int row = 0; row < table->rowCount(); ++row) {
        if (table->item(row, 3)->text() == QStringLiteral("FREMD")) table->selectRow(row);
    }
    click("Vergleich_Uebernehmen");
    EXPECT_EQ(text("PS_T"), "FREMD");
    EXPECT_EQ(profile(kSet1, "RDS", "PS"), "FREMD");
    EXPECT_THAT(text("Vergleich_Stand"), StartsWith("0 von "));
    EXPECT_THAT(got(), IsEmpty());
}

TEST_F(Tasks, RunAShippedScenario) {
    workOn(kRdsPage);
    choose("Mnu_Ansicht_Ablauf");
    dialogs.files = {QString::fromStdString((folder.data() / "Scenarios" / "pi_change.yaml").string())};
    click("Ablauf_Oeffnen");
    click("Ablauf_Start");
    std::set<std::string> onAir;
    for (int i = 0; i < 10000 && enabled("Ablauf_Stop"); ++i) {
        if (enabled("Ablauf_Weiter")) click("Ablauf_Weiter");
        clock.advance(50ms);
        tick("AblaufTimer");
        onAir.insert(has("PI"));
    }
    EXPECT_EQ(text("Ablauf_Stand"), "zu Ende");
    for (const char* identification : {"D3C1", "D3C2", "D4C1", "D5C1", "1E10"})
        EXPECT_THAT(onAir, Contains(identification));
    EXPECT_EQ(has("PI"), "D7A1") << "as before";
    EXPECT_EQ(text("PI_T"), "D7A1");
}

TEST_F(Tasks, SetTheFrequencyByArrowKeys) {
    workOn(kRfPage);
    for (int i = 0; i < 3; ++i) press("Input_HF_Freq_Label", Qt::Key_Up);
    press("Input_HF_Pegel_Label", Qt::Key_Down);
    EXPECT_EQ(ask("FREQ?;:POW?"), "98.8;79");
    EXPECT_EQ(text("Input_HF_Freq_Label"), "98.8");
    EXPECT_EQ(text("Status_17"), "98.8");
    dialogs.inputs = {QStringLiteral("101.25")};
    click("Input_HF_Freq_Label");
    EXPECT_EQ(ask("FREQ?"), "101.25");
}

TEST_F(Tasks, PanicStopsEverything) {
    workOn(kTmcPage);
    select("TMC_Event_Combo", 0);
    select("TMC_Loc_Combo", 0);
    click("TMC_Gr8_apply");
    click("optMultiMessage");
    click("TMC_Senden_Taste");
    showPage(kRdsPage);
    click("Check1");
    click("TA_Option_1");
    click("Taste_PS_Auto");  // the option would stop it
    clock.advance(1s);
    tick("TA_Timer");
    ASSERT_EQ(has("TA"), "1");
    ASSERT_TRUE(tick("PS_Timer"));
    ASSERT_TRUE(tick("TMC_Sende_Timer"));
    got();
    click("Panik_Taste");
    EXPECT_THAT(got(), ElementsAre(direct("TA=0")));
    EXPECT_FALSE(checked("Taste_PS_Auto"));
    EXPECT_EQ(has("TA"), "0");
    EXPECT_EQ(text("Status_0"), "aus");
    for (const char* timer : {"TA_Timer", "TA_Rep_Timer", "PS_Timer", "TMC_Sende_Timer", "EON_TA_Zeit"})
        EXPECT_FALSE(tick(timer)) << timer;
    EXPECT_FALSE(find("Panik_Taste")->isVisible());
}

}  // namespace
}  // namespace kdx::test
