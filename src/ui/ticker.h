#pragma once

#include <QTimer>

#include <vector>

#include "ui/automatics.h"

namespace kdx {

class Tick;
class Ticker;

/// The window's timers, to be held all at once: while a box about a broken link waits for the user, and while a closed
/// session must not be sent to.
class TickerGroup {
public:
    /// Holds all ticks back, or lets them go; timers made later follow.
    void setHeld(bool held);
    /// What they drive.
    [[nodiscard]] Automatics& automatics() { return m_automatics; }
    /// What is being sent by one of them; null when none is.
    [[nodiscard]] Tick* tick() const { return m_tick; }

private:
    friend class Tick;
    friend class Ticker;
    std::vector<Ticker*> m_tickers;
    Automatics m_automatics;
    Tick* m_tick = nullptr;
    bool m_held = false;
};

/// A timer of the window: it ticks while it is enabled and its interval is above 0, as the window's timers are
/// described; setting either starts the interval anew. A tick whose handler still runs (it may be showing a box) lets
/// no further tick of its own in.
class Ticker : public QTimer {
    Q_OBJECT
public:
    /// Longest interval a timer takes, in milliseconds.
    static constexpr int kLongestInterval = 65535;

    /// @param group may hold the ticks back; it outlives the timer.
    Ticker(TickerGroup& group, QObject* parent);
    ~Ticker() override;

    void setEnabled(bool enabled);
    [[nodiscard]] bool isEnabled() const { return m_enabled; }

    /// @param milliseconds 0 to 65535; 0 stops the ticks. @throws std::out_of_range beyond, and nothing changes.
    void setPeriod(double milliseconds);
    [[nodiscard]] int period() const { return m_period; }

protected:
    void timerEvent(QTimerEvent* event) override;

private:
    friend class TickerGroup;
    void apply();

    TickerGroup& m_group;
    bool m_enabled = false;
    bool m_ticking = false;
    int m_period = 0;
};

}  // namespace kdx
