#include "stereo/deviation.h"

#include <gtest/gtest.h>

#include <ostream>
#include <string>

namespace kdx {
namespace {

struct DeviationCase {
    const char* name;
    const Deviation& deviation;
    int tensOfHertz;
    const char* setting;
    const char* shown;
    friend void PrintTo(const DeviationCase& value, std::ostream* out) { *out << value.name; }
};

std::string caseName(const ::testing::TestParamInfo<DeviationCase>& info) {
    return info.param.name;
}

class DeviationTexts : public ::testing::TestWithParam<DeviationCase> {};

TEST_P(DeviationTexts, AreStoredWithZerosInFrontAndShownInKilohertz) {
    EXPECT_EQ(deviationSetting(GetParam().deviation, GetParam().tensOfHertz), GetParam().setting);
    EXPECT_EQ(deviationText(GetParam().deviation, GetParam().tensOfHertz), GetParam().shown);
}

INSTANTIATE_TEST_SUITE_P(
    Values, DeviationTexts,
    ::testing::Values(DeviationCase{"TotalHighest", kTotalDeviation, 8000, "08000", "80.0 kHz"},
                      DeviationCase{"TotalNone", kTotalDeviation, 0, "00000", "0.0 kHz"},
                      DeviationCase{"TotalOneStep", kTotalDeviation, 10, "00010", "0.1 kHz"},
                      DeviationCase{"TotalHalfIsRoundedUp", kTotalDeviation, 5, "00005", "0.1 kHz"},
                      DeviationCase{"TotalBelowHalfIsRoundedDown", kTotalDeviation, 4, "00004", "0.0 kHz"},
                      DeviationCase{"TotalHalfOfAnyTenth", kTotalDeviation, 7475, "07475", "74.8 kHz"},
                      DeviationCase{"TotalRoundedToTheNextWhole", kTotalDeviation, 995, "00995", "10.0 kHz"},
                      DeviationCase{"TotalBelowTheNextWhole", kTotalDeviation, 994, "00994", "9.9 kHz"},
                      DeviationCase{"TotalUsual", kTotalDeviation, 7500, "07500", "75.0 kHz"},
                      DeviationCase{"TotalTooLongKeepsItsEnd", kTotalDeviation, 123456, "23456", "1234.6 kHz"},
                      DeviationCase{"PilotHighest", kPilotDeviation, 1500, "1500", "15.00 kHz"},
                      DeviationCase{"PilotOneStep", kPilotDeviation, 5, "0005", "0.05 kHz"},
                      DeviationCase{"PilotNone", kPilotDeviation, 0, "0000", "0.00 kHz"},
                      DeviationCase{"PilotUsual", kPilotDeviation, 675, "0675", "6.75 kHz"},
                      DeviationCase{"RdsHighest", kRdsDeviation, 400, "0400", "4.00 kHz"},
                      DeviationCase{"RdsUsual", kRdsDeviation, 200, "0200", "2.00 kHz"},
                      DeviationCase{"RdsSmallest", kRdsDeviation, 1, "0001", "0.01 kHz"},
                      DeviationCase{"AriHighest", kAriDeviation, 800, "0800", "8.00 kHz"},
                      DeviationCase{"AriUsual", kAriDeviation, 350, "0350", "3.50 kHz"},
                      DeviationCase{"FourDigitsKeepTheirEnd", kAriDeviation, 12345, "2345", "123.45 kHz"}),
    caseName);

TEST(PilotPhaseTest, IsTheLastTwoCharactersWithZerosInFront) {
    EXPECT_EQ(pilotPhaseSetting(-4), "-4");
    EXPECT_EQ(pilotPhaseSetting(-1), "-1");
    EXPECT_EQ(pilotPhaseSetting(0), "00");
    EXPECT_EQ(pilotPhaseSetting(2), "02");
    EXPECT_EQ(pilotPhaseSetting(5), "05");
}

TEST(DeviationTest, TheStoredNamesAndTheSentNamesDifferWhereTheyAlwaysDid) {
    EXPECT_STREQ(kTotalDeviation.setting.sendKey, "MPX_HUB");
    EXPECT_STREQ(kTotalDeviation.setting.place.key, "MPX_DEV");
    EXPECT_STREQ(kAriDeviation.setting.sendKey, "ARI-HUB");
    EXPECT_STREQ(kAriDeviation.setting.place.key, "ARI_HUB");
}

}  // namespace
}  // namespace kdx
