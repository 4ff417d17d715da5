#include "stereo/multiplex.h"

#include <utility>

#include "parttest.h"

namespace kdx::test {
namespace {

class MultiplexTest : public PartTest {
protected:
    void set(const char* key, const char* value) { setProfile("RDS_Allg.INI", "FM", key, value); }
    void storeEverything() {
        for (const auto& [key, value] : {std::pair{"MPX_DEV", "07500"},
                                         {"MPX_SOURCE", "3"},
                                         {"MPX_IMPEDANZ", "2"},
                                         {"Stereo_Mode", "4"},
                                         {"PREEMPHASIS", "1"},
                                         {"PILOT", "1"},
                                         {"PILOT_HUB", "0675"},
                                         {"PILOT_PHASE", "-4"},
                                         {"ARI", "0"},
                                         {"ARI_HUB", "0350"},
                                         {"ARI_ID", "3"},
                                         {"ARI_BK", "2"},
                                         {"RDS", "1"},
                                         {"RDS_HUB", "0200"}}) {
            set(key, value);
        }
    }
    Steps steps() const {
        Steps steps;
        multiplex.appendSteps(steps);
        return steps;
    }
    Steps openingSteps() const {
        Steps steps;
        multiplex.appendOpeningSteps(steps);
        return steps;
    }

