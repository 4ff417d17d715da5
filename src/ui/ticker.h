#pragma once

#include <QTimer>

namespace kdx {

/// A timer of the window: it ticks while it is enabled and its interval is above 0, as the window's timers are
/// described; setting either starts the interval anew. A tick whose handler still runs (it may be showing a box) lets
/// no further tick of its own in.
class Ticker : public QTimer {
    Q_OBJECT
public:
    /// Longest interval a timer takes, in milliseconds.
    static constexpr int kLongestInterval = 65535;

    explicit Ticker(QObject* parent);

    void setEnabled(bool enabled);
    [[nodiscard]] bool isEnabled() const { return m_enabled; }

    /// @param milliseconds 0 to 65535; 0 stops the ticks. @throws std::out_of_range beyond, and nothing changes.
    void setPeriod(double milliseconds);
    [[nodiscard]] int period() const { return m_period; }

    /// Holds all ticks back, as while a box about a broken link waits for the user; letting go starts the interval
    /// anew.
    void setHeld(bool held);

protected:
    void timerEvent(QTimerEvent* event) override;

private:
    void apply();

    bool m_enabled = false;
    bool m_held = false;
    bool m_ticking = false;
    int m_period = 0;
};

}  // namespace kdx
