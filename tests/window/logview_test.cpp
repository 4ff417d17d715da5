#include "window/logview.h"

#include <gtest/gtest.h>

#include <QClipboard>
#include <QGuiApplication>
#include <QPushButton>
#include <QTableView>

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
        table = view->findChild<QTableView*>(QStringLiteral("LogTable"));
        view->findChild<QPushButton*>(QStringLiteral("LogClear"))->click();
    }
    std::string cell(int row, int column) const {
        return table->model()->index(row, column).data().toString().toStdString();
    }
    int rows() const { return table->model()->rowCount(); }

    LogView* view = nullptr;
    QTableView* table = nullptr;
};

TEST_F(LogViewTest, ShowsEachLineAsItIsLoggedWithTimeDirectionAndStatus) {
    open();
    clock.set(3723.5);
    click("Store_Taste_2");
    ASSERT_EQ(rows(), 2);
    EXPECT_EQ(cell(0, TrafficLog::Direction), "log");
    EXPECT_EQ(cell(0, TrafficLog::Text), "          STORE= \":STEREO:DIRECT \"STORE=3\"\"");
    EXPECT_EQ(cell(0, TrafficLog::Time), "01:02:03.500");
    EXPECT_EQ(cell(1, TrafficLog::Direction), "->");
    EXPECT_EQ(cell(1, TrafficLog::Text), ":STEREO:DIRECT \"STORE=3\"");
    EXPECT_EQ(cell(1, TrafficLog::Status), "0");
    EXPECT_EQ(cell(1, TrafficLog::Time), "01:02:03.550");
    EXPECT_EQ(folder.read("RDS_log.txt"), "");
}

TEST_F(LogViewTest, ShowsAnswersWithoutTheirControlCharacters) {
    open();
    visa.answersTo[":STEREO:DIRECT? \"PS\""] =
        "\"A\x01"
        "B\"\n";
    click("Command5");
    ASSERT_EQ(rows(), 5);  // question, its log line, answer, two log lines
    EXPECT_EQ(cell(2, TrafficLog::Direction), "<-");
    EXPECT_EQ(cell(2, TrafficLog::Text),
              "\"A\xC2\xB7"
              "B\"");
}

TEST_F(LogViewTest, AFailureShowsItsStatus) {
    open();
    visa.writeStatus = visa::kConnectionLost;
    dialogs.expectedMessages = 1;
    click("Store_Taste_2");
    EXPECT_EQ(cell(1, TrafficLog::Status), "-1073807194");
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
    ASSERT_EQ(rows(), 4);  // a log line before each command
    EXPECT_FALSE(isRed(1));
    EXPECT_TRUE(isRed(3));
    dialogs.expectedMessages = 1;
    visa.writeStatus = visa::kConnectionLost;
    type("PS_T", "RADIO");
    click("PS_Taste");
    EXPECT_TRUE(isRed(5));
}

TEST_F(LogViewTest, TheFilterKeepsWhatContainsItsText) {
    open();
    click("Store_Taste_0");
    click("Store_Taste_1");
    view->findChild<QLineEdit*>(QStringLiteral("LogFilter"))->setText(QStringLiteral("store=2"));
    EXPECT_EQ(rows(), 2);
    view->findChild<QLineEdit*>(QStringLiteral("LogFilter"))->setText(QStringLiteral("->"));
    EXPECT_EQ(rows(), 2);
}

TEST_F(LogViewTest, CopiesTheSelectedLinesOrAllThatAreShown) {
    open();
    clock.set(3723.5);
    click("Store_Taste_0");
    click("Store_Taste_1");
    view->findChild<QPushButton*>(QStringLiteral("LogCopy"))->click();
    EXPECT_EQ(QGuiApplication::clipboard()->text().count(QLatin1Char('\n')), 4);
    table->selectRow(1);
    view->findChild<QPushButton*>(QStringLiteral("LogCopy"))->click();
    EXPECT_EQ(QGuiApplication::clipboard()->text().toStdString(), "01:02:03.550\t->\t:STEREO:DIRECT \"STORE=1\"\t0\n");
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
