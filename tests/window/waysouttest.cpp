#include "window/waysouttest.h"

#include <QMouseEvent>

#include <algorithm>
#include <utility>

namespace kdx::test {

WaysOutTest::WaysOutTest() {
    slow->script().answersTo["*IDN?"] = "KDX,TEST\n";
    slow->script().answersTo[coder("EON PI?")] = "\" \"\n";
}

WaysOutTest::~WaysOutTest() {
    slow->goOn();
    if (m_other.joinable()) m_other.join();
    end();
}

WorkerVisa* WaysOutTest::worker() {
    if (m_worker == nullptr) m_worker = std::make_unique<WorkerVisa>(slow);
    return m_worker.get();
}

void WaysOutTest::startAndOpen() {
    startShipped();
    openSession();
    sent();
}

Lines WaysOutTest::sent() {
    Lines lines;
    const auto calls = slow->calls();
    for (std::size_t at = std::exchange(m_seen, calls.size()); at < calls.size(); ++at) {
        if (calls[at].starts_with("write ")) lines.push_back(calls[at].substr(6));
    }
    return lines;
}

std::ptrdiff_t WaysOutTest::closings() {
    const auto calls = slow->calls();
    return std::count(calls.begin(), calls.end(), "close");
}

void WaysOutTest::hangAnd(const std::function<void()>& act, bool abortable) {
    if (m_other.joinable()) m_other.join();
    slow->hang(abortable);
    m_other = std::thread([this, act] {
        slow->waitForCall();
        QMetaObject::invokeMethod(window.get(), act, Qt::QueuedConnection);
    });
}

void WaysOutTest::mouse(QWidget* control, QEvent::Type type) {
    const QPointF at = control->rect().center();
    const bool pressed = type == QEvent::MouseButtonPress;
    QMouseEvent event(type, at, control->mapToGlobal(at), Qt::LeftButton, pressed ? Qt::LeftButton : Qt::NoButton,
                      Qt::NoModifier);
    QApplication::sendEvent(control, &event);
}

void WaysOutTest::mouse(const char* name) {
    for (const auto type : {QEvent::MouseButtonPress, QEvent::MouseButtonRelease}) mouse(find(name), type);
}

void WaysOutTest::key(QWidget* control, Qt::Key key, const QString& text) {
    for (const auto type : {QEvent::KeyPress, QEvent::KeyRelease}) {
        QKeyEvent event(type, key, Qt::NoModifier, text);
        QApplication::sendEvent(control, &event);
    }
}

void WaysOutTest::stop() {
    stopped = std::chrono::steady_clock::now();
    mouse("Stop_Taste");
}

void WaysOutTest::cycleMessages() {
    click("TMC_Gr8_apply");
    click("optMultiMessage");
    click("TMC_Senden_Taste");
}

void WaysOutTest::announceAutomatically() {
    if (!checked("Check1")) click("Check1");
    click("TA_Option_1");
}

void WaysOutTest::announceOnTheOtherNetwork() {
    if (!checked("Check1")) click("Check1");
    click("TA_Check");
    click("Check1");
    if (!checked("EON_TP_Check")) click("EON_TP_Check");
    click("EON_TA_Schalter");
}

void WaysOutTest::expectClosingAsksAbout(const QString& running) {
    dialogs.confirmations = {false};
    EXPECT_FALSE(window->close());
    EXPECT_TRUE(window->isVisible());
    EXPECT_TRUE(find("Panik_Taste")->isVisible()) << "it goes on";
    dialogs.confirmations = {true};
    EXPECT_TRUE(window->close());
    ASSERT_EQ(dialogs.shown.size(), 2U);
    for (const auto& box : dialogs.shown)
        EXPECT_EQ(box.text, QStringLiteral("Es läuft noch: %1. Anhalten und das Programm beenden?").arg(running));
    EXPECT_EQ(closings(), 1);
}

}  // namespace kdx::test
