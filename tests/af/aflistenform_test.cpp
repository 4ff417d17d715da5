#include "aflistenformtest.h"
#include "support/everyfont.h"

namespace kdx {
namespace {

using test::EditorTest;
using test::kSet1;
using test::Lines;

TEST_F(EditorTest, OpensOnListOne) {
    setProfile(kSet1, "RDS", "AF_LISTE", "3");
    setList("AF_LISTE3", "100.1,88.0");
    open();
    EXPECT_EQ(editor->objectName(), QStringLiteral("AF_Listenform"));
    EXPECT_TRUE(editor->isModal());
    EXPECT_TRUE(checked("AFList_Opt_0"));
    EXPECT_EQ(text("AF_TN"), "87.6");
    EXPECT_EQ(rows(), Lines({"90.1", "94.3"}));
}

TEST_F(EditorTest, TheTitleNamesTheKindOfTheLists) {
    open();
    EXPECT_EQ(editor->windowTitle(), QStringLiteral("AF Listen bearbeiten"));
    state.afEditorKind = "EON AF";
    useLanguage("english");
    open();
    EXPECT_EQ(editor->windowTitle(), QStringLiteral("Edit EON AF lists"));
}

TEST_F(EditorTest, TheControlsBearTheirTexts) {
    open();
    for (int i = 0; i < 5; ++i) {
        EXPECT_EQ(text(("AFList_Opt_" + std::to_string(i)).c_str()), "Liste " + std::to_string(i + 1));
    }
    EXPECT_EQ(text("AF_OF_add"), "Einfügen");
    EXPECT_EQ(text("Rem_Freq"), "Löschen");
}

TEST_F(EditorTest, ChoosingAListShowsItAndStoresNothing) {
    setList("AF_LISTE4", "100.1,88.0");
    const std::string before = folder.read(kSet1);
    open();
    click("AFList_Opt_3");
    EXPECT_EQ(text("AF_TN"), "100.1");
    EXPECT_EQ(rows(), Lines{"88.0"});
    EXPECT_EQ(folder.read(kSet1), before);
}

TEST_F(EditorTest, AListWithoutAfsLeavesTheFormerOneInView) {
    setList("AF_LISTE2", "100.1");
    open();
    click("AFList_Opt_1");
    EXPECT_EQ(text("AF_TN"), "87.6");
    EXPECT_EQ(rows(), Lines({"90.1", "94.3"}));
    click("Uebernahme_Knopf");
    EXPECT_EQ(profile(kSet1, "RDS", "AF_LISTE2"), "87.6,90.1,94.3");
}

TEST_F(EditorTest, ChoosingAnotherListDropsWhatWasNotAccepted) {
    setList("AF_LISTE2", "100.1,88.0");
    open();
    type("Text2", "99.9");
    click("Command1");
    click("AFList_Opt_1");
    click("AFList_Opt_0");
    EXPECT_EQ(rows(), Lines({"90.1", "94.3"}));
}

TEST_F(EditorTest, EonListsAreReadAndStoredUnderTheirOwnKeys) {
    state.afEditorKind = "EON AF";
    setList("EON_AFB1", "91.7,104.2");
    setList("EON_AFB5", "98.5,106.5");
    open();
    EXPECT_EQ(text("AF_TN"), "91.7");
    click("AFList_Opt_4");
    type("Text2", "88.0");
    click("Command1");
    click("Uebernahme_Knopf");
    EXPECT_EQ(profile(kSet1, "RDS", "EON_AFB5"), "98.5,106.5,88.0");
    EXPECT_EQ(profile(kSet1, "RDS", "AF_LISTE5"), "");
}

TEST_F(EditorTest, ListsBelongToTheCurrentDataSet) {
    state.CurrentDataSet = "3";
    setProfile("Datenset3.INI", "RDS", "AF_LISTE1", "100.1,88.0");
    open();
    EXPECT_EQ(text("AF_TN"), "100.1");
    type("Text2", "90.0");
    click("Command1");
    click("Uebernahme_Knopf");
    EXPECT_EQ(profile("Datenset3.INI", "RDS", "AF_LISTE1"), "100.1,88.0,90.0");
    EXPECT_EQ(profile(kSet1, "RDS", "AF_LISTE1"), "87.6,90.1,94.3");
}

TEST_F(EditorTest, AcceptingStoresTheListAndCloses) {
    open();
    type("Text2", "107.1");
    click("Command1");
    click("Uebernahme_Knopf");
    EXPECT_EQ(profile(kSet1, "RDS", "AF_LISTE1"), "87.6,90.1,94.3,107.1");
    EXPECT_FALSE(editor->isVisible());
    EXPECT_EQ(sent(), Lines{});
}

TEST_F(EditorTest, ClosingStoresNothing) {
    open();
    type("Text2", "107.1");
    click("Command1");
    click("Ende_Knopf");
    EXPECT_EQ(profile(kSet1, "RDS", "AF_LISTE1"), "87.6,90.1,94.3");
    EXPECT_FALSE(editor->isVisible());
}

TEST_F(EditorTest, EscapeAsksBeforeChangesAreLost) {
    open();
    editor->reject();
    EXPECT_FALSE(editor->isVisible()) << "nothing would be lost";
    open();
    type("Text2", "107.1");
    click("Command1");
    dialogs.confirmations = {false, true};
    editor->close();
    EXPECT_TRUE(editor->isVisible());
    EXPECT_EQ(rows().size(), 3U);
    editor->reject();
    EXPECT_FALSE(editor->isVisible());
    EXPECT_EQ(dialogs.shown.back().text, QStringLiteral("Die Änderungen verwerfen?"));
    EXPECT_EQ(profile(kSet1, "RDS", "AF_LISTE1"), "87.6,90.1,94.3");
}

TEST_F(EditorTest, AListWithoutAfsIsStoredAsItsTunedFrequencyAlone) {
    setList("AF_LISTE1", "87.6,90.1");
    dialogs.confirmations = {true};
    open();
    selectRow(0);
    click("Rem_Freq");
    click("Uebernahme_Knopf");
    EXPECT_EQ(profile(kSet1, "RDS", "AF_LISTE1"), "87.6");
}

TEST_F(EditorTest, AListWithoutATunedFrequencyIsStoredWithALeadingComma) {
    setList("AF_LISTE1", "");
    open();
    type("Text2", "90.1");
    click("Command1");
    click("Uebernahme_Knopf");
    EXPECT_EQ(profile(kSet1, "RDS", "AF_LISTE1"), ",90.1");
}

TEST_F(EditorTest, AppendingTakesTheTextAsTyped) {
    open();
    for (const char* typed : {"87.5", "108.0", "99", "88.123"}) {
        type("Text2", typed);
        click("Command1");
    }
    EXPECT_EQ(rows(), Lines({"90.1", "94.3", "87.5", "108.0", "99", "88.123"}));
}

TEST_F(EditorTest, TheEnterKeyAppends) {
    open();
    type("Text2", "99.9");
    pressEnter("Text2");
    EXPECT_EQ(rows(), Lines({"90.1", "94.3", "99.9"}));
    EXPECT_TRUE(editor->isVisible());
}

TEST_F(EditorTest, AnAfOutsideItsRangeIsRefused) {
    open();
    selectRow(0);
    std::size_t box = 0;
    for (const char* typed : {"87.4", "86", "108.1", "", "abc"}) {
        type("Text2", typed);
        dialogs.expectedMessages = 2;
        click("Command1");
        click("AF_OF_add");
        expectRefusal(box++, 164);
        expectRefusal(box++, 164);
    }
    EXPECT_EQ(rows(), Lines({"90.1", "94.3"}));
}

TEST_F(EditorTest, ADecimalCommaIsRefusedOnlyWhenItsWholeNumberIsOutOfRange) {
    open();
    dialogs.expectedMessages = 1;
    type("Text2", "87,6");
    click("Command1");
    expectRefusal(0, 164);
    type("Text2", "90,1");
    click("Command1");
    EXPECT_EQ(rows(), Lines({"90.1", "94.3", "90,1"}));
    click("Uebernahme_Knopf");
    EXPECT_EQ(profile(kSet1, "RDS", "AF_LISTE1"), "87.6,90.1,94.3,90,1");
    open();
    EXPECT_EQ(rows(), Lines({"90.1", "94.3", "90", "1"}));
}

TEST_F(EditorTest, InsertingPutsTheAfBeforeTheSelectedRow) {
    open();
    selectRow(1);
    type("Text2", "92.0");
    click("AF_OF_add");
    EXPECT_EQ(rows(), Lines({"90.1", "92.0", "94.3"}));
    EXPECT_EQ(find<QListWidget>("AF_List1")->currentItem()->text(), QStringLiteral("94.3"));
}

TEST_F(EditorTest, InsertingWithoutASelectedRowDoesNothing) {
    open();
    type("Text2", "92.0");
    click("AF_OF_add");
    type("Text2", "12");
    click("AF_OF_add");
    EXPECT_EQ(rows(), Lines({"90.1", "94.3"}));
}

TEST_F(EditorTest, RemovingAsksInOneSentenceAndRemovesOnYes) {
    dialogs.confirmations = {true};
    open();
    selectRow(0);
    click("Rem_Freq");
    EXPECT_EQ(rows(), Lines{"94.3"});
    ASSERT_EQ(dialogs.shown.size(), 1U);
    EXPECT_EQ(dialogs.shown[0].title, QStringLiteral("Change List?"));
    EXPECT_EQ(dialogs.shown[0].text, QStringLiteral("Do you want to erase this 90.1 MHz frequency from the list?"));
}

TEST_F(EditorTest, RemovingKeepsTheAfOnNo) {
    dialogs.confirmations = {false};
    open();
    selectRow(0);
    click("Rem_Freq");
    EXPECT_EQ(rows(), Lines({"90.1", "94.3"}));
}

TEST_F(EditorTest, RemovingAsksInGermanOnlyForTheLanguageWithACapitalLetter) {
    state.language = "Deutsch";
    dialogs.confirmations = {true};
    open();
    selectRow(1);
    click("Rem_Freq");
    EXPECT_EQ(dialogs.shown[0].title, QStringLiteral("Liste ändern?"));
    EXPECT_EQ(dialogs.shown[0].text, QStringLiteral("Möchten Sie diese Frequenz 94.3 MHz aus der Liste löschen?"));
    EXPECT_EQ(rows(), Lines{"90.1"});
}

TEST_F(EditorTest, RemovingNeedsASelectedRowThatIsNotEmpty) {
    setList("AF_LISTE1", "87.6,,90.1");
    open();
    click("Rem_Freq");
    selectRow(0);
    click("Rem_Freq");
    EXPECT_EQ(rows(), Lines({"", "90.1"}));
    EXPECT_TRUE(dialogs.shown.empty());
}

TEST_F(EditorTest, TheTunedFrequencyIsAskedForAndCutToOneDecimal) {
    dialogs.inputs = {QStringLiteral("101.25")};
    open();
    clickTuned();
    EXPECT_EQ(text("AF_TN"), "101.2");
    ASSERT_EQ(dialogs.shown.size(), 1U);
    EXPECT_EQ(dialogs.shown[0].text, toText(captions.text(162)));
    EXPECT_EQ(dialogs.shown[0].title, toText(captions.text(161)));
    EXPECT_EQ(dialogs.shown[0].preset, QStringLiteral("87.6"));
    click("Uebernahme_Knopf");
    EXPECT_EQ(profile(kSet1, "RDS", "AF_LISTE1"), "101.2,90.1,94.3");
}

TEST_F(EditorTest, TheTunedFrequencyIsReachedByTheKeyboard) {
    dialogs.inputs = {QStringLiteral("90")};
    open();
    pressEnter("AF_TN");
    EXPECT_EQ(text("AF_TN"), "90.0");
    EXPECT_EQ(rows(), Lines({"90.1", "94.3"}));
}

TEST_F(EditorTest, AnEmptyAnswerLeavesTheTunedFrequency) {
    dialogs.inputs = {QString()};
    open();
    clickTuned();
    EXPECT_EQ(text("AF_TN"), "87.6");
}

TEST_F(EditorTest, ARefusedTunedFrequencyIsAskedForAgainWithWhatWasTyped) {
    dialogs.inputs = {QStringLiteral("85.9"), QStringLiteral("108.1"), QStringLiteral("abc"), QStringLiteral("86")};
    dialogs.expectedMessages = 3;
    open();
    clickTuned();
    EXPECT_EQ(text("AF_TN"), "86.0");
    ASSERT_EQ(dialogs.shown.size(), 7U);
    expectRefusal(1, 164);
    EXPECT_EQ(dialogs.shown[2].preset, QStringLiteral("85.9"));
    expectRefusal(3, 164);
    EXPECT_EQ(dialogs.shown[4].preset, QStringLiteral("108.1"));
    expectRefusal(5, 164);
    EXPECT_EQ(dialogs.shown[6].preset, QStringLiteral("abc"));
}

TEST_F(EditorTest, ATunedFrequencyWithACommaGetsTheCommaMessageWhateverItsValue) {
    dialogs.inputs = {QStringLiteral("98,5"), QStringLiteral("12,5"), QString()};
    dialogs.expectedMessages = 2;
    open();
    clickTuned();
    expectRefusal(1, 166);
    expectRefusal(3, 166);
    EXPECT_EQ(dialogs.shown[4].preset, QStringLiteral("12,5"));
    EXPECT_EQ(text("AF_TN"), "87.6");
}

TEST_F(EditorTest, ADecimalCommaIsAPointWhereThatIsCorrected) {
    state.corrections.decimalComma = true;
    dialogs.inputs = {QStringLiteral("98,5")};
    open();
    clickTuned();
    EXPECT_EQ(text("AF_TN"), "98.5");
    type("Text2", "87,6");
    click("Command1");
    EXPECT_EQ(text("Text2"), "87.6");
    selectRow(0);
    type("Text2", "90,1");
    click("AF_OF_add");
    EXPECT_EQ(rows(), (Lines{"90.1", "90.1", "94.3", "87.6"}));
    click("Uebernahme_Knopf");
    EXPECT_EQ(profile(kSet1, "RDS", "AF_LISTE1"), "98.5,90.1,90.1,94.3,87.6");
}

TEST_F(EditorTest, WhatIsNoNumberIsRefusedWhereThatIsCorrected) {
    state.corrections.decimalComma = true;
    dialogs.inputs = {QStringLiteral("98,5x"), QStringLiteral("120,5"), QString()};
    dialogs.expectedMessages = 4;
    open();
    clickTuned();
    EXPECT_EQ(dialogs.shown[2].preset, QStringLiteral("98,5x"));
    EXPECT_EQ(dialogs.shown[4].preset, QStringLiteral("120.5"));
    for (const char* refused : {"90.1 MHz", "87,4"}) {
        type("Text2", refused);
        click("Command1");
    }
    for (const std::size_t box : {1U, 3U, 5U, 6U}) expectRefusal(box, 164);
    EXPECT_EQ(rows(), (Lines{"90.1", "94.3"}));
}

TEST_F(EditorTest, NothingIsCutOffInAnyLanguageAtAnySizeOfLetters) {
    std::string longest = "107.6";
    for (int i = 0; i < 25; ++i) longest += ",107.6";
    setList("AF_LISTE1", longest);
    test::expectNothingCutOffAnywhere([this](const char* language) -> QWidget& {
        useLanguage(language);
        open();
        type("Text2", "107.6");
        return *editor;
    });
}

TEST_F(EditorTest, EveryCaptionFitsInEveryLanguage) {
    for (const char* language : {"deutsch", "english", "english US"}) {
        useLanguage(language);
        open();
        EXPECT_LE(editor->width(), 640) << language;
        EXPECT_LE(editor->height(), 480) << language;
        for (const char* name : {"AF_TN", "AF_List1", "Text2"}) {
            EXPECT_FALSE(find(name)->accessibleName().isEmpty()) << name;
        }
    }
}

}  // namespace
}  // namespace kdx
