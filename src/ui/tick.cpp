#include "ui/tick.h"

#include <utility>

#include "ui/caption.h"
#include "ui/ticker.h"

namespace kdx {

Tick::Tick(const PageContext& with, QString name, std::function<void()> stop)
    : m_with(with),
      m_sequence(with.instrument, CommandSequence::Kind::Tick),
      m_name(std::move(name)),
      m_stop(std::move(stop)),
      m_around(std::exchange(with.tickers.m_tick, this)) {}

Tick::~Tick() {
    m_with.tickers.m_tick = m_around;
    if (m_stopped) m_stop();  // the sequence is still there, and stopped: switching off sends nothing
}

void Tick::stop() {
    m_stopped = true;
    m_with.instrument.stopSequence();
}

QString Tick::stopText() const {
    return captionText(m_with.captions, {835, "%1 &stoppen"}).arg(m_name);
}

void Tick::tell(Dialogs::Icon icon, const QString& title, const QString& text) {
    if (m_with.dialogs.messageOrStop(title, text, {}, stopText(), icon)) stop();
}

}  // namespace kdx