    Multiplex multiplex;
};

TEST_F(MultiplexTest, TheStoredSettingsAreReadAsTheyAreSent) {
    storeEverything();
    multiplex.load(settings);
    EXPECT_EQ(multiplex.totalDeviation, "07500");
    EXPECT_EQ(multiplex.source, "3");
    EXPECT_EQ(multiplex.impedance, "1");
    EXPECT_EQ(multiplex.stereoMode, "4");
    EXPECT_EQ(multiplex.preemphasis, "1");
    EXPECT_EQ(multiplex.pilot, "1");
    EXPECT_EQ(multiplex.pilotDeviation, "0675");
    EXPECT_EQ(multiplex.pilotPhase, "-4");
    EXPECT_EQ(multiplex.ari, "0");
    EXPECT_EQ(multiplex.ariDeviation, "0350");
    EXPECT_EQ(multiplex.ariType, "3");
    EXPECT_EQ(multiplex.ariArea, "C");
    EXPECT_EQ(multiplex.rds, "1");
    EXPECT_EQ(multiplex.rdsDeviation, "0200");
}

TEST_F(MultiplexTest, LoadingAndSendingStoreNothing) {
    storeEverything();
    const std::string before = folder.read("RDS_Allg.INI");
    multiplex.load(settings);
    EXPECT_EQ(steps().size(), 7U);
    EXPECT_EQ(folder.read("RDS_Allg.INI"), before);
    EXPECT_TRUE(sent().empty());
}

TEST_F(MultiplexTest, MissingSettingsReadAsZeroAndChooseNothing) {
    storeEverything();
    multiplex.load(settings);
    folder.write("RDS_Allg.INI", "");
    multiplex.load(settings);
    EXPECT_EQ(multiplex.totalDeviation, "00000");
    EXPECT_EQ(multiplex.source, "");
    EXPECT_EQ(multiplex.impedance, "");
    EXPECT_EQ(multiplex.stereoMode, "");
    EXPECT_EQ(multiplex.preemphasis, "");
    EXPECT_EQ(multiplex.pilot, "0");
    EXPECT_EQ(multiplex.pilotDeviation, "0000");
    EXPECT_EQ(multiplex.pilotPhase, "00");
    EXPECT_EQ(multiplex.ari, "0");
    EXPECT_EQ(multiplex.ariDeviation, "0000");
    EXPECT_EQ(multiplex.ariType, "");
    EXPECT_EQ(multiplex.ariArea, "");
    EXPECT_EQ(multiplex.rds, "0");
    EXPECT_EQ(multiplex.rdsDeviation, "0000");
}

TEST_F(MultiplexTest, GarbageIsReadLeniently) {
    set("MPX_DEV", "99999999999");
    set("PILOT_HUB", "-5");
    set("PILOT_PHASE", "abc");
    set("RDS_HUB", "200 kHz");
    set("ARI_HUB", "12.5");
    set("MPX_SOURCE", "4");
    set("PREEMPHASIS", "1 ms");
    set("PILOT", "yes");
    set("RDS", "01");
    multiplex.load(settings);
    EXPECT_EQ(multiplex.totalDeviation, "08000");
    EXPECT_EQ(multiplex.pilotDeviation, "0000");
    EXPECT_EQ(multiplex.pilotPhase, "00");
    EXPECT_EQ(multiplex.rdsDeviation, "0200");
    EXPECT_EQ(multiplex.ariDeviation, "0013");
    EXPECT_EQ(multiplex.source, "");
    EXPECT_EQ(multiplex.preemphasis, "");
    EXPECT_EQ(multiplex.pilot, "0");
    EXPECT_EQ(multiplex.rds, "0");
}

TEST_F(MultiplexTest, ThePilotPhaseStaysWithinItsRange) {
    for (const auto& [stored, phase] : {std::pair{"-4", "-4"}, {"-9", "-4"}, {"5", "05"}, {"90", "05"}, {"-1", "-1"}}) {
        set("PILOT_PHASE", stored);
        multiplex.load(settings);
        EXPECT_EQ(multiplex.pilotPhase, phase) << stored;
    }
}

// The file counts the impedances from 1, what is sent from 0.
TEST_F(MultiplexTest, AStoredOneIsTheFirstImpedanceAndTwoTheSecond) {
    for (const auto& [stored, sentAs] : {std::pair{"1", "0"}, {"2", "1"}, {"0", ""}, {"3", ""}, {"", ""}}) {
        set("MPX_IMPEDANZ", stored);
        multiplex.load(settings);
        EXPECT_EQ(multiplex.impedance, sentAs) << stored;
    }
}

// The area is kept under two names, one for the number that is read and one for the letter that nobody reads.
TEST_F(MultiplexTest, AStoredAreaIsOneOfTheFirstFourByNumber) {
    set("ARI-BK", "F");
    for (const auto& [stored, area] : {std::pair{"0", "A"}, {"3", "D"}, {"4", ""}, {"5", ""}, {"D", ""}, {"", ""}}) {
        set("ARI_BK", stored);
        multiplex.load(settings);
        EXPECT_EQ(multiplex.ariArea, area) << stored;
    }
}

TEST_F(MultiplexTest, TheSettingsAreSentInTheirOrder) {
    storeEverything();
    multiplex.load(settings);
    EXPECT_EQ(sentFor(steps()),
              (Lines{":stereo:audio:preemphasis:state ON;:stereo:audio:preemphasis 50us", ":stereo:pilot:state ON",
                     ":STEREO:PILOT:DEVIATION 6750HZ", ":STEREO:PILOT:PHASE -4DEG", ":stereo:ari:state OFF",
                     ":stereo:rds:state ON", ":STEREO:RDS:DEVIATION 2000HZ"}));
}

// "ARI_HUB", "ARI_ID" and "AR_BK" are spelled otherwise than the instrument's parameters.
TEST_F(MultiplexTest, TheDetailsOfAriAreNoSteps) {
    storeEverything();
    multiplex.load(settings);
    EXPECT_EQ(shown(steps()), (Lines{"PREEMPHASIS=1", "PILOT=1", "PILOT_HUB=0675", "PILOT_PHASE=-4", "ARI=0", "RDS=1",
                                     "RDS_HUB=0200"}));
}

TEST_F(MultiplexTest, ADataSetWithoutPreemphasisSendsAnEmptyCommandInItsPlace) {
    multiplex.load(settings);
    EXPECT_EQ(sentFor(steps()),
              (Lines{"", ":stereo:pilot:state OFF", ":STEREO:PILOT:DEVIATION 0HZ", ":STEREO:PILOT:PHASE 00DEG",
                     ":stereo:ari:state OFF", ":stereo:rds:state OFF", ":STEREO:RDS:DEVIATION 0HZ"}));
}

TEST_F(MultiplexTest, TheOpeningPutsDeviationSourceAndTheFirstImpedanceInForce) {
    storeEverything();
    multiplex.load(settings);
    EXPECT_EQ(shown(openingSteps()), (Lines{"MPX_HUB=07500", "MPX_SOURCE=3", "MPX_IMPEDANZ=0"}));
    EXPECT_EQ(sentFor(openingSteps()), (Lines{":STEREO:DEVIATION 75000HZ", "STEREO:STAT ON;:stereo:source LFGEN", ""}));
}

TEST_F(MultiplexTest, TheFirstImpedanceIsLeftAloneWhenItIsChosenAlready) {
    set("MPX_IMPEDANZ", "1");
    multiplex.load(settings);
    EXPECT_EQ(shown(openingSteps()), (Lines{"MPX_HUB=00000", "MPX_SOURCE="}));
}

TEST_F(MultiplexTest, WithoutAnImpedanceTheFirstOneIsChosen) {
    multiplex.load(settings);
    EXPECT_EQ(shown(openingSteps()), (Lines{"MPX_HUB=00000", "MPX_SOURCE=", "MPX_IMPEDANZ=0"}));
}

TEST(OptionTextTest, IsTheIndexOrTheLetterAndNothingForNone) {
    EXPECT_EQ(optionText(-1), "");
    EXPECT_EQ(optionText(0), "0");
    EXPECT_EQ(optionText(4), "4");
    EXPECT_EQ(areaCode(-1), "");
    EXPECT_EQ(areaCode(0), "A");
    EXPECT_EQ(areaCode(5), "F");
}

}  // namespace
}  // namespace kdx::test
