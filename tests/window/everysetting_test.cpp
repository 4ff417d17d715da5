#include "window/everysetting.h"

#include <gtest/gtest.h>

namespace kdx::test {
namespace {

TEST_F(EverySetting, OfTheStereoPageArrives) {
    showPage(0);
    expectScroll("FM_Hub_Scroll", ":STEREO:DEVIATION?", {{8000, "80000"}, {10, "100"}, {0, "0"}, {7500, "75000"}});
    click("FM_Source_Opt_0");
    EXPECT_EQ(observer.ask("STEREO:STAT?"), "0");
    for (const auto& [option, source] : {std::pair{1, "LREXT"}, {2, "SPEXT"}, {3, "LFGEN"}}) {
        click(numbered("FM_Source_Opt", option));
        EXPECT_EQ(observer.ask("STEREO:STAT?;:STEREO:SOURCE?"), "1;" + std::string(source));
    }
    // The instrument's parameter counts the impedances from 1, the options count from 0: the first one sends nothing,
    // the second one the first impedance.
    observer.tell(":STEREO:EXTERNAL:IMP 100000");
    expectOptions("FM_Imp_Opt", ":STEREO:EXTERNAL:IMP?", {"100000", "600"});
    expectOptions("Pre_opt", ":STEREO:AUDIO:PRE:STAT?;:STEREO:AUDIO:PRE?", {"0;50US", "1;50US", "1;75US"});
    // The stereo modes are counted in the same two ways.
    observer.tell(":STEREO:AUDIO:MODE RNEL");
    expectOptions("Stereo_Opt", ":STEREO:AUDIO:MODE?", {"RNEL", "LEFT", "RIGHT", "REL", "REML"});
    expectSwitch("Pilot_OnOff", ":STEREO:PILOT:STATE?");
    expectScroll("Pilot_Hub_Scroll", ":STEREO:PILOT:DEVIATION?", {{1500, "15000"}, {5, "50"}, {0, "0"}, {675, "6750"}});
    expectScroll("HScroll1", ":STEREO:PILOT:PHASE?", {{-4, "-4"}, {0, "0"}, {5, "5"}, {2, "2"}});
    expectSwitch("RDS_OnOff", ":STEREO:RDS:STATE?");
    expectScroll("RDS_Hub_Scroll", ":STEREO:RDS:DEVIATION?", {{400, "4000"}, {5, "50"}, {0, "0"}, {200, "2000"}});
    expectSwitch("Ari_OnOff", ":STEREO:ARI:STATE?");
    expectScroll("Ari_hub_Scroll", ":STEREO:ARI:DEVIATION?", {{800, "8000"}, {5, "50"}, {0, "0"}, {350, "3500"}});
    expectOptions("ARI_Mode_Opt", ":STEREO:ARI:TYPE:STATE?;:STEREO:ARI:TYPE?", {"0;DK", "1;DK", "1;BK", "1;BKDK"});
    expectOptions("BK_Opt", ":STEREO:ARI:BK?", {"A", "B", "C", "D", "E", "F"});

    click("Taste_DATA_MODE");
    expectCoder("BIN", "1");
    for (int pattern = 3; pattern >= 0; --pattern) {
        click(numbered("TestDat_Opt", pattern));
        expectCoder("BIN", std::to_string(pattern + 1));
    }
    click("Taste_DATA_MODE");
    expectCoder("BIN", "0");

    click("Btn_SetRdsStereo");
    expectAllUsed(0, {"RDS_Phase_Scroll"});  // hidden: the program has no command for it
}

TEST_F(EverySetting, OfTheRdsPageArrives) {
    showPage(1);
    type("PS_T", "Grün 1");
    click("PS_Taste");
    expectCoder("PS", "Gr\xFCn 1  ");
    type("PI_T", "D3C2");
    click("Command3");
    expectCoder("PI", "D3C2");
    for (const int programmeType : {31, 0, 10}) {
        select("PTY_Combo1", programmeType);
        expectCoder("PTY", (programmeType < 10 ? "0" : "") + std::to_string(programmeType));
    }
    click("Check1");
    EXPECT_EQ(observer.ask(":STEREO:RDS:TRAFFIC:PROGRAM?"), "1");
    for (const char* flag : {"1", "0"}) {
        click("TA_Check");
        expectCoder("TA", flag);
    }
    click("Check1");
    EXPECT_EQ(observer.ask(":STEREO:RDS:TRAFFIC:PROGRAM?"), "0");
    click("MS_opt_1");
    expectCoder("MS", "S");
    click("MS_opt_0");
    expectCoder("MS", "M");
    for (int info = 15; info >= 0; --info) {
        click(numbered("DI_Opt", info));
        expectCoder("DI", std::to_string(info));
    }
    type("RT_Text1", "Radiotext, mit Komma");
    click("RT_Taste1");
    expectCoder("RT", "Radiotext, mit Komma");
    expectCoder("RT-N", "10,0");
    click("RT_clear1");
    expectCoder("RT", "   ");
    clock.set(8 * 3600 + 15 * 60 + 30);
    ASSERT_TRUE(tick("Timer1"));
    expectCoder("CT", "08:15:30,05.03.09");
    click("Zeit_Taste");  // off: the coder's clock runs on
    expectCoder("CT", "08:15:30,05.03.09");
    // What sends only as time goes by, and what only explains.
    expectAllUsed(1, {"PS_dyn_Check", "Taste_PS_Auto", "TA_EON_Hilfe", "TA_HScroll", "TA_Option_0", "TA_Option_1",
                      "TA_Rep_HScroll", "Uhr_Zeit"});
}

TEST_F(EverySetting, OfTheListPageArrives) {
    showPage(2);
    for (int number = 1; number <= 5; ++number) {
        click(numbered("AFList_Opt", number - 1));
        editList("AF_Bearbeiten", number);
        EXPECT_EQ(text("AF_TN"), "99.9") << number;
    }
    click("AFMethod_opt_1");
    click("Taste_AF_Senden");
    for (int number = 1; number <= 5; ++number) {
        expectCoder(("AF" + std::to_string(number)).c_str(), editedPairs(number));
    }
    click("AFMethod_opt_0");
    click("Taste_AF_Senden");
    for (int number = 1; number <= 5; ++number) {
        expectCoder(("AF" + std::to_string(number)).c_str(), edited(number));
    }
    expectAllUsed(2);
}

TEST_F(EverySetting, OfTheGroupPageArrives) {
    showPage(3);
    click("newList");
    std::string sequence;
    for (int group = 15; group >= 0; --group) {
        if (group == 4) continue;
        click("Gruppe" + std::to_string(group));
        sequence += (sequence.empty() ? "" : ",") + std::to_string(group) + "A";
    }
    click("GS_Senden");
    expectCoder("GS", sequence);
    EXPECT_FALSE(find("Gruppe4")->isEnabled());
    expectAllUsed(3, {"Gruppe4", "Gruppe_Nach", "Gruppe_Vor", "Gruppe_Zurueck"});  // these store nothing of their own
}

TEST_F(EverySetting, OfTheOtherNetworkArrives) {
    // An announcement of the other network needs TP off and TA on here: TA can only be given while TP is on.
    for (const char* box : {"Check1", "TA_Check", "Check1"}) click(box);
    showPage(4);
    expectCoder("EON PI?", " D7A2,");
    type("EON_PI_Text", "D3C4");
    click("EON_PI_Taste");
    expectCoder("EON PI?", " D3C4,");
    type("EON_PS_Text", "ANDERES");
    click("EON_PS_Taste");
    expectCoder("EON-PS,D3C4", "ANDERES ");
    for (const char* flag : {"0", "1"}) {
        click("EON_TP_Check");
        expectCoder("EON-TP,D3C4", flag);
    }
    click("EON_TA_Schalter");
    expectCoder("EON-TA,D3C4", "1");
    ASSERT_TRUE(tick("EON_TA_Zeit"));
    expectCoder("EON-TA,D3C4", "0");
    EXPECT_FALSE(tick("EON_TA_Zeit"));
    for (int number = 1; number <= 5; ++number) {
        click(numbered("EON_AFB_Opt", number - 1));
        editList("EON_AF_Bearbeiten", number);
        EXPECT_EQ(text("Tuned_AFB"), "99.9") << number;
    }
    click("EON_AFB_Senden");
    for (int number = 1; number <= 5; ++number) {
        expectCoder(("EON-AFB,D3C4," + std::to_string(number)).c_str(), edited(number));
    }
    EXPECT_EQ(observer.errors(), kNoErrors);
    // The type's name goes out in place of a PI, which the coder refuses: networks and types stay as they were.
    select("EON_PTY_Combo", 10);
    EXPECT_EQ(observer.errors(), kIllegalValue);
    expectCoder("EON PI?", " D3C4,");
    expectCoder("EON-PTY,D3C4", "00");
    expectAllUsed(4);
}

TEST_F(EverySetting, OfTheMemoryPageArrives) {
    showPage(6);
    for (int memory = 4; memory >= 0; --memory) click(numbered("Store_Taste", memory));
    expectCoder("STORE", "1,2,3,4,5");
    expectAllUsed(6);
}

TEST_F(EverySetting, OfTheGeneratorPageArrives) {
    showPage(8);
    const std::tuple<const char*, const char*, const char*, const char*> values[] = {
        {"Input_HF_Freq_Label", "101.25", "FREQ?", "101.25"},
        {"Input_HF_Pegel_Label", "66.5", "POW?", "66.5"},
        {"Input_AF_Freq_Label", "0.4", ":STEREO:AUDIO:FREQ?", "0.4"}};
    for (const auto& [label, typed, query, answer] : values) {
        dialogs.inputs = {QString::fromLatin1(typed)};
        clickLabel(label);
        EXPECT_EQ(observer.ask(query), answer) << label;
    }
    EXPECT_EQ(observer.ask(":OUTPUT:STAT?"), "1") << "the opening has switched it on";
    expectSwitch("HfOnOffState", ":OUTPUT:STAT?");
    expectAllUsed(8);
}

/// 26 frequencies that begin with the tuned one: 129 characters or more.
std::string longList(int tuned) {
    std::string list = std::to_string(tuned) + ".5";
    for (int i = 0; i < 25; ++i) list += "," + std::to_string(88 + i % 10) + ".9";
    return list;
}

// A read takes 60 bytes; what an answer has beyond them is dropped with the next command, so that every question gets
// the beginning of its own answer. (The virtual instrument inside the program keeps it.)
TEST_F(EverySetting, ListsLongerThanAReadAreCutAndTheRestIsDroppedWithTheNextQuestion) {
    std::string shown;
    for (int list = 1; list <= 5; ++list) {
        const std::string frequencies = longList(87 + list);
        observer.tell(std::string(R"(:STEREO:DIRECT "AF=)") + (list == 1 ? "N," : "+,") + frequencies + '"');
        shown += (list == 1 ? "AF" : "\nAF") + std::to_string(list) + ": " + frequencies.substr(0, 58);
    }
    EXPECT_EQ(observer.askCoder("AF5"), longList(92));
    click("Command4");
    EXPECT_EQ(text("gelesen"), shown);
    click("Command6");
    EXPECT_EQ(text("gelesen"), observer.askCoder("PI")) << "nothing is left over";
    EXPECT_EQ(observer.errors(), Lines(5, R"(-410,"Query INTERRUPTED")"));
}

}  // namespace
}  // namespace kdx::test
