#include "tmc/tmclistedit.h"

#include "support/everyfont.h"
#include "tmc/tmclistedittest.h"
#include "ui/application.h"

#include <QListView>

namespace kdx::test {
namespace {

TEST_F(TmcListeditTest, AnEntryCanBeChanged) {
    EXPECT_FALSE(enabled("Eintrag_Aendern"));
    find<QListView>("List1")->setCurrentIndex(find<QListView>("List1")->model()->index(0, 0));
    dialogs.inputs = {QStringLiteral("Stau, lang"), QStringLiteral("00102")};
    click("Eintrag_Aendern");
    EXPECT_EQ(dialogs.shown.at(0).preset, QStringLiteral("Stau"));
    EXPECT_EQ(dialogs.shown.at(1).preset, QStringLiteral("00101"));
    EXPECT_EQ(folder.read("Event.txt"), "Stau, lang;00102\r\nUnfall;00201\r\n");
    EXPECT_EQ(entries("List1"), (Lines{entry("Stau, lang", "00102"), entry("Unfall", "00201")}));
    dialogs.inputs = {QString()};  // cancelled
    click("Eintrag_Aendern");
    dialogs.inputs = {QStringLiteral("x"), QString()};
    click("Eintrag_Aendern");
    EXPECT_EQ(folder.read("Event.txt"), "Stau, lang;00102\r\nUnfall;00201\r\n");
}

TEST_F(TmcListeditTest, AnEntryCanBeDeletedAfterAQuestion) {
    auto* events = find<QListView>("List1");
    auto* locations = find<QListView>("List2");
    events->setCurrentIndex(events->model()->index(1, 0));
    dialogs.confirmations = {false, true};
    click("Eintrag_Loeschen");
    EXPECT_EQ(folder.read("Event.txt"), "Stau;00101\r\nUnfall;00201\r\n");
    click("Eintrag_Loeschen");
    EXPECT_EQ(folder.read("Event.txt"), "Stau;00101\r\n");
    EXPECT_EQ(entries("List1"), Lines{entry("Stau", "00101")});
    locations->setCurrentIndex(locations->model()->index(0, 0));
    EXPECT_FALSE(events->selectionModel()->hasSelection()) << "the buttons mean one entry";
    dialogs.confirmations = {true};
    click("Eintrag_Loeschen");
    EXPECT_EQ(folder.read("Location.txt"), "");
    EXPECT_FALSE(enabled("Eintrag_Loeschen"));
}

TEST_F(TmcListeditTest, AnEntryThatAnotherProgramChangedIsNotTouched) {
    auto* events = find<QListView>("List1");
    events->setCurrentIndex(events->model()->index(0, 0));
    folder.write("Event.txt", "Anders;00300\r\n");
    dialogs.confirmations = {true};
    dialogs.expectedMessages = 1;
    click("Eintrag_Loeschen");
    EXPECT_EQ(folder.read("Event.txt"), "Anders;00300\r\n");
    EXPECT_EQ(entries("List1"), Lines{entry("Anders", "00300")});
}

TEST_F(TmcListeditTest, OpeningShowsBothLists) {
    EXPECT_EQ(entries("List1"), (Lines{entry("Stau", "00101"), entry("Unfall", "00201")}));
    EXPECT_EQ(entries("List2"), Lines{entry("Musterstadt", "12345")});
    EXPECT_EQ(editor->objectName().toStdString(), "TMC_Listedit");
    EXPECT_EQ(editor->windowTitle().toStdString(), "Edit TMC List");
}

TEST_F(TmcListeditTest, TheListsAreInAFixedPitchFontWithTheHeadingsOverTheirColumns) {
    for (const auto& [list, heading] : {std::pair{"List1", "Label1"}, std::pair{"List2", "Label2"}}) {
        const QFontMetrics metrics = find(list)->fontMetrics();
        EXPECT_EQ(find(list)->font().families().first().toStdString(), "Courier New");
        EXPECT_EQ(metrics.horizontalAdvance(QStringLiteral("iiii")), metrics.horizontalAdvance(QStringLiteral("WWWW")));
        EXPECT_EQ(find(heading)->fontMetrics().horizontalAdvance(QString(42, QLatin1Char('0'))),
                  metrics.horizontalAdvance(QString(42, QLatin1Char('0'))));
    }
    EXPECT_EQ(text("Label1"), entry("E v e n t", "C o d e"));
    EXPECT_EQ(text("Label2"), entry("L o c a t i o n", "C o d e"));
}

TEST_F(TmcListeditTest, TheInputLabelsAskForTextAndCode) {
    enter("Event_Input_TXT", "Nebel");
    enter("Event_Input_Nr", "01332");
    enter("Loc_INput_TXT1", "Beispielheim");
    enter("Loc_Input_Nr", "00007");
    EXPECT_EQ(text("Event_Input_TXT"), "Nebel");
    EXPECT_EQ(text("Event_Input_Nr"), "01332");
    EXPECT_EQ(text("Loc_INput_TXT1"), "Beispielheim");
    EXPECT_EQ(text("Loc_Input_Nr"), "00007");
    Lines prompts;
    for (const auto& box : dialogs.shown) {
        prompts.push_back(box.text.toStdString());
        EXPECT_EQ(box.title.toStdString(), "Eingabe");
    }
    EXPECT_EQ(prompts, (Lines{"Event Text", "Event Nr", "Location Text", "Location Nr"}));
}

TEST_F(TmcListeditTest, AnEmptyAnswerLeavesTheLabel) {
    enter("Event_Input_TXT", "Nebel");
    enter("Event_Input_TXT", "");
    EXPECT_EQ(text("Event_Input_TXT"), "Nebel");
}

TEST_F(TmcListeditTest, AddingAnEventAppendsItAndShowsIt) {
    enter("Event_Input_TXT", "Nebel");
    enter("Event_Input_Nr", "01332");
    click("Event_Hinzu");
    EXPECT_EQ(folder.read("Event.txt"), "Stau;00101\r\nUnfall;00201\r\nNebel;01332\r\n");
    EXPECT_EQ(entries("List1").back(), entry("Nebel", "01332"));
    EXPECT_EQ(text("Event_Input_TXT"), "");
    EXPECT_EQ(text("Event_Input_Nr"), "");
}

TEST_F(TmcListeditTest, AddingALocationAppendsItAndShowsIt) {
    enter("Loc_INput_TXT1", "München");
    enter("Loc_Input_Nr", "00007");
    click("Loc_Hinzu");
    EXPECT_EQ(folder.read("Location.txt"), "Musterstadt;12345\r\nM\xfcnchen;00007\r\n");
    EXPECT_EQ(entries("List2").back(), "München" + std::string(42 - 7, ' ') + "00007");
    EXPECT_EQ(folder.read("Event.txt"), "Stau;00101\r\nUnfall;00201\r\n");
}

TEST_F(TmcListeditTest, AddingWithoutACodeOrWithoutATextWritesNothing) {
    enter("Event_Input_TXT", "Nebel");
    click("Event_Hinzu");
    enter("Loc_Input_Nr", "00007");
    click("Loc_Hinzu");
    EXPECT_EQ(folder.read("Event.txt"), "Stau;00101\r\nUnfall;00201\r\n");
    EXPECT_EQ(folder.read("Location.txt"), "Musterstadt;12345\r\n");
    EXPECT_EQ(text("Event_Input_TXT"), "Nebel");
    EXPECT_EQ(text("Loc_Input_Nr"), "00007");
}

TEST_F(TmcListeditTest, ALongTextIsCutInTheListAndWholeInTheFile) {
    const std::string longText(50, 'x');
    enter("Event_Input_TXT", longText.c_str());
    enter("Event_Input_Nr", "00007");
    click("Event_Hinzu");
    EXPECT_EQ(entries("List1").back(), std::string(42, 'x') + "00007");
    EXPECT_TRUE(folder.read("Event.txt").ends_with(longText + ";00007\r\n"));
}

TEST_F(TmcListeditTest, NeitherDuplicatesNorCodesAreChecked) {
    enter("Event_Input_TXT", "Stau");
    enter("Event_Input_Nr", "a;b");
    click("Event_Hinzu");
    EXPECT_EQ(entries("List1").back(), entry("Stau", "a;b"));
}

TEST_F(TmcListeditTest, TheExitButtonClosesTheWindow) {
    click("Zuruek_Knopf");
    EXPECT_FALSE(editor->isVisible());
}

TEST_F(TmcListeditTest, EscapeAsksBeforeWhatWasTypedIsLost) {
    enter("Event_Input_TXT", "Stau");
    dialogs.confirmations = {false, true};
    editor->close();
    EXPECT_TRUE(editor->isVisible());
    EXPECT_EQ(text("Event_Input_TXT"), "Stau");
    editor->reject();
    EXPECT_FALSE(editor->isVisible());
}

TEST_F(TmcListeditTest, AMissingFileIsToldAndLeavesItsListEmpty) {
    auto& application = dynamic_cast<Application&>(*QApplication::instance());
    Lines told;
    application.onFailure([&told](const QString&, const QString& error) { told.push_back(error.toStdString()); });
    std::filesystem::remove(folder.data() / "Event.txt");
    open();
    application.onFailure({});
    EXPECT_EQ(told, Lines{"Event.txt kann nicht gelesen werden."});
    EXPECT_TRUE(editor->isVisible());
    EXPECT_TRUE(entries("List1").empty());
    EXPECT_EQ(entries("List2"), Lines{entry("Musterstadt", "12345")});
}

TEST_F(TmcListeditTest, AddingToAMissingFileCreatesIt) {
    std::filesystem::remove(folder.data() / "Event.txt");
    enter("Event_Input_TXT", "Nebel");
    enter("Event_Input_Nr", "01332");
    click("Event_Hinzu");
    EXPECT_EQ(folder.read("Event.txt"), "Nebel;01332\r\n");
    EXPECT_EQ(entries("List1"), Lines{entry("Nebel", "01332")});
}

TEST_F(TmcListeditTest, NothingIsCutOffInAnyLanguageAtAnySizeOfLetters) {
    expectNothingCutOffAnywhere([this](const char* language) -> QWidget& {
        useLanguage(language);
        open();
        return *editor;
    });
}

TEST_F(TmcListeditTest, AMillionEntriesAreShownToTheLast) {
    std::string lines;
    for (int i = 0; i < 1'000'000; ++i) lines += "Ort;" + std::to_string(i) + "\r\n";
    folder.write("Location.txt", lines);
    open();
    auto* list = find<QListView>("List2");
    EXPECT_EQ(list->model()->rowCount(), 1'000'000);
    const QModelIndex last = list->model()->index(999'999, 0);
    EXPECT_EQ(last.data().toString().toStdString(), entry("Ort", "999999"));
    list->scrollToBottom();
    EXPECT_TRUE(list->viewport()->rect().contains(list->visualRect(last)));
}

TEST_F(TmcListeditTest, AnEntryOfAMegabyteIsShownCutAndStaysWholeInTheFile) {
    const std::string line = "Stau;" + std::string(1'000'000, '0') + "\r\n";
    folder.write("Event.txt", line);
    open();
    EXPECT_EQ(entries("List1"), Lines{entry("Stau", std::string(1000 - 42, '0'))});
    enter("Event_Input_TXT", "Nebel");
    enter("Event_Input_Nr", "01332");
    click("Event_Hinzu");
    EXPECT_EQ(folder.read("Event.txt"), line + "Nebel;01332\r\n");
}

}  // namespace
}  // namespace kdx::test
