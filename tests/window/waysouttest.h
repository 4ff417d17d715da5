#pragma once

#include <chrono>
#include <functional>
#include <memory>
#include <thread>

#include "link/workervisa.h"
#include "support/hangingvisa.h"
#include "support/windowtest.h"

namespace kdx::test {

/// The whole window on an instrument that can be made to hang, its calls in a thread of their own as in the program.
class WaysOutTest : public WindowTest {
protected:
    WaysOutTest();
    ~WaysOutTest() override;
    Visa& instrumentLink() override { return *worker(); }
    WorkerVisa* worker() override;

    void startAndOpen();
    /// Every command sent since the last call.
    Lines sent();
    std::ptrdiff_t closings();
    /// From now on the instrument hangs; as soon as a call does, the user acts. @param abortable see HangingVisa.
    void hangAnd(const std::function<void()>& act, bool abortable = false);
    /// Presses or releases the left button over a control.
    static void mouse(QWidget* control, QEvent::Type type);
    void mouse(const char* name);
    static void key(QWidget* control, Qt::Key key, const QString& text = {});
    /// Presses "Stop", and notes when.
    void stop();
    [[nodiscard]] std::chrono::duration<double> sinceStop() const { return std::chrono::steady_clock::now() - stopped; }
    void cycleMessages();
    void announceAutomatically();
    /// An announcement by hand, so that there is one of the other network to refer to.
    void announceOnTheOtherNetwork();
    /// No keeps the window and what runs, Yes ends both.
    void expectClosingAsksAbout(const QString& running);

    std::shared_ptr<HangingVisa> slow = std::make_shared<HangingVisa>();
    std::chrono::steady_clock::time_point stopped;

private:
    std::unique_ptr<WorkerVisa> m_worker;
    std::thread m_other;
    std::size_t m_seen = 0;
};

}  // namespace kdx::test
