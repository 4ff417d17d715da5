// What the pages "AF Liste" and "E O N" tell of a value that did not reach the instrument.
#include "af/afpage.h"
#include "af/settings.h"
#include "eonpagetest.h"

namespace kdx::test {
namespace {

class AfMarksTest : public PageTest {
protected:
    AfMarksTest() {
        page.label();
        setList("87.6,90.1,94.3");
        setProfile(kSet1, "RDS", "AF_LISTE2", "98.5,99.1");
        lists.load(settings);
        page.load();
        click("Taste_AF_Senden");
        sent();
    }
    QWidget& root() override { return page; }
    void setList(const std::string& list) { setProfile(kSet1, "RDS", "AF_LISTE1", list); }

    AfListSet lists;
    AfPage page{context, lists, nullptr};
};

TEST_F(AfMarksTest, AListThatWasChangedInTheEditorIsMarkedUntilItIsSent) {
    EXPECT_EQ(stateOf("AF_List1"), "");
    page.openEditorBy([this] { setList("87.6,90.1"); });
    click("AF_Bearbeiten");
    EXPECT_EQ(stateOf("AF_List1"), "ungesendet");
    EXPECT_EQ(stateOf("AF_TN"), "ungesendet");
    click("AFList_Opt_1");
    EXPECT_EQ(stateOf("AF_List1"), "") << "the other one is in force still";
    click("AFList_Opt_0");
    click("Taste_AF_Senden");
    EXPECT_EQ(stateOf("AF_List1"), "");
    EXPECT_EQ(stateOf("AF_TN"), "");
}

TEST_F(AfMarksTest, AListThatDidNotArriveIsMarked) {
    visa.writeStatuses = {visa::kTimeout};
    dialogs.expectedMessages = 1;
    click("Taste_AF_Senden");
    EXPECT_EQ(stateOf("AF_List1"), "ungesendet");
    EXPECT_EQ(find("AF_List1")->toolTip().toStdString(), "Nicht beim Gerät angekommen.");
    click("AFList_Opt_1");
    EXPECT_EQ(stateOf("AF_List1"), "");
    click("AFList_Opt_0");
    click("Taste_AF_Senden");
    EXPECT_EQ(stateOf("AF_List1"), "");
}

TEST_F(AfMarksTest, WhatAStoppedSendingLeftOutIsMarked) {
    page.openEditorBy([this] {
        setList("87.6,90.1");
        setProfile(kSet1, "RDS", "AF_LISTE2", "98.5");
    });
    click("AF_Bearbeiten");
    visa.writeStatuses = {visa::kTimeout};
    dialogs.expectedMessages = 1;
    dialogs.stopAtFailure = true;
    click("Taste_AF_Senden");
    EXPECT_EQ(stateOf("AF_List1"), "ungesendet");
    click("AFList_Opt_1");
    EXPECT_EQ(stateOf("AF_List1"), "ungesendet");
}

TEST_F(AfMarksTest, AMethodIsInForceWithTheListsThatWentOutInIt) {
    click("AFMethod_opt_1");
    EXPECT_EQ(stateOf("AFMethod_opt_1"), "ungesendet");
    EXPECT_EQ(stateOf("AF_List1"), "ungesendet");
    click("AFMethod_opt_0");
    EXPECT_EQ(stateOf("AFMethod_opt_0"), "");
    EXPECT_EQ(stateOf("AFMethod_opt_1"), "");
    EXPECT_EQ(stateOf("AF_List1"), "");
    click("AFMethod_opt_1");
    visa.writeStatus = visa::kTimeout;
    dialogs.expectedMessages = 2;
    click("Taste_AF_Senden");
    EXPECT_EQ(stateOf("AFMethod_opt_1"), "ungesendet");
    visa.writeStatus = 0;
    click("Taste_AF_Senden");
    EXPECT_EQ(stateOf("AFMethod_opt_1"), "");
    EXPECT_EQ(stateOf("AF_List1"), "");
}

using EonMarksTest = EonPageTest;

TEST_F(EonMarksTest, AValueOfTheNetworkThatDidNotArriveIsMarkedUntilItDoes) {
    load();
    for (const bool corrected : {false, true}) {
        state.corrections.eonType = corrected;
        inVain([&] { select("EON_PTY_Combo", corrected ? 5 : 3); });
        EXPECT_EQ(stateOf("EON_PTY_Combo"), "ungesendet") << corrected;
        select("EON_PTY_Combo", corrected ? 6 : 4);
        EXPECT_EQ(stateOf("EON_PTY_Combo"), "") << corrected;
    }
    inVain([&] { click("EON_TA_Schalter"); });
    EXPECT_EQ(stateOf("EON_TA_Schalter"), "ungesendet");
    click("EON_TA_Schalter");
    EXPECT_EQ(stateOf("EON_TA_Schalter"), "");
    inVain([&] { click("EON_TP_Check"); });
    EXPECT_EQ(stateOf("EON_TP_Check"), "ungesendet");
    click("EON_TP_Check");
    EXPECT_EQ(stateOf("EON_TP_Check"), "");
}

TEST_F(EonMarksTest, AListThatWasChangedInTheEditorIsMarkedUntilItIsSent) {
    store("EON_AFB1", "87.6,90.1");
    store("EON_AFB", "1");
    load();
    click("EON_AFB_Senden");
    EXPECT_EQ(stateOf("AFB_Liste"), "");
    page->openEditorBy([this] { store("EON_AFB1", "87.6,90.2"); });
    click("EON_AF_Bearbeiten");
    EXPECT_EQ(stateOf("AFB_Liste"), "ungesendet");
    EXPECT_EQ(stateOf("Tuned_AFB"), "ungesendet");
    inVain([&] { click("EON_AFB_Senden"); });
    EXPECT_EQ(stateOf("AFB_Liste"), "ungesendet");
    click("EON_AFB_Senden");
    EXPECT_EQ(stateOf("AFB_Liste"), "");
}

TEST_F(EonMarksTest, ANetworkThatIsSentAnewHasNothingButItsPi) {
    store("EON_AFB1", "87.6,90.1");
    store("EON_AFB", "1");
    load();
    held();
    EXPECT_EQ(stateOf("EON_TP_Check"), "");
    EXPECT_EQ(stateOf("AFB_Liste"), "");
    visa.answersTo[coder("EON PI?")] = "\"D3C2\"\n";
    click("EON_PI_Taste");
    EXPECT_EQ(stateOf("EON_TP_Check"), "ungesendet");
    EXPECT_EQ(stateOf("AFB_Liste"), "ungesendet");
}

}  // namespace
}  // namespace kdx::test
