#include "rds/testmode.h"

#include <gtest/gtest.h>

#include "support/pagetest.h"

namespace kdx::test {
namespace {

class TestModeTest : public PageTest {
protected:
    QWidget& root() override { return frame; }

    void expectPatternsEnabled(bool expected) {
        for (const char* pattern : {"TestDat_Opt_0", "TestDat_Opt_1", "TestDat_Opt_2", "TestDat_Opt_3"}) {
            EXPECT_EQ(enabled(pattern), expected) << pattern;
        }
    }

    TestMode frame{context, nullptr};
};

const std::string kBin0 = R"(:STEREO:DIRECT "BIN=0")";
const std::string kBin1 = R"(:STEREO:DIRECT "BIN=1")";

TEST_F(TestModeTest, BearsTheSystemsNameAndItsTexts) {
    EXPECT_EQ(frame.objectName(), QStringLiteral("Frame11"));
    EXPECT_EQ(frame.title(), QStringLiteral("Test Mode"));
    EXPECT_EQ(text("Taste_DATA_MODE"), "RDS_Mode");
    EXPECT_EQ(text("TestDat_Opt_0"), "0 0 0 0 0 0 0 0");
    EXPECT_EQ(text("TestDat_Opt_1"), "1 1 1 1 1 1 1 1");
    EXPECT_EQ(text("TestDat_Opt_2"), "0 1 0 1 0 1 0 1");
    EXPECT_EQ(text("TestDat_Opt_3"), "1 1 0 0 1 1 0 0");
    expectPatternsEnabled(false);
}

TEST_F(TestModeTest, TheFirstClickAfterTheStartSelectsRdsMode) {
    click("Taste_DATA_MODE");
    EXPECT_EQ(sent(), Lines{kBin0});
    EXPECT_EQ(text("Taste_DATA_MODE"), "&RDS_Mode");
    expectPatternsEnabled(false);
}

TEST_F(TestModeTest, FurtherClicksGoToTheTestAndBack) {
    click("Taste_DATA_MODE");
    click("Taste_DATA_MODE");
    EXPECT_EQ(sent(), (Lines{kBin0, kBin1}));
    EXPECT_EQ(text("Taste_DATA_MODE"), "&Test_Mode");
    expectPatternsEnabled(true);
    click("Taste_DATA_MODE");
    EXPECT_EQ(sent(), Lines{kBin0});
    EXPECT_EQ(text("Taste_DATA_MODE"), "&RDS_Mode");
    expectPatternsEnabled(false);
}

TEST_F(TestModeTest, ThePatternsAreNumberedFromOne) {
    click("Taste_DATA_MODE");
    click("Taste_DATA_MODE");
    sent();
    for (const char* pattern : {"TestDat_Opt_0", "TestDat_Opt_1", "TestDat_Opt_2", "TestDat_Opt_3"}) click(pattern);
    EXPECT_EQ(sent(),
              (Lines{kBin1, R"(:STEREO:DIRECT "BIN=2")", R"(:STEREO:DIRECT "BIN=3")", R"(:STEREO:DIRECT "BIN=4")"}));
}

// Both keys share one coder command; only the log tells them apart.
TEST_F(TestModeTest, ModeAndPatternDifferInTheLogOnly) {
    state.LogEnabled = true;
    click("Taste_DATA_MODE");
    click("Taste_DATA_MODE");
    click("TestDat_Opt_0");
    EXPECT_EQ(sent(), (Lines{kBin0, kBin1, kBin1}));
    const std::string log = folder.read("RDS_log.txt");
    EXPECT_NE(log.find("TEST_M"), std::string::npos);
    EXPECT_NE(log.find("TEST_D"), std::string::npos);
}

TEST_F(TestModeTest, APatternCannotBeSentOutsideTheTest) {
    click("TestDat_Opt_2");
    EXPECT_TRUE(sent().empty());
}

TEST_F(TestModeTest, SelectingTheFirstPatternAtTheStartSendsAndLogsNothing) {
    state.LogEnabled = true;
    frame.selectFirstPattern();
    EXPECT_TRUE(checked("TestDat_Opt_0"));
    EXPECT_TRUE(sent().empty());
    EXPECT_EQ(folder.read("RDS_log.txt"), "");
}

TEST_F(TestModeTest, SendingADataSetReturnsToRdsModeFromEveryState) {
    frame.toRdsMode();
    EXPECT_EQ(sent(), Lines{kBin0});
    EXPECT_EQ(text("Taste_DATA_MODE"), "&RDS_Mode");
    frame.toRdsMode();
    EXPECT_EQ(sent(), Lines{kBin0});
    click("Taste_DATA_MODE");
    EXPECT_EQ(text("Taste_DATA_MODE"), "&Test_Mode");
    sent();
    frame.toRdsMode();
    EXPECT_EQ(sent(), Lines{kBin0});
    EXPECT_EQ(text("Taste_DATA_MODE"), "&RDS_Mode");
    expectPatternsEnabled(false);
}

TEST_F(TestModeTest, RelabellingKeepsTheMode) {
    click("Taste_DATA_MODE");
    click("Taste_DATA_MODE");
    sent();
    useLanguage("english");
    frame.label();
    EXPECT_EQ(frame.title(), QStringLiteral("Test mode"));
    EXPECT_EQ(text("Taste_DATA_MODE"), "&Test_Mode");
    expectPatternsEnabled(true);
    EXPECT_TRUE(sent().empty());
}

}  // namespace
}  // namespace kdx::test
