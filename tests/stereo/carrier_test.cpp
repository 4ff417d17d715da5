#include "stereo/carrier.h"

#include "parttest.h"

namespace kdx::test {
namespace {

class CarrierTest : public PartTest {
protected:
    CarrierTest() {
        set("Datenset1.INI", "HF_Frequenz", "98.5");
        set("Datenset1.INI", "HF_Pegel", "80");
        set("Datenset1.INI", "NF_Frequenz", "1");
    }
    void set(const char* file, const char* key, const char* value) { setProfile(file, "VRN", key, value); }
    Steps steps() const {
        Steps steps;
        carrier.appendSteps(steps);
        return steps;
    }
    Steps openingSteps() const {
        Steps steps;
        carrier.appendOpeningSteps(steps);
        return steps;
    }

    Carrier carrier;
};

TEST_F(CarrierTest, FrequencyAndLevelGoWithTheDataSet) {
    carrier.load(settings);
    EXPECT_EQ(shown(steps()), (Lines{"HF-Frequenz=98.5", "HF-Pegel=80"}));
    EXPECT_EQ(sentFor(steps()), (Lines{"FREQ 98.5MHZ", ":POW 80DBUV"}));
}

// The generator knows no command for the sine: it is no step and leaves no line in the log.
TEST_F(CarrierTest, TheOpeningTurnsTheOutputOverAndSetsTheAudioFrequency) {
    carrier.load(settings);
    state.LogEnabled = true;
    EXPECT_EQ(shown(openingSteps()), (Lines{"HF:PEGEL:STATE=ON", "NF-Frequenz=1"}));
    EXPECT_EQ(sentFor(openingSteps()), (Lines{":OUTPUT:STAT ON", ":STEREO:AUDIO:FREQ 1KHZ"}));
    EXPECT_NE(folder.read("RDS_log.txt").find("NF-Frequenz"), std::string::npos);
    EXPECT_EQ(folder.read("RDS_log.txt").find("NFShape"), std::string::npos);
    carrier.outputOn = true;
    EXPECT_EQ(shown(openingSteps()), (Lines{"HF:PEGEL:STATE=OFF", "NF-Frequenz=1"}));
}

TEST_F(CarrierTest, LoadingLeavesTheOutputAsItIs) {
    carrier.outputOn = true;
    carrier.load(settings);
    EXPECT_TRUE(carrier.outputOn);
}

TEST_F(CarrierTest, TheValuesComeFromDataSetOneWhateverSetIsAtWork) {
    state.CurrentDataSet = "3";
    set("Datenset3.INI", "HF_Frequenz", "70");
    set("Datenset3.INI", "HF_Pegel", "7");
    set("Datenset3.INI", "NF_Frequenz", "0.7");
    carrier.load(settings);
    EXPECT_EQ(carrier.rfFrequency, "98.5");
    EXPECT_EQ(carrier.rfLevel, "80");
    EXPECT_EQ(carrier.audioFrequency, "1");
}

TEST_F(CarrierTest, TheValuesAreSentAsTheyAreStored) {
    set("Datenset1.INI", "HF_Frequenz", "098,50 x");
    set("Datenset1.INI", "HF_Pegel", "loud");
    carrier.load(settings);
    EXPECT_EQ(sentFor(steps()), (Lines{"FREQ 098,50 xMHZ", ":POW loudDBUV"}));
}

TEST_F(CarrierTest, MissingValuesAreSentEmpty) {
    folder.write("Datenset1.INI", "");
    carrier.load(settings);
    EXPECT_EQ(sentFor(steps()), (Lines{"FREQ MHZ", ":POW DBUV"}));
    EXPECT_EQ(sentFor(openingSteps()), (Lines{":OUTPUT:STAT ON", ":STEREO:AUDIO:FREQ KHZ"}));
}

}  // namespace
}  // namespace kdx::test
