#include "grouppagetest.h"

#include "support/layoutcheck.h"

namespace kdx {
namespace {

using test::direct;
using test::GroupPageTest;
using test::kSet1;
using test::Lines;

std::string repeated(const std::string& text, int times) {
    std::string all;
    for (int i = 0; i < times; ++i) all += text;
    return all;
}

TEST_F(GroupPageTest, EveryButtonAppendsItsGroup) {
    for (int number = 0; number < 16; ++number) press({number});
    EXPECT_EQ(text("Label10"), "Gruppenfolge:0A,1A,2A,3A,4A,5A,6A,7A,8A,9A,10A,11A,12A,13A,14A,15A,");
    EXPECT_EQ(state.groupCount, 16);
    EXPECT_EQ(state.group8ACount, 1);
    EXPECT_EQ(sent(), Lines{});
    EXPECT_EQ(profile(kSet1, "RDS", "GR_FOLGE"), "");
}

TEST_F(GroupPageTest, TheControlsBearTheirTexts) {
    const auto caption = [this](int number) { return toText(captions.text(number)).toStdString(); };
    for (int number = 0; number < 16; ++number) {
        const std::string shown = std::to_string(number);
        EXPECT_EQ(text(("Gruppe" + shown).c_str()), "Gruppe " + shown);
    }
    EXPECT_EQ(text("newList"), caption(156));
    EXPECT_EQ(text("GS_Senden"), caption(82));
    EXPECT_EQ(text("Label10"), "Gruppenfolge:");
}

TEST_F(GroupPageTest, SendingStoresAndSendsTheSequence) {
    press({0, 2, 8});
    EXPECT_EQ(text("Label10"), "Gruppenfolge:0A,2A,8A,");
    click("GS_Senden");
    EXPECT_EQ(sent(), Lines{direct("GS=0A,2A,8A")});
    EXPECT_EQ(profile(kSet1, "RDS", "GR_FOLGE"), "0A,2A,8A,");
    EXPECT_EQ(state.group8ACount, 1);
    EXPECT_EQ(state.groupCount, 3);
    EXPECT_EQ(text("Label10"), "Gruppenfolge:0A,2A,8A,");
}

TEST_F(GroupPageTest, ASequenceWithoutGroup8CountsAsHavingOne) {
    press({0});
    EXPECT_EQ(state.group8ACount, 0);
    click("GS_Senden");
    EXPECT_EQ(sent(), Lines{direct("GS=0A")});
    EXPECT_EQ(state.group8ACount, 1);
}

TEST_F(GroupPageTest, EveryGroup8IsCounted) {
    press({8, 0, 8, 8});
    click("GS_Senden");
    EXPECT_EQ(state.group8ACount, 3);
    EXPECT_EQ(state.groupCount, 4);
}

TEST_F(GroupPageTest, AGroupMayBeChosenAsOftenAsWanted) {
    std::string sequence;
    for (int i = 0; i < 300; ++i) {
        press({15});
        sequence += sequence.empty() ? "15A" : ",15A";
    }
    click("GS_Senden");
    EXPECT_EQ(sent(), Lines{direct("GS=" + sequence)});
}

TEST_F(GroupPageTest, FullCountersStayFull) {
    state.groupCount = 32767;
    state.group8ACount = 32767;
    press({8});
    EXPECT_EQ(state.groupCount, 32767);
    EXPECT_EQ(state.group8ACount, 32767);
}

TEST_F(GroupPageTest, SendingWithoutAGroupIsRefusedInEnglishWhateverTheLanguage) {
    dialogs.expectedMessages = 2;
    click("GS_Senden");
    useLanguage("english");
    page.label();
    click("GS_Senden");
    for (const auto& box : dialogs.shown) {
        EXPECT_EQ(box.icon, Dialogs::Icon::Exclamation);
        EXPECT_EQ(box.title, QStringLiteral("Group Error"));
        EXPECT_EQ(box.text, QStringLiteral("Please select a group!"));
    }
    EXPECT_EQ(sent(), Lines{});
    EXPECT_EQ(profile(kSet1, "RDS", "GR_FOLGE"), "");
    EXPECT_EQ(state.group8ACount, 0);
}

TEST_F(GroupPageTest, ANewListEmptiesTheSequenceAndTheCounters) {
    press({0, 8});
    click("newList");
    EXPECT_EQ(text("Label10"), "Gruppenfolge:");
    EXPECT_EQ(state.groupCount, 0);
    EXPECT_EQ(state.group8ACount, 0);
    press({3});
    EXPECT_EQ(text("Label10"), "Gruppenfolge:3A,");
    dialogs.expectedMessages = 1;
    click("newList");
    click("GS_Senden");
}

TEST_F(GroupPageTest, SendingStoresInTheCurrentDataSet) {
    state.CurrentDataSet = "5";
    press({1});
    click("GS_Senden");
    EXPECT_EQ(profile("Datenset5.INI", "RDS", "GR_FOLGE"), "1A,");
    EXPECT_EQ(profile(kSet1, "RDS", "GR_FOLGE"), "");
}

TEST_F(GroupPageTest, OpeningThePageShowsTheSequenceOfDataSetOneWhateverSetIsCurrent) {
    state.CurrentDataSet = "3";
    setProfile(kSet1, "RDS", "GR_Folge", "0A,2A,");
    setProfile("Datenset3.INI", "RDS", "GR_Folge", "15A,");
    press({7});
    page.opened();
    EXPECT_EQ(text("Label10"), "Gruppenfolge:0A,2A,");
    EXPECT_EQ(state.storedGroupSequence, "0A,2A,");
    EXPECT_EQ(sent(), Lines{});
}

TEST_F(GroupPageTest, EachOpeningReadsTheFileAnewAndDisablesGroup4) {
    EXPECT_TRUE(enabled("Gruppe4"));
    page.opened();
    EXPECT_FALSE(enabled("Gruppe4"));
    EXPECT_EQ(text("Label10"), "Gruppenfolge:");
    setProfile(kSet1, "RDS", "GR_Folge", "0A,");
    page.opened();
    EXPECT_FALSE(enabled("Gruppe4"));
    EXPECT_EQ(text("Label10"), "Gruppenfolge:0A,");
    for (const char* other : {"Gruppe0", "Gruppe3", "Gruppe5", "Gruppe15"}) EXPECT_TRUE(enabled(other)) << other;
}

TEST_F(GroupPageTest, StartUpShowsTheStoredSequenceAndCountsFromZero) {
    setProfile(kSet1, "RDS", "GR_FOLGE", "0A,8A,");
    state.groupCount = 7;
    state.group8ACount = 7;
    const std::string before = folder.read(kSet1);
    load();
    EXPECT_EQ(text("Label10"), "Gruppenfolge:0A,8A,");
    EXPECT_EQ(state.storedGroupSequence, "0A,8A,");
    EXPECT_EQ(state.groupCount, 0);
    EXPECT_EQ(state.group8ACount, 0);
    EXPECT_TRUE(enabled("Gruppe4"));
    EXPECT_EQ(sent(), Lines{});
    EXPECT_EQ(folder.read(kSet1), before);
}

TEST_F(GroupPageTest, AStoredSequenceGrowsByTheButtonsPressed) {
    setProfile(kSet1, "RDS", "GR_FOLGE", "0A,");
    load();
    press({2});
    click("GS_Senden");
    EXPECT_EQ(sent(), Lines{direct("GS=0A,2A")});
    EXPECT_EQ(profile(kSet1, "RDS", "GR_FOLGE"), "0A,2A,");
    EXPECT_EQ(state.groupCount, 1);
}

TEST_F(GroupPageTest, TheDataSetHoldsWhatIsShownWhateverSetIsAtWork) {
    state.CurrentDataSet = "3";
    setProfile(kSet1, "RDS", "GR_FOLGE", "0A,8A,");
    setProfile("Datenset3.INI", "RDS", "GR_FOLGE", "15A,");
    load();
    EXPECT_EQ(text("Label10"), "Gruppenfolge:15A,");
    press({2});
    EXPECT_EQ(part.groups, "15A,2A,");
    click("newList");
    EXPECT_EQ(part.groups, "");
    page.opened();
    EXPECT_EQ(part.groups, "0A,8A,");
}

TEST_F(GroupPageTest, ASequenceThatGoesOutWithTheWholeDataSetIsStoredInTheSetAtWork) {
    setProfile(kSet1, "RDS", "GR_FOLGE", "0A,8A,");
    load();
    state.CurrentDataSet = "2";
    Steps steps;
    part.appendSteps(steps);
    ASSERT_EQ(steps.size(), 1U);
    page.stepGoesOut(steps.front());
    EXPECT_EQ(profile("Datenset2.INI", "RDS", "GR_FOLGE"), "0A,8A,");
    EXPECT_EQ(sent(), Lines{}) << "whoever runs the steps sends them";
    EXPECT_EQ(state.group8ACount, 0);
}

TEST_F(GroupPageTest, OtherStepsStoreNothing) {
    load();
    page.stepGoesOut({Step::Kind::Parameter, "PS", "RADIO"});
    page.stepGoesOut({Step::Kind::Identify});
    EXPECT_FALSE(std::filesystem::exists(folder.data() / kSet1));
}

TEST_F(GroupPageTest, TheSequenceIsStoredBeforeItIsSent) {
    press({0, 2});
    std::string stored;
    const test::TrafficListener listener(instrument, [&](const Traffic& traffic) {
        if (traffic.kind == Traffic::Kind::Written) stored = profile(kSet1, "RDS", "GR_FOLGE");
    });
    click("GS_Senden");
    EXPECT_EQ(stored, "0A,2A,");
}

/// A sequence longer than a reading of the file gives, stored in data set 1.
class LongGroupSequence : public GroupPageTest {
protected:
    LongGroupSequence() {
        for (int i = 0; i < 100; ++i) press({15});
        click("GS_Senden");
        stored = folder.read(kSet1);
        page.opened();
        sent();
    }
    std::string note() {
        const auto* label = find<QLabel>("SequenceNote");
        return label->isHidden() ? std::string() : label->text().toStdString();
    }

