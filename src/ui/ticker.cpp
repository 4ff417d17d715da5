#include "ui/ticker.h"

#include <QScopedValueRollback>

#include <cmath>
#include <stdexcept>

namespace kdx {

void TickerGroup::setHeld(bool held) {
    m_held = held;
    for (Ticker* ticker : m_tickers) ticker->apply();  // letting go starts each interval anew
}

Ticker::Ticker(TickerGroup& group, QObject* parent) : QTimer(parent), m_group(group) {
    m_group.m_tickers.push_back(this);
    setTimerType(Qt::PreciseTimer);  // the default timer is up to 50 ms late
}

Ticker::~Ticker() {
    std::erase(m_group.m_tickers, this);
}

void Ticker::setEnabled(bool enabled) {
    m_enabled = enabled;
    apply();
}

void Ticker::setPeriod(double milliseconds) {
    const double whole = std::nearbyint(milliseconds);
    if (!(whole >= 0 && whole <= kLongestInterval)) throw std::out_of_range("timer interval");
    m_period = static_cast<int>(whole);
    apply();
}

void Ticker::timerEvent(QTimerEvent* event) {
    if (m_ticking) return;
    const QScopedValueRollback ticking(m_ticking, true);
    QTimer::timerEvent(event);
}

void Ticker::apply() {
    if (m_enabled && !m_group.m_held && m_period > 0) {
        start(m_period);
    } else {
        stop();
    }
}

}  // namespace kdx
