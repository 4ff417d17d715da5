#include "window/waysouttest.h"

#include <QPushButton>

namespace kdx::test {
namespace {

using namespace std::chrono_literals;

constexpr auto kAtOnce = 300ms;

class WaitingTest : public WaysOutTest {};

TEST_F(WaitingTest, StopEndsARunAtOnceAlsoWhenTheCallCannotBeEnded) {
    startAndOpen();
    for (const bool abortable : {true, false}) {
        hangAnd([this] { stop(); }, abortable);
        click("Btn_SetRdsStereo");
        EXPECT_LT(sinceStop(), kAtOnce);
        EXPECT_EQ(sent().size(), 1U) << "the rest is not sent";
        EXPECT_FALSE(find("Stop_Taste")->isVisible());
        EXPECT_TRUE(find("SSTab1")->isEnabled()) << "the session stays open";
        EXPECT_EQ(text("Verbindung_Anzeige"), "verbunden: 127.0.0.1") << "who stops it has lost nothing";
        slow->goOn();
        click("Store_Taste_0");
        EXPECT_EQ(sent(), Lines{direct("STORE=1")});
    }
}

TEST_F(WaitingTest, EscapeIsStop) {
    startAndOpen();
    hangAnd([this] { key(window.get(), Qt::Key_Escape); });
    click("Btn_SetRdsStereo");
    EXPECT_EQ(sent().size(), 1U);
}

TEST_F(WaitingTest, StopEndsAnOpeningThatFindsNobody) {
    startShipped();
    std::string waitsFor;
    hangAnd([this, &waitsFor] {
        waitsFor = text("QuietLine");
        stop();
    });
    const std::string quiet = text("QuietLine");
    openSession();
    EXPECT_LT(sinceStop(), kAtOnce);
    EXPECT_EQ(waitsFor, "Wartet auf " + text("Adr1_Label"));
    EXPECT_EQ(text("QuietLine"), quiet);
    EXPECT_TRUE(dialogs.shown.empty()) << "the user knows";
    EXPECT_FALSE(find("SSTab1")->isEnabled());
    EXPECT_TRUE(find("INIT_Taste")->isEnabled());
    slow->goOn();
    openSession();
    EXPECT_TRUE(find("SSTab1")->isEnabled());
    EXPECT_EQ(closings(), 1) << "of the session that opened too late";
}

TEST_F(WaitingTest, TheCallsOfALaterRunWaitTheirTurnBehindTheOneThatHangs) {
    startAndOpen();
    hangAnd([this] { stop(); });
    click("Btn_SetRdsStereo");
    hangAnd([this] { stop(); });
    click("Btn_SetRdsStereo");
    EXPECT_LT(sinceStop(), kAtOnce);
    EXPECT_EQ(sent().size(), 1U) << "of the first run";
    EXPECT_EQ(slow->mostAtOnce(), 1);
}

TEST_F(WaitingTest, WhatIsPressedAndTypedDuringARunIsDropped) {
    startAndOpen();
    showPage(1);
    const std::string ps = text("PS_T");
    find("PS_T")->setFocus();
    hangAnd([this] {
        mouse("PS_Taste");
        key(find("PS_T"), Qt::Key_X, QStringLiteral("X"));
        mouse("INIT_Taste");
        mouse("GTL_Taste");
        slow->goOn();
    });
    window->SetRdsStereo();
    EXPECT_GT(sent().size(), 20U) << "the run went on";
    QCoreApplication::processEvents();
    EXPECT_EQ(sent(), Lines{}) << "and nothing came after it";
    EXPECT_EQ(text("PS_T"), ps);
    EXPECT_TRUE(find("SSTab1")->isEnabled());
}

TEST_F(WaitingTest, StopStandsThereDuringEveryRunAndOnlyThen) {
    std::vector<bool> visible;
    heard = [&](const Traffic& traffic) {
        if (traffic.kind != Traffic::Kind::Logged) visible.push_back(find("Stop_Taste")->isVisible());
    };
    startShipped();
    const auto seen = [&](const std::function<void()>& action) {
        visible.clear();
        slow->script().answers.assign(10, "0\n");
        action();
        EXPECT_FALSE(find("Stop_Taste")->isVisible());
        EXPECT_FALSE(visible.empty());
        const auto count = std::count(visible.begin(), visible.end(), true);
        EXPECT_TRUE(count == 0 || count == static_cast<std::ptrdiff_t>(visible.size())) << "during the whole run";
        return count > 0;
    };
    EXPECT_TRUE(seen([this] { openSession(); }));
    EXPECT_TRUE(seen([this] { click("Btn_SetRdsStereo"); }));
    EXPECT_TRUE(seen([this] { click("Command1"); })) << "four questions";
    EXPECT_TRUE(seen([this] { click("EON_PI_Taste"); }));
    EXPECT_FALSE(seen([this] { click("Store_Taste_0"); })) << "a single command";
    EXPECT_FALSE(seen([this] { click("Command5"); })) << "a single question";
}

TEST_F(WaitingTest, ASlowSingleCommandShowsItAndDropsWhatIsDone) {
    startAndOpen();
    Qt::CursorShape shape = Qt::ArrowCursor;
    hangAnd([&] {
        QTimer::singleShot(250ms, window.get(), [&] {
            if (const QCursor* cursor = QApplication::overrideCursor()) shape = cursor->shape();
            EXPECT_FALSE(find("Stop_Taste")->isVisible());
            mouse("Store_Taste_1");
            slow->goOn();
        });
    });
    click("Store_Taste_0");
    EXPECT_EQ(shape, Qt::WaitCursor);
    EXPECT_EQ(QApplication::overrideCursor(), nullptr) << "it is gone again";
    QCoreApplication::processEvents();
    EXPECT_EQ(sent(), Lines{direct("STORE=1")});
}

TEST_F(WaitingTest, AButtonThatWasPressedBeforeIsReleasedAfterTheWait) {
    startAndOpen();
    showPage(1);
    auto* button = find<QPushButton>("PS_Taste");
    mouse(button, QEvent::MouseButtonPress);
    hangAnd([&] {
        mouse(button, QEvent::MouseButtonRelease);
        EXPECT_TRUE(button->isDown());
        slow->goOn();
    });
    window->SetRdsStereo();
    sent();
    QCoreApplication::processEvents();
    EXPECT_FALSE(button->isDown());
    EXPECT_EQ(sent().size(), 1U);
}

TEST_F(WaitingTest, ATimerWhoseTimeComesTicksOnceAfterTheWait) {
    startAndOpen();
    Ticker ticker(tickers, nullptr);
    int ticks = 0;
    QObject::connect(&ticker, &Ticker::timeout, &ticker, [&] { ++ticks; });
    ticker.setPeriod(20);
    ticker.setEnabled(true);
    hangAnd([&] {
        QTimer::singleShot(100ms, window.get(), [&] {
            EXPECT_EQ(ticks, 0);
            slow->goOn();
        });
    });
    click("Store_Taste_0");
    EXPECT_EQ(ticks, 0);
    ticker.setPeriod(20);
    EXPECT_EQ(ticks, 0) << "a timer that was set anew meanwhile is another one";
    hangAnd([&] { QTimer::singleShot(50ms, window.get(), [this] { slow->goOn(); }); });
    click("Store_Taste_0");
    QCoreApplication::sendPostedEvents();
    EXPECT_EQ(ticks, 1);
}

TEST_F(WaitingTest, TheWindowIsPaintedMeanwhile) {
    startAndOpen();
    class Painted final : public QWidget {
    public:
        using QWidget::QWidget;
        void paintEvent(QPaintEvent*) override { ++paintings; }
        int paintings = 0;
    };
    Painted widget(window.get());
    widget.setGeometry(0, 0, 10, 10);
    widget.show();
    QCoreApplication::processEvents();
    int before = 0;
    hangAnd([&] {
        before = widget.paintings;
        widget.update();
        QTimer::singleShot(100ms, window.get(), [this] { slow->goOn(); });
    });
    window->SetRdsStereo();
    EXPECT_GT(widget.paintings, before);
}

TEST_F(WaitingTest, ClosingWhileARunGoesOutAsksAndNoGoesOn) {
    startAndOpen();
    dialogs.confirmations = {false};
    hangAnd([this] {
        window->close();
        QTimer::singleShot(0, window.get(), [this] { slow->goOn(); });
    });
    window->SetRdsStereo();
    EXPECT_GT(sent().size(), 20U);
    QCoreApplication::processEvents();
    EXPECT_TRUE(window->isVisible());
    ASSERT_EQ(dialogs.shown.size(), 1U);
    EXPECT_EQ(dialogs.shown[0].text, QStringLiteral("Es wird gerade gesendet. Abbrechen und das Programm beenden?"));
}

TEST_F(WaitingTest, ClosingWhileARunGoesOutEndsItAndTheSession) {
    startAndOpen();
    cycleMessages();
    dialogs.confirmations = {true};
    hangAnd([this] { window->close(); }, true);
    window->SetRdsStereo();
    EXPECT_EQ(sent().size(), 1U);
    slow->goOn();
    QCoreApplication::processEvents();
    EXPECT_FALSE(window->isVisible());
    EXPECT_EQ(closings(), 1);
    EXPECT_EQ(dialogs.shown.size(), 1U) << "one question is enough";
}

TEST_F(WaitingTest, TheEndOfTheProgramIsNotHeldUp) {
    startAndOpen();
    dialogs.stopAtFailure = true;
    hangAnd([this] {
        dialogs.ending = true;
        window->close();
    });
    window->SetRdsStereo();
    EXPECT_EQ(sent().size(), 1U);
    EXPECT_FALSE(window->isVisible());
    slow->goOn();
}

}  // namespace
}  // namespace kdx::test
