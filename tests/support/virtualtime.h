#pragma once

#include <QApplication>
#include <QTimerEvent>
#include <QWidget>

#include <chrono>
#include <map>

#include "support/fakeclock.h"
#include "ui/ticker.h"

namespace kdx::test {

/// Runs a window's timers by the test's clock: hours pass in seconds, and a tick comes exactly when the clock says so.
/// Ticks of real time are kept away. The clock must not pass midnight.
class VirtualTime final : public QObject {
public:
    /// @param window its timers are the ones it has now.
    VirtualTime(FakeClock& clock, const QWidget& window) : m_clock(clock), m_tickers(window.findChildren<Ticker*>()) {
        qApp->installEventFilter(this);
        lookForStarts();
    }

    /// Lets each timer tick when its time comes, the earliest first; gives how many ticks there were. The clock goes on
    /// beyond the end when a handler takes so long.
    int advance(std::chrono::duration<double> duration) {
        const double end = now() + duration.count();
        int ticks = 0;
        for (;;) {
            lookForStarts();
            auto next = m_due.end();
            for (auto it = m_due.begin(); it != m_due.end(); ++it) {
                if (next == m_due.end() || it->second.at < next->second.at) next = it;
            }
            if (next == m_due.end() || next->second.at > end) {
                waitUntil(end);
                return ticks;
            }
            waitUntil(next->second.at);
            // As the real timers: what was missed while a handler ran is not made up for.
            const double interval = next->first->interval() / 1000.0;
            next->second.at += interval;
            if (next->second.at < now()) next->second.at = now() + interval;
            tick(*next->first);
            ++ticks;
        }
    }

    bool eventFilter(QObject* watched, QEvent* event) override {
        return event->type() == QEvent::Timer && event != m_letIn && qobject_cast<Ticker*>(watched) != nullptr;
    }

private:
    struct Due {
        int timerId;
        double at;  ///< seconds since midnight
    };

    [[nodiscard]] double now() const { return m_clock.secondsSinceMidnight(); }

    /// A timer that was started has a new identification and counts its interval from now.
    void lookForStarts() {
        for (Ticker* ticker : m_tickers) {
            if (!ticker->isActive()) {
                m_due.erase(ticker);
                continue;
            }
            const auto known = m_due.find(ticker);
            if (known != m_due.end() && known->second.timerId == ticker->timerId()) continue;
            m_due[ticker] = {ticker->timerId(), now() + ticker->interval() / 1000.0};
        }
    }

    void waitUntil(double time) {
        const std::chrono::duration<double> left{time - now()};
        if (left.count() > 0) m_clock.advance(std::chrono::round<std::chrono::nanoseconds>(left));
    }

    void tick(Ticker& ticker) {
        QTimerEvent event(ticker.timerId());
        m_letIn = &event;
        QApplication::sendEvent(&ticker, &event);
        m_letIn = nullptr;
    }

    FakeClock& m_clock;
    QList<Ticker*> m_tickers;
    std::map<Ticker*, Due> m_due;
    const QEvent* m_letIn = nullptr;
};

}  // namespace kdx::test
