#include "stereo/rfpage.h"

#include <gtest/gtest.h>

#include <QGroupBox>
#include <QMouseEvent>

#include "stereo/carrier.h"
#include "support/pagetest.h"

namespace kdx::test {
namespace {

class RfPageTest : public PageTest {
protected:
    RfPageTest() {
        setProfile(kSet1, "VRN", "HF_Frequenz", "98.5");
        setProfile(kSet1, "VRN", "HF_Pegel", "80");
        setProfile(kSet1, "VRN", "NF_Frequenz", "1");
        setProfile(kSet1, "VRN", "FM_Ulim", "65");
        setProfile(kSet1, "VRN", "FM_Olim", "110");
        setProfile(kSet1, "VRN", "NF_Ulim", "0.01");
        setProfile(kSet1, "VRN", "NF_Olim", "15.1");
    }
    QWidget& root() override { return page; }

    /// Clicks a label as a mouse does.
    void clickLabel(const char* name) {
        auto* shown = find<QLabel>(name);
        const QPointF inside(3, 3);
        for (const auto type : {QEvent::MouseButtonPress, QEvent::MouseButtonRelease}) {
            QMouseEvent event(type, inside, shown->mapToGlobal(inside), Qt::LeftButton, Qt::LeftButton, {});
            QApplication::sendEvent(shown, &event);
        }
    }
    void answer(std::initializer_list<const char*> answers) {
        for (const char* text : answers) dialogs.inputs.push_back(QString::fromUtf8(text));
    }

    /// Sends what goes out with the data set and at the opening, as a running sequence does.
    void sendSequence() {
        carrier.load(settings);
        Steps steps;
        carrier.appendSteps(steps);
        carrier.appendOpeningSteps(steps);
        for (const Step& step : steps) {
            page.stepGoesOut(step);
            params.SendParam(step.key, std::string(step.value));
        }
    }

