#include <gtest/gtest.h>

#include "support/windowtest.h"

namespace kdx::test {
namespace {

class ValueStatesTest : public WindowTest {
protected:
    std::string stateOf(const char* name) { return find(name)->property("zustand").toString().toStdString(); }
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
    // Everything fails, and the user goes on to the end.
    visa.writeStatus = -1073807339;
    dialogs.expectedMessages = 1000;
    click("Btn_SetRdsStereo");
    dialogs.expectedMessages = 0;
    for (const char* name : {"Status_1", "Status_2", "Status_3", "Status_4", "PS_T", "PI_T", "RT_Text1", "EON_PI_Text",
                             "EON_PS_Text", "Label10"})
        EXPECT_EQ(stateOf(name), "ungesendet") << name;
    visa.writeStatus = 0;
    click("Btn_SetRdsStereo");
    for (const char* name : {"Status_1", "Status_2", "Status_3", "Status_4", "PS_T", "PI_T", "RT_Text1", "EON_PI_Text",
                             "EON_PS_Text", "Label10"})
        EXPECT_EQ(stateOf(name), "") << name;
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

}  // namespace
}  // namespace kdx::test
