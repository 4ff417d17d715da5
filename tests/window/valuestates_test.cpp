#include <gtest/gtest.h>

#include <functional>
#include <vector>

#include "support/windowtest.h"

namespace kdx::test {
namespace {

class ValueStatesTest : public WindowTest {
protected:
    /// What is done while nothing reaches the instrument; the user goes on at every box, or stops at the first one.
    void withoutInstrument(const std::function<void()>& action, bool stop = false) {
        visa.writeStatus = visa::kTimeout;
        dialogs.stopAtFailure = stop;
        dialogs.expectedMessages = stop ? 1 : 1000;
        action();
        visa.writeStatus = 0;
        dialogs.stopAtFailure = false;
        dialogs.expectedMessages = 0;
    }
};

TEST_F(ValueStatesTest, WhatSendingAllSentIsInForceAndShown) {
    startShipped();
    EXPECT_EQ(stateOf("Status_3"), "ungesendet");
    openSession();
    for (const char* name : {"Status_1", "Status_2", "Status_3", "Status_4", "PS_T", "PI_T", "RT_Text1"})
        EXPECT_EQ(stateOf(name), "") << name;
    type("PI_T", "12AB");
    EXPECT_EQ(stateOf("PI_T"), "ungesendet");
    EXPECT_NE(text("Status_2"), "12AB");
    click("Btn_SetRdsStereo");
    EXPECT_EQ(text("Status_2"), "12AB");
    EXPECT_EQ(stateOf("Status_2"), "");
    EXPECT_EQ(stateOf("PI_T"), "");
}

TEST_F(ValueStatesTest, WhatDidNotArriveInASequenceIsNotInForce) {
    startShipped();
    openSession();
    const std::vector<const char*> shown = {"Status_0",
                                            "Status_1",
                                            "Status_2",
                                            "Status_3",
                                            "Status_4",
                                            "Status_10",
                                            "Status_13",
                                            "PS_T",
                                            "PI_T",
                                            "RT_Text1",
                                            "PTY_Combo1",
                                            "Check1",
                                            "TA_Check",
                                            "MS_opt_0",
                                            "Label10",
                                            "AF_List1",
                                            "EON_PI_Text",
                                            "EON_PS_Text",
                                            "EON_TP_Check",
                                            "EON_TA_Schalter",
                                            "Pre_opt_1",
                                            "HScroll1",
                                            "HScroll1_Zahl",
                                            "Pilot_OnOff",
                                            "Pilot_Hub_Zahl",
                                            "RDS_Hub_Scroll",
                                            "RDS_OnOff",
                                            "Ari_OnOff",
                                            "Taste_DATA_MODE",
                                            "Input_HF_Freq_Label",
                                            "Status_17"};
    withoutInstrument([this] { click("Btn_SetRdsStereo"); });
    for (const char* name : shown) EXPECT_EQ(stateOf(name), "ungesendet") << name;
    click("Btn_SetRdsStereo");
    for (const char* name : shown) EXPECT_EQ(stateOf(name), "") << name;
}

TEST_F(ValueStatesTest, ASequenceStoppedAtAStepLeavesThatStepUnsent) {
    startShipped();
    openSession();
    type("PI_T", "12AB");
    sent();
    click("Btn_SetRdsStereo");
    const Lines commands = sent();
    const auto pi = std::find(commands.begin(), commands.end(), direct("PI=12AB"));
    ASSERT_NE(pi, commands.end());
    type("PI_T", "12CD");
    visa.writeStatuses.assign(static_cast<std::size_t>(pi - commands.begin()), 0);
    visa.writeStatuses.push_back(-1073807339);
    dialogs.stopAtFailure = true;
    dialogs.expectedMessages = 1;
    click("Btn_SetRdsStereo");
    EXPECT_EQ(stateOf("PI_T"), "ungesendet");
    EXPECT_EQ(stateOf("Status_2"), "ungesendet");
    EXPECT_EQ(stateOf("PS_T"), "") << "what was sent before is in force still";
}

TEST_F(ValueStatesTest, AWrongPiIsFoundInTheStatusRow) {
    startShipped();
    openSession();
    type("PI_T", "12XY");
    click("Btn_SetRdsStereo");
    EXPECT_EQ(stateOf("Status_2"), "abgelehnt");
    EXPECT_TRUE(find("Status_2")->toolTip().startsWith(QStringLiteral("Die PI muss")));
    EXPECT_EQ(stateOf("PI_T"), "abgelehnt");
}

TEST_F(ValueStatesTest, ANumberOfTheGeneratorThatTheCoderRefusesIsMarked) {
    startShipped();
    openSession();
    EXPECT_EQ(stateOf("Status_17"), "");
    dialogs.inputs = {QStringLiteral("98,7")};
    QMouseEvent release(QEvent::MouseButtonRelease, QPointF(1, 1), QPointF(1, 1), Qt::LeftButton, Qt::NoButton, {});
    QApplication::sendEvent(find("Input_HF_Freq_Label"), &release);
    EXPECT_EQ(text("Status_17"), "98,7");
    EXPECT_EQ(stateOf("Status_17"), "abgelehnt");
    EXPECT_EQ(stateOf("Input_HF_Freq_Label"), "abgelehnt");
    click("Btn_SetRdsStereo");  // sends what data set 1 holds
    EXPECT_EQ(stateOf("Status_17"), "");
    EXPECT_EQ(stateOf("Input_HF_Freq_Label"), "");
}

TEST_F(ValueStatesTest, TheMarksFollowTheLanguage) {
    startShipped();
    openSession();
    type("PS_T", "NEW");
    action("Mnu_Info_Sprache_E")->trigger();
    EXPECT_EQ(find("PS_T")->toolTip().toStdString(),
              "Not sent yet.\nProgramme service name: what a radio shows, 8 characters at most");
}

TEST_F(ValueStatesTest, WhatAStoppedOpeningLeftOutIsNotInForce) {
    startShipped();
    visa.writeStatuses.assign(4, 0);  // the identification and the base state
    withoutInstrument([this] { openSession(); }, true);
    for (const char* name : {"FM_Hub_Zahl", "FM_Hub_Scroll", "FM_Source_Opt_3", "Pre_opt_1", "Pilot_OnOff", "AF_List1",
                             "PTY_Combo1", "MS_opt_0", "EON_TP_Check", "HfOnOffState"})
        EXPECT_EQ(stateOf(name), "ungesendet") << name;
    EXPECT_TRUE(find("FM_Hub_Zahl")->toolTip().startsWith(QStringLiteral("Nicht beim Gerät angekommen.")));
    EXPECT_TRUE(find("Pre_opt_1")->toolTip().startsWith(QStringLiteral("Noch nicht gesendet.")));
    click("GTL_Taste");
    openSession();
    for (const char* name : {"FM_Hub_Zahl", "FM_Hub_Scroll", "FM_Source_Opt_3", "Pre_opt_1", "Pilot_OnOff", "AF_List1",
                             "PTY_Combo1", "MS_opt_0", "EON_TP_Check", "HfOnOffState"})
        EXPECT_EQ(stateOf(name), "") << name;
}

TEST_F(ValueStatesTest, AMarkStaysWithTheNextLanguageAndSaysItThere) {
    startShipped();
    openSession();
    withoutInstrument([this] { click("Pre_opt_2"); });
    EXPECT_EQ(find("Pre_opt_2")->palette().color(find("Pre_opt_2")->backgroundRole()), QColor(0xFF, 0xF8, 0xD0));
    action("Mnu_Info_Sprache_E")->trigger();
    EXPECT_EQ(stateOf("Pre_opt_2"), "ungesendet");
    EXPECT_TRUE(find("Pre_opt_2")->toolTip().startsWith(QStringLiteral("Has not reached the instrument.\n")));
    click("Pre_opt_2");
    EXPECT_EQ(stateOf("Pre_opt_2"), "");
    EXPECT_FALSE(find("Pre_opt_2")->toolTip().isEmpty());
    EXPECT_FALSE(find("Pre_opt_2")->toolTip().contains(QStringLiteral("instrument.\n")));
}

TEST_F(ValueStatesTest, AnotherDataSetIsNotInForceBeforeItIsSent) {
    startShipped();
    openSession();
    dialogs.confirmations = {false};
    action("Mnu_Datensatz_3")->trigger();
    for (const char* name : {"PS_T", "PTY_Combo1", "DI_Opt_3", "AF_List1", "EON_PI_Text"})
        EXPECT_EQ(stateOf(name), "ungesendet") << name;
    EXPECT_EQ(stateOf("FM_Hub_Zahl"), "") << "belongs to no set";
    click("Btn_SetRdsStereo");
    for (const char* name : {"PS_T", "PTY_Combo1", "AF_List1", "EON_PI_Text"}) EXPECT_EQ(stateOf(name), "") << name;
    EXPECT_EQ(stateOf("DI_Opt_3"), "ungesendet") << "a whole data set leaves it out";
    click("DI_Opt_3");
    EXPECT_EQ(stateOf("DI_Opt_3"), "");
}

TEST_F(ValueStatesTest, NothingThatWasSentIsMarkedAfterAnOpening) {
    startShipped();
    openSession();
    for (const QWidget* control : window->findChildren<QWidget*>()) {
        // There is no code of a message that nobody has chosen.
        if (control->objectName() == QStringLiteral("TMC_Gr8_Label")) continue;
        EXPECT_EQ(control->property("zustand").toString().toStdString(), "") << control->objectName().toStdString();
    }
}

}  // namespace
}  // namespace kdx::test
