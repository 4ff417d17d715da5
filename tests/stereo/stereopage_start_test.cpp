#include <gtest/gtest.h>

#include "stereopagetest.h"

namespace kdx::test {
namespace {

/// The page as start-up and the opening of the session drive it.
class StereoPageStart : public StereoPageTest {
protected:
    void storeEverything() {
        setGeneral("MPX_DEV", "07500");
        setGeneral("MPX_SOURCE", "3");
        setGeneral("MPX_IMPEDANZ", "2");
        setGeneral("Stereo_Mode", "4");
        setGeneral("PREEMPHASIS", "1");
        setGeneral("PILOT", "1");
        setGeneral("PILOT_HUB", "0675");
        setGeneral("PILOT_PHASE", "-4");
        setGeneral("ARI", "0");
        setGeneral("ARI_HUB", "0350");
        setGeneral("ARI_ID", "3");
        setGeneral("ARI_BK", "2");
        setGeneral("RDS", "1");
        setGeneral("RDS_HUB", "0200");
        setGeneral("RDS_PHASE", "90");
    }
};

TEST_F(StereoPageStart, TheStoredSettingsStandInTheControls) {
    storeEverything();
    start();
    EXPECT_EQ(position("FM_Hub_Scroll"), 7500);
    EXPECT_EQ(text("FM_Hub_Label2"), "Hub 75.0 kHz");
    EXPECT_EQ(chosen("FM_Source_Opt", 4), 3);
    EXPECT_EQ(chosen("FM_Imp_Opt", 2), 1);
    EXPECT_EQ(chosen("Stereo_Opt", 5), 4);
    EXPECT_EQ(chosen("Pre_opt", 3), 1);
    EXPECT_TRUE(checked("Pilot_OnOff"));
    EXPECT_EQ(text("Pilot_hub_Label"), "Hub 6.75 kHz");
    EXPECT_EQ(position("HScroll1"), -4);
    EXPECT_EQ(text("HScroll1_Label"), "Phase -4 °");
    EXPECT_FALSE(checked("Ari_OnOff"));
    EXPECT_EQ(text("Ari_Label"), "Hub 3.50 kHz");
    EXPECT_EQ(chosen("ARI_Mode_Opt", 4), 3);
    EXPECT_EQ(chosen("BK_Opt", 6), 2);
    EXPECT_TRUE(checked("RDS_OnOff"));
    EXPECT_EQ(text("RDS_Hub_Label"), "Hub 2.00 kHz");
    EXPECT_EQ(position("RDS_Phase_Scroll"), 90);
}

TEST_F(StereoPageStart, OnlyTheHandlersOfTheOnOffButtonsRun) {
    storeEverything();
    start();
    EXPECT_EQ(sent(), (Lines{":stereo:pilot:state ON", ":stereo:ari:state OFF", ":stereo:rds:state ON"}));
}

TEST_F(StereoPageStart, NothingIsSentBeforeASessionIsOpen) {
    storeEverything();
    state.InstrumentOnline = false;
    start();
    EXPECT_TRUE(sent().empty());
    EXPECT_TRUE(checked("Pilot_OnOff"));
}

TEST_F(StereoPageStart, NothingFlipsFromStartToStart) {
    storeEverything();
    const std::string before = folder.read("RDS_Allg.INI");
    for (int again = 0; again < 3; ++again) {
        start();
        EXPECT_TRUE(checked("Pilot_OnOff"));
        EXPECT_FALSE(checked("Ari_OnOff"));
        EXPECT_TRUE(checked("RDS_OnOff"));
        EXPECT_EQ(folder.read("RDS_Allg.INI"), before);
    }
}

TEST_F(StereoPageStart, MissingSettingsReadAsZeroAndChooseNothing) {
    start();
    EXPECT_EQ(text("FM_Hub_Label2"), "Hub 0.0 kHz");
    EXPECT_EQ(text("Pilot_hub_Label"), "Hub 0.00 kHz");
    EXPECT_EQ(text("HScroll1_Label"), "Phase 0 °");
    EXPECT_EQ(chosen("FM_Source_Opt", 4), -1);
    EXPECT_EQ(chosen("FM_Imp_Opt", 2), -1);
    EXPECT_EQ(chosen("Pre_opt", 3), -1);
    EXPECT_EQ(chosen("Stereo_Opt", 5), -1);
    EXPECT_EQ(chosen("ARI_Mode_Opt", 4), -1);
    EXPECT_EQ(chosen("BK_Opt", 6), -1);
    EXPECT_FALSE(checked("Pilot_OnOff"));
    EXPECT_FALSE(checked("RDS_OnOff"));
    EXPECT_FALSE(checked("Ari_OnOff"));
    EXPECT_EQ(multiplex.source, "");
    EXPECT_EQ(multiplex.totalDeviation, "00000");
}

TEST_F(StereoPageStart, GarbageIsReadLeniently) {
    setGeneral("MPX_DEV", "99999999999");
    setGeneral("PILOT_HUB", "-5");
    setGeneral("PILOT_PHASE", "abc");
    setGeneral("RDS_HUB", "200 kHz");
    setGeneral("MPX_SOURCE", "4");
    setGeneral("PILOT", "yes");
    start();
    EXPECT_EQ(multiplex.totalDeviation, "08000");
    EXPECT_EQ(position("Pilot_Hub_Scroll"), 0);
    EXPECT_EQ(position("HScroll1"), 0);
    EXPECT_EQ(position("RDS_Hub_Scroll"), 200);
    EXPECT_EQ(chosen("FM_Source_Opt", 4), -1);
    EXPECT_FALSE(checked("Pilot_OnOff"));
}

// The file counts the impedances from 1, the click stores its index from 0.
TEST_F(StereoPageStart, AStoredOneIsTheFirstImpedanceAndTwoTheSecond) {
    for (const auto& [stored, option] : {std::pair{"1", 0}, {"2", 1}, {"0", -1}, {"3", -1}, {"", -1}}) {
        setGeneral("MPX_IMPEDANZ", stored);
        start();
        EXPECT_EQ(chosen("FM_Imp_Opt", 2), option) << stored;
    }
}

// Written with a hyphen, read with an underscore: the two never met, and existing files hold both.
TEST_F(StereoPageStart, AnAreaChosenInTheWindowIsNotRestored) {
    setGeneral("ARI_BK", "1");
    click("BK_Opt_3");
    EXPECT_EQ(general("ARI-BK"), "D");
    EXPECT_EQ(general("ARI_BK"), "1");
    start();
    EXPECT_EQ(chosen("BK_Opt", 6), 1);
}

TEST_F(StereoPageStart, AStoredAreaIsOneOfTheFirstFourByNumber) {
    for (const auto& [stored, option] : {std::pair{"0", 0}, {"3", 3}, {"4", -1}, {"5", -1}, {"D", -1}}) {
        setGeneral("ARI_BK", stored);
        start();
        EXPECT_EQ(chosen("BK_Opt", 6), option) << stored;
    }
}

TEST_F(StereoPageStart, TheMultiplexStaysAsTheControlsAre) {
    storeEverything();
    start();
    EXPECT_EQ(multiplex.totalDeviation, "07500");
    EXPECT_EQ(multiplex.source, "3");
    EXPECT_EQ(multiplex.pilot, "1");
    scroll("FM_Hub_Scroll", 10);
    click("FM_Source_Opt_0");
    click("Pilot_OnOff");
    EXPECT_EQ(multiplex.totalDeviation, "00010");
    EXPECT_EQ(multiplex.source, "0");
    EXPECT_EQ(multiplex.pilot, "0");
}

TEST_F(StereoPageStart, TheImpedanceThatTheOpeningSendsIsChosenAndStored) {
    setGeneral("MPX_IMPEDANZ", "2");
    start();
    sent();
    page.stepGoesOut({Step::Kind::Parameter, "MPX_IMPEDANZ", "0"});
    EXPECT_EQ(chosen("FM_Imp_Opt", 2), 0);
    EXPECT_EQ(multiplex.impedance, "0");
    EXPECT_EQ(general("MPX_IMPEDANZ"), "0");
    EXPECT_TRUE(sent().empty());
}

TEST_F(StereoPageStart, OtherStepsChangeNothingHere) {
    storeEverything();
    start();
    sent();
    const std::string before = folder.read("RDS_Allg.INI");
    for (const char* key : {"MPX_HUB", "MPX_SOURCE", "PILOT", "RDS", "TEST_M"}) {
        page.stepGoesOut({Step::Kind::Parameter, key, "0"});
    }
    EXPECT_EQ(position("FM_Hub_Scroll"), 7500);
    EXPECT_EQ(chosen("FM_Source_Opt", 4), 3);
    EXPECT_EQ(chosen("FM_Imp_Opt", 2), 1);
    EXPECT_TRUE(checked("Pilot_OnOff"));
    EXPECT_EQ(multiplex.source, "3");
    EXPECT_EQ(folder.read("RDS_Allg.INI"), before);
    EXPECT_TRUE(sent().empty());
}

TEST_F(StereoPageStart, TheFrameOfTheTestModeHearsWhatThePageHears) {
    testMode->heard.clear();
    page.label();
    page.load();
    page.opened();
    page.stepGoesOut({Step::Kind::Parameter, "TEST_M", "0"});
    EXPECT_EQ(testMode->heard, (Lines{"label", "load", "opened", "TEST_M=0"}));
}

TEST_F(StereoPageStart, TheRdsPhaseIsHidden) {
    EXPECT_FALSE(find("RDS_Phase_Scroll")->isHidden());
    start();
    EXPECT_TRUE(find("RDS_Phase_Label")->isHidden());
    EXPECT_TRUE(find("RDS_Phase_Scroll")->isHidden());
}

}  // namespace
}  // namespace kdx::test
