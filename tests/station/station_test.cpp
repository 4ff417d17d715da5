#include "station/station.h"

#include <gtest/gtest.h>

#include "base/paths.h"
#include "support/linkfixture.h"

namespace kdx::test {
namespace {

constexpr const char* kGeneral =
    "[FM]\r\nMPX_DEV=06750\r\nMPX_SOURCE=1\r\nMPX_IMPEDANZ=2\r\nStereo_Mode=2\r\nPREEMPHASIS=2\r\nPILOT=1\r\n"
    "PILOT_HUB=0675\r\nPILOT_PHASE=-4\r\nARI=0\r\nARI_HUB=0350\r\nARI_ID=3\r\nARI_BK=1\r\nRDS=1\r\nRDS_HUB=0205\r\n";
constexpr const char* kDataSet1 =
    "[RDS]\r\nPI=D3C2\r\nPS=EINS\r\nPTY=1\r\n[VRN]\r\nHF_Frequenz=98.5\r\nHF_Pegel=60\r\nNF_Frequenz=1\r\n";
constexpr const char* kDataSet2 =
    "[RDS]\r\nPI=d3c\r\nPS=ZWEI\r\nPTY=9\r\nMS=S\r\nRTA=Hallo\r\nGR_FOLGE=0A,2A,8A,\r\nAF_LISTE1=87.6,90.1\r\n"
    "AF_LISTE2=88.0,1,2,3,4,5,6,7,8,9,10,11,12,13\r\nAF_LISTE3=101.1\r\nEON_PI=D3C3\r\nEON_PS=RADIO 1\r\nEON_TP=1\r\n"
    "EON_AFB2=99.2,101.5\r\n[VRN]\r\nHF_Frequenz=107\r\nHF_Pegel=20\r\nNF_Frequenz=9\r\n";

class StationTest : public ::testing::Test, protected Bench {
protected:
    StationTest() {
        folder.write("RDS_Allg.INI", kGeneral);
        folder.write("Datenset1.INI", kDataSet1);
        folder.write("Datenset2.INI", kDataSet2);
    }
    /// The steps, a line each, as they read.
    static Lines lines(const Steps& steps) {
        constexpr std::array kKinds = {"", "Identify", "AskNetworks", "Refused ", "Close"};
        Lines read;
        for (const Step& step : steps) {
            const std::string kind = kKinds.at(static_cast<std::size_t>(step.kind));
            read.push_back(kind + step.key + (step.key.empty() ? "" : "=" + step.value));
        }
        return read;
    }
};

const Lines kStepsOfDataSet2 = {"PREEMPHASIS=2",
                                "PILOT=1",
                                "PILOT_HUB=0675",
                                "PILOT_PHASE=-4",
                                "ARI=0",
                                "RDS=1",
                                "RDS_HUB=0205",
                                "PI=d3c",
                                "TP=0",
                                "TA=0",
                                "PS=ZWEI",
                                "TEST_M=0",
                                "MS=S",
                                "RT=Hallo",
                                "AF1=N,87.6,90.1",
                                "AF2=+,88.0,1,2,3,4,5,6,7,8,9,10,11,12,13",
                                "AF3=+,101.1",
                                "PTY=9",
                                "AskNetworks",
                                "EON_DEL=",
                                "EON_PI=D3C3",
                                "EON_TA=0",
                                "EON_TP=1",
                                "EON_PS=RADIO 1",
                                "EON_AFB2=+,99.2,101.5",
                                "GROUPSEQ=0A,2A,8A",
                                "HF-Frequenz=98.5",
                                "HF-Pegel=60"};

TEST_F(StationTest, DataSet2GivesItsStepsWithTheCarrierOfDataSet1) {
    EXPECT_EQ(lines(dataSetSteps(loadStation(data, "2"))), kStepsOfDataSet2);
}

TEST_F(StationTest, AnyFileCanTakeThePlaceOfADataSet) {
    folder.write("Anderswo.INI", kDataSet2);
    Station station;
    station.load(Profile::ofFile(data, utf8Of(folder.data() / "Anderswo.INI")));
    EXPECT_EQ(lines(dataSetSteps(station)), kStepsOfDataSet2);
}

TEST_F(StationTest, AnOpeningPutsTheBaseStateInFrontAndTheOutputAndAudioBehind) {
    Lines expected = {
        "Identify", "AM_AUS=", "FM_AUS=", "STEREO_EIN=", "MPX_HUB=06750", "MPX_SOURCE=1", "MPX_IMPEDANZ=0"};
    expected.insert(expected.end(), kStepsOfDataSet2.begin(), kStepsOfDataSet2.end());
    expected.insert(expected.end(), {"HF:PEGEL:STATE=ON", "NF-Frequenz=1"});
    EXPECT_EQ(lines(openingSteps(loadStation(data, "2"))), expected);
}

TEST_F(StationTest, AnOpeningLeavesAFirstImpedanceAloneAndTurnsTheOutputOver) {
    Station station = loadStation(data, "2");
    station.multiplex.impedance = kFirstImpedance;
    station.carrier.outputOn = true;
    const Lines opening = lines(openingSteps(station));
    EXPECT_EQ(std::count(opening.begin(), opening.end(), "MPX_IMPEDANZ=0"), 0);
    EXPECT_EQ(std::count(opening.begin(), opening.end(), "HF:PEGEL:STATE=OFF"), 1);
}

TEST_F(StationTest, AListThatMethodBCannotCarryIsRefusedBetweenItsNeighbours) {
    Station station = loadStation(data, "2");
    station.af.method = AfMethod::B;
    const Lines steps = lines(dataSetSteps(station));
    const auto first = std::find(steps.begin(), steps.end(), "AF1=N,87.6,87.6,90.1");
    ASSERT_NE(first, steps.end());
    EXPECT_EQ(first[1], "Refused AF2=88.0,1,2,3,4,5,6,7,8,9,10,11,12,13");
    EXPECT_EQ(first[2], "AF3=+,101.1");
}

TEST_F(StationTest, AMissingDataSetGivesStepsWithNothingInThem) {
    const Lines steps = lines(dataSetSteps(loadStation(data, "4")));
    for (const char* empty : {"PI=", "PS=", "MS=", "RT=", "PTY=0", "EON_PI=", "EON_PS="}) {
        EXPECT_EQ(std::count(steps.begin(), steps.end(), empty), 1) << empty;
    }
    for (const std::string& step : steps) {
        EXPECT_FALSE(step.starts_with("AF") || step.starts_with("GROUPSEQ") || step.starts_with("EON_AFB")) << step;
    }
}

TEST_F(StationTest, AnImpossibleProgrammeTypeIsSentAsMinusOne) {
    setProfile("Datenset2.INI", "RDS", "PTY", "32");
    const Lines steps = lines(dataSetSteps(loadStation(data, "2")));
    EXPECT_EQ(std::count(steps.begin(), steps.end(), "PTY=-1"), 1);
}

TEST_F(StationTest, ListsAndCarrierAreLookedUpWheneverTheyGoOut) {
    Station station = loadStation(data, "2");
    setProfile("Datenset2.INI", "RDS", "AF_LISTE1", "99.9");
    setProfile("Datenset2.INI", "RDS", "EON_AFB2", "");
    setProfile("Datenset2.INI", "RDS", "PS", "DREI");
    setProfile("Datenset1.INI", "VRN", "HF_Pegel", "");
    state.CurrentDataSet = "2";
    station.reload(settings);
    const Lines steps = lines(dataSetSteps(station));
    EXPECT_EQ(std::count(steps.begin(), steps.end(), "AF1=N,99.9"), 1);
    EXPECT_EQ(std::count(steps.begin(), steps.end(), "EON_AFB2=+,99.2,101.5"), 0);
    EXPECT_EQ(std::count(steps.begin(), steps.end(), "PS=ZWEI"), 1);  // what was shown, not what the file says now
    EXPECT_EQ(steps.back(), "HF-Pegel=");
}

TEST_F(StationTest, ASessionEndsByClosingIt) {
    EXPECT_EQ(lines(closingSteps()), Lines{"Close"});
}

}  // namespace
}  // namespace kdx::test
