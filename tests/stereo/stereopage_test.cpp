#include "stereo/stereopage.h"

#include <gtest/gtest.h>

#include <QLabel>
#include <QLineEdit>
#include <QPushButton>

#include <ostream>
#include <set>

#include "stereopagetest.h"

namespace kdx::test {
namespace {

struct ScrollCase {
    const char* scroll;
    const char* label;
    int value;
    const char* shown;
    const char* command;
    const char* key;
    const char* stored;
    std::string Multiplex::*member;
    friend void PrintTo(const ScrollCase& tried, std::ostream* out) { *out << tried.scroll << " at " << tried.value; }
};

class StereoScroll : public StereoPageTest, public ::testing::WithParamInterface<ScrollCase> {};

TEST_P(StereoScroll, IsShownSentKeptAndStored) {
    scroll(GetParam().scroll, GetParam().value);
    EXPECT_EQ(text(GetParam().label), GetParam().shown);
    EXPECT_EQ(sent(), Lines{GetParam().command});
    EXPECT_EQ(general(GetParam().key), GetParam().stored);
    EXPECT_EQ(multiplex.*GetParam().member, GetParam().stored);
}

INSTANTIATE_TEST_SUITE_P(
    Values, StereoScroll,
    ::testing::Values(ScrollCase{"FM_Hub_Scroll", "FM_Hub_Label2", 8000, "Hub 80.0 kHz", ":STEREO:DEVIATION 80000HZ",
                                 "MPX_DEV", "08000", &Multiplex::totalDeviation},
                      ScrollCase{"FM_Hub_Scroll", "FM_Hub_Label2", 10, "Hub 0.1 kHz", ":STEREO:DEVIATION 100HZ",
                                 "MPX_DEV", "00010", &Multiplex::totalDeviation},
                      ScrollCase{"Pilot_Hub_Scroll", "Pilot_hub_Label", 1500, "Hub 15.00 kHz",
                                 ":STEREO:PILOT:DEVIATION 15000HZ", "PILOT_HUB", "1500", &Multiplex::pilotDeviation},
                      ScrollCase{"Pilot_Hub_Scroll", "Pilot_hub_Label", 675, "Hub 6.75 kHz",
                                 ":STEREO:PILOT:DEVIATION 6750HZ", "PILOT_HUB", "0675", &Multiplex::pilotDeviation},
                      ScrollCase{"RDS_Hub_Scroll", "RDS_Hub_Label", 400, "Hub 4.00 kHz", ":STEREO:RDS:DEVIATION 4000HZ",
                                 "RDS_HUB", "0400", &Multiplex::rdsDeviation},
                      ScrollCase{"RDS_Hub_Scroll", "RDS_Hub_Label", 5, "Hub 0.05 kHz", ":STEREO:RDS:DEVIATION 50HZ",
                                 "RDS_HUB", "0005", &Multiplex::rdsDeviation},
                      ScrollCase{"Ari_hub_Scroll", "Ari_Label", 800, "Hub 8.00 kHz", ":stereo:ari:deviation 8000HZ",
                                 "ARI_HUB", "0800", &Multiplex::ariDeviation},
                      ScrollCase{"Ari_hub_Scroll", "Ari_Label", 350, "Hub 3.50 kHz", ":stereo:ari:deviation 3500HZ",
                                 "ARI_HUB", "0350", &Multiplex::ariDeviation},
                      ScrollCase{"HScroll1", "HScroll1_Label", -4, "Phase -4 °", ":STEREO:PILOT:PHASE -4DEG",
                                 "PILOT_PHASE", "-4", &Multiplex::pilotPhase},
                      ScrollCase{"HScroll1", "HScroll1_Label", 0, "Phase 0 °", ":STEREO:PILOT:PHASE 00DEG",
                                 "PILOT_PHASE", "00", &Multiplex::pilotPhase},
                      ScrollCase{"HScroll1", "HScroll1_Label", 5, "Phase 5 °", ":STEREO:PILOT:PHASE 05DEG",
                                 "PILOT_PHASE", "05", &Multiplex::pilotPhase}));

struct RangeCase {
    const char* scroll;
    int lowest;
    int highest;
    int step;
    int design;
    friend void PrintTo(const RangeCase& range, std::ostream* out) { *out << range.scroll; }
};

class StereoRange : public StereoPageTest, public ::testing::WithParamInterface<RangeCase> {};

TEST_P(StereoRange, CannotBeLeft) {
    const auto* bar = find<QScrollBar>(GetParam().scroll);
    EXPECT_EQ(bar->minimum(), GetParam().lowest);
    EXPECT_EQ(bar->maximum(), GetParam().highest);
    EXPECT_EQ(bar->singleStep(), GetParam().step);
    EXPECT_EQ(bar->pageStep(), GetParam().step);
    EXPECT_EQ(bar->value(), GetParam().design);
    scroll(GetParam().scroll, GetParam().highest + 1000);
    EXPECT_EQ(bar->value(), GetParam().highest);
    scroll(GetParam().scroll, GetParam().lowest - 1000);
    EXPECT_EQ(bar->value(), GetParam().lowest);
}

INSTANTIATE_TEST_SUITE_P(
    Values, StereoRange,
    ::testing::Values(RangeCase{"FM_Hub_Scroll", 0, 8000, 10, 0}, RangeCase{"Pilot_Hub_Scroll", 0, 1500, 5, 0},
                      RangeCase{"RDS_Hub_Scroll", 0, 400, 5, 0}, RangeCase{"Ari_hub_Scroll", 0, 800, 5, 0},
                      RangeCase{"HScroll1", -4, 5, 1, 2}, RangeCase{"RDS_Phase_Scroll", 0, 359, 1, 0}));

struct OptionCase {
    const char* option;
    const char* command;
    const char* entry;  ///< the stored line, its key spelled as in the file
    std::string Multiplex::*member;
    friend void PrintTo(const OptionCase& value, std::ostream* out) { *out << value.option; }
};

class StereoOption : public StereoPageTest, public ::testing::WithParamInterface<OptionCase> {};

TEST_P(StereoOption, IsSentKeptAndStored) {
    click(GetParam().option);
    EXPECT_TRUE(checked(GetParam().option));
    EXPECT_EQ(sent(), Lines{GetParam().command});
    const std::string entry = GetParam().entry;
    EXPECT_NE(folder.read("RDS_Allg.INI").find("\n" + entry + "\r\n"), std::string::npos)
        << folder.read("RDS_Allg.INI");
    EXPECT_EQ(multiplex.*GetParam().member, entry.substr(entry.find('=') + 1));
}

INSTANTIATE_TEST_SUITE_P(
    Sources, StereoOption,
    ::testing::Values(
        OptionCase{"FM_Source_Opt_0", "STEREO:STAT OFF", "MPX_SOURCE=0", &Multiplex::source},
        OptionCase{"FM_Source_Opt_1", "STEREO:STAT ON;:stereo:source LREXT", "MPX_SOURCE=1", &Multiplex::source},
        OptionCase{"FM_Source_Opt_2", "STEREO:STAT ON;:stereo:source SPEXT", "MPX_SOURCE=2", &Multiplex::source},
        OptionCase{"FM_Source_Opt_3", "STEREO:STAT ON;:stereo:source LFGEN", "MPX_SOURCE=3", &Multiplex::source}));

// The dispatcher knows the impedances as 1 and 2, the options count from 0: the first one sends an empty command and
// the second one the first impedance.
INSTANTIATE_TEST_SUITE_P(Impedances, StereoOption,
                         ::testing::Values(OptionCase{"FM_Imp_Opt_0", "", "MPX_IMPEDANZ=0", &Multiplex::impedance},
                                           OptionCase{"FM_Imp_Opt_1", ":STEREO:EXTERNAL:IMP 600", "MPX_IMPEDANZ=1",
                                                      &Multiplex::impedance}));

INSTANTIATE_TEST_SUITE_P(
    Preemphases, StereoOption,
    ::testing::Values(OptionCase{"Pre_opt_0", ":stereo:audio:preemphasis:state OFF", "PREEMPHASIS=0",
                                 &Multiplex::preemphasis},
                      OptionCase{"Pre_opt_1", ":stereo:audio:preemphasis:state ON;:stereo:audio:preemphasis 50us",
                                 "PREEMPHASIS=1", &Multiplex::preemphasis},
                      OptionCase{"Pre_opt_2", ":stereo:audio:preemphasis:state ON;:stereo:audio:preemphasis 75us",
                                 "PREEMPHASIS=2", &Multiplex::preemphasis}));

// Here too the dispatcher counts from 1 and the options from 0.
INSTANTIATE_TEST_SUITE_P(
    StereoModes, StereoOption,
    ::testing::Values(OptionCase{"Stereo_Opt_0", "", "Stereo_Mode=0", &Multiplex::stereoMode},
                      OptionCase{"Stereo_Opt_1", ":stereo:audio:mode LEFT", "Stereo_Mode=1", &Multiplex::stereoMode},
                      OptionCase{"Stereo_Opt_2", ":stereo:audio:mode RIGHT", "Stereo_Mode=2", &Multiplex::stereoMode},
                      OptionCase{"Stereo_Opt_3", ":stereo:audio:mode REL", "Stereo_Mode=3", &Multiplex::stereoMode},
                      OptionCase{"Stereo_Opt_4", ":stereo:audio:mode REML", "Stereo_Mode=4", &Multiplex::stereoMode}));

INSTANTIATE_TEST_SUITE_P(
    AriModes, StereoOption,
    ::testing::Values(
        OptionCase{"ARI_Mode_Opt_0", ":stereo:ari:type:state OFF", "ARI_ID=0", &Multiplex::ariType},
        OptionCase{"ARI_Mode_Opt_1", ":stereo:ari:type:state ON;:stereo:ari:type DK", "ARI_ID=1", &Multiplex::ariType},
        OptionCase{"ARI_Mode_Opt_2", ":stereo:ari:type:state ON;:stereo:ari:type BK", "ARI_ID=2", &Multiplex::ariType},
        OptionCase{"ARI_Mode_Opt_3", ":stereo:ari:type:state ON;:stereo:ari:type BKDK", "ARI_ID=3",
                   &Multiplex::ariType}));

INSTANTIATE_TEST_SUITE_P(AriAreas, StereoOption,
                         ::testing::Values(OptionCase{"BK_Opt_0", ":stereo:ari:bk A", "ARI-BK=A", &Multiplex::ariArea},
                                           OptionCase{"BK_Opt_1", ":stereo:ari:bk B", "ARI-BK=B", &Multiplex::ariArea},
                                           OptionCase{"BK_Opt_2", ":stereo:ari:bk C", "ARI-BK=C", &Multiplex::ariArea},
                                           OptionCase{"BK_Opt_3", ":stereo:ari:bk D", "ARI-BK=D", &Multiplex::ariArea},
                                           OptionCase{"BK_Opt_4", ":stereo:ari:bk E", "ARI-BK=E", &Multiplex::ariArea},
                                           OptionCase{"BK_Opt_5", ":stereo:ari:bk F", "ARI-BK=F",
                                                      &Multiplex::ariArea}));

struct SwitchCase {
    const char* button;
    const char* key;
    const char* on;
    const char* off;
    std::string Multiplex::*member;
    friend void PrintTo(const SwitchCase& value, std::ostream* out) { *out << value.button; }
};

class StereoSwitch : public StereoPageTest, public ::testing::WithParamInterface<SwitchCase> {};

TEST_P(StereoSwitch, TwoClicksReturnToWhereItWas) {
    EXPECT_FALSE(checked(GetParam().button));
    click(GetParam().button);
    EXPECT_TRUE(checked(GetParam().button));
    EXPECT_EQ(sent(), Lines{GetParam().on});
    EXPECT_EQ(general(GetParam().key), "1");
    EXPECT_EQ(multiplex.*GetParam().member, "1");
    click(GetParam().button);
    EXPECT_FALSE(checked(GetParam().button));
    EXPECT_EQ(sent(), Lines{GetParam().off});
    EXPECT_EQ(general(GetParam().key), "0");
    EXPECT_EQ(multiplex.*GetParam().member, "0");
}

INSTANTIATE_TEST_SUITE_P(Values, StereoSwitch,
                         ::testing::Values(SwitchCase{"Pilot_OnOff", "PILOT", ":stereo:pilot:state ON",
                                                      ":stereo:pilot:state OFF", &Multiplex::pilot},
                                           SwitchCase{"RDS_OnOff", "RDS", ":stereo:rds:state ON",
                                                      ":stereo:rds:state OFF", &Multiplex::rds},
                                           SwitchCase{"Ari_OnOff", "ARI", ":stereo:ari:state ON",
                                                      ":stereo:ari:state OFF", &Multiplex::ari}));

TEST_F(StereoPageTest, TheOptionsBearTheirTexts) {
    const auto caption = [this](int number) { return toText(captions.text(number)).toStdString(); };
    EXPECT_EQ(text("FM_Source_Opt_0"), caption(22));
    EXPECT_EQ(text("FM_Source_Opt_1"), caption(23));
    EXPECT_EQ(text("FM_Source_Opt_2"), caption(24));
    EXPECT_EQ(text("FM_Source_Opt_3"), caption(25));
    EXPECT_EQ(text("Pre_opt_0"), caption(28));
    EXPECT_EQ(text("Pre_opt_1"), "50 µs");
    EXPECT_EQ(text("Pre_opt_2"), "75 µs");
    EXPECT_EQ(text("ARI_Mode_Opt_0"), caption(193));
    EXPECT_EQ(text("ARI_Mode_Opt_3"), "DK + BK");
    EXPECT_EQ(text("FM_Imp_Opt_0"), "600 Ohm");
    EXPECT_EQ(text("FM_Imp_Opt_1"), "100k Ohm");
    EXPECT_EQ(text("Stereo_Opt_0"), "links");
    EXPECT_EQ(text("Stereo_Opt_1"), "rechts");
    EXPECT_EQ(text("Stereo_Opt_2"), "links = rechts");
    EXPECT_EQ(text("Stereo_Opt_3"), "links = -rechts");
    EXPECT_EQ(text("Stereo_Opt_4"), "links =/ rechts");
    EXPECT_EQ(text("BK_Opt_0"), "A");
    EXPECT_EQ(text("BK_Opt_5"), "F");
}

TEST_F(StereoPageTest, OneOptionOfEachGroupIsChosenAtATime) {
    click("ARI_Mode_Opt_1");
    click("BK_Opt_2");
    click("BK_Opt_4");
    EXPECT_EQ(chosen("ARI_Mode_Opt", 4), 1);
    EXPECT_EQ(chosen("BK_Opt", 6), 4);
    EXPECT_FALSE(checked("BK_Opt_2"));
}

TEST_F(StereoPageTest, TheRdsPhaseDoesNothing) {
    state.LogEnabled = true;
    scroll("RDS_Phase_Scroll", 100);
    EXPECT_TRUE(sent().empty());
    EXPECT_EQ(folder.read("RDS_log.txt"), "");
    EXPECT_EQ(general("RDS_PHASE"), "");
}

TEST_F(StereoPageTest, SendingEverythingIsAskedForByASignal) {
    int requests = 0;
    QObject::connect(&page, &StereoPage::setRdsStereoRequested, &page, [&requests] { ++requests; });
    click("Btn_SetRdsStereo");
    EXPECT_EQ(requests, 1);
    EXPECT_TRUE(sent().empty());
}

TEST_F(StereoPageTest, RelabellingChangesTheWordsOnly) {
    scroll("FM_Hub_Scroll", 7500);
    scroll("HScroll1", -3);
    click("FM_Source_Opt_1");
    click("Pilot_OnOff");
    sent();
    useLanguage("english");
    page.label();
    EXPECT_EQ(text("FM_Hub_Label2"), captions.text(21) + " 75.0 kHz");
    EXPECT_EQ(text("Pilot_hub_Label"), captions.text(21) + " 0.00 kHz");
    EXPECT_EQ(text("HScroll1_Label"), "Phase -3 °");
    EXPECT_EQ(text("Pre_opt_0"), captions.text(28));
    EXPECT_EQ(text("ARI_Mode_Opt_0"), "off");
    EXPECT_EQ(text("Stereo_Opt_3"), "left = -right");
    EXPECT_EQ(find<QGroupBox>("FM_Sorce_Frame")->title(), toText(captions.text(20)));
    EXPECT_EQ(find<QGroupBox>("FM_Imp_Frame")->title(), toText(captions.text(26)));
    EXPECT_EQ(find<QGroupBox>("Pre_Frame")->title(), toText(captions.text(27)));
    EXPECT_EQ(find<QGroupBox>("Frame_stereo")->title(), toText(captions.text(29)));
    EXPECT_EQ(position("FM_Hub_Scroll"), 7500);
    EXPECT_EQ(chosen("FM_Source_Opt", 4), 1);
    EXPECT_TRUE(checked("Pilot_OnOff"));
    EXPECT_TRUE(sent().empty());
}

TEST_F(StereoPageTest, WithoutALanguageFileTheDesignTextsStand) {
    folder.write("Sprachen.ini", "");
    useLanguage("deutsch");
    page.label();
    EXPECT_EQ(text("Stereo_Opt_4"), "links =/ rechts");
    EXPECT_EQ(find<QGroupBox>("RDS_Frame")->title().toStdString(), "R D S");
    EXPECT_EQ(find<QGroupBox>("Ari_Frame")->title().toStdString(), "A R I");
}

TEST_F(StereoPageTest, EveryControlWithoutATextHasAnAccessibleName) {
    for (const char* name : {"FM_Hub_Scroll", "Pilot_Hub_Scroll", "HScroll1", "RDS_Hub_Scroll", "RDS_Phase_Scroll",
                             "Ari_hub_Scroll", "Pilot_OnOff", "RDS_OnOff", "Ari_OnOff"}) {
        EXPECT_FALSE(find(name)->accessibleName().isEmpty()) << name;
    }
}

TEST_F(StereoPageTest, NoLanguageTakesTheMnemonicsOfTheTestMode) {
    for (const char* language : {"deutsch", "english", "english US"}) {
        useLanguage(language);
        page.label();
        for (const char16_t* mode : {u"&RDS_Mode", u"&Test_Mode"}) {
            testMode->button->setText(QString::fromUtf16(mode));
            std::multiset<QString> keys;
            for (const auto* button : page.findChildren<QAbstractButton*>()) {
                const QString key = QKeySequence::mnemonic(button->text()).toString();
                if (!key.isEmpty()) keys.insert(key);
            }
            EXPECT_EQ(keys.size(), 2U) << language;
            EXPECT_EQ(keys.size(), std::set<QString>(keys.begin(), keys.end()).size()) << language;
        }
    }
}

TEST_F(StereoPageTest, TheTabKeyFollowsTheColumns) {
    Lines order;
    for (const QWidget* at = find("FM_Hub_Zahl");;) {
        const bool reached = (at->focusPolicy() & Qt::TabFocus) != 0 && at->focusProxy() == nullptr &&
                             at->objectName() != QStringLiteral("qt_spinbox_lineedit");
        if (reached && !at->objectName().startsWith(QStringLiteral("RDS_Phase"))) {
            const std::string name = at->objectName().toStdString();
            if (qobject_cast<const QRadioButton*>(at) == nullptr) order.push_back(name);
        }
        at = at->nextInFocusChain();
        if (at == find("FM_Hub_Zahl")) break;
    }
    EXPECT_EQ(order, (Lines{"FM_Hub_Zahl", "FM_Hub_Scroll", "Pilot_OnOff", "Pilot_Hub_Zahl", "Pilot_Hub_Scroll",
                            "HScroll1_Zahl", "HScroll1", "RDS_OnOff", "RDS_Hub_Zahl", "RDS_Hub_Scroll", "Ari_OnOff",
                            "Ari_hub_Zahl", "Ari_hub_Scroll", "Taste_DATA_MODE", "Btn_SetRdsStereo"}));
}

}  // namespace
}  // namespace kdx::test
