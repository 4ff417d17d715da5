#include "window/waysout.h"

#include <QMainWindow>
#include <QPushButton>

#include "settings/programstate.h"
#include "station/session.h"
#include "ui/dialogs.h"
#include "ui/text.h"
#include "ui/tick.h"
#include "ui/ticker.h"
#include "window/failurehint.h"
#include "window/progressline.h"

namespace kdx {

namespace {

const Caption kCloseWhileSending{832, "Es wird gerade gesendet. Abbrechen und das Programm beenden?"};
const Caption kCloseWhileRunning{833, "Es läuft noch: %1. Anhalten und das Programm beenden?"};

}  // namespace

WaysOut::WaysOut(const Surroundings& surroundings, const ProgressLine& lowerEdge, QMainWindow* window)
    : QObject(window),
      m_s(surroundings),
      m_lowerEdge(lowerEdge),
      m_waiting(m_s.dialogs, window, lowerEdge.stop(), [this] { return askToClose(kCloseWhileSending); }) {
    Instrument& instrument = m_s.session.instrument;
    m_book.text(lowerEdge.stop(), {830, "&Stop"});
    m_book.tip(lowerEdge.stop(), {831, "Der Rest wird nicht gesendet, die Verbindung bleibt offen (Esc)"});
    m_book.text(lowerEdge.panic(), {848, "Alles an&halten"});
    m_book.tip(lowerEdge.panic(), {849, "Hält an, was von selbst sendet, und schaltet TA aus"});
    connect(lowerEdge.stop(), &QPushButton::clicked, &m_waiting, &WaitingLoop::giveUp);
    connect(&m_waiting, &WaitingLoop::givenUp, this, [this, &instrument] {
        instrument.stopSequence();
        emit givenUp();
    });
    const auto close = [this, window] {
        m_sure = true;
        window->close();
        m_sure = false;
    };
    connect(&m_waiting, &WaitingLoop::closeConfirmed, this, close, Qt::QueuedConnection);
    Automatics& automatics = m_s.tickers.automatics();
    lowerEdge.panic()->setProperty(kWorksWhileSending, true);
    connect(lowerEdge.panic(), &QPushButton::clicked, this, &WaysOut::panic);
    connect(this, &WaysOut::panicWanted, this, &WaysOut::panic, Qt::QueuedConnection);
    automatics.onChange([this] { m_lowerEdge.panic()->setVisible(m_s.tickers.automatics().anyRuns()); });
    instrument.onFailure(
        [this](const std::string& text, bool sequenceRuns) { return tellFailure(text, sequenceRuns); });
    instrument.onRun([this](bool begins) { runBegins(begins); });
    if (m_s.worker != nullptr) m_s.worker->setWaiter(&m_waiting);
}

WaysOut::~WaysOut() {
    if (m_s.worker != nullptr) m_s.worker->setWaiter(nullptr);
    m_s.session.instrument.onRun(nullptr);
    m_s.session.instrument.onFailure(nullptr);
    m_s.tickers.automatics().onChange(nullptr);
}

/// While a slow instrument is waited for, its call ends first: nothing can be sent within it.
void WaysOut::panic() {
    if (!m_waiting.isWaiting()) return m_s.tickers.automatics().panic();
    m_waiting.giveUp();
    emit panicWanted();
}

void WaysOut::label() {
    m_book.label(m_s.captions);
}

void WaysOut::runBegins(bool begins) {
    m_lowerEdge.stop()->setVisible(begins);
    m_waiting.setRun(begins);
}

bool WaysOut::tellFailure(const std::string& text, bool sequenceRuns) {
    const VisaStatus status = m_s.session.instrument.LastVisaStatus;
    if (status == visa::kAborted && m_waiting.wasGivenUp()) return true;  // the user knows
    if (m_taker && m_taker()) return true;
    // While the box waits, timers would send more to the same broken link and pile up more boxes.
    m_s.tickers.setHeld(true);
    const QString title = QStringLiteral("Interface Error");
    Tick* const tick = m_s.tickers.tick();
    bool stop = false;
    if (sequenceRuns) {
        stop = m_s.dialogs.messageOrStop(title, toText(text), hint(status),
                                         tick != nullptr ? tick->stopText() : QString());
    } else {
        m_s.dialogs.message(Dialogs::Icon::Critical, title, toText(text), hint(status));
    }
    if (stop && tick != nullptr) tick->stop();
    m_s.tickers.setHeld(false);
    return stop;
}

void WaysOut::tellOpening(VisaStatus status) {
    if (m_s.session.instrument.isSequenceStopped()) return;
    m_s.dialogs.message(Dialogs::Icon::Critical, QStringLiteral("Interface Error"),
                        QStringLiteral("Please Check Device! %1").arg(status), hint(status));
}

bool WaysOut::mayClose() {
    if (!m_s.dialogs.canAsk() || !m_s.session.instrument.isOpen()) return true;  // at the end the session is let go
    Automatics& automatics = m_s.tickers.automatics();
    if (!m_sure && automatics.anyRuns() && !askToClose(kCloseWhileRunning)) return false;
    automatics.stopAll();
    emit localRequested();
    return true;
}

bool WaysOut::askToClose(const Caption& question) const {
    const QStringList running = m_s.tickers.automatics().names();
    const QString text = caption(question);
    return m_s.dialogs.confirmLoss(QStringLiteral("KDX-RDS"), text.contains(QStringLiteral("%1"))
                                                                  ? text.arg(running.join(QStringLiteral(", ")))
                                                                  : text);
}

QString WaysOut::hint(VisaStatus status) const {
    return failureHint(status, m_s.answerTime, m_s.captions, numberLocale(m_s.state.language));
}

}  // namespace kdx