    std::string stored;
};

TEST_F(LongGroupSequence, IsStoredWholeAndReadInPart) {
    EXPECT_NE(stored.find("=" + repeated("15A,", 100) + "\r\n"), std::string::npos);
    EXPECT_EQ(part.groups, repeated("15A,", 100).substr(0, kLongestValue));
}

TEST_F(LongGroupSequence, IsNotStoredAgainAsItWasRead) {
    click("GS_Senden");
    EXPECT_EQ(sent().size(), 1U);
    EXPECT_EQ(folder.read(kSet1), stored);
    Steps steps;
    part.appendSteps(steps);
    page.stepGoesOut(steps.front());  // with the whole data set
    EXPECT_EQ(folder.read(kSet1), stored);
}

TEST_F(LongGroupSequence, IsNotStoredWithAGroupMoreBehindTheCut) {
    press({8});
    EXPECT_NE(note(), "");
    click("GS_Senden");
    EXPECT_EQ(sent().size(), 1U);
    EXPECT_EQ(folder.read(kSet1), stored);
}

TEST_F(LongGroupSequence, IsNotStoredInAnotherSetAsItWasRead) {
    setProfile("Datenset2.INI", "RDS", "GR_FOLGE", "0A,");
    state.CurrentDataSet = "2";
    click("GS_Senden");
    EXPECT_EQ(profile("Datenset2.INI", "RDS", "GR_FOLGE"), "0A,");
}

TEST_F(LongGroupSequence, IsStoredOnceItIsComposedAnew) {
    click("newList");
    press({0, 2});
    click("GS_Senden");
    EXPECT_EQ(profile(kSet1, "RDS", "GR_FOLGE"), "0A,2A,");
}

TEST_F(LongGroupSequence, IsToldInWordsOfTheLanguage) {
    EXPECT_EQ(note(), "Eine gespeicherte Folge wird nur bis zum 254. Zeichen gelesen.");
    for (const char* language : {"english", "english US"}) {
        useLanguage(language);
        page.label();
        EXPECT_EQ(note(), "A stored sequence is read up to its 254th character only.");
    }
    click("newList");
    EXPECT_EQ(note(), "");
    for (int i = 0; i < 63; ++i) press({15});
    EXPECT_EQ(note(), "") << "252 characters are read back whole";
    press({15});
    EXPECT_NE(note(), "");
}

TEST_F(LongGroupSequence, LeavesThePageItsSize) {
    page.resize(620, 322);
    page.show();
    QApplication::processEvents();
    EXPECT_LE(page.minimumSizeHint().height(), 322);
    EXPECT_LE(page.minimumSizeHint().width(), 620);
    EXPECT_TRUE(find("SequenceNote")->isVisible());
    test::expectNothingCutOff(page, "long sequence");
}

TEST_F(GroupPageTest, ASequenceThatWasOnlyReadIsNotWrittenBack) {
    setProfile(kSet1, "RDS", "GR_FOLGE", "0A,2A");  // by hand, without the last comma
    part.load(settings);
    page.load();
    click("GS_Senden");
    EXPECT_EQ(profile(kSet1, "RDS", "GR_FOLGE"), "0A,2A");
    press({8});
    click("GS_Senden");
    EXPECT_EQ(profile(kSet1, "RDS", "GR_FOLGE"), "0A,2A8A,");
}

/// The sequence as a reader of the label finds it: after the heading of fixed length, without the last comma.
class GroupHeading : public GroupPageTest, public ::testing::WithParamInterface<const char*> {};

TEST_P(GroupHeading, LeavesTheSequenceAtItsFixedPlaceInTheLabel) {
    useLanguage(GetParam());
    page.label();
    press({0, 2, 8});
    const std::size_t from = state.language == "english" ? 14 : 13;
    const std::string shown = text("Label10");
    EXPECT_EQ(shown.at(from - 1), ':');
    click("GS_Senden");
    EXPECT_EQ(sent(), Lines{direct("GS=" + shown.substr(from, shown.size() - from - 1))});
    EXPECT_EQ(profile(kSet1, "RDS", "GR_FOLGE"), shown.substr(from));
}

INSTANTIATE_TEST_SUITE_P(Languages, GroupHeading, ::testing::Values("deutsch", "english", "english US"));

TEST_F(GroupPageTest, RelabellingChangesTheHeadingAndKeepsTheSequence) {
    press({0, 8});
    useLanguage("english");
    page.label();
    EXPECT_EQ(text("Label10"), toText(captions.text(83)).toStdString() + ":0A,8A,");
    EXPECT_EQ(text("Gruppe8"), "Group 8");
    EXPECT_EQ(state.groupCount, 2);
    EXPECT_EQ(state.group8ACount, 1);
    click("GS_Senden");
    EXPECT_EQ(sent(), Lines{direct("GS=0A,8A")});
}

TEST_F(GroupPageTest, AHeadingOfAnyLengthLeavesTheSequenceWhole) {
    folder.write(kLanguageFile, "[deutsch]\r\n83=Folge\r\n");
    useLanguage("deutsch");
    page.label();
    press({0, 2});
    EXPECT_EQ(text("Label10"), "Folge:0A,2A,");
    click("GS_Senden");
    EXPECT_EQ(sent(), Lines{direct("GS=0A,2A")});
}

TEST_F(GroupPageTest, ALongSequenceWrapsInsideThePage) {
    page.resize(620, 322);
    page.show();
    QApplication::processEvents();
    auto* sequence = find<QLabel>("Label10");
    EXPECT_LT(sequence->heightForWidth(sequence->width()), 2 * sequence->fontMetrics().height());
    for (int i = 0; i < 500; ++i) press({15});
    QApplication::processEvents();
    EXPECT_EQ(page.size(), QSize(620, 322));
    EXPECT_GT(sequence->height(), 5 * sequence->fontMetrics().height());
    EXPECT_GE(sequence->height(), sequence->heightForWidth(sequence->width()));
    EXPECT_FALSE(sequence->visibleRegion().isEmpty());
    EXPECT_TRUE(sequence->visibleRegion().contains(QPoint(4, sequence->height() - 4))) << "the last group is in view";
}

}  // namespace
}  // namespace kdx
