#include <gtest/gtest.h>

#include <QComboBox>

#include "window/correctionstest.h"

namespace kdx::test {
namespace {

class CorrectedSignalTest : public CorrectionsTest {
protected:
    CorrectedSignalTest() {
        setGeneral("FM", "Stereo_Mode", "2");
        setGeneral("FM", "MPX_IMPEDANZ", "2");
    }
    static Lines modes(const Lines& commands) { return beginning(commands, ":stereo:audio:mode"); }
    static Lines impedances(const Lines& commands) { return beginning(commands, ":STEREO:EXTERNAL:IMP"); }
    static Lines outputs(const Lines& commands) { return beginning(commands, ":OUTPUT"); }
};

TEST_F(CorrectedSignalTest, TheStereoModeGoesOutOneBesideThePanelAsDescribed) {
    EXPECT_EQ(modes(openWith({})), Lines{});
    EXPECT_EQ(sentBy("Stereo_Opt_1"), Lines{":stereo:audio:mode LEFT"});
    EXPECT_EQ(general("FM", "Stereo_Mode"), "1");
    EXPECT_EQ(modes(sentBy("Btn_SetRdsStereo")), Lines{});
}

TEST_F(CorrectedSignalTest, TheStereoModeGoesOutAsThePanelNamesItWhenCorrected) {
    EXPECT_EQ(modes(openWith({"Stereo_Mode"})), Lines{":stereo:audio:mode REL"});
    EXPECT_TRUE(checked("Stereo_Opt_2"));
    for (const auto& [option, mode] : {std::pair("Stereo_Opt_0", "LEFT"), std::pair("Stereo_Opt_1", "RIGHT"),
                                       std::pair("Stereo_Opt_3", "REML"), std::pair("Stereo_Opt_4", "RNEL")}) {
        EXPECT_EQ(sentBy(option), Lines{std::string(":stereo:audio:mode ") + mode});
        EXPECT_EQ(general("FM", "Stereo_Mode"), std::string(1, option[11]));
    }
    EXPECT_EQ(modes(sentBy("Btn_SetRdsStereo")), Lines{":stereo:audio:mode RNEL"});
    EXPECT_EQ(sentBy("FM_Imp_Opt_1"), Lines{":STEREO:EXTERNAL:IMP 600"}) << "a correction of its own";
}

TEST_F(CorrectedSignalTest, AModeThatIsNotChosenIsNotSentWhenCorrected) {
    setGeneral("FM", "Stereo_Mode", "7");
    EXPECT_EQ(modes(openWith({"Stereo_Mode"})), Lines{});
}

TEST_F(CorrectedSignalTest, TheImpedanceGoesOutOneBesideThePanelAsDescribed) {
    const Lines opening = openWith({});
    EXPECT_EQ(impedances(opening), Lines{});
    EXPECT_EQ(std::count(opening.begin(), opening.end(), ""), 1) << "the first option has no command";
    EXPECT_EQ(sentBy("FM_Imp_Opt_1"), Lines{":STEREO:EXTERNAL:IMP 600"});
    EXPECT_EQ(general("FM", "MPX_IMPEDANZ"), "1");
    EXPECT_EQ(impedances(sentBy("Btn_SetRdsStereo")), Lines{});
}

TEST_F(CorrectedSignalTest, TheImpedanceGoesOutAsThePanelNamesItWhenCorrected) {
    const Lines opening = openWith({"Impedanz"});
    EXPECT_EQ(impedances(opening), Lines{":STEREO:EXTERNAL:IMP 600"});
    EXPECT_EQ(std::count(opening.begin(), opening.end(), ""), 0);
    EXPECT_TRUE(checked("FM_Imp_Opt_0"));
    EXPECT_EQ(general("FM", "MPX_IMPEDANZ"), "0");
    EXPECT_EQ(sentBy("FM_Imp_Opt_1"), Lines{":STEREO:EXTERNAL:IMP 100000"});
    EXPECT_EQ(general("FM", "MPX_IMPEDANZ"), "1");
    EXPECT_EQ(impedances(sentBy("Btn_SetRdsStereo")), Lines{":STEREO:EXTERNAL:IMP 100000"});
    EXPECT_TRUE(checked("FM_Imp_Opt_1"));
    EXPECT_EQ(general("FM", "MPX_IMPEDANZ"), "1");
    EXPECT_EQ(sentBy("FM_Imp_Opt_0"), Lines{":STEREO:EXTERNAL:IMP 600"});
    click("GTL_Taste");
    EXPECT_EQ(impedances(opened()), Lines{":STEREO:EXTERNAL:IMP 600"}) << "also when it is chosen already";
    EXPECT_EQ(sentBy("Stereo_Opt_1"), Lines{":stereo:audio:mode LEFT"}) << "a correction of its own";
}

TEST_F(CorrectedSignalTest, TheLevelThatIsReadBackBearsTheUnitItWasSetInWhenCorrected) {
    visa.answersTo["POW?"] = "60.0\n";
    for (const char* unit : {"dBm", "dBµV"}) {
        if (std::string(unit) == "dBm") {
            openWith({});
        } else {
            openWith({"Pegel"});
        }
        showPage(5);
        EXPECT_EQ(sentBy("Command22"), Lines{"POW?"});
        EXPECT_EQ(text("gelesen"), std::string("60.0 ") + unit);
        click("GTL_Taste");
    }
}

TEST_F(CorrectedSignalTest, EveryOpeningTurnsTheOutputOverAsDescribed) {
    EXPECT_EQ(outputs(openWith({})), Lines{":OUTPUT:STAT ON"});
    click("GTL_Taste");
    EXPECT_EQ(outputs(opened()), Lines{":OUTPUT:STAT OFF"});
    EXPECT_FALSE(checked("HfOnOffState"));
}

TEST_F(CorrectedSignalTest, TheOutputStaysAsTheSwitchShowsItWhenCorrected) {
    EXPECT_EQ(outputs(openWith({"HF_Ausgang"})), Lines{":OUTPUT:STAT ON"});
    click("GTL_Taste");
    EXPECT_EQ(outputs(opened()), Lines{":OUTPUT:STAT ON"});
    EXPECT_TRUE(checked("HfOnOffState"));
    EXPECT_EQ(sentBy("HfOnOffState"), Lines{":OUTPUT:STAT OFF"});
    click("GTL_Taste");
    EXPECT_EQ(outputs(opened()), Lines{":OUTPUT:STAT OFF"});
    EXPECT_FALSE(checked("HfOnOffState"));
}

TEST_F(CorrectedSignalTest, AFailedOpeningIsNotTheFirstOne) {
    visa.openStatus = -1073807343;
    dialogs.expectedMessages = 1;
    EXPECT_EQ(openWith({"HF_Ausgang"}), Lines{});
    visa.openStatus = 0;
    EXPECT_EQ(outputs(opened()), Lines{":OUTPUT:STAT ON"});
}

TEST_F(CorrectedSignalTest, EnteredRfValuesAreForgottenAsDescribed) {
    openWith({});
    dialogs.inputs = {QStringLiteral("101.3")};
    clickLabel("Input_HF_Freq_Label");
    EXPECT_EQ(sent(), Lines{"FREQ 101.3MHZ"});
    const std::string kept = dataSet1("VRN", "HF_Frequenz");
    EXPECT_NE(kept, "101.3");
    EXPECT_EQ(beginning(sentBy("Btn_SetRdsStereo"), "FREQ"), Lines{"FREQ " + kept + "MHZ"});
}

TEST_F(CorrectedSignalTest, EnteredRfValuesAreKeptWhenCorrected) {
    openWith({"HF_Werte"});
    dialogs.inputs = {QStringLiteral("101.3"), QStringLiteral("0"), QStringLiteral("47.5"), QStringLiteral("2.5"),
                      QString()};
    for (const char* label : {"Input_HF_Freq_Label", "Input_HF_Pegel_Label", "Input_AF_Freq_Label"}) clickLabel(label);
    EXPECT_EQ(sent(), (Lines{"FREQ 101.3MHZ", ":POW 47.5DBUV", ":STEREO:AUDIO:FREQ 2.5KHZ"}));
    EXPECT_EQ(dataSet1("VRN", "HF_Frequenz"), "101.3");
    EXPECT_EQ(dataSet1("VRN", "HF_Pegel"), "47.5");
    EXPECT_EQ(dataSet1("VRN", "NF_Frequenz"), "2.5");
    clickLabel("Input_HF_Freq_Label");  // cancelled
    EXPECT_EQ(dataSet1("VRN", "HF_Frequenz"), "101.3");
    click("GTL_Taste");
    const Lines again = opened();
    EXPECT_EQ(beginning(again, "FREQ"), Lines{"FREQ 101.3MHZ"});
    EXPECT_EQ(beginning(again, ":POW"), Lines{":POW 47.5DBUV"});
    EXPECT_EQ(again.back(), ":STEREO:AUDIO:FREQ 2.5KHZ");
}

TEST_F(CorrectedSignalTest, WithoutAllFieldsATrafficMessageLacksBitsAsDescribed) {
    openWith({});
    EXPECT_EQ(text("TMC_Gr8_Label"), "-000000000") << "no field is chosen";
    select("TMC_Var_Combo", 5);
    select("TMC_Event_Combo", 3);
    EXPECT_EQ(text("TMC_Gr8_Label").front(), '-') << "the T bit is not chosen";
}

TEST_F(CorrectedSignalTest, FieldsNobodyChoseCountAs0WhenCorrected) {
    openWith({"TMC_Felder"});
    EXPECT_EQ(text("TMC_Gr8_Label"), "0000000000");
    select("TMC_Var_Combo", 5);
    EXPECT_EQ(text("TMCBL3_Event"), "-") << "the display tells what was chosen";
    EXPECT_EQ(text("TMC_Gr8_Label"), "0028000000");
    click("TMC_Gr8_apply");
    click("TMC_Senden_Taste");
    sent();
    EXPECT_TRUE(tick("TMC_Sende_Timer"));
    EXPECT_EQ(sent().back(), direct("8A=02,0028000000"));
    EXPECT_EQ(dataSet1("RDS", "TMC"), "02,0028000000");
}

TEST_F(CorrectedSignalTest, WhatIsCorrectedMayChangeWhileTheProgramRuns) {
    openWith({});
    EXPECT_EQ(sentBy("Stereo_Opt_1"), Lines{":stereo:audio:mode LEFT"});
    setGeneral("Berichtigungen", "Stereo_Mode", "1");
    setGeneral("Berichtigungen", "Mitternacht", "1");
    EXPECT_EQ(sentBy("Stereo_Opt_1"), Lines{":stereo:audio:mode LEFT"}) << "not before it is read";
    session->readCorrections();
    EXPECT_EQ(sentBy("Stereo_Opt_1"), Lines{":stereo:audio:mode RIGHT"});
    EXPECT_TRUE(clock.midnightCorrected());
}

}  // namespace
}  // namespace kdx::test
