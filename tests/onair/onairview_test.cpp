#include <gmock/gmock.h>

#include <QClipboard>
#include <QFile>
#include <QGuiApplication>
#include <QPushButton>
#include <QRegularExpression>

#include "onairviewtest.h"

namespace kdx::test {
namespace {

using namespace std::chrono_literals;
using ::testing::AllOf;
using ::testing::HasSubstr;
using ::testing::Not;

TEST_F(OnAirViewTest, TheRadioShowsWhatTheDataSetMakesOfTheCoder) {
    open();
    listen();
    EXPECT_EQ(text("Air_PI"), "D7A1");
    EXPECT_EQ(text("Air_PS"), "MESSTURM");
    EXPECT_EQ(text("Air_RT"), "Messturm - Musik und Verkehr aus dem Labor");
    EXPECT_EQ(mark("Air_PI") + mark("Air_PS") + mark("Air_RT") + mark("Air_PTY") + mark("Air_MS"), "");
}

TEST_F(OnAirViewTest, TheRadioFollowsTheButtonsOfThePages) {
    open();
    type("PS_T", "RADIO 12");
    click("PS_Taste");
    type("PI_T", "D3C1");
    click("Command3");
    select("PTY_Combo1", 4);
    click("MS_opt_1");
    type("RT_Text1", "Guten Tag");
    click("RT_Taste1");
    listen();
    EXPECT_EQ(text("Air_PS"), "RADIO 12");
    EXPECT_EQ(text("Air_PI"), "D3C1");
    EXPECT_EQ(text("Air_PTY"), "Sport");
    EXPECT_EQ(text("Air_MS"), "Sprache");
    EXPECT_EQ(text("Air_RT"), "Guten Tag");
    EXPECT_EQ(text("Air_TA"), "aus");
    click("Check1");
    click("TA_Check");
    listen();
    EXPECT_EQ(text("Air_TP"), "ein");
    EXPECT_EQ(text("Air_TA"), "ein");
}

TEST_F(OnAirViewTest, TheClockComesAtTheFullMinute) {
    open();
    clock.set(12 * 3600 + 50);
    session->params.SendParam("ZEIT", "");
    listen(15s);
    EXPECT_EQ(text("Air_CT"), "2009-03-05 12:01");
}

TEST_F(OnAirViewTest, AlternativeFrequenciesAreListed) {
    open();
    click("Taste_AF_Senden");
    listen(15s);
    EXPECT_THAT(cells("Air_AF"), HasSubstr("A||98.5, 89.3, 94.7, 101.2|"));
}

TEST_F(OnAirViewTest, OtherNetworksAreListed) {
    open();
    type("EON_PI_Text", "D3C4");
    click("EON_PI_Taste");
    type("EON_PS_Text", "RADIO 2");
    click("EON_PS_Taste");
    listen(15s);
    EXPECT_THAT(cells("Air_EON"), HasSubstr("D3C4|RADIO 2 |"));
}

TEST_F(OnAirViewTest, TrafficMessagesAreInWordsFromTheLists) {
    open();
    sendMessage();
    listen();
    EXPECT_EQ(cell("Air_TMC", 0, 0), "Verkehrsproblem / traffic problem");
    EXPECT_EQ(cell("Air_TMC", 0, 1), "Land Probia");
}

TEST_F(OnAirViewTest, GroupsAreShownWithTheirShares) {
    open();
    session->params.SendParam("GROUPSEQ", "0A,2A");
    listen(19s);
    EXPECT_EQ(cell("Air_Gruppen", 0, 0), "0A");
    EXPECT_EQ(cell("Air_Gruppen", 0, 1).substr(0, 4), "D7A1");
    EXPECT_EQ(cell("Air_Gruppen", 0, 2), "50 %");
    EXPECT_EQ(cell("Air_Gruppen", 2, 0), "2A");
    EXPECT_EQ(cell("Air_Gruppen", 2, 2), "50 %");
    EXPECT_EQ(cell("Air_Gruppen", 1, 2), "");
}

TEST_F(OnAirViewTest, CommandsCountWithoutASession) {
    folder.copyShipped();
    start();
    openView();
    session->params.SendParam("RDS", "1");
    session->params.SendParam("PS", "OHNE");
    listen();
    EXPECT_EQ(sent(), Lines{});
    EXPECT_EQ(text("Air_PS"), "OHNE    ");
}

TEST_F(OnAirViewTest, TheBudgetsAreThereWithTheirWarnings) {
    open();
    EXPECT_THAT(cells("Air_Budget"), HasSubstr("Radiotext|"));
    EXPECT_THAT(cells("Air_Budget"), HasSubstr("|von 75 kHz|"));
    EXPECT_THAT(cells("Air_Budget"), HasSubstr("\nGruppen|Anteil||\n0A|60.0 %||\n2A|20.0 %||\n14A|20.0 %||\n"));
    EXPECT_THAT(cells("Air_Budget"), Not(HasSubstr("8A ohne 3A")));
    session->params.SendParam("GROUPSEQ", "0A,2A,8A");
    listen();
    EXPECT_THAT(cells("Air_Budget"), HasSubstr("! 8A ohne 3A|"));
    EXPECT_THAT(cells("Air_Budget"), HasSubstr("! EON ist gesetzt, aber 14A hat keinen Platz in der Folge|"));
}

TEST_F(OnAirViewTest, NoGroupsAreShownWhileNoneGoOut) {
    open();
    listen();
    EXPECT_THAT(cells("Air_Gruppen"), HasSubstr("%"));
    session->params.SendParam("RDS", "0");
    listen(1s);
    EXPECT_THAT(cells("Air_Gruppen"), Not(HasSubstr("%")));
    session->params.SendParam("RDS", "1");
    listen(1s);
    EXPECT_THAT(cells("Air_Gruppen"), HasSubstr("%"));
}

TEST_F(OnAirViewTest, OpensBesideTheWindowAndComesBackWhereItWas) {
    open();
    const QRect screen = view->screen()->availableGeometry();
    EXPECT_TRUE(screen.contains(view->geometry()));
    view->move(screen.topLeft() + QPoint(7, 11));
    const QPoint place = view->pos();
    view->close();
    openView();
    EXPECT_EQ(view->pos(), place);
}

TEST_F(OnAirViewTest, WhatCannotBeSentIsToldInTheLanguageOfTheWindow) {
    open();
    type("PS_T", "A\xC2\xA6");
    click("PS_Taste");
    session->params.SendParam("AF1", "N,98.7,108.0");
    session->params.SendParam("AF2", "+,86.0,86.0,98.7");
    listen();
    EXPECT_THAT(
        cells("Air_Budget"),
        AllOf(HasSubstr("! PS: \"\xC2\xA6\" hat keinen Platz im RDS-Zeichensatz und geht als Leerzeichen hinaus|"),
              HasSubstr("! AF-Liste 1: 108.0 MHz hat keinen Code und entfällt|"),
              HasSubstr("! AF-Liste 2: die Senderfrequenz 86.0 MHz hat keinen Code, deshalb entfällt die Liste|")));
    action("Mnu_Info_Sprache_E")->trigger();
    listen();
    EXPECT_THAT(cells("Air_Budget"), HasSubstr("! AF list 1: 108.0 MHz has no code and is left out|"));
}

TEST_F(OnAirViewTest, NothingThatCanBeTypedIntoHasTheFocusAtFirst) {
    open();
    EXPECT_EQ(view->focusWidget(), find<QPushButton>("Air_Kopieren"));
}

TEST_F(OnAirViewTest, SaysThatItShowsTheVirtualCoder) {
    open();
    EXPECT_EQ(text("Air_Hinweis"),
              "Gezeigt wird, was der virtuelle Coder aus den Befehlen macht; das Gerät selbst wird nicht gehört.");
}

TEST_F(OnAirViewTest, TheSpectrumAndThePeakDeviationFollowTheMultiplex) {
    open();
    const auto shown = [this] {
        listen(1s);
        return find("Air_Spektrum")->grab().toImage();
    };
    session->params.SendParam("PILOT", "1");
    const QImage withPilot = shown();
    const QRegularExpression deviation(QStringLiteral("^Spitzenhub [0-9]+[.][0-9] kHz$"));
    EXPECT_TRUE(deviation.match(QString::fromStdString(text("Air_Spitzenhub"))).hasMatch()) << text("Air_Spitzenhub");
    session->params.SendParam("PILOT", "0");
    const QImage without = shown();
    EXPECT_NE(withPilot, without);
    session->params.SendParam("RDS", "0");
    EXPECT_NE(shown(), without);
}

TEST_F(OnAirViewTest, MessagesThatNobodyAnnouncedAreTold) {
    open();
    session->params.SendParam("GROUPSEQ", "0A,8A");
    sendMessage();
    listen();
    EXPECT_EQ(cells("Air_TMC"), "\u2260 8A ohne 3A: das Radio übergeht die Meldungen|||||\n");
}

TEST_F(OnAirViewTest, ANewListOfEventsIsReadAnew) {
    open();
    session->params.SendParam("3A", "01,0068000CD46");
    sendMessage();
    listen();
    const std::string before = cell("Air_TMC", 0, 0);
    std::ifstream list(folder.path() / "Daten" / "Event.txt", std::ios::binary);
    std::string bytes(std::istreambuf_iterator<char>(list), {});
    const auto at = bytes.find(QString::fromStdString(before).toLatin1().toStdString());
    ASSERT_NE(at, std::string::npos) << before;
    bytes.replace(at, 1, "#");
    std::ofstream(folder.path() / "Daten" / "Event.txt", std::ios::binary) << bytes;
    listen();
    EXPECT_EQ(cell("Air_TMC", 0, 0), before);
    view->forgetTexts();
    listen();
    EXPECT_EQ(cell("Air_TMC", 0, 0), "#" + before.substr(1));
}

TEST_F(OnAirViewTest, SpeaksTheLanguageOfTheWindow) {
    open();
    select("PTY_Combo1", 4);
    click("Check1");
    click("TA_Check");
    listen();
    EXPECT_EQ(view->windowTitle(), QStringLiteral("Auf Sendung"));
    action("Mnu_Info_Sprache_E")->trigger();
    listen();
    EXPECT_EQ(view->windowTitle(), QStringLiteral("On air"));
    EXPECT_EQ(text("Air_TA"), "on");
    EXPECT_THAT(text("Air_Gruppen_Sichern"), HasSubstr("Save"));
    action("Mnu_Info_RDS_RBDS")->trigger();
    EXPECT_EQ(text("Air_PTY"), "Talk") << "of RBDS";
}

TEST_F(OnAirViewTest, SavesTheLatestGroupsToAFile) {
    open();
    listen(5s);
    const std::filesystem::path file = folder.path() / "groups.txt";
    dialogs.files = {QString::fromStdString(file.string())};
    click("Air_Gruppen_Sichern");
    std::ifstream lines(file);
    std::string first;
    ASSERT_TRUE(std::getline(lines, first));
    EXPECT_THAT(first, ::testing::MatchesRegex("D7A1 .... .... .... @2009/03/05 12:00:..\\..."));
    dialogs.files = {QString()};  // cancelled
    click("Air_Gruppen_Sichern");
}

TEST_F(OnAirViewTest, WhatCannotBeSavedIsTold) {
    open();
    listen(5s);
    const QString file = QString::fromStdString((folder.path() / "no such folder" / "x").string());
    dialogs.files = {file, file};
    dialogs.expectedMessages = 2;
    click("Air_Gruppen_Sichern");
    EXPECT_EQ(dialogs.shown.back().text, file + QStringLiteral(" kann nicht gespeichert werden."));
    click("Air_MPX_Sichern");
    EXPECT_EQ(dialogs.shown.back().text, file + QStringLiteral(" kann nicht gespeichert werden."));
}

TEST_F(OnAirViewTest, SavesTheMultiplexOfTheLatestGroups) {
    open();
    view->close();
    view->show();
    listen(1s);
    const std::filesystem::path file = folder.path() / "multiplex.wav";
    dialogs.files = {QString::fromStdString(file.string())};
    click("Air_MPX_Sichern");
    EXPECT_GT(std::filesystem::file_size(file), 800'000U) << "some 0.9 s of 228000 samples of four bytes";
}

TEST_F(OnAirViewTest, CopiesAllThatIsShown) {
    open();
    listen();
    click("Air_Kopieren");
    const std::string copied = QGuiApplication::clipboard()->text().toStdString();
    EXPECT_THAT(copied, HasSubstr("PS\tMESSTURM\n"));
    EXPECT_THAT(copied, HasSubstr("0A\tD7A1 "));
}

TEST_F(OnAirViewTest, RestsWhileItIsClosedAndIsThereAgain) {
    open();
    listen();
    view->close();
    EXPECT_FALSE(find<QTimer>("AirTimer")->isActive());
    type("PS_T", "RADIO 12");
    click("PS_Taste");
    clock.advance(1h);
    openView();
    EXPECT_TRUE(find<QTimer>("AirTimer")->isActive());
    EXPECT_EQ(text("Air_PS"), "RADIO 12");
}

}  // namespace
}  // namespace kdx::test
