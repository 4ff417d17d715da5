// The connection in words, the RF output and the title.
#include <gtest/gtest.h>

#include "support/windowtest.h"

namespace kdx::test {
namespace {

class IndicatorsTest : public WindowTest {
protected:
    IndicatorsTest() { folder.copyShipped(); }
    void failWith(VisaStatus status) {
        visa.writeStatus = status;
        dialogs.expectedMessages = 1;
        click("Command3");
        visa.writeStatus = 0;
    }
    std::string connection() { return text("Verbindung_Anzeige"); }
    std::string mark() { return find("Verbindung_Marke")->toolTip().toStdString(); }
};

TEST_F(IndicatorsTest, TheConnectionIsToldInWords) {
    start();
    EXPECT_EQ(connection(), "nicht verbunden");
    openSession();
    EXPECT_EQ(connection(), "verbunden: 127.0.0.1");
    EXPECT_EQ(mark(), connection());
    action("Mnu_Info_Sprache_E")->trigger();
    EXPECT_EQ(connection(), "connected: 127.0.0.1");
    click("GTL_Taste");
    EXPECT_EQ(connection(), "not connected");
    EXPECT_EQ(mark(), connection());
}

TEST_F(IndicatorsTest, AGpibAddressIsToldAsOne) {
    setGeneral("BUS", "INTERFACE", "IEC");
    start();
    openSession();
    EXPECT_EQ(connection(), "verbunden: GPIB 28");
}

TEST_F(IndicatorsTest, ALinkThatIsLostIsToldUntilTheNextCommandThatSucceeds) {
    start();
    openSession();
    failWith(visa::kConnectionLost);
    EXPECT_EQ(connection(), "Verbindung verloren");
    click("Command3");
    EXPECT_EQ(connection(), "verbunden: 127.0.0.1");
}

TEST_F(IndicatorsTest, EveryStatusThatSaysThatNobodyIsThereIsALoss) {
    start();
    openSession();
    for (const VisaStatus status : {visa::kConnectionLost, visa::kInputOutput, visa::kResourceNotFound,
                                    visa::kInvalidObject, visa::kSystemError, visa::kNoListeners}) {
        failWith(status);
        EXPECT_EQ(connection(), "Verbindung verloren") << status;
        EXPECT_EQ(mark(), connection());
        click("Command3");
        EXPECT_EQ(connection(), "verbunden: 127.0.0.1") << status;
    }
}

TEST_F(IndicatorsTest, AStoppedCallAHeldDeviceAndASlowAnswerAreNoLoss) {
    start();
    openSession();
    for (const VisaStatus status : {visa::kAborted, visa::kResourceLocked, visa::kTimeout}) {
        failWith(status);
        EXPECT_EQ(connection(), "verbunden: 127.0.0.1") << status;
        EXPECT_EQ(mark(), connection());
    }
}

TEST_F(IndicatorsTest, ALostLinkStaysLostWhenTheNextCommandIsStoppedOrSilent) {
    start();
    openSession();
    failWith(visa::kConnectionLost);
    for (const VisaStatus status : {visa::kAborted, visa::kResourceLocked, visa::kTimeout}) {
        failWith(status);
        EXPECT_EQ(connection(), "Verbindung verloren") << status;
    }
}

TEST_F(IndicatorsTest, LocalAndAnOpeningEndALostLink) {
    start();
    openSession();
    failWith(visa::kConnectionLost);
    click("GTL_Taste");
    EXPECT_EQ(connection(), "nicht verbunden");
    openSession();
    EXPECT_EQ(connection(), "verbunden: 127.0.0.1");
}

TEST_F(IndicatorsTest, AnOpeningThatFailsLeavesTheWindowWithoutAConnection) {
    start();
    visa.openStatus = visa::kConnectionLost;
    dialogs.expectedMessages = 1;
    openSession();
    EXPECT_EQ(connection(), "nicht verbunden");
}

TEST_F(IndicatorsTest, TheVirtualInstrumentIsToldAsSuch) {
    simulated = true;
    start();
    EXPECT_EQ(connection(), "nicht verbunden");
    openSession();
    EXPECT_EQ(connection(), "simuliert");
}

TEST_F(IndicatorsTest, TheRfOutputIsToldBesideTheLevel) {
    start();
    EXPECT_EQ(text("HF_Anzeige"), "--") << "nobody knows";
    openSession();
    EXPECT_EQ(text("HF_Anzeige"), "ein");
    click("HfOnOffState");
    EXPECT_EQ(text("HF_Anzeige"), "aus");
    action("Mnu_Info_Sprache_E")->trigger();
    EXPECT_EQ(text("HF_Anzeige"), "off");
    EXPECT_GT(find("HF_Anzeige")->x(), find("Status_13")->x());
    EXPECT_LT(find("HF_Anzeige")->x(), find("Status_14")->x());
}

TEST_F(IndicatorsTest, AnOutputThatCouldNotBeSwitchedIsNotToldAsSwitched) {
    start();
    openSession();
    for (const VisaStatus status : {visa::kConnectionLost, visa::kTimeout}) {
        visa.writeStatus = status;
        dialogs.expectedMessages = 1;
        click("HfOnOffState");
        EXPECT_EQ(text("HF_Anzeige"), "ein");
    }
}

TEST_F(IndicatorsTest, TheTitleShowsControlCharactersAsBlanksAndIsTheProgramsAgainAfterLocal) {
    visa.answersTo["*IDN?"] = std::string("KDX,\tTEST\n");
    start();
    openSession();
    EXPECT_EQ(window->windowTitle().toStdString(), "KDX, TEST " + std::string(50, ' '));
    click("GTL_Taste");
    EXPECT_EQ(window->windowTitle().toStdString(), "KDX-RDS V 1.0  / Mar. 2009  ");
}

}  // namespace
}  // namespace kdx::test
