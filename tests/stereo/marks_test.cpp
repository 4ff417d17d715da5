// What the page "FM / Stereo" tells of a value that did not reach the instrument.
#include <gtest/gtest.h>

#include <QDoubleSpinBox>

#include "stereopagetest.h"

namespace kdx::test {
namespace {

class StereoMarksTest : public StereoPageTest {
protected:
    void enterNumber(const char* name, const char* number) {
        auto* entry = find(name)->findChild<QLineEdit*>();
        entry->selectAll();
        entry->insert(QString::fromLatin1(number));
        press(name, Qt::Key_Return);
    }
    std::string tipOf(const char* name) { return find(name)->toolTip().toStdString(); }
};

TEST_F(StereoMarksTest, AnOptionThatDidNotArriveIsMarkedUntilItDoes) {
    for (const char* option :
         {"FM_Source_Opt_1", "FM_Imp_Opt_1", "Pre_opt_2", "Stereo_Opt_1", "ARI_Mode_Opt_3", "BK_Opt_4"}) {
        inVain([&] { click(option); });
        EXPECT_EQ(stateOf(option), "ungesendet") << option;
        EXPECT_EQ(tipOf(option), "Nicht beim Gerät angekommen.") << option;
        click(option);
        EXPECT_EQ(stateOf(option), "") << option;
        EXPECT_EQ(tipOf(option), "") << option;
    }
}

TEST_F(StereoMarksTest, TheMarkGoesWithTheChosenOption) {
    inVain([&] { click("Stereo_Opt_1"); });
    inVain([&] { click("Stereo_Opt_3"); });
    EXPECT_EQ(stateOf("Stereo_Opt_1"), "");
    EXPECT_EQ(stateOf("Stereo_Opt_3"), "ungesendet");
    click("Stereo_Opt_2");
    for (const char* option : {"Stereo_Opt_1", "Stereo_Opt_2", "Stereo_Opt_3"})
        EXPECT_EQ(stateOf(option), "") << option;
}

TEST_F(StereoMarksTest, ASwitchThatDidNotArriveIsMarked) {
    for (const char* button : {"Pilot_OnOff", "RDS_OnOff", "Ari_OnOff"}) {
        inVain([&] { click(button); });
        EXPECT_EQ(stateOf(button), "ungesendet") << button;
        click(button);
        EXPECT_EQ(stateOf(button), "") << button;
    }
}

TEST_F(StereoMarksTest, ABarThatDidNotArriveIsMarkedWithItsNumberAndItsLabel) {
    const struct {
        const char *bar, *number, *label;
        int first, second;
    } rows[] = {{"FM_Hub_Scroll", "FM_Hub_Zahl", "FM_Hub_Label2", 6000, 5000},
                {"Pilot_Hub_Scroll", "Pilot_Hub_Zahl", "Pilot_hub_Label", 700, 600},
                {"RDS_Hub_Scroll", "RDS_Hub_Zahl", "RDS_Hub_Label", 200, 300},
                {"Ari_hub_Scroll", "Ari_hub_Zahl", "Ari_Label", 400, 500},
                {"HScroll1", "HScroll1_Zahl", "HScroll1_Label", 3, 4}};
    for (const auto& row : rows) {
        inVain([&] { scroll(row.bar, row.first); });
        for (const char* name : {row.bar, row.number, row.label}) EXPECT_EQ(stateOf(name), "ungesendet") << name;
        page.label();
        EXPECT_EQ(stateOf(row.number), "ungesendet") << row.number;
        scroll(row.bar, row.second);
        for (const char* name : {row.bar, row.number, row.label}) EXPECT_EQ(stateOf(name), "") << name;
    }
}

TEST_F(StereoMarksTest, AnEnteredNumberThatDidNotArriveStaysMarked) {
    inVain([&] { enterNumber("FM_Hub_Zahl", "60"); });
    EXPECT_EQ(stateOf("FM_Hub_Zahl"), "ungesendet");
    EXPECT_TRUE(tipOf("FM_Hub_Zahl").starts_with("Nicht beim Gerät angekommen.\n"));
    enterNumber("FM_Hub_Zahl", "60");  // no change, so nothing goes out
    EXPECT_EQ(stateOf("FM_Hub_Zahl"), "ungesendet");
    enterNumber("FM_Hub_Zahl", "61");
    EXPECT_EQ(stateOf("FM_Hub_Zahl"), "");
}

TEST_F(StereoMarksTest, WithoutASessionNothingIsMarked) {
    state.InstrumentOnline = false;
    click("Stereo_Opt_1");
    scroll("FM_Hub_Scroll", 6000);
    EXPECT_EQ(stateOf("Stereo_Opt_1"), "");
    EXPECT_EQ(stateOf("FM_Hub_Zahl"), "");
}

}  // namespace
}  // namespace kdx::test
