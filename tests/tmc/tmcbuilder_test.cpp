#include "tmcpagetest.h"

#include <QAbstractItemView>
#include <QCheckBox>

namespace kdx::test {
namespace {

using TmcBuilderTest = TmcPageTest;

constexpr std::array kBitLabels = {"TMCBL3_T", "TMCBL3_F",      "TMCBL3_DP",    "TMCBL3_D",
                                   "TMCBL3_U", "TMCBL3_Extent", "TMCBL3_Event", "TMCBL3_Local"};

TEST_F(TmcBuilderTest, TheCodeIsMarkedWhileAFieldIsNotChosen) {
    const auto tip = [this] { return find("TMC_Gr8_Label")->toolTip().toStdString(); };
    EXPECT_EQ(tip(), "Noch nicht gew\u00E4hlt: T, F, DP, D, U, Extent, Event, Location");
    EXPECT_EQ(find("TMC_Gr8_Label")->property("zustand").toString().toStdString(), "abgelehnt");
    click("TMC_Div");
    EXPECT_EQ(tip(), "Noch nicht gew\u00E4hlt: T, F, DP, U, Extent, Event, Location");
    composeMessage();
    EXPECT_EQ(tip(), "");
    EXPECT_EQ(find("TMC_Gr8_Label")->property("zustand").toString().toStdString(), "");
}

TEST_F(TmcBuilderTest, FieldsThatCountAsZeroAreNotMissed) {
    state.corrections.trafficFields = true;
    click("TMC_Div");
    EXPECT_EQ(find("TMC_Gr8_Label")->toolTip(), QString());
}

TEST_F(TmcBuilderTest, NothingIsComposedAtTheStart) {
    for (const char* label : kBitLabels) EXPECT_EQ(text(label), "-") << label;
    EXPECT_EQ(find<QComboBox>("TMC_Event_Combo")->currentIndex(), -1);
    EXPECT_EQ(find<QComboBox>("TMC_Loc_Combo")->currentIndex(), -1);
    EXPECT_FALSE(checked("Tmc_richtung_0"));
    EXPECT_FALSE(checked("Tmc_richtung_1"));
    EXPECT_EQ(text("TMC_Gr8_Label"), "-000000000");
}

TEST_F(TmcBuilderTest, ALongListOpensAsAScrolledListOfSomeEntries) {
    std::string lines;
    for (int i = 0; i < 100'000; ++i) lines += "Ort;" + std::to_string(i) + "\r\n";
    folder.write("Location.txt", lines);
    page->reloadLists();
    page->show();
    auto* combo = find<QComboBox>("TMC_Loc_Combo");
    combo->showPopup();
    const auto* list = find("TMC_Loc_Combo_Treffer");
    EXPECT_TRUE(list->isVisible());
    EXPECT_GT(list->height(), 10 * list->fontMetrics().height());
    EXPECT_LT(list->height(), 30 * list->fontMetrics().height());
    combo->hidePopup();
}

TEST_F(TmcBuilderTest, ExtentAndDurationOfferZeroToSevenAndShowZero) {
    for (const char* name : {"TMC_Var_Combo", "DurationCombo"}) {
        const auto* combo = find<QComboBox>(name);
        ASSERT_EQ(combo->count(), 8) << name;
        for (int i = 0; i < 8; ++i) EXPECT_EQ(combo->itemText(i), QString::number(i));
        EXPECT_EQ(text(name), "0") << name;
    }
}

TEST_F(TmcBuilderTest, ComposesTheWorkedExample) {
    composeMessage();
    EXPECT_EQ(text("TMCBL3_T"), "0");
    EXPECT_EQ(text("TMCBL3_F"), "1");
    EXPECT_EQ(text("TMCBL3_DP"), "000");
    EXPECT_EQ(text("TMCBL3_D"), "0");
    EXPECT_EQ(text("TMCBL3_U"), "0");
    EXPECT_EQ(text("TMCBL3_Extent"), "010");
    EXPECT_EQ(text("TMCBL3_Event"), "00000000001");
    EXPECT_EQ(text("TMCBL3_Local"), "0011000000111001");
    EXPECT_EQ(text("TMC_Gr8_Label"), "0810013039");
    EXPECT_TRUE(sent().empty());
}

TEST_F(TmcBuilderTest, TheEventShowsItsNumberInHexadecimalWithoutLeadingZeros) {
    select("TMC_Event_Combo", 2);
    EXPECT_EQ(text("TMC_Event_Hex_Label"), "1A");
    EXPECT_EQ(text("TMCBL3_Event"), "00000011010");
}

TEST_F(TmcBuilderTest, TheLocationShowsItsNumberInHexadecimal) {
    select("TMC_Loc_Combo", 0);
    EXPECT_EQ(text("TMC_Local_Hex_Label"), "3039");
    EXPECT_EQ(text("TMCBL3_Local"), "0011000000111001");
}

TEST_F(TmcBuilderTest, AnEventWithoutANumberIsEventZero) {
    select("TMC_Event_Combo", 3);
    EXPECT_EQ(text("TMC_Event_Hex_Label"), "0");
    EXPECT_EQ(text("TMCBL3_Event"), "00000000000");
}

TEST_F(TmcBuilderTest, AnEventAbove2047IsCutToItsLowBits) {
    select("TMC_Event_Combo", 4);
    EXPECT_EQ(text("TMC_Event_Hex_Label"), "1001");
    EXPECT_EQ(text("TMCBL3_Event"), "00000000001");
}

TEST_F(TmcBuilderTest, ALocationAbove65535IsCutToItsLowBitsInTheCode) {
    composeMessage();
    select("TMC_Loc_Combo", 2);
    EXPECT_EQ(text("TMC_Local_Hex_Label"), "10005");
    EXPECT_EQ(text("TMCBL3_Local"), "2000000000000101");  // the number function does not guard against it
    EXPECT_EQ(text("TMC_Gr8_Label"), "0810010005");
}

TEST_F(TmcBuilderTest, ATypedExtentCounts) {
    find<QComboBox>("TMC_Var_Combo")->setEditText(QStringLiteral("5"));
    EXPECT_EQ(text("TMCBL3_Extent"), "101");
    EXPECT_EQ(find<QComboBox>("TMC_Var_Combo")->count(), 8);
}

TEST_F(TmcBuilderTest, ATypedExtentAboveSevenIsCutToItsLowThreeBits) {
    find<QComboBox>("TMC_Var_Combo")->setEditText(QStringLiteral("12"));
    EXPECT_EQ(text("TMCBL3_Extent"), "100");
}

TEST_F(TmcBuilderTest, ChoosingTheExtentThatShowsAlreadySetsItsBits) {
    select("TMC_Var_Combo", 0);
    EXPECT_EQ(text("TMCBL3_Extent"), "000");
}

TEST_F(TmcBuilderTest, DirectionIsOneForBackwards) {
    click("Tmc_richtung_1");
    EXPECT_EQ(text("TMCBL3_U"), "1");
    click("Tmc_richtung_0");
    EXPECT_EQ(text("TMCBL3_U"), "0");
}

TEST_F(TmcBuilderTest, TheFlagsFollowTheirBoxes) {
    const std::array<std::pair<const char*, const char*>, 3> flags = {
        {{"TMC_Div", "TMCBL3_D"}, {"TMC_F_Check", "TMCBL3_F"}, {"TMC_T_Check", "TMCBL3_T"}}};
    for (const auto& [box, label] : flags) {
        click(box);
        EXPECT_EQ(text(label), "1") << label;
        click(box);
        EXPECT_EQ(text(label), "0") << label;
    }
}

TEST_F(TmcBuilderTest, TheTFlagLeadsTheCodeAndTheOthersMakeItsFirstDigits) {
    composeMessage();
    click("TMC_T_Check");
    EXPECT_EQ(text("TMC_Gr8_Label"), "1810013039");
    click("TMC_F_Check");
    EXPECT_EQ(text("TMC_Gr8_Label"), "1010013039");
    click("TMC_Div");
    EXPECT_EQ(text("TMC_Gr8_Label"), "1090013039");
    click("Tmc_richtung_1");
    EXPECT_EQ(text("TMC_Gr8_Label"), "10D0013039");
}

TEST_F(TmcBuilderTest, TheDurationBoxesMoveTheDurationList) {
    click("TMC_DP1_Check");
    click("TMC_DP3Check");
    EXPECT_EQ(find<QComboBox>("DurationCombo")->currentIndex(), 5);
    EXPECT_EQ(text("TMCBL3_DP"), "101");
}

TEST_F(TmcBuilderTest, TheDurationBoxesWorkWithAnEmptyDurationList) {
    find<QComboBox>("DurationCombo")->clear();
    click("TMC_DP2_Check");
    EXPECT_EQ(text("TMCBL3_DP"), "010");
    EXPECT_EQ(find<QComboBox>("DurationCombo")->currentIndex(), -1);
}

TEST_F(TmcBuilderTest, TheDurationListSetsTheBoxes) {
    click("TMC_DP3Check");
    select("DurationCombo", 6);
    EXPECT_TRUE(checked("TMC_DP1_Check"));
    EXPECT_TRUE(checked("TMC_DP2_Check"));
    EXPECT_FALSE(checked("TMC_DP3Check"));
    EXPECT_EQ(text("TMCBL3_DP"), "110");
    EXPECT_EQ(text("DurationCombo"), "6");
}

TEST_F(TmcBuilderTest, EveryDurationCanBeChosenAfterEveryOther) {
    for (int before = 0; before < 8; ++before) {
        for (int duration = 0; duration < 8; ++duration) {
            select("DurationCombo", before);
            select("DurationCombo", duration);
            const int boxes = (checked("TMC_DP1_Check") ? 4 : 0) + (checked("TMC_DP2_Check") ? 2 : 0) +
                              (checked("TMC_DP3Check") ? 1 : 0);
            EXPECT_EQ(boxes, duration) << "after " << before;
            EXPECT_EQ(find<QComboBox>("DurationCombo")->currentIndex(), duration) << "after " << before;
        }
    }
}

TEST_F(TmcBuilderTest, ChoosingTheDurationThatShowsAlreadySetsItsBits) {
    select("DurationCombo", 0);
    EXPECT_EQ(text("TMCBL3_DP"), "000");
}

TEST_F(TmcBuilderTest, TheBitDisplayIsHiddenAtTheStart) {
    EXPECT_EQ(text("TMCInfoOnOff"), ">");
    for (const char* label : kBitLabels) EXPECT_TRUE(find(label)->isHidden()) << label;
}

TEST_F(TmcBuilderTest, TheBitDisplayIsShownAndHiddenByItsButton) {
    page->show();
    click("TMCInfoOnOff");
    EXPECT_EQ(text("TMCInfoOnOff"), "<");
    for (const char* label : kBitLabels) EXPECT_TRUE(find(label)->isVisible()) << label;
    composeMessage();
    click("TMCInfoOnOff");
    EXPECT_EQ(text("TMCInfoOnOff"), ">");
    for (const char* label : kBitLabels) EXPECT_FALSE(find(label)->isVisible()) << label;
    EXPECT_EQ(text("TMC_Gr8_Label"), "0810013039");
}

TEST_F(TmcBuilderTest, TheButtonOfTheBitDisplayHasItsCaptionBesideIt) {
    for (const char* language : {"deutsch", "english", "english US"}) {
        useLanguage(language);
        page->label();
        page->show();
        QCoreApplication::processEvents();
        const QWidget* button = find("TMCInfoOnOff");
        const QLabel* caption = nullptr;
        for (const QLabel* label : page->findChildren<QLabel*>())
            if (label->buddy() == button) caption = label;
        ASSERT_NE(caption, nullptr);
        EXPECT_EQ(caption->text(), QStringLiteral("Bits")) << language;
        EXPECT_TRUE(caption->isVisible());
        const auto place = [this](const QWidget& of) { return QRect(of.mapTo(page.get(), QPoint()), of.size()); };
        EXPECT_LT(place(*caption).left() - place(*button).right(), 20);
        EXPECT_GT(place(*caption).left(), place(*button).right());
        EXPECT_LT(std::abs(place(*caption).bottom() - place(*button).bottom()), 5) << "in one row";
    }
}

TEST_F(TmcBuilderTest, EveryBitLabelHasItsHeadingAboveIt) {
    page->resize(620, 322);
    page->show();
    click("TMCInfoOnOff");
    const std::array<const char*, 8> headings = {"T", "F", "DP", "D", "U", "Extent", "Event", "Location"};
    for (std::size_t i = 0; i < kBitLabels.size(); ++i) {
        const auto* bits = find(kBitLabels[i]);
        const QLabel* above = nullptr;
        for (const auto* label : page->findChildren<QLabel*>()) {
            if (label->text() == QLatin1String(headings[i]) && label->isVisible() &&
                label->geometry().bottom() < bits->geometry().top() &&
                std::abs(label->geometry().center().x() - bits->geometry().center().x()) <= 1) {
                above = label;
            }
        }
        EXPECT_NE(above, nullptr) << headings[i];
    }
}

}  // namespace
}  // namespace kdx::test
