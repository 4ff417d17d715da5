#include "tmc/runline.h"

#include "base/clock.h"
#include "coder/keyfacts.h"
#include "settings/programstate.h"
#include "tmc/groupcode.h"
#include "tmc/settings.h"
#include "ui/caption.h"
#include "ui/elided.h"
#include "ui/text.h"

namespace kdx {

RunLine::RunLine(const PageContext& with, QWidget* parent) : QLabel(parent), m_with(with) {
    setSizePolicy(QSizePolicy::Ignored, QSizePolicy::Preferred);  // a long line does not widen the page
    elideLongText(*this);
}

void RunLine::label() {
    setText(text());
    setToolTip(text());
}

void RunLine::begin(int milliseconds, bool once) {
    m_running = true;
    m_once = once;
    m_interval = milliseconds;
    m_count = 0;
    m_since = timeText(m_with.clock);
    label();
}

void RunLine::sent(const std::string& code, int number, int messages) {
    ++m_count;
    m_code = code;
    m_number = number;
    m_messages = messages;
    label();
}

void RunLine::end() {
    m_running = false;
    m_until = timeText(m_with.clock);
    label();
}

QString RunLine::seconds() const {
    constexpr double kPerSecond = 1000;
    return numberLocale(m_with.state.language).toString(m_interval / kPerSecond, 'g', QLocale::FloatingPointShortest);
}

QString RunLine::shownCode() const {
    QString code = toText(m_code);
    if (!wrongValue(setting::kTrafficMessage.sendKey, sentMessage(m_code))) return code;
    return QStringLiteral("%1 (%2)").arg(code, captionText(m_with.captions, {1091, "vom Coder abgelehnt"}));
}

QString RunLine::text() const {
    const auto say = [this](const Caption& caption) { return captionText(m_with.captions, caption); };
    if (m_running && m_interval == 0)
        return say({880, "Wechselzeit 0: Es wird nichts gesendet, bis eine andere gilt."});
    if (m_running && m_once) return say({881, "Sendet eine Meldung nach %1 s."}).arg(seconds());
    if (m_running && m_count == 0)
        return say({882, "Sendet alle %1 s eine Meldung, seit %2, bis zum Anhalten."}).arg(seconds(), toText(m_since));
    if (m_running) {
        return say({883, "Sendet %1 (%2 von %3) alle %4 s, %5-mal seit %6, bis zum Anhalten."})
            .arg(shownCode())
            .arg(m_number)
            .arg(m_messages)
            .arg(seconds())
            .arg(m_count)
            .arg(toText(m_since));
    }
    if (m_count == 0) return say({884, "Es wird nichts gesendet."});
    return say({885, "Gesendet: %1-mal von %2 bis %3, zuletzt %4."})
        .arg(m_count)
        .arg(toText(m_since), toText(m_until), shownCode());
}

}  // namespace kdx
