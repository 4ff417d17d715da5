#include "settings/corrections.h"

#include <gtest/gtest.h>

#include "settings/datafolder.h"
#include "settings/profile.h"
#include "support/sourcefolder.h"
#include "support/tempfolder.h"

namespace kdx {
namespace {

class CorrectionsTest : public ::testing::Test {
protected:
    Corrections read() { return readCorrections(Profile::followingDataSet(data, dataSet)); }

    test::TempFolder folder;
    DataFolder data{folder.path()};
    std::string dataSet = "1";
};

TEST_F(CorrectionsTest, WithoutSettingsNothingIsCorrected) {
    const Corrections corrections = read();
    for (const auto& [key, isOn] : kCorrectionKeys) EXPECT_FALSE(corrections.*isOn) << key;
}

TEST_F(CorrectionsTest, EachIsSwitchedOnByItsOwnKeyAlone) {
    for (const auto& [switched, unused] : kCorrectionKeys) {
        data.WriteIni("Berichtigungen", switched, "1", kGeneralSettings);
        const Corrections corrections = read();
        for (const auto& [key, isOn] : kCorrectionKeys) {
            EXPECT_EQ(corrections.*isOn, std::string(key) == switched) << key << " with " << switched;
        }
        data.WriteIni("Berichtigungen", switched, "0", kGeneralSettings);
    }
}

TEST_F(CorrectionsTest, OnlyTheNumberOneSwitchesOn) {
    for (const char* off : {"", "0", "2", "ja", "on", "-1"}) {
        data.WriteIni("Berichtigungen", "Komma", off, kGeneralSettings);
        EXPECT_FALSE(read().decimalComma) << off;
    }
    data.WriteIni("berichtigungen", "KOMMA", "1", kGeneralSettings);
    EXPECT_TRUE(read().decimalComma);
}

TEST_F(CorrectionsTest, TheShippedSettingsCorrectMidnightAlone) {
    DataFolder shipped{test::sourceFolder()};
    const Corrections corrections = readCorrections(Profile::followingDataSet(shipped, dataSet));
    for (const auto& [key, isOn] : kCorrectionKeys) {
        EXPECT_EQ(corrections.*isOn, std::string(key) == "Mitternacht") << key;
    }
}

}  // namespace
}  // namespace kdx
