#include "station/wrongsettings.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <algorithm>

#include "coder/keyfacts.h"
#include "coder/sendparam.h"
#include "station/station.h"
#include "support/linkfixture.h"
#include "support/sourcefolder.h"

namespace kdx::test {
namespace {

using ::testing::ElementsAre;
using ::testing::EndsWith;

struct Stored {
    const char* place;  ///< "[FM] PILOT"
    const char* wrong;
    const char* legal;
};

std::vector<std::string> sentencesAbout(const Profile& source) {
    std::vector<std::string> sentences;
    for (const WrongSetting& wrong : wrongSettings(source)) sentences.push_back(wrong.sentence);
    return sentences;
}

class WrongSettingsTest : public ::testing::TestWithParam<Stored>, protected Bench {
protected:
    /// What is wrong with a whole set-up that has this value and a PI.
    std::vector<std::string> wrongWith(const std::string& value) {
        const std::string place = GetParam().place;
        const std::size_t end = place.find("] ") + 1;
        const std::string section = place.substr(0, end) + "\r\n" + place.substr(end + 1) + "=" + value + "\r\n";
        folder.write("Lab.INI", section + "[RDS]\r\nPI=D3C1\r\n[FM]\r\nARI=0\r\n");
        return sentencesAbout(Profile::ofFile(data, "Lab.INI"));
    }
};

TEST_P(WrongSettingsTest, AreNamedWithTheirPlaceAndValue) {
    const std::string wrong = GetParam().wrong;
    EXPECT_THAT(wrongWith(wrong),
                ElementsAre(EndsWith(" It stands in Lab.INI, " + std::string(GetParam().place) + "=" + wrong + ".")));
    EXPECT_THAT(wrongWith(GetParam().legal), ElementsAre());
    EXPECT_THAT(wrongWith(""), ElementsAre());
}

INSTANTIATE_TEST_SUITE_P(
    Places, WrongSettingsTest,
    ::testing::Values(Stored{"[FM] MPX_DEV", "99999999", "08000"}, Stored{"[FM] MPX_SOURCE", "9", "3"},
                      Stored{"[FM] MPX_IMPEDANZ", "3", "0"}, Stored{"[FM] PREEMPHASIS", "7", "2"},
                      Stored{"[FM] PILOT", "x", "0"}, Stored{"[FM] PILOT_HUB", "1501", "0675"},
                      Stored{"[FM] PILOT_PHASE", "90", "-4"}, Stored{"[FM] RDS", "2", "1"},
                      Stored{"[FM] RDS_HUB", "-1", "0400"}, Stored{"[VRN] HF_Frequenz", "0", "98.5"},
                      Stored{"[VRN] HF_Pegel", "60,5", "60.5"}, Stored{"[VRN] NF_Frequenz", "81", "1"}));

class WrongDataSetTest : public ::testing::Test, protected Bench {};

TEST_F(WrongDataSetTest, EachValueOfTheDataSetIsNamedInTheOrderOfSending) {
    folder.write("RDS_Allg.INI", "[FM]\r\nPILOT=x\r\n");
    folder.write("Datenset2.INI",
                 "[RDS]\r\nGR_FOLGE=0A,2A\r\nEON_AFB5=1\r\nEON_PS=123456789\r\nEON_TP=2\r\nEON_TA=x\r\nEON_PI=12\r\n"
                 "PTY=77\r\nAF_LISTE1=98.5,\r\nRTA=\x99\r\nMS=Q\r\nPS=123456789\r\nPI=xyz\r\n");
    const auto in2 = [](const std::string& key) { return EndsWith(" Datenset2.INI, [RDS] " + key + "."); };
    EXPECT_THAT(sentencesAbout(Profile::ofFile(data, "Datenset2.INI")),
                ElementsAre(EndsWith(" RDS_Allg.INI, [FM] PILOT=x."), in2("PI=xyz"), in2("PS=123456789"), in2("MS=Q"),
                            in2("RTA=™"), in2("AF_LISTE1=98.5,"), in2("PTY=77"), in2("EON_PI=12"), in2("EON_TA=x"),
                            in2("EON_TP=2"), in2("EON_PS=123456789"), in2("EON_AFB5=1"), in2("GR_Folge=0A,2A")));
}

TEST_F(WrongDataSetTest, TheOrderIsTheOneThatAnOpeningSendsIn) {
    folder.write("Lab.INI",
                 "[FM]\r\nMPX_DEV=x\r\nMPX_SOURCE=9\r\nMPX_IMPEDANZ=9\r\nPREEMPHASIS=9\r\nPILOT=9\r\nPILOT_HUB=x\r\n"
                 "PILOT_PHASE=90\r\nARI=9\r\nRDS=9\r\nRDS_HUB=x\r\n[VRN]\r\nHF_Frequenz=x\r\nHF_Pegel=x\r\n"
                 "NF_Frequenz=x\r\n[RDS]\r\nPI=x\r\nPS=123456789\r\nMS=Q\r\nRTA=\x99\r\nAF_LISTE1=98.5,\r\n"
                 "AF_LISTE2=98.5,\r\nAF_LISTE3=98.5,\r\nAF_LISTE4=98.5,\r\nAF_LISTE5=98.5,\r\nPTY=77\r\nEON_PI=x\r\n"
                 "EON_TA=x\r\nEON_TP=x\r\nEON_PS=123456789\r\nEON_AFB1=98.5,\r\nEON_AFB2=98.5,\r\nEON_AFB3=98.5,\r\n"
                 "EON_AFB4=98.5,\r\nEON_AFB5=98.5,\r\nGR_FOLGE=0A,2A\r\n");
    const Profile source = Profile::ofFile(data, "Lab.INI");
    std::vector<std::string> judged;
    for (const WrongSetting& wrong : wrongSettings(source)) judged.push_back(wrong.key);
    EXPECT_EQ(judged.size(), 33U);
    std::vector<std::string> sent;
    Station station;
    station.load(source);
    for (const Step& step : openingSteps(station)) {
        if (std::find(judged.begin(), judged.end(), step.key) != judged.end()) sent.push_back(step.key);
    }
    EXPECT_EQ(judged, sent);
}

TEST_F(WrongDataSetTest, OnlyThePiMustNotBeMissing) {
    folder.write("Datenset2.INI", "[RDS]\r\nPS=\r\n");
    EXPECT_THAT(
        sentencesAbout(Profile::ofFile(data, "Datenset2.INI")),
        ElementsAre("PI cannot be \"\". Legal: four hexadecimal digits. It stands in Datenset2.INI, [RDS] PI=."));
}

TEST_F(WrongDataSetTest, NothingIsWrongInTheShippedOnesAndAllTheySendIsLegal) {
    DataFolder shipped{sourceFolder()};
    for (const char* number : {"1", "2", "3", "4", "5"}) {
        EXPECT_THAT(sentencesAbout(Profile::ofFile(shipped, dataSetFile(number))), ElementsAre());
        for (const Step& step : openingSteps(loadStation(shipped, number))) {
            std::string value = step.value;
            if (step.kind != Step::Kind::Parameter || value.empty()) continue;
            if (!composeCommand(step.key, value, {}).value_or("").empty()) {
                EXPECT_EQ(wrongValue(step.key, step.value), std::nullopt);
            }
        }
    }
}

}  // namespace
}  // namespace kdx::test
