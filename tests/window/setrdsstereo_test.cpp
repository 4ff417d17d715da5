#include <gtest/gtest.h>

#include <algorithm>

#include "station/rehearsal.h"
#include "station/wholedataset.h"
#include "support/windowtest.h"

namespace kdx::test {
namespace {

class SetRdsStereoTest : public WindowTest {
protected:
    SetRdsStereoTest() {
        folder.copyShipped();
        folder.write("RDS_Allg.INI", kWholeGeneral);
        folder.write("Datenset1.INI", kWholeDataSet);
        visa.answersTo[coder("EON PI?")] = kTwoNetworks;
    }
};

TEST_F(SetRdsStereoTest, OpeningASessionSendsExactlyThis) {
    start();
    openSession();
    EXPECT_EQ(sent(), openingCommands());
}

TEST_F(SetRdsStereoTest, TheButtonSendsTheDataSetAlone) {
    start();
    openSession();
    sent();
    click("Btn_SetRdsStereo");
    EXPECT_EQ(sent(), kDataSetCommands);
}

class EachDataSet : public WindowTest, public testing::WithParamInterface<const char*> {};

TEST_P(EachDataSet, IsSentByTheButtonAsItIsSentWithoutAWindow) {
    folder.copyShipped();
    folder.write("Datenset1.INI", folder.read(dataSetFile(GetParam())));
    start();
    openSession();
    sent();
    click("Btn_SetRdsStereo");
    const Lines byButton = sent();
    Rehearsal rehearsal(data, captions);
    rehearsal.apply(session->profile);
    const Lines& opening = rehearsal.commands();
    EXPECT_GT(byButton.size(), 20U);
    EXPECT_NE(std::search(opening.begin(), opening.end(), byButton.begin(), byButton.end()), opening.end());
}
INSTANTIATE_TEST_SUITE_P(Shipped, EachDataSet, testing::Values("1", "2", "3", "4", "5"));

TEST_F(SetRdsStereoTest, WhatIsTypedAndNotSentYetGoesOutWithTheDataSet) {
    start();
    openSession();
    sent();
    type("PI_T", "A1B2");
    type("RT_Text1", "Neuer Text");
    click("Btn_SetRdsStereo");
    const Lines commands = sent();
    EXPECT_EQ(std::count(commands.begin(), commands.end(), direct("PI=A1B2")), 1);
    EXPECT_EQ(std::count(commands.begin(), commands.end(), direct("RT=10,0,Neuer Text")), 1);
    EXPECT_NE(folder.read("Datenset1.INI").find("PI=d3c"), std::string::npos);
}

TEST_F(SetRdsStereoTest, AnImpossibleProgrammeTypeGoesOutAsMinusOne) {
    setDataSet1("RDS", "PTY", "32");
    start();
    openSession();
    const Lines commands = sent();
    EXPECT_EQ(std::count(commands.begin(), commands.end(), direct("PTY=-1")), 1);
}

TEST_F(SetRdsStereoTest, AMissingFrequencyLevelOrAudioFrequencyIsShownEmpty) {
    start();
    openSession();
    for (const char* key : {"HF_Frequenz", "HF_Pegel", "NF_Frequenz"}) setDataSet1("VRN", key, "");
    click("GTL_Taste");
    openSession();
    for (const char* shown : {"Status_17", "Status_13", "Status_14", "Input_HF_Freq_Label", "Input_HF_Pegel_Label",
                              "Input_AF_Freq_Label"}) {
        EXPECT_EQ(text(shown), "") << shown;
    }
}

/// Notes the refusal of a list among the commands, as the user meets it, and lets a timer run out while it shows.
class RefusalDialogs final : public Dialogs {
public:
    void message(Icon, const QString& title, const QString&, const QString&) override {
        if (onMessage) onMessage(title.toStdString());
    }
    bool messageOrStop(const QString&, const QString&, const QString&, const QString&, Icon) override { return true; }
    bool confirm(const QString&, const QString&) override { return false; }
    QString input(const QString&, const QString&, const QString&) override { return {}; }
    std::function<void(const std::string& title)> onMessage;
};

class RefusedListTest : public SetRdsStereoTest {
protected:
    Dialogs& boxesOfWindow() override { return boxes; }
    RefusalDialogs boxes;
};

TEST_F(RefusedListTest, ShowsItsBoxBetweenItsNeighboursAndLetsNoTimerIn) {
    setDataSet1("RDS", "AF_LISTE2", "88.0,1,2,3,4,5,6,7,8,9,10,11,12,13");
    start();
    openSession();
    click("AFMethod_opt_1");
    // An announcement of the other network is on: its end must not overtake what the data set says of it.
    click("Check1");
    click("TA_Check");
    click("Check1");
    click("EON_TA_Schalter");
    ASSERT_TRUE(find<QTimer>("EON_TA_Zeit")->isActive());
    sent();
    Lines titles;
    boxes.onMessage = [&](const std::string& title) {
        titles.push_back(title);
        EXPECT_EQ(visa.written.back(), direct("AF=N,87.6,87.6,90.1,87.6,94.3"));
        EXPECT_FALSE(tick("EON_TA_Zeit"));
    };
    click("Btn_SetRdsStereo");
    EXPECT_EQ(titles, Lines{"Liste Nr.2 ungültig"});
    const Lines commands = sent();
    const auto first = std::find(commands.begin(), commands.end(), direct("AF=N,87.6,87.6,90.1,87.6,94.3"));
    ASSERT_NE(first, commands.end());
    EXPECT_EQ(first[1], direct("AF=+,101.1"));
    EXPECT_TRUE(tick("EON_TA_Zeit"));
    EXPECT_EQ(sent(), Lines{direct("EON-TA=D3C2,0")});
}

TEST_F(SetRdsStereoTest, TheIndicatorsShowWhatWasSent) {
    start();
    openSession();
    EXPECT_EQ(text("Status_17"), "98.5");
    EXPECT_EQ(text("Status_13"), "60");
    EXPECT_EQ(text("Status_14"), "1");
    EXPECT_EQ(text("Input_HF_Freq_Label"), "98.5");
    EXPECT_EQ(text("Input_HF_Pegel_Label"), "60");
    EXPECT_EQ(text("Input_AF_Freq_Label"), "1");
    EXPECT_EQ(text("Status_10"), "aus");
    EXPECT_EQ(text("Status_0"), "aus");
    EXPECT_EQ(text("Taste_DATA_MODE"), "&RDS_Mode");
    EXPECT_FALSE(enabled("TestDat_Opt_0"));
}

TEST_F(SetRdsStereoTest, TheRestCanBeStoppedAtTheFirstBox) {
    start();
    openSession();
    sent();
    visa.writeStatus = visa::kConnectionLost;
    dialogs.expectedMessages = 1;
    dialogs.stopAtFailure = true;
    click("Btn_SetRdsStereo");
    EXPECT_EQ(sent().size(), 1U);
    // The next button press tries again.
    dialogs.expectedMessages = 1;
    click("Store_Taste_0");
    EXPECT_EQ(sent().size(), 1U);
}

TEST_F(SetRdsStereoTest, WithoutAStoredGroupSequenceNoneIsSentOrStored) {
    setDataSet1("RDS", "GR_FOLGE", "");
    start();
    openSession();
    for (const std::string& command : sent()) EXPECT_EQ(command.find("GS="), std::string::npos);
    EXPECT_NE(folder.read("Datenset1.INI").find("GR_FOLGE=\r\n"), std::string::npos);
}

/// How far the window's lower edge had counted when each command went out.
class ProgressTest : public SetRdsStereoTest {
protected:
    void count() {
        heard = [this](const Traffic& traffic) {
            if (traffic.kind == Traffic::Kind::Written) shown.push_back(text("QuietLine"));
        };
    }
    Lines shown;
};

TEST_F(ProgressTest, TellsWhichCommandOfHowManyIsBeingSent) {
    start();
    count();
    openSession();
    const std::size_t commands = sent().size();
    ASSERT_EQ(shown.size(), commands);
    // One removal of another network is foreseen: the coder holds two here.
    EXPECT_EQ(shown.front(), "Sende Befehl 1 von " + std::to_string(commands - 1));
    EXPECT_EQ(shown.back(), "Sende Befehl " + std::to_string(commands) + " von " + std::to_string(commands));
    EXPECT_EQ(text("QuietLine"), "");
    EXPECT_TRUE(find("ProgressBar")->isHidden());
}

TEST_F(ProgressTest, CountsExactlyWhateverTheDataSetHolds) {
    for (const char* key : {"AF_LISTE1", "EON_AFB2", "GR_FOLGE"}) {
        setDataSet1("RDS", key, "");
        visa.answersTo[coder("EON PI?")] = "\" 1234,\"\n";
        start();
        shown.clear();
        count();
        openSession();
        const std::string commands = std::to_string(sent().size());
        EXPECT_EQ(shown.front(), "Sende Befehl 1 von " + commands) << key;
        std::string last = "Sende Befehl " + commands;
        last += " von " + commands;
        EXPECT_EQ(shown.back(), last) << key;
    }
}

TEST_F(ProgressTest, SpeaksTheCurrentLanguage) {
    setGeneral("Sprache", "Sprache", "english");
    start();
    count();
    openSession();
    EXPECT_EQ(shown.front().find("Sending command 1 of "), 0U) << shown.front();
}

TEST_F(ProgressTest, ASingleCommandIsNotCounted) {
    start();
    openSession();
    count();
    click("Store_Taste_0");
    EXPECT_EQ(shown, Lines{""});
}

}  // namespace
}  // namespace kdx::test
