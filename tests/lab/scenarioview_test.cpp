#include <QPushButton>

#include "scenariotest.h"
#include "support/everyfont.h"

namespace kdx::test {
namespace {

using ScenarioViewTest = ScenarioTest;

TEST_F(ScenarioViewTest, ListsTheStepsOfAScenario) {
    openView();
    EXPECT_FALSE(enabled("Ablauf_Start"));
    load("title: Probe\nsteps: [send: {PS: RADIO}, {repeat: 3, steps: [wait: 1 s, note: half]}, pause: ready]");
    EXPECT_EQ(table->rowCount(), 5);
    EXPECT_EQ(cell(0, 0), "1");
    EXPECT_EQ(cell(0, 1), "senden PS=RADIO");
    EXPECT_EQ(cell(2, 0), "2.1");
    EXPECT_EQ(cell(2, 1), "    warten: 1 s");
    EXPECT_EQ(text("Ablauf_Titel"), "Probe  (test.yaml)");
    EXPECT_TRUE(enabled("Ablauf_Start"));
    EXPECT_EQ(taken(), Lines{});
}

TEST_F(ScenarioViewTest, EveryShippedScenarioCanBeOpened) {
    openView();
    for (const auto& entry : std::filesystem::directory_iterator(folder.data() / "Scenarios")) {
        dialogs.files.push_back(QString::fromStdString(entry.path().string()));
        click("Ablauf_Oeffnen");
        EXPECT_GT(table->rowCount(), 2) << entry.path();
    }
}

TEST_F(ScenarioViewTest, BeginsToLookWhereScenariosAre) {
    const auto folderShown = [this](const std::filesystem::path& chosen) {
        dialogs.files.push_back(QString::fromStdString(chosen.string()));
        click("Ablauf_Oeffnen");
        return std::filesystem::path(dialogs.shown.back().preset.toStdString());
    };
    const auto own = folder.data() / "Scenarios";
    openView();
    EXPECT_EQ(folderShown({}), own) << "none are shipped";
    std::filesystem::remove_all(own);
    EXPECT_EQ(folderShown({}), "") << "no folder that is not there";
    shipped = folder.path() / "shipped";
    const auto theirs = shipped / "Daten" / "Scenarios";
    std::filesystem::create_directories(theirs);
    openView();
    EXPECT_EQ(folderShown({}), theirs);
    std::filesystem::create_directories(folder.path() / "mine");
    const auto mine = folder.path() / "mine" / "a.yaml";
    std::ofstream(mine) << "steps: [note: a]";
    EXPECT_EQ(folderShown(mine), theirs);
    EXPECT_EQ(folderShown({}), folder.path() / "mine");
}

TEST_F(ScenarioViewTest, OfALongValueThereIsAsMuchToBeSeenAsFits) {
    openView();
    const auto pictureOf = [this](char letter) {
        const std::string value(60, letter);
        load("steps: [send: {RT: \"" + value + "\"}]");
        EXPECT_TRUE(table->item(0, 1)->toolTip().endsWith(QString::fromStdString(value)));
        QApplication::processEvents();
        return table->viewport()->grab(table->visualItemRect(table->item(0, 1))).toImage();
    };
    view->resize(500, 300);
    EXPECT_NE(pictureOf('0'), pictureOf('W'));
}

TEST_F(ScenarioViewTest, AFileWithMistakesIsToldWithTheirPlacesAndTheOldOneStays) {
    openView();
    load("steps: [note: a]");
    dialogs.expectedMessages = 1;
    load("steps:\n  - send: {PTY: 99}\n  - jump: 3");
    const auto& box = dialogs.shown.back();
    EXPECT_EQ(box.text, QStringLiteral("test.yaml"));
    EXPECT_TRUE(box.preset.contains(QStringLiteral("Zeile 2, Spalte "))) << box.preset.toStdString();
    EXPECT_TRUE(box.preset.contains(QStringLiteral("Zeile 3, Spalte "))) << box.preset.toStdString();
    EXPECT_EQ(table->rowCount(), 1);
}

TEST_F(ScenarioViewTest, SendsEachStepWhenItsTimeHasCome) {
    openView();
    load("steps: [send: {PS: EINS}, wait: 10 s, send: {PS: ZWEI}]");
    click("Ablauf_Start");
    pass(1s);
    EXPECT_EQ(taken(), Lines{direct("PS=EINS    ")});
    EXPECT_EQ(text("Ablauf_Stand"), "Schritt 2; noch 10 s");
    EXPECT_TRUE(table->item(1, 0)->font().bold());
    EXPECT_FALSE(table->item(0, 0)->font().bold());
    pass(8s);
    EXPECT_EQ(text("Ablauf_Stand"), "Schritt 2; noch 2 s");
    EXPECT_EQ(taken(), Lines{});
    passAll();
    EXPECT_EQ(taken(), Lines{direct("PS=ZWEI    ")});
    EXPECT_EQ(text("Ablauf_Stand"), "zu Ende");
    EXPECT_EQ(result(0), "\u2713");
    EXPECT_EQ(result(2), "\u2713");
}

TEST_F(ScenarioViewTest, TheWindowStaysInUseMeanwhile) {
    openView();
    load("steps: [wait: 1 h]");
    click("Ablauf_Start");
    pass(1s);
    clock.sleeps.clear();
    pass(60s);
    EXPECT_EQ(clock.sleptMs(), 0);  // nothing sleeps: a timer waits
    type("PS_T", "RADIO");
    click("PS_Taste");
    EXPECT_EQ(taken(), Lines{direct("PS=RADIO   ")});
    EXPECT_TRUE(view->isRunning());
    EXPECT_EQ(text("Ablauf_Stand"), "Schritt 1; noch 59:00");
}

TEST_F(ScenarioViewTest, ALongRepetitionWithoutWaitsLetsTheWindowInAfterEachCommand) {
    openView();
    load("steps: [{repeat: 1000, steps: [send: {TA: 1, TP: 1}]}]");
    click("Ablauf_Start");
    for (int left = 4; left > 0; --left) tick("AblaufTimer");
    EXPECT_LT(commands.size(), 4U);
    EXPECT_GT(commands.size(), 0U);
    EXPECT_TRUE(view->isRunning());
}

TEST_F(ScenarioViewTest, PauseHoldsTheTimeThatIsLeft) {
    openView();
    load("steps: [wait: 10 s, send: {PS: ZWEI}]");
    click("Ablauf_Start");
    pass(4100ms);
    click("Ablauf_Pause");
    pass(1h);
    EXPECT_EQ(text("Ablauf_Stand"), "Schritt 1; noch 6 s; angehalten");
    EXPECT_TRUE(checked("Ablauf_Pause"));
    EXPECT_EQ(taken(), Lines{});
    click("Ablauf_Pause");
    pass(5s);
    EXPECT_EQ(taken(), Lines{});
    pass(2s);
    EXPECT_EQ(taken(), Lines{direct("PS=ZWEI    ")});
}

TEST_F(ScenarioViewTest, APauseOfTheScenarioWaitsForThePerson) {
    openView();
    load("steps: [pause: Radio an, send: {PS: ZWEI}]");
    click("Ablauf_Start");
    EXPECT_FALSE(enabled("Ablauf_Weiter"));
    pass(60s);
    EXPECT_EQ(text("Ablauf_Stand"), "Schritt 1; wartet auf Weiter");
    EXPECT_TRUE(enabled("Ablauf_Weiter"));
    EXPECT_EQ(result(0), "") << "not before it is over";
    EXPECT_EQ(taken(), Lines{});
    click("Ablauf_Weiter");
    passAll();
    EXPECT_EQ(taken(), Lines{direct("PS=ZWEI    ")});
    EXPECT_EQ(result(0), "\u2713");
}

TEST_F(ScenarioViewTest, ALoopUntilReturnEndsAtTheWordOfThePerson) {
    openView();
    load("steps: [{sweep: HF-Pegel, points: [60, 50, 40], dwell: 5 s, until: Return}, send: {TA: 1}]");
    click("Ablauf_Start");
    pass(7s);
    EXPECT_EQ(result(0), "2/3: 50");
    click("Ablauf_Weiter");
    passAll();
    EXPECT_EQ(taken(), (Lines{":POW 60DBUV", ":POW 50DBUV", direct("TA=1")}));
    EXPECT_EQ(result(0), "2/3: 50");
}

TEST_F(ScenarioViewTest, WhatIsNotMetStaysToBeSeen) {
    openView();
    load("steps: [send: {PS: EINS}, {repeat: 2, steps: [{expect: {PS: ZWEI}}, send: {PS: ZWEI}]}]");
    click("Ablauf_Start");
    passAll();
    EXPECT_EQ(result(2), "\u2717 nicht erfüllt: EINS");
    EXPECT_EQ(text("Ablauf_Stand"), "zu Ende; nicht erfüllt: 1");
}

TEST_F(ScenarioViewTest, TheReportStandsBesideTheScenario) {
    openView();
    load("report: out.csv\nsteps: [send: {PS: EINS}, note: fertig]");
    click("Ablauf_Start");
    passAll();
    std::ifstream file(folder.path() / "out.csv");
    const std::string bytes{std::istreambuf_iterator<char>(file), {}};
    EXPECT_NE(bytes.find("1,PS,EINS"), std::string::npos) << bytes;
    EXPECT_NE(bytes.find("2,note,fertig"), std::string::npos) << bytes;
}

TEST_F(ScenarioViewTest, NoReportGoesIntoAFolderThatIsOnlyRead) {
    openView();
    std::ofstream(folder.data() / "inside.yaml") << "report: report.csv\nsteps: [send: {PS: EINS}]";
    dialogs.files.push_back(QString::fromStdString((folder.data() / "inside.yaml").string()));
    click("Ablauf_Oeffnen");
    data.setReadOnly();
    dialogs.expectedMessages = 1;
    click("Ablauf_Start");
    EXPECT_FALSE(view->isRunning());
    EXPECT_FALSE(std::filesystem::exists(folder.data() / "report.csv"));
}

TEST_F(ScenarioViewTest, AFileThatIsNoReportIsNotOverwritten) {
    openView();
    folder.write("../brief.csv", "lieber Leser");
    load("report: brief.csv\nsteps: [send: {PS: EINS}]");
    dialogs.expectedMessages = 1;
    click("Ablauf_Start");
    EXPECT_FALSE(view->isRunning());
    EXPECT_TRUE(dialogs.shown.back().text.contains(QStringLiteral("brief.csv")));
    EXPECT_EQ(taken(), Lines{});
}

TEST_F(ScenarioViewTest, ADataSetGoesOutFirstAndTheWindowKeepsWhatItShows) {
    openView();
    setProfile("Datenset3.INI", "RDS", "PS", "DREI");
    setProfile("Datenset3.INI", "RDS", "PI", "3333");
    load("data_set: 3\nsteps: [wait: 1 s]");
    EXPECT_EQ(cell(0, 1), "Datensatz 3 senden");
    click("Ablauf_Start");
    passAll();
    EXPECT_EQ(value("PS"), "DREI");
    EXPECT_EQ(value("HF:PEGEL:STATE"), "ON");  // as of a program that was just started
    EXPECT_EQ(text("PS_T"), "MESSTURM");
    EXPECT_EQ(text("Status_3"), "MESSTURM");
    EXPECT_EQ(session->station.programme.ps, "MESSTURM");
    EXPECT_EQ(state.CurrentDataSet, "1");
    type("PS_T", "EIGEN");
    click("PS_Taste");
    EXPECT_EQ(profile(kSet1, "RDS", "PS"), "EIGEN");
    EXPECT_EQ(profile("Datenset3.INI", "RDS", "PS"), "DREI");
}

TEST_F(ScenarioViewTest, NothingIsCutOffInAnyLanguageAtAnySizeOfLetters) {
    expectNothingCutOffAnywhere([this](const char* language) -> QWidget& {
        openView(language);
        dialogs.files.push_back(QString::fromStdString((folder.data() / "Scenarios" / "sensitivity.yaml").string()));
        click("Ablauf_Oeffnen");
        click("Ablauf_Start");
        pass(1s);
        std::map<QString, QString> mnemonics;
        for (const QAbstractButton* button : view->findChildren<QPushButton*>()) {
            const QString key = QKeySequence::mnemonic(button->text()).toString();
            EXPECT_FALSE(key.isEmpty()) << button->text().toStdString();
            EXPECT_TRUE(mnemonics.emplace(key, button->text()).second) << language << ' ' << key.toStdString();
        }
        return *view;
    });
}

TEST_F(ScenarioViewTest, SpeaksTheLanguageOfTheWindow) {
    openView("english");
    EXPECT_EQ(view->windowTitle(), QStringLiteral("Scenario"));
    load("steps: [wait: 5 s]");
    click("Ablauf_Start");
    pass(1100ms);
    EXPECT_EQ(text("Ablauf_Stand"), "step 1; 4 s left");
    action("Mnu_Info_Sprache_D")->trigger();
    EXPECT_EQ(text("Ablauf_Stand"), "Schritt 1; noch 4 s");
}

TEST_F(ScenarioViewTest, OnlyAFileThatRestoresIsSaidToBringBackWhatWasBefore) {
    openView();
    load("restore: true\nsteps: [wait: 10 s]");
    click("Ablauf_Start");
    EXPECT_EQ(text("Ablauf_Stand"), "was vorher war, wird gelesen und kommt danach wieder");
    passAll();
    load("restore: false\nsteps: [wait: 10 s]");
    click("Ablauf_Start");
    EXPECT_EQ(text("Ablauf_Stand"), "");
    click("Ablauf_Pause");
    EXPECT_EQ(text("Ablauf_Stand"), "angehalten");
    click("Ablauf_Pause");
    pass(1s);
    EXPECT_EQ(text("Ablauf_Stand"), "Schritt 1; noch 10 s");
    passAll();
}

TEST_F(ScenarioViewTest, AReportDoesNotReplaceAFileOfTheProgram) {
    openView();
    const std::string before = folder.read("Datenset3.INI");
    load("report: " + folder.data().filename().string() + "/Datenset3.INI\nsteps: [note: a]");
    dialogs.expectedMessages = 1;
    click("Ablauf_Start");
    EXPECT_FALSE(view->isRunning());
    EXPECT_EQ(folder.read("Datenset3.INI"), before);
    EXPECT_EQ(dialogs.shown.back().preset.toStdString(), "Diese Datei gehört dem Programm: bitte eine andere wählen.");
}

}  // namespace
}  // namespace kdx::test
