#include <gtest/gtest.h>

#include <QMenu>

#include "support/windowtest.h"
#include "ui/clickablelabel.h"

namespace kdx::test {
namespace {

class SessionTest : public WindowTest {
protected:
    SessionTest() { folder.copyShipped(); }

    void useGpib() {
        setGeneral("BUS", "INTERFACE", "IEC");
        start();
    }
    void useLan() {
        setGeneral("BUS", "INTERFACE", "TCPIP");
        start();
    }
};

TEST_F(SessionTest, OpensTheGpibAddressOnBoard0) {
    setGeneral("ADRESSEN", "KDX_IEEE", "17");
    useGpib();
    EXPECT_EQ(text("INIT_Taste"), "Init IEEE");
    openSession();
    EXPECT_EQ(visa.calls, (Lines{"viOpenDefaultRM", "viStatusDesc 0", "viOpen GPIB0::17::INSTR 0 0"}));
}

TEST_F(SessionTest, OpensTheLanAddressExactlyAsTyped) {
    useLan();
    EXPECT_EQ(text("INIT_Taste"), "Init TCPIP");
    dialogs.inputs = {QStringLiteral(" lab 7 ")};
    emit find<ClickableLabel>("Adr1_Label")->clicked();
    EXPECT_EQ(folder.read("RDS_Allg.INI").find("KDX_TCPIP= lab 7 \r\n") != std::string::npos, true);
    openSession();
    EXPECT_EQ(visa.calls.back(), "viOpen TCPIP:: lab 7 ::INSTR 0 0");
}

TEST_F(SessionTest, TheStatusOfTheDescriptionReplacesTheManagersStatus) {
    visa.rmStatus = -1073807202;
    visa.descStatus = 0;
    visa.openStatus = -1073807343;
    dialogs.expectedMessages = 1;
    useLan();
    openSession();
    EXPECT_EQ(visa.calls[1], "viStatusDesc -1073807202");
    EXPECT_EQ(session->instrument.LastVisaStatus, -1073807343);
}

TEST_F(SessionTest, AFailedOpenShowsTheStatusAndChangesNothingElse) {
    visa.openStatus = -1073807343;
    dialogs.expectedMessages = 1;
    useLan();
    openSession();
    EXPECT_EQ(dialogs.shown.back().title, QStringLiteral("Interface Error"));
    EXPECT_EQ(dialogs.shown.back().text, QStringLiteral("Please Check Device! -1073807343"));
    EXPECT_EQ(dialogs.shown.back().icon, Dialogs::Icon::Critical);
    EXPECT_FALSE(state.InstrumentOnline);
    EXPECT_TRUE(find("INIT_Taste")->isEnabled());
    EXPECT_FALSE(find("SSTab1")->isEnabled());
    click("Store_Taste_0");
    EXPECT_EQ(sent(), Lines{});
}

TEST_F(SessionTest, APositiveStatusOfTheOpenIsAFailureToo) {
    visa.openStatus = 1073676290;
    dialogs.expectedMessages = 1;
    useLan();
    openSession();
    EXPECT_FALSE(state.InstrumentOnline);
}

TEST_F(SessionTest, TheAnswerBecomesTheTitleWithABlankForItsLineEnd) {
    useLan();
    openSession();
    EXPECT_EQ(window->windowTitle().toStdString(), "KDX,TEST" + std::string(52, ' '));
}

TEST_F(SessionTest, AFailedIdentificationGoesOn) {
    visa.readStatuses = {-1073807339};
    dialogs.expectedMessages = 1;
    useLan();
    openSession();
    EXPECT_EQ(dialogs.shown[0].text, QStringLiteral("Fehler: -1073807339"));
    EXPECT_EQ(window->windowTitle().toStdString(), "Error");
    EXPECT_TRUE(state.InstrumentOnline);
}

TEST_F(SessionTest, AnOpenSessionSwitchesThePagesOnAndTheConnectionOff) {
    useLan();
    openSession();
    for (const char* on : {"SSTab1", "Frame7", "GTL_Taste", "Command5"}) EXPECT_TRUE(find(on)->isEnabled()) << on;
    for (const char* off : {"Frame8", "INIT_Taste", "Ende_Taste"}) EXPECT_FALSE(find(off)->isEnabled()) << off;
    EXPECT_FALSE(action("Mnu_Info_RS232")->isEnabled());
    EXPECT_FALSE(window->findChild<QMenu*>(QStringLiteral("Mnu_Info_Interface"))->isEnabled());
}

TEST_F(SessionTest, ClosingSwitchesThemBackExceptTheSerialEntry) {
    useLan();
    openSession();
    sent();
    click("GTL_Taste");
    EXPECT_EQ(visa.calls.back(), "viClose " + std::to_string(session->instrument.InstrSession));
    for (const char* on : {"Frame8", "INIT_Taste", "Ende_Taste"}) EXPECT_TRUE(find(on)->isEnabled()) << on;
    for (const char* off : {"SSTab1", "Frame7"}) EXPECT_FALSE(find(off)->isEnabled()) << off;
    EXPECT_FALSE(action("Mnu_Info_RS232")->isEnabled());
    EXPECT_TRUE(window->findChild<QMenu*>(QStringLiteral("Mnu_Info_Interface"))->isEnabled());
    EXPECT_TRUE(state.InstrumentOnline);
    EXPECT_NE(session->instrument.InstrSession, 0);
    click("Store_Taste_0");  // the switched-off page keeps it away from the closed handle
    EXPECT_EQ(sent(), Lines{});
}

TEST_F(SessionTest, TimersRestFromTheClosingToTheNextOpening) {
    // The clock is on from the start: it must not send to the closed handle every 20 s.
    useLan();
    EXPECT_TRUE(tick("Timer1"));  // before the first opening nothing is sent, and the clock runs on the page
    openSession();
    EXPECT_TRUE(tick("Timer1"));
    click("GTL_Taste");
    sent();
    for (const char* timer : {"Timer1", "PS_Timer", "TA_Timer", "TA_Rep_Timer", "EON_TA_Zeit", "TMC_Sende_Timer"}) {
        EXPECT_FALSE(tick(timer)) << timer;
    }
    visa.openStatus = visa::kTimeout;
    dialogs.expectedMessages = 1;
    openSession();
    EXPECT_FALSE(tick("Timer1"));  // the opening failed
    visa.openStatus = 0;
    openSession();
    sent();
    EXPECT_TRUE(tick("Timer1"));
    EXPECT_EQ(sent().size(), 1U);
}

TEST_F(SessionTest, AFailingCloseIsSilent) {
    visa.closeStatus = -1073807346;
    useLan();
    openSession();
    click("GTL_Taste");
    EXPECT_EQ(session->instrument.LastVisaStatus, -1073807346);
}

TEST_F(SessionTest, ANewOpeningRunsAllStepsAgain) {
    useLan();
    openSession();
    const Lines first = sent();
    click("GTL_Taste");
    visa.calls.clear();
    openSession();
    EXPECT_EQ(visa.calls[0], "viOpenDefaultRM");
    const Lines second = sent();
    EXPECT_EQ(second.front(), "*IDN?");
    // The impedance stays chosen, and the RF output is switched again.
    EXPECT_NE(std::find(first.begin(), first.end(), ":OUTPUT:STAT ON"), first.end());
    EXPECT_NE(std::find(second.begin(), second.end(), ":OUTPUT:STAT OFF"), second.end());
}

TEST_F(SessionTest, TheInterfaceInUseIsGreyedOut) {
    useGpib();
    EXPECT_FALSE(action("Mnu_Info_Interface_IEC")->isEnabled());
    EXPECT_TRUE(action("Mnu_Info_Interface_COM")->isEnabled());
    EXPECT_FALSE(action("Mnu_Info_RS232")->isEnabled());
    action("Mnu_Info_Interface_COM")->trigger();
    EXPECT_TRUE(action("Mnu_Info_Interface_IEC")->isEnabled());
    EXPECT_FALSE(action("Mnu_Info_Interface_COM")->isEnabled());
    EXPECT_TRUE(action("Mnu_Info_RS232")->isEnabled());
    EXPECT_EQ(general("BUS", "INTERFACE"), "TCPIP");
    EXPECT_EQ(text("INIT_Taste"), "Init TCPIP");
    EXPECT_EQ(text("Adr1_Label"), "127.0.0.1");
    EXPECT_TRUE(find("Label6")->isHidden());
    action("Mnu_Info_Interface_COM")->trigger();  // greyed out: nothing happens
    action("Mnu_Info_Interface_IEC")->trigger();
    EXPECT_EQ(general("BUS", "INTERFACE"), "IEC");
    EXPECT_EQ(text("Adr1_Label"), "28");
    EXPECT_FALSE(find("Label6")->isHidden());
    EXPECT_TRUE(find("Adr1_VScroll")->isHidden());
}

TEST_F(SessionTest, AnInterfaceThatWasNeverStoredIsWrittenInItsOwnSpelling) {
    folder.write("RDS_Allg.INI", "");
    start();
    action("Mnu_Info_Interface_COM")->trigger();
    EXPECT_NE(folder.read("RDS_Allg.INI").find("[BUS]\r\nInterface=TCPIP\r\n"), std::string::npos);
}

TEST_F(SessionTest, AGpibAddressMustLieBetween1And31) {
    useGpib();
    dialogs.inputs = {QStringLiteral("31"), QStringLiteral("1"), QStringLiteral("0"), QStringLiteral("x"),
                      QStringLiteral("30")};
    emit find<ClickableLabel>("Adr1_Label")->clicked();
    EXPECT_EQ(text("Adr1_Label"), "30");
    EXPECT_EQ(general("ADRESSEN", "KDX_IEEE"), "30");
    EXPECT_EQ(dialogs.shown.size(), 5U);
    EXPECT_EQ(dialogs.shown[0].text, QStringLiteral("Please enter here: "));
    EXPECT_EQ(dialogs.shown[0].title, QStringLiteral("IEC Adress."));
    EXPECT_EQ(dialogs.shown[0].preset, QStringLiteral("28"));
}

TEST_F(SessionTest, AGpibAddressIsStoredAsTyped) {
    useGpib();
    for (const char* typed : {"2", "1.5", "30.9 "}) {
        dialogs.inputs = {QString::fromLatin1(typed)};
        emit find<ClickableLabel>("Adr1_Label")->clicked();
        EXPECT_EQ(text("Adr1_Label"), typed);
    }
}

TEST_F(SessionTest, CancellingTheAddressChangesNothing) {
    useLan();
    dialogs.inputs = {QString()};
    emit find<ClickableLabel>("Adr1_Label")->clicked();
    EXPECT_EQ(text("Adr1_Label"), "127.0.0.1");
    EXPECT_EQ(dialogs.shown[0].title, QStringLiteral("TCPIP Adress."));
}

TEST_F(SessionTest, TheInterfaceIsReadAgainAtTheOpening) {
    useLan();
    setGeneral("BUS", "INTERFACE", "IEC");
    openSession();
    EXPECT_EQ(visa.calls.back(), "viOpen GPIB0::127.0.0.1::INSTR 0 0");
}

}  // namespace
}  // namespace kdx::test
