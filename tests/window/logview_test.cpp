#include "window/logview.h"

#include <gtest/gtest.h>

#include <QClipboard>
#include <QGuiApplication>
#include <QPushButton>
#include <QScrollBar>
#include <QTableView>

#include "support/everyfont.h"
#include "support/windowtest.h"
#include "window/trafficlog.h"

namespace kdx::test {
namespace {

class LogViewTest : public WindowTest {
protected:
    void open() {
        folder.copyShipped();
        setGeneral("ADRESSEN", "Log_Key", "0");  // the view works without the log file
        start();
        openSession();
        action("Mnu_Info_Log")->trigger();
        view = window->findChild<LogView*>(QStringLiteral("LogView"));
        table = view->findChild<QTableView*>(QStringLiteral("Log_Liste"));
        view->findChild<QPushButton*>(QStringLiteral("LogClear"))->click();
    }
    std::string cell(int row, int column) const {
        return table->model()->index(row, column).data().toString().toStdString();
    }
    int rows() const { return table->model()->rowCount(); }

    LogView* view = nullptr;
    QTableView* table = nullptr;
};

TEST_F(LogViewTest, ShowsALineACommandWithTimeDirectionAndStatus) {
    open();
    clock.set(3723.5);
    click("Store_Taste_2");
    ASSERT_EQ(rows(), 1);
    EXPECT_EQ(cell(0, TrafficLog::Direction), "->");
    EXPECT_EQ(cell(0, TrafficLog::Text), ":STEREO:DIRECT \"STORE=3\"");
    EXPECT_EQ(cell(0, TrafficLog::Status), "0");
    EXPECT_EQ(cell(0, TrafficLog::Time), "01:02:03.550");
    EXPECT_EQ(folder.read("RDS_log.txt"), "");
}

TEST_F(LogViewTest, ShowsAnswersWithoutTheirControlCharacters) {
    open();
    visa.answersTo[":STEREO:DIRECT? \"PS\""] =
        "\"A\x01"
        "B\"\n";
    click("Command5");
    ASSERT_EQ(rows(), 3);  // question, answer, and what was made of it
    EXPECT_EQ(cell(0, TrafficLog::Text), ":STEREO:DIRECT? \"PS\"");
    EXPECT_EQ(cell(1, TrafficLog::Direction), "<-");
    EXPECT_EQ(cell(1, TrafficLog::Text),
              "\"A\xC2\xB7"
              "B\"");
}

TEST_F(LogViewTest, AFailureShowsItsStatus) {
    open();
    visa.writeStatus = visa::kConnectionLost;
    dialogs.expectedMessages = 1;
    click("Store_Taste_2");
    EXPECT_EQ(cell(0, TrafficLog::Status), "-1073807194");
}

TEST_F(LogViewTest, FailuresAndTextsThatEndEarlyAreRed) {
    open();
    const auto isRed = [this](int row) {
        const QVariant colour = table->model()->index(row, TrafficLog::Text).data(Qt::ForegroundRole);
        return colour.isValid() && colour.value<QBrush>().color() == Qt::red;
    };
    type("PS_T", "RADIO");
    click("PS_Taste");
    type("PS_T", "A\"B");
    click("PS_Taste");
    ASSERT_EQ(rows(), 2);
    EXPECT_FALSE(isRed(0));
    EXPECT_TRUE(isRed(1));
    dialogs.expectedMessages = 1;
    visa.writeStatus = visa::kConnectionLost;
    type("PS_T", "RADIO");
    click("PS_Taste");
    EXPECT_TRUE(isRed(2));
}

TEST_F(LogViewTest, TheFilterKeepsWhatContainsItsText) {
    open();
    click("Store_Taste_0");
    click("Store_Taste_1");
    view->findChild<QLineEdit*>(QStringLiteral("Log_Filter"))->setText(QStringLiteral("store=2"));
    EXPECT_EQ(rows(), 1);
    view->findChild<QLineEdit*>(QStringLiteral("Log_Filter"))->setText(QStringLiteral("->"));
    EXPECT_EQ(rows(), 2);
}

TEST_F(LogViewTest, CopiesTheSelectedLinesOrAllThatAreShown) {
    open();
    clock.set(3723.5);
    click("Store_Taste_0");
    click("Store_Taste_1");
    view->findChild<QPushButton*>(QStringLiteral("LogCopy"))->click();
    EXPECT_EQ(QGuiApplication::clipboard()->text().count(QLatin1Char('\n')), 2);
    table->selectRow(0);
    view->findChild<QPushButton*>(QStringLiteral("LogCopy"))->click();
    EXPECT_EQ(QGuiApplication::clipboard()->text().toStdString(), "01:02:03.550\t->\t:STEREO:DIRECT \"STORE=1\"\t0\n");
}

TEST_F(LogViewTest, CommandsComposedWithoutASessionAreMarkedAsNotSent) {
    folder.copyShipped();
    start();
    action("Mnu_Info_Log")->trigger();
    view = window->findChild<LogView*>(QStringLiteral("LogView"));
    table = view->findChild<QTableView*>(QStringLiteral("Log_Liste"));
    view->findChild<QPushButton*>(QStringLiteral("LogClear"))->click();
    session->params.SendParam("TA", std::string("1"));
    ASSERT_EQ(rows(), 1);
    EXPECT_EQ(cell(0, TrafficLog::Direction), "->");
    EXPECT_EQ(cell(0, TrafficLog::Text), direct("TA=1"));
    EXPECT_EQ(cell(0, TrafficLog::Status), "nicht gesendet");
    openSession();
    session->params.SendParam("TA", std::string("0"));
    EXPECT_EQ(cell(rows() - 1, TrafficLog::Status), "0");
}

TEST_F(LogViewTest, APauseHoldsTheListAndLosesNothing) {
    open();
    click("Log_Pause");
    click("Store_Taste_0");
    click("Store_Taste_1");
    EXPECT_EQ(rows(), 0);
    click("Log_Pause");
    ASSERT_EQ(rows(), 2);
    EXPECT_EQ(cell(1, TrafficLog::Text), direct("STORE=2"));
}

TEST_F(LogViewTest, ATipHasTheWholeTextAndItIsWrappedOnDemand) {
    open();
    std::string sequence;
    for (int i = 0; i < 80; ++i) sequence += "0A,";
    session->params.SendParam("GROUPSEQ", sequence);
    const QString tip = table->model()->index(0, TrafficLog::Text).data(Qt::ToolTipRole).toString();
    EXPECT_EQ(QString(tip).remove(QLatin1Char('\n')).toStdString(), cell(0, TrafficLog::Text));
    EXPECT_TRUE(tip.contains(QLatin1Char('\n')));
    const int line = table->rowHeight(0);
    click("Log_Umbruch");
    EXPECT_GT(table->rowHeight(0), 2 * line);
    session->params.SendParam("GROUPSEQ", sequence);
    EXPECT_GT(table->rowHeight(1), 2 * line);
    click("Log_Umbruch");
    EXPECT_EQ(table->rowHeight(0), line);
}

TEST_F(LogViewTest, WrappingKeepsTheEndInView) {
    open();
    for (int i = 0; i < 60; ++i)
        session->params.SendParam("GROUPSEQ", std::string("0A,2A,0A,2A,0A,2A,0A,2A,0A,2A,0A,2A,0A,2A,0A,2A,0A,"));
    click("Log_Umbruch");
    session->params.SendParam("TA", std::string("1"));
    QCoreApplication::processEvents();
    EXPECT_EQ(table->verticalScrollBar()->value(), table->verticalScrollBar()->maximum());
    EXPECT_GT(table->verticalScrollBar()->maximum(), 0);
    // Who reads further up is not disturbed.
    table->verticalScrollBar()->setValue(20);
    session->params.SendParam("TA", std::string("0"));
    QCoreApplication::processEvents();
    EXPECT_EQ(table->verticalScrollBar()->value(), 20);
}

TEST_F(LogViewTest, SavesTheLinesThatAreShown) {
    open();
    clock.set(3723.5);
    click("Store_Taste_0");
    click("Store_Taste_1");
    type("Log_Filter", "STORE=2");
    const auto file = folder.path() / "log.txt";
    dialogs.files = {QString::fromStdString(file.string()), QString()};
    click("Log_Sichern");
    EXPECT_EQ(folder.read("../log.txt"), "01:02:03.600\t->\t:STEREO:DIRECT \"STORE=2\"\t0\n");
    click("Log_Sichern");  // cancelled
}

TEST_F(LogViewTest, ALogThatCannotBeSavedIsTold) {
    open();
    dialogs.files = {QString::fromStdString((folder.path() / "nowhere" / "log.txt").string())};
    dialogs.expectedMessages = 1;
    click("Log_Sichern");
    EXPECT_EQ(dialogs.shown.back().icon, Dialogs::Icon::Critical);
}

TEST_F(LogViewTest, TheFilesOfTheProgramAreNotReplaced) {
    folder.copyShipped();
    folder.write("opened.ini", "[RDS]\r\nPS=ANDERS\r\n");
    const auto opened = folder.data() / "opened.ini";
    setGeneral("ADRESSEN", "Log_Key", "1");
    start();
    openSession();
    action("Mnu_Info_Log")->trigger();
    state.openedFile = opened.string();
    ASSERT_NE(folder.read("RDS_log.txt"), "");
    for (const char* name :
         {"RDS_log.txt", "Datenset1.INI", "Datenset4.INI", "RDS_Allg.INI", "Sprachen.ini", "Event.txt", "opened.ini"}) {
        const std::string before = folder.read(name);
        dialogs.files = {QString::fromStdString((folder.data() / name).string())};
        dialogs.expectedMessages = 1;
        click("Log_Sichern");
        EXPECT_EQ(folder.read(name), before) << name;
        EXPECT_EQ(dialogs.shown.back().preset.toStdString(),
                  "Diese Datei gehört dem Programm: bitte eine andere wählen.");
    }
    dialogs.files = {QString::fromStdString((folder.data() / "saved.txt").string())};
    click("Log_Sichern");
    EXPECT_NE(folder.read("saved.txt"), "");
}

TEST_F(LogViewTest, NothingIsCutOffInAnyLanguageAtAnySizeOfLetters) {
    folder.copyShipped();
    expectNothingCutOffAnywhere([this](const char* language) -> QWidget& {
        setGeneral("Sprache", "Sprache", language);
        start();
        action("Mnu_Info_Log")->trigger();
        openSession();
        return *window->findChild<LogView*>(QStringLiteral("LogView"));
    });
}

TEST_F(LogViewTest, EveryButtonHasAKeyOfItsOwn) {
    for (const char* language : {"deutsch", "english", "english US"}) {
        folder.copyShipped();
        setGeneral("Sprache", "Sprache", language);
        start();
        action("Mnu_Info_Log")->trigger();
        view = window->findChild<LogView*>(QStringLiteral("LogView"));
        QCoreApplication::processEvents();
        std::map<QString, QString> mnemonics;
        for (const QAbstractButton* button : view->findChildren<QPushButton*>()) {
            const QString key = QKeySequence::mnemonic(button->text()).toString();
            EXPECT_FALSE(key.isEmpty()) << button->text().toStdString();
            EXPECT_TRUE(mnemonics.emplace(key, button->text()).second) << language << ' ' << key.toStdString();
        }
    }
}

TEST_F(LogViewTest, KeepsSomeThousandsOfLinesAndForgetsTheOldest) {
    start();
    TrafficLog log(session->instrument, clock, nullptr);
    for (int i = 0; i < 5000; ++i) log.passed({Traffic::Kind::Written, std::to_string(i), 0});
    EXPECT_EQ(log.rowCount(), static_cast<int>(TrafficLog::kMostLines));
    EXPECT_EQ(log.index(0, TrafficLog::Text).data().toString(), QStringLiteral("1000"));
}

TEST_F(LogViewTest, SpeaksTheLanguageOfTheWindow) {
    open();
    EXPECT_EQ(table->model()->headerData(0, Qt::Horizontal).toString(), QStringLiteral("Zeit"));
    action("Mnu_Info_Sprache_E")->trigger();
    EXPECT_EQ(table->model()->headerData(0, Qt::Horizontal).toString(), QStringLiteral("Time"));
    EXPECT_EQ(view->findChild<QPushButton*>(QStringLiteral("LogCopy"))->text(), QStringLiteral("&Copy"));
}

}  // namespace
}  // namespace kdx::test