    Carrier carrier;
    RfPage page{context, carrier, nullptr};
};

TEST_F(RfPageTest, ShowsDashesAndTheOutputOffAtFirst) {
    EXPECT_EQ(text("Input_HF_Freq_Label"), "-");
    EXPECT_EQ(text("Input_HF_Pegel_Label"), "-");
    EXPECT_EQ(text("Input_AF_Freq_Label"), "-");
    EXPECT_FALSE(checked("HfOnOffState"));
    EXPECT_EQ(find<QGroupBox>("RF_Freq_Frame")->title(), toText(captions.text(212)));
    EXPECT_EQ(find<QGroupBox>("AF_Freq_Frame")->title(), toText(captions.text(215)));
    EXPECT_EQ(find<QGroupBox>("RF_Level_Frame")->title(), toText(captions.text(218)));
}

TEST_F(RfPageTest, TheArrowKeysStepTheValueThatIsShown) {
    sendSequence();
    sent();
    press("Input_HF_Freq_Label", Qt::Key_Up);
    press("Input_HF_Pegel_Label", Qt::Key_Down);
    press("Input_AF_Freq_Label", Qt::Key_Right);
    EXPECT_EQ(sent(), (Lines{"FREQ 98.6MHZ", ":POW 79DBUV", ":STEREO:AUDIO:FREQ 1.1KHZ"}));
    EXPECT_EQ(text("Input_HF_Freq_Label"), "98.6");
    EXPECT_EQ(status(StatusSlot::RfLevel), "79");
    EXPECT_EQ(profile(kSet1, "VRN", "HF_Frequenz"), "98.5");  // entered values are not kept
    for (const auto& [name, key] : {std::pair{"Input_HF_Freq_Label", Qt::Key_Left},
                                    {"Input_HF_Pegel_Label", Qt::Key_Up},
                                    {"Input_AF_Freq_Label", Qt::Key_Up}}) {
        QKeyEvent event(QEvent::KeyPress, key, Qt::ShiftModifier);
        QApplication::sendEvent(find(name), &event);
    }
    EXPECT_EQ(sent(), (Lines{"FREQ 97.6MHZ", ":POW 89DBUV", ":STEREO:AUDIO:FREQ 2.1KHZ"}));
}

TEST_F(RfPageTest, ThereIsNoStepFromAValueThatTheInstrumentRefused) {
    const struct {
        const char *label, *refused, *good, *stepped;
    } rows[] = {{"Input_HF_Freq_Label", "98,7", "98.7", "FREQ 98.8MHZ"},
                {"Input_HF_Pegel_Label", "66,5", "66.5", ":POW 67.5DBUV"},
                {"Input_AF_Freq_Label", "2,4", "2.4", ":STEREO:AUDIO:FREQ 2.5KHZ"}};
    for (const auto& row : rows) {
        answer({row.refused});
        clickLabel(row.label);
        ASSERT_EQ(stateOf(row.label), "abgelehnt") << row.label;
        sent();
        for (const Qt::Key key : {Qt::Key_Up, Qt::Key_Down}) press(row.label, key);
        EXPECT_EQ(sent(), Lines{});
        EXPECT_EQ(text(row.label), row.refused);
        answer({row.good});
        clickLabel(row.label);
        sent();
        press(row.label, Qt::Key_Up);
        EXPECT_EQ(sent(), Lines{row.stepped});
    }
}

TEST_F(RfPageTest, ARefusedValueStaysMarkedWhenItsCommaIsCorrectedFromNowOn) {
    answer({"98,7"});
    clickLabel("Input_HF_Freq_Label");
    state.corrections.decimalComma = true;
    page.label();
    EXPECT_EQ(stateOf("Input_HF_Freq_Label"), "abgelehnt");
    EXPECT_EQ(stateOf(StatusSlot::RfFrequency), "abgelehnt");
    EXPECT_FALSE(find("Input_HF_Freq_Label")->accessibleDescription().isEmpty()) << "why";
    sent();
    press("Input_HF_Freq_Label", Qt::Key_Up);
    EXPECT_EQ(sent(), Lines{});
    answer({"98,7"});
    clickLabel("Input_HF_Freq_Label");
    EXPECT_EQ(sent(), Lines{"FREQ 98.7MHZ"});
    EXPECT_EQ(stateOf("Input_HF_Freq_Label"), "");
    EXPECT_EQ(stateOf(StatusSlot::RfFrequency), "");
}

TEST_F(RfPageTest, AStepStaysWithinTheLimitsAndStartsFromWhatIsKept) {
    press("Input_HF_Freq_Label", Qt::Key_Up);  // nothing was sent yet
    EXPECT_EQ(sent(), Lines{"FREQ 98.6MHZ"});
    setProfile(kSet1, "VRN", "FM_Olim", "98.7");
    press("Input_HF_Freq_Label", Qt::Key_Up);
    EXPECT_EQ(sent(), Lines{});
    EXPECT_EQ(text("Input_HF_Freq_Label"), "98.6");
    setProfile(kSet1, "VRN", "FM_Olim", "110");
    state.corrections.rfValues = true;  // then they are kept
    press("Input_HF_Freq_Label", Qt::Key_Up);
    EXPECT_EQ(sent(), Lines{"FREQ 98.7MHZ"});
    EXPECT_EQ(profile(kSet1, "VRN", "HF_Frequenz"), "98.7");
}

TEST_F(RfPageTest, AValueThatDidNotArriveIsMarkedUntilItDoes) {
    sendSequence();
    const struct {
        const char* label;
        StatusSlot slot;
    } rows[] = {{"Input_HF_Freq_Label", StatusSlot::RfFrequency},
                {"Input_HF_Pegel_Label", StatusSlot::RfLevel},
                {"Input_AF_Freq_Label", StatusSlot::AudioFrequency}};
    for (const auto& row : rows) {
        inVain([&] { press(row.label, Qt::Key_Up); });
        EXPECT_EQ(stateOf(row.label), "ungesendet") << row.label;
        EXPECT_EQ(stateOf(row.slot), "ungesendet") << row.label;
        EXPECT_TRUE(find(row.label)->toolTip().startsWith(QStringLiteral("Nicht beim Gerät angekommen.")));
        press(row.label, Qt::Key_Up);
        EXPECT_EQ(stateOf(row.label), "") << row.label;
        EXPECT_EQ(stateOf(row.slot), "") << row.label;
    }
    inVain([&] { click("HfOnOffState"); });
    EXPECT_EQ(stateOf("HfOnOffState"), "ungesendet");
    click("HfOnOffState");
    EXPECT_EQ(stateOf("HfOnOffState"), "");
}

TEST_F(RfPageTest, AFrequencyIsAskedForShownAndSent) {
    answer({"101.2"});
    clickLabel("Input_HF_Freq_Label");
    ASSERT_EQ(dialogs.shown.size(), 1U);
    EXPECT_EQ(dialogs.shown[0].text, toText(captions.text(210)));
    EXPECT_EQ(dialogs.shown[0].title, toText(captions.text(211)));
    EXPECT_EQ(dialogs.shown[0].preset, QStringLiteral("98.5"));
    EXPECT_EQ(text("Input_HF_Freq_Label"), "101.2");
    EXPECT_EQ(status(StatusSlot::RfFrequency), "101.2");
    EXPECT_EQ(sent(), Lines{"FREQ 101.2MHZ"});
}

TEST_F(RfPageTest, ALevelIsAskedForShownAndSent) {
    answer({"66.5"});
    clickLabel("Input_HF_Pegel_Label");
    ASSERT_EQ(dialogs.shown.size(), 1U);
    EXPECT_EQ(dialogs.shown[0].text, toText(captions.text(216)));
    EXPECT_EQ(dialogs.shown[0].title, toText(captions.text(217)));
    EXPECT_EQ(dialogs.shown[0].preset, QStringLiteral("80"));
    EXPECT_EQ(text("Input_HF_Pegel_Label"), "66.5");
    EXPECT_EQ(status(StatusSlot::RfLevel), "66.5");
    EXPECT_EQ(sent(), Lines{":POW 66.5DBUV"});
}

TEST_F(RfPageTest, AnAudioFrequencyIsAskedForShownAndSent) {
    answer({"0.4"});
    clickLabel("Input_AF_Freq_Label");
    ASSERT_EQ(dialogs.shown.size(), 1U);
    EXPECT_EQ(dialogs.shown[0].text, toText(captions.text(213)));
    EXPECT_EQ(dialogs.shown[0].title, toText(captions.text(214)));
    EXPECT_EQ(dialogs.shown[0].preset, QStringLiteral("1"));
    EXPECT_EQ(text("Input_AF_Freq_Label"), "0.4");
    EXPECT_EQ(status(StatusSlot::AudioFrequency), "0.4");
    EXPECT_EQ(sent(), Lines{":STEREO:AUDIO:FREQ 0.4KHZ"});
}

TEST_F(RfPageTest, TheLimitsOfTheLevelAreRefusedThemselves) {
    answer({"0", "120", "-3", "121", "abc", "0.1"});
    clickLabel("Input_HF_Pegel_Label");
    EXPECT_EQ(sent(), Lines{":POW 0.1DBUV"});
    answer({"119.9"});
    clickLabel("Input_HF_Pegel_Label");
    EXPECT_EQ(sent(), Lines{":POW 119.9DBUV"});
}

TEST_F(RfPageTest, TheLimitsOfTheFrequenciesAreRefusedThemselves) {
    answer({"110", "65", "110.0", "109.9"});
    clickLabel("Input_HF_Freq_Label");
    EXPECT_EQ(sent(), Lines{"FREQ 109.9MHZ"});
    answer({"15.1", "0.01", "0.011"});
    clickLabel("Input_AF_Freq_Label");
    EXPECT_EQ(sent(), Lines{":STEREO:AUDIO:FREQ 0.011KHZ"});
}

TEST_F(RfPageTest, ARefusedTextStaysInTheBox) {
    answer({"120", "abc", ""});
    clickLabel("Input_HF_Pegel_Label");
    ASSERT_EQ(dialogs.shown.size(), 3U);
    EXPECT_EQ(dialogs.shown[0].preset, QStringLiteral("80"));
    EXPECT_EQ(dialogs.shown[1].preset, QStringLiteral("120"));
    EXPECT_EQ(dialogs.shown[2].preset, QStringLiteral("abc"));
}

TEST_F(RfPageTest, CancellingSendsNothingAndKeepsTheLabel) {
    answer({"", "200", ""});
    clickLabel("Input_HF_Freq_Label");
    clickLabel("Input_HF_Freq_Label");
    EXPECT_TRUE(sent().empty());
    EXPECT_EQ(text("Input_HF_Freq_Label"), "-");
    EXPECT_EQ(status(StatusSlot::RfFrequency), "--");
}

TEST_F(RfPageTest, TheAnswerIsShownAndSentAsItWasTyped) {
    answer({" 098.50 x"});
    clickLabel("Input_HF_Freq_Label");
    EXPECT_EQ(text("Input_HF_Freq_Label"), " 098.50 x");
    EXPECT_EQ(sent(), Lines{"FREQ  098.50 xMHZ"});
}

TEST_F(RfPageTest, NothingEnteredIsStoredAndTheNextBoxOffersTheStoredValueAgain) {
    answer({"101.2", ""});
    clickLabel("Input_HF_Freq_Label");
    clickLabel("Input_HF_Freq_Label");
    EXPECT_EQ(profile(kSet1, "VRN", "HF_Frequenz"), "98.5");
    EXPECT_EQ(carrier.rfFrequency, "");
    EXPECT_EQ(dialogs.shown[1].preset, QStringLiteral("98.5"));
}

TEST_F(RfPageTest, LimitsAndValuesComeFromDataSetOneWhateverSetIsCurrent) {
    state.CurrentDataSet = "3";
    setProfile("Datenset3.INI", "VRN", "HF_Frequenz", "70");
    setProfile("Datenset3.INI", "VRN", "FM_Olim", "80");
    answer({"101.2"});
    clickLabel("Input_HF_Freq_Label");
    EXPECT_EQ(dialogs.shown[0].preset, QStringLiteral("98.5"));
    EXPECT_EQ(sent(), Lines{"FREQ 101.2MHZ"});
    sendSequence();
    EXPECT_EQ(text("Input_HF_Freq_Label"), "98.5");
    EXPECT_EQ(sent()[0], "FREQ 98.5MHZ");
}

TEST_F(RfPageTest, WithoutStoredLimitsNoFrequencyFits) {
    setProfile(kSet1, "VRN", "FM_Ulim", "");
    setProfile(kSet1, "VRN", "FM_Olim", "");
    answer({"98.5", "-1", "0", ""});
    clickLabel("Input_HF_Freq_Label");
    EXPECT_TRUE(sent().empty());
}

TEST_F(RfPageTest, TheFirstClickSwitchesTheOutputOnTheSecondOff) {
    click("HfOnOffState");
    EXPECT_TRUE(checked("HfOnOffState"));
    click("HfOnOffState");
    EXPECT_FALSE(checked("HfOnOffState"));
    EXPECT_EQ(sent(), (Lines{":OUTPUT:STAT ON", ":OUTPUT:STAT OFF"}));
}

TEST_F(RfPageTest, OpeningTheSessionTurnsTheOutputOver) {
    sendSequence();
    EXPECT_TRUE(checked("HfOnOffState"));
    EXPECT_TRUE(carrier.outputOn);
    EXPECT_EQ(sent()[2], ":OUTPUT:STAT ON");
    sendSequence();
    EXPECT_FALSE(checked("HfOnOffState"));
    EXPECT_FALSE(carrier.outputOn);
    EXPECT_EQ(sent()[2], ":OUTPUT:STAT OFF");
    click("HfOnOffState");
    EXPECT_TRUE(carrier.outputOn);
    EXPECT_EQ(sent(), Lines{":OUTPUT:STAT ON"});
}

TEST_F(RfPageTest, TheStoredValuesAreSentAndShown) {
    sendSequence();
    EXPECT_EQ(sent(), (Lines{"FREQ 98.5MHZ", ":POW 80DBUV", ":OUTPUT:STAT ON", ":STEREO:AUDIO:FREQ 1KHZ"}));
    EXPECT_EQ(text("Input_HF_Freq_Label"), "98.5");
    EXPECT_EQ(text("Input_HF_Pegel_Label"), "80");
    EXPECT_EQ(text("Input_AF_Freq_Label"), "1");
    EXPECT_EQ(status(StatusSlot::RfFrequency), "98.5");
    EXPECT_EQ(status(StatusSlot::RfLevel), "80");
    EXPECT_EQ(status(StatusSlot::AudioFrequency), "1");
}

TEST_F(RfPageTest, AMissingValueIsSentAndShownEmpty) {
    answer({"101.2"});
    clickLabel("Input_HF_Freq_Label");
    sent();
    setProfile(kSet1, "VRN", "HF_Frequenz", "");
    sendSequence();
    EXPECT_EQ(sent()[0], "FREQ MHZ");
    EXPECT_EQ(text("Input_HF_Freq_Label"), "");
    EXPECT_EQ(status(StatusSlot::RfFrequency), "");
    EXPECT_EQ(text("Input_HF_Pegel_Label"), "80");
}

TEST_F(RfPageTest, StepsOfOtherPagesChangeNothing) {
    for (const char* key : {"RDS", "MPX_HUB", "NFShape Sinus", ""}) {
        page.stepGoesOut({Step::Kind::Parameter, key, "1"});
    }
    EXPECT_EQ(text("Input_HF_Freq_Label"), "-");
    EXPECT_EQ(text("Input_HF_Pegel_Label"), "-");
    EXPECT_EQ(text("Input_AF_Freq_Label"), "-");
    EXPECT_FALSE(checked("HfOnOffState"));
    EXPECT_TRUE(sent().empty());
}

TEST_F(RfPageTest, AnEmptyValueLeavesTheFramesWhereTheyAre) {
    page.resize(620, 322);
    page.show();
    QApplication::processEvents();
    const QRect before = find("AF_Freq_Frame")->geometry();
    setProfile(kSet1, "VRN", "HF_Frequenz", "");
    setProfile(kSet1, "VRN", "HF_Pegel", "");
    sendSequence();
    QApplication::processEvents();
    EXPECT_EQ(text("Input_HF_Pegel_Label"), "");
    EXPECT_EQ(find("AF_Freq_Frame")->geometry(), before);
}

TEST_F(RfPageTest, RelabellingKeepsTheValues) {
    sendSequence();
    sent();
    useLanguage("english");
    page.label();
    EXPECT_EQ(text("Input_HF_Freq_Label"), "98.5");
    EXPECT_EQ(find<QGroupBox>("RF_Level_Frame")->title(), toText(captions.text(218)));
    EXPECT_TRUE(sent().empty());
}

TEST_F(RfPageTest, EveryControlHasAnAccessibleName) {
    sendSequence();
    EXPECT_EQ(find("Input_HF_Freq_Label")->accessibleName(), toText(captions.text(212)) + QStringLiteral(": 98.5"));
    EXPECT_FALSE(find("Input_HF_Pegel_Label")->accessibleName().isEmpty());
    EXPECT_FALSE(find("Input_AF_Freq_Label")->accessibleName().isEmpty());
    EXPECT_FALSE(find("HfOnOffState")->accessibleName().isEmpty());
}

}  // namespace
}  // namespace kdx::test
