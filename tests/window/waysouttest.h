#pragma once

#include <QMouseEvent>
#include <QPushButton>

#include <chrono>
#include <memory>
#include <thread>

#include "link/workervisa.h"
#include "support/hangingvisa.h"
#include "support/windowtest.h"

namespace kdx::test {

/// The whole window on an instrument that can be made to hang, its calls in a thread of their own as in the program.
class WaysOutTest : public WindowTest {
protected:
    WaysOutTest() {
        slow->script().answersTo["*IDN?"] = "KDX,TEST\n";
        slow->script().answersTo[coder("EON PI?")] = "\" \"\n";
    }
    ~WaysOutTest() override {
        slow->goOn();
        if (m_other.joinable()) m_other.join();
        end();
    }
    Visa& instrumentLink() override { return *worker(); }
    WorkerVisa* worker() override {
        if (m_worker == nullptr) m_worker = std::make_unique<WorkerVisa>(slow);
        return m_worker.get();
    }

    void startAndOpen() {
        startShipped();
        openSession();
        sent();
    }
    /// Every command sent since the last call.
    Lines sent() {
        Lines lines;
        const auto calls = slow->calls();
        for (std::size_t at = std::exchange(m_seen, calls.size()); at < calls.size(); ++at) {
            if (calls[at].starts_with("write ")) lines.push_back(calls[at].substr(6));
        }
        return lines;
    }
    std::ptrdiff_t closings() {
        const auto calls = slow->calls();
        return std::count(calls.begin(), calls.end(), "close");
    }
    /// From now on the instrument hangs; as soon as a call does, the user acts. @param abortable see HangingVisa.
    void hangAnd(const std::function<void()>& act, bool abortable = false) {
        if (m_other.joinable()) m_other.join();
        slow->hang(abortable);
        m_other = std::thread([this, act] {
            slow->waitForCall();
            QMetaObject::invokeMethod(window.get(), act, Qt::QueuedConnection);
        });
    }
    /// Presses or releases the left button over a control.
    static void mouse(QWidget* control, QEvent::Type type) {
        const QPointF at = control->rect().center();
        const bool pressed = type == QEvent::MouseButtonPress;
        QMouseEvent event(type, at, control->mapToGlobal(at), Qt::LeftButton, pressed ? Qt::LeftButton : Qt::NoButton,
                          Qt::NoModifier);
        QApplication::sendEvent(control, &event);
    }
    void mouse(const char* name) {
        for (const auto type : {QEvent::MouseButtonPress, QEvent::MouseButtonRelease}) mouse(find(name), type);
    }
    static void key(QWidget* control, Qt::Key key, const QString& text = {}) {
        for (const auto type : {QEvent::KeyPress, QEvent::KeyRelease}) {
            QKeyEvent event(type, key, Qt::NoModifier, text);
            QApplication::sendEvent(control, &event);
        }
    }
    /// Presses "Stop", and notes when.
    void stop() {
        stopped = std::chrono::steady_clock::now();
        mouse("Stop_Taste");
    }
    [[nodiscard]] std::chrono::duration<double> sinceStop() const { return std::chrono::steady_clock::now() - stopped; }
    void cycleMessages() {
        click("TMC_Gr8_apply");
        click("optMultiMessage");
        click("TMC_Senden_Taste");
    }
    void announceAutomatically() {
        if (!checked("Check1")) click("Check1");
        click("TA_Option_1");
    }
    /// An announcement by hand, so that there is one of the other network to refer to.
    void announceOnTheOtherNetwork() {
        if (!checked("Check1")) click("Check1");
        click("TA_Check");
        click("Check1");
        if (!checked("EON_TP_Check")) click("EON_TP_Check");
        click("EON_TA_Schalter");
    }
    /// No keeps the window and what runs, Yes ends both.
    void expectClosingAsksAbout(const QString& running) {
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

    std::shared_ptr<HangingVisa> slow = std::make_shared<HangingVisa>();
    std::chrono::steady_clock::time_point stopped;

private:
    std::unique_ptr<WorkerVisa> m_worker;
    std::thread m_other;
    std::size_t m_seen = 0;
};

}  // namespace kdx::test
