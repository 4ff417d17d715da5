#include <gtest/gtest.h>

#include "support/windowtest.h"

namespace kdx::test {
namespace {

constexpr const char* kGeneral =
    "[BUS]\r\nINTERFACE=TCPIP\r\n[ADRESSEN]\r\nKDX_TCPIP=10.0.0.1\r\nLog_Key=1\r\n[Sprache]\r\nSprache=deutsch\r\n"
    "RDS_RBDS=RDS\r\n[FM]\r\nMPX_DEV=06750\r\nMPX_SOURCE=1\r\nMPX_IMPEDANZ=2\r\nStereo_Mode=2\r\nPREEMPHASIS=2\r\n"
    "PILOT=1\r\nPILOT_HUB=0675\r\nPILOT_PHASE=-4\r\nARI=0\r\nARI_HUB=0350\r\nARI_ID=3\r\nARI_BK=1\r\nRDS=1\r\n"
    "RDS_HUB=0205\r\nRDS_PHASE=0\r\n[RDS]\r\nTA_ON=10\r\nTA_REP=60\r\nPS_Dyn=2500\r\n";

constexpr const char* kDataSet =
    "[RDS]\r\nPI=d3c\r\nPS=FUNK\r\nPTY=9\r\nMS=S\r\nDI=3\r\nRTA=Hallo\r\nRTB=Welt\r\nGR_FOLGE=0A,2A,8A,\r\nAF_LISTE="
    "2\r\n"
    "AF_LISTE1=87.6,90.1,94.3\r\nAF_LISTE2=88.0,99.9\r\nAF_LISTE3=\r\nAF_LISTE4=101.1\r\nAF_LISTE5=90.0,91.0\r\n"
    "EON_PI=D3C2\r\nEON_PS=RADIO 1\r\nEON_PTY=4\r\nEON_TP=1\r\nEON_TA=0\r\nEON_AFB=1\r\nEON_AFB1=87.6,90.1\r\n"
    "EON_AFB2=99.2,101.5\r\nEON_AFB3=\r\nEON_AFB4=\r\nEON_AFB5=\r\n"
    "[VRN]\r\nHF_Frequenz=98.5\r\nHF_Pegel=60\r\nNF_Frequenz=1\r\nFM_Ulim=65\r\nFM_Olim=110\r\nNF_Ulim=0\r\nNF_Olim="
    "15\r\n";

class SetRdsStereoTest : public WindowTest {
protected:
    SetRdsStereoTest() {
        folder.copyShipped();
        folder.write("RDS_Allg.INI", kGeneral);
        folder.write("Datenset1.INI", kDataSet);
        visa.answersTo[":STEREO:DIRECT? \"EON PI?\""] = "\" 1234,5678,\"\n";
    }
};

const Lines kDataSetCommands = {
    ":stereo:audio:preemphasis:state ON;:stereo:audio:preemphasis 75us",
    ":stereo:pilot:state ON",
    ":STEREO:PILOT:DEVIATION 6750HZ",
    ":STEREO:PILOT:PHASE -4DEG",
    ":stereo:ari:state OFF",
    ":stereo:rds:state ON",
    ":STEREO:RDS:DEVIATION 2050HZ",
    ":STEREO:DIRECT \"PI=d3c \"",
    ":stereo:rds:traffic:program OFF",
    ":STEREO:DIRECT \"TA=0\"",
    ":STEREO:DIRECT \"PS=FUNK    \"",
    ":STEREO:DIRECT \"BIN=0\"",
    ":STEREO:DIRECT \"MS=S\"",
    ":STEREO:DIRECT \"RT=10,0,Hallo\"",
    ":STEREO:DIRECT \"AF=N,87.6,90.1,94.3\"",
    ":STEREO:DIRECT \"AF=+,88.0,99.9\"",
    ":STEREO:DIRECT \"AF=+,101.1\"",
    ":STEREO:DIRECT \"AF=+,90.0,91.0\"",
    ":STEREO:DIRECT \"PTY=09\"",
    ":STEREO:DIRECT? \"EON PI?\"",
    ":STEREO:DIRECT \"EON-DEL=1234\"",
    ":STEREO:DIRECT \"EON-DEL=5678\"",
    ":STEREO:DIRECT \"EON-PI=D3C2\"",
    ":STEREO:DIRECT \"EON-TA=D3C2,0\"",
    ":STEREO:DIRECT \"EON-TP=D3C2,1\"",
    ":STEREO:DIRECT \"EON-PS=D3C2,RADIO 1 \"",
    ":STEREO:DIRECT \"EON-AFB=D3C2,N,87.6,90.1\"",
    ":STEREO:DIRECT \"EON-AFB=D3C2,+,99.2,101.5\"",
    ":STEREO:DIRECT \"GS=0A,2A,8A\"",
    "FREQ 98.5MHZ",
    ":POW 60DBUV",
};

TEST_F(SetRdsStereoTest, OpeningASessionSendsExactlyThis) {
    start();
    openSession();
    Lines expected = {
        "*IDN?",
        "AM:STAT OFF",
        "FM:STAT OFF",
        "STEREO:STAT ON",
        ":STEREO:DEVIATION 67500HZ",
        "STEREO:STAT ON;:stereo:source LREXT",
        "",  // the first impedance has the index 0, for which there is no command
    };
    expected.insert(expected.end(), kDataSetCommands.begin(), kDataSetCommands.end());
    expected.insert(expected.end(), {":OUTPUT:STAT ON", ":STEREO:AUDIO:FREQ 1KHZ"});
    EXPECT_EQ(sent(), expected);
}

TEST_F(SetRdsStereoTest, TheButtonSendsTheDataSetAlone) {
    start();
    openSession();
    sent();
    click("Btn_SetRdsStereo");
    EXPECT_EQ(sent(), kDataSetCommands);
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

TEST_F(SetRdsStereoTest, EveryCommandWaitsAndTheQuestionOnceMore) {
    start();
    openSession();
    const auto commands = static_cast<double>(sent().size());
    // All but "*IDN?" and the question wait before they go out; the question waits before its answer is read.
    EXPECT_NEAR(clock.sleptMs(), (commands - 1) * 50, commands * 4);
}

TEST_F(SetRdsStereoTest, EveryFailingCommandShowsItsBoxAndTheNextOneGoesOut) {
    start();
    openSession();
    const std::size_t commands = kDataSetCommands.size();
    sent();
    visa.writeStatus = visa::kTimeout;
    // The failing question is not answered either, so one removal without a network goes out instead of two.
    visa.answersTo.clear();
    dialogs.expectedMessages = static_cast<int>(commands);
    click("Btn_SetRdsStereo");
    EXPECT_EQ(sent().size(), commands - 1);
}

TEST_F(SetRdsStereoTest, AFailedQuestionForOtherNetworksRemovesOneWithoutAName) {
    start();
    openSession();
    sent();
    visa.readStatuses = {visa::kTimeout};
    dialogs.expectedMessages = 1;
    click("Btn_SetRdsStereo");
    const Lines commands = sent();
    EXPECT_EQ(std::count(commands.begin(), commands.end(), ":STEREO:DIRECT \"EON-DEL=\""), 1);
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

TEST_F(SetRdsStereoTest, AnEmptyFirstListKeepsAllAfListsBack) {
    setDataSet1("RDS", "AF_LISTE1", "");
    start();
    openSession();
    for (const std::string& command : sent()) EXPECT_EQ(command.find("\"AF="), std::string::npos);
}

TEST_F(SetRdsStereoTest, TheLogHoldsALineForEveryCommand) {
    start();
    openSession();
    const std::string log = folder.read("RDS_log.txt");
    EXPECT_NE(log.find("             PS= \":STEREO:DIRECT \"PS=FUNK    \"\"\r\n"), std::string::npos) << log;
    EXPECT_NE(log.find("         EON-PI= :STEREO:DIRECT? \"EON PI?\"\r\n"), std::string::npos) << log;
    EXPECT_EQ(log.find("ARI_HUB"), std::string::npos);  // a key without a command leaves no trace
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
        visa.answersTo[":STEREO:DIRECT? \"EON PI?\""] = "\" 1234,\"\n";
        start();
        shown.clear();
        count();
        openSession();
        const std::string commands = std::to_string(sent().size());
        EXPECT_EQ(shown.front(), "Sende Befehl 1 von " + commands) << key;
        EXPECT_EQ(shown.back(), "Sende Befehl " + commands + " von " + commands) << key;
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
