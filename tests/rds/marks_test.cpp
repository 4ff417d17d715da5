// What the page "R D S" and the test mode tell of a value that did not reach the instrument.
#include "rds/testmode.h"
#include "rdspagetest.h"

namespace kdx::test {
namespace {

class RdsMarksTest : public RdsPageTest {
protected:
    RdsMarksTest() {
        load();
        sent();
    }
};

TEST_F(RdsMarksTest, AChoiceThatDidNotArriveIsMarkedUntilItDoes) {
    inVain([&] { select("PTY_Combo1", 7); });
    EXPECT_EQ(stateOf("PTY_Combo1"), "ungesendet");
    EXPECT_EQ(stateOf(StatusSlot::Pty), "ungesendet");
    select("PTY_Combo1", 7);
    EXPECT_EQ(stateOf("PTY_Combo1"), "");
    for (const char* option : {"DI_Opt_5", "MS_opt_1"}) {
        inVain([&] { click(option); });
        EXPECT_EQ(stateOf(option), "ungesendet") << option;
        EXPECT_EQ(find(option)->toolTip().toStdString(), "Nicht beim Gerät angekommen.") << option;
        click(option);
        EXPECT_EQ(stateOf(option), "") << option;
    }
}

TEST_F(RdsMarksTest, TheTrafficFlagsThatDidNotArriveAreMarkedInTheStatusRowToo) {
    inVain([&] { click("Check1"); });
    EXPECT_EQ(stateOf("Check1"), "ungesendet");
    EXPECT_EQ(stateOf(StatusSlot::Tp), "ungesendet");
    useLanguage("english");
    page.label();
    EXPECT_EQ(stateOf(StatusSlot::Tp), "ungesendet");
    click("Check1");
    EXPECT_EQ(stateOf("Check1"), "");
    EXPECT_EQ(stateOf(StatusSlot::Tp), "");
    click("Check1");
    inVain([&] { click("TA_Check"); });
    EXPECT_EQ(stateOf("TA_Check"), "ungesendet");
    EXPECT_EQ(stateOf(StatusSlot::Ta), "ungesendet");
    click("TA_Check");
    EXPECT_EQ(stateOf("TA_Check"), "");
    EXPECT_EQ(stateOf(StatusSlot::Ta), "");
}

TEST_F(RdsMarksTest, ATimeThatDidNotArriveIsMarkedAsLongAsItIsShown) {
    inVain([&] { ASSERT_TRUE(tick("Timer1")); });
    EXPECT_EQ(stateOf("Uhr_Zeit"), "ungesendet");
    click("Zeit_Taste");
    EXPECT_EQ(stateOf("Uhr_Zeit"), "") << "the word for off is no time";
}

TEST_F(RdsMarksTest, ALoadedSetIsInForceAsFarAsItIsWhatTheInstrumentHas) {
    select("PTY_Combo1", 7);
    click("DI_Opt_5");
    click("MS_opt_1");
    programme.pty = "7";
    programme.decoderInfo = "3";
    programme.musicSpeech = "M";
    page.showDataSet();
    EXPECT_EQ(stateOf("PTY_Combo1"), "");
    EXPECT_EQ(stateOf("DI_Opt_3"), "ungesendet");
    EXPECT_EQ(find("DI_Opt_3")->toolTip().toStdString(), "Noch nicht gesendet.");
    EXPECT_EQ(stateOf("MS_opt_0"), "ungesendet");
    sendProgramme();
    EXPECT_EQ(stateOf("MS_opt_0"), "");
    click("DI_Opt_3");
    EXPECT_EQ(stateOf("DI_Opt_3"), "");
}

class TestModeMarksTest : public PageTest {
protected:
    QWidget& root() override { return frame; }

    TestMode frame{context, nullptr};
};

TEST_F(TestModeMarksTest, AModeAndAPatternThatDidNotArriveAreMarked) {
    click("Taste_DATA_MODE");
    inVain([&] { click("Taste_DATA_MODE"); });
    EXPECT_EQ(stateOf("Taste_DATA_MODE"), "ungesendet");
    inVain([&] { click("TestDat_Opt_2"); });
    EXPECT_EQ(stateOf("TestDat_Opt_2"), "ungesendet");
    click("TestDat_Opt_2");
    click("Taste_DATA_MODE");
    EXPECT_EQ(stateOf("TestDat_Opt_2"), "");
    EXPECT_EQ(stateOf("Taste_DATA_MODE"), "");
}

}  // namespace
}  // namespace kdx::test
