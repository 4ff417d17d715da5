#include "rds/testmode.h"

#include <QGroupBox>

#include "support/pagetest.h"

namespace kdx::test {
namespace {

class TestModeTest : public PageTest {
protected:
    TestModeTest() { frame.label(); }
    QWidget& root() override { return frame; }
    QString title() { return find<QGroupBox>("Frame11")->title(); }

    void expectPatternsEnabled(bool expected) {
        for (const char* pattern : {"TestDat_Opt_0", "TestDat_Opt_1", "TestDat_Opt_2", "TestDat_Opt_3"}) {
            EXPECT_EQ(enabled(pattern), expected) << pattern;
        }
    }

    TestMode frame{context, nullptr};
};

const std::string kBin0 = direct("BIN=0");
const std::string kBin1 = direct("BIN=1");

TEST_F(TestModeTest, BearsTheSystemsNameAndItsTexts) {
    EXPECT_EQ(title(), QStringLiteral("Test Mode"));
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
    EXPECT_EQ(sent(), (Lines{kBin1, direct("BIN=2"), direct("BIN=3"), direct("BIN=4")}));
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
    frame.load();
    EXPECT_TRUE(checked("TestDat_Opt_0"));
    EXPECT_TRUE(sent().empty());
    EXPECT_EQ(folder.read("RDS_log.txt"), "");
}

TEST_F(TestModeTest, SendingADataSetReturnsToRdsModeFromEveryState) {
    const Step toRdsMode{.key = "TEST_M", .value = "0"};
    frame.stepGoesOut(toRdsMode);
    EXPECT_EQ(text("Taste_DATA_MODE"), "&RDS_Mode");
    frame.stepGoesOut(toRdsMode);
    EXPECT_EQ(text("Taste_DATA_MODE"), "&RDS_Mode");
    EXPECT_TRUE(sent().empty());  // sending is for whoever runs the sequence
    click("Taste_DATA_MODE");
    EXPECT_EQ(text("Taste_DATA_MODE"), "&Test_Mode");
    expectPatternsEnabled(true);
    frame.stepGoesOut({.key = "TEST_D", .value = "0"});  // not the mode
    EXPECT_EQ(text("Taste_DATA_MODE"), "&Test_Mode");
    frame.stepGoesOut(toRdsMode);
    EXPECT_EQ(text("Taste_DATA_MODE"), "&RDS_Mode");
    expectPatternsEnabled(false);
    EXPECT_EQ(sent(), Lines{kBin1});
}

TEST_F(TestModeTest, RelabellingKeepsTheMode) {
    click("Taste_DATA_MODE");
    click("Taste_DATA_MODE");
    sent();
    useLanguage("english");
    frame.label();
    EXPECT_EQ(title(), QStringLiteral("Test mode"));
    EXPECT_EQ(text("Taste_DATA_MODE"), "&Test_Mode");
    expectPatternsEnabled(true);
    EXPECT_TRUE(sent().empty());
}

}  // namespace
}  // namespace kdx::test
