#include "window/waitingloop.h"

#include <QAbstractButton>
#include <QAbstractSlider>
#include <QApplication>
#include <QKeyEvent>
#include <QTimerEvent>
#include <QWidget>

#include <algorithm>
#include <chrono>
#include <utility>

#include "ui/automatics.h"
#include "ui/dialogs.h"

namespace kdx {

namespace {

constexpr std::chrono::milliseconds kPatience{150};  // longer than a healthy instrument takes

bool isInput(QEvent::Type type) {
    switch (type) {
        case QEvent::MouseButtonPress:
        case QEvent::MouseButtonRelease:
        case QEvent::MouseButtonDblClick:
        case QEvent::MouseMove:
        case QEvent::Wheel:
        case QEvent::KeyPress:
        case QEvent::KeyRelease:
        case QEvent::ShortcutOverride:
        case QEvent::Shortcut:
        case QEvent::InputMethod:
        case QEvent::ContextMenu:
        case QEvent::DragEnter:
        case QEvent::DragMove:
        case QEvent::Drop:
        case QEvent::TouchBegin:
        case QEvent::TouchUpdate:
        case QEvent::TouchEnd:
        case QEvent::TabletPress:
        case QEvent::TabletMove:
        case QEvent::TabletRelease:
        case QEvent::NativeGesture:
            return true;
        default:
            return false;
    }
}

bool isRelease(QEvent::Type type) {
    return type == QEvent::MouseButtonRelease || type == QEvent::KeyRelease;
}

/// Whether a control was pressed before and would stay so without its release: a scroll bar would scroll for ever.
bool waitsForRelease(const QObject* control) {
    const auto* button = qobject_cast<const QAbstractButton*>(control);
    return (button != nullptr && button->isDown()) || qobject_cast<const QAbstractSlider*>(control) != nullptr;
}

}  // namespace

WaitingLoop::WaitingLoop(const Dialogs& dialogs, QWidget* window, QWidget* stop, std::function<bool()> askToClose)
    : m_dialogs(dialogs), m_window(window), m_stop(stop), m_askToClose(std::move(askToClose)) {
    m_patience.setSingleShot(true);
    m_patience.setInterval(kPatience);
    connect(&m_patience, &QTimer::timeout, this, &WaitingLoop::becomeSlow);
    // Queued: from the other thread, to end the waiting for events; and from within a filter.
    connect(
        this, &WaitingLoop::woken, this, [] {}, Qt::QueuedConnection);
    connect(this, &WaitingLoop::closeRequested, this, &WaitingLoop::ask, Qt::QueuedConnection);
    m_window->installEventFilter(this);
}

WaitingLoop::~WaitingLoop() {
    showBusy(false);
}

void WaitingLoop::setRun(bool runs) {
    m_runs = runs;
    m_givenUp = false;
    if (runs) return;
    if (m_busy) {
        // What was pressed and typed between the last commands is still on its way here.
        m_waiting = true;
        qApp->installEventFilter(this);
        process(false);
        endWait();
    }
    showBusy(false);
    closeWhenOver();
}

void WaitingLoop::giveUp() {
    m_givenUp = true;
    emit givenUp();
}

void WaitingLoop::waitUntil(const std::function<bool()>& over) {
    if (m_waiting) return;  // a call within a call: nobody waits for it
    if (!m_runs) m_givenUp = m_closing || !m_dialogs.canAsk();
    m_waiting = true;
    qApp->installEventFilter(this);
    m_patience.start();
    if (m_runs) {
        showBusy(true);
        process(false);  // a healthy run is painted and can be stopped, too
    }
    while (!m_givenUp && !over()) process(true);
    if (m_slow) process(false);
    endWait();
    if (m_runs) return;
    showBusy(false);
    closeWhenOver();
}

void WaitingLoop::wake() {
    emit woken();
}

void WaitingLoop::process(bool wait) {
    QEventLoop::ProcessEventsFlags flags = wait ? QEventLoop::WaitForMoreEvents : QEventLoop::AllEvents;
    if (!m_runs && !m_slow) flags |= QEventLoop::ExcludeUserInputEvents;
    QCoreApplication::processEvents(flags);
}

void WaitingLoop::endWait() {
    qApp->removeEventFilter(this);
    m_patience.stop();
    m_waiting = false;
    m_slow = false;
    for (const auto& [timer, identification] : std::exchange(m_held, {})) {
        if (timer && timer->isActive() && timer->timerId() == identification)
            QCoreApplication::postEvent(timer, new QTimerEvent(identification));
    }
    for (auto& [control, release] : std::exchange(m_releases, {})) {
        if (control) QCoreApplication::postEvent(control, release.release());
    }
}

void WaitingLoop::becomeSlow() {
    m_slow = true;
    showBusy(true);
    m_window->show();  // when the session opens at the start, nothing else is on the screen yet
}

void WaitingLoop::showBusy(bool busy) {
    const bool shown = m_busy && !m_blocked;
    m_busy = busy;
    const bool shows = m_busy && !m_blocked;
    if (shows && !shown) QApplication::setOverrideCursor(Qt::WaitCursor);
    if (!shows && shown) QApplication::restoreOverrideCursor();
}

bool WaitingLoop::eventFilter(QObject* receiver, QEvent* event) {
    if (receiver == m_window && (event->type() == QEvent::WindowBlocked || event->type() == QEvent::WindowUnblocked)) {
        const bool shown = m_busy;
        showBusy(false);
        m_blocked = event->type() == QEvent::WindowBlocked;
        showBusy(shown);
        return false;
    }
    if (!m_waiting) return false;
    if (event->type() == QEvent::Timer) return holdsTimer(receiver, event);
    if (m_asking) return false;
    if (event->type() == QEvent::Close) return meetsClose(receiver, event);
    if (!isInput(event->type())) return false;
    return dropsInput(receiver, event);
}

/// A time that came is not forgotten: the timer ticks after the wait. Controls that repeat what is held down do not.
bool WaitingLoop::holdsTimer(QObject* receiver, QEvent* event) {
    if (receiver == &m_patience) return false;
    auto* timer = qobject_cast<QTimer*>(receiver);
    if (timer == nullptr) return !m_asking && receiver->isWidgetType();
    const std::pair held{QPointer(timer), static_cast<QTimerEvent*>(event)->timerId()};
    if (std::find(m_held.begin(), m_held.end(), held) == m_held.end()) m_held.push_back(held);
    return true;
}

bool WaitingLoop::meetsClose(const QObject* receiver, QEvent* event) {
    if (!m_dialogs.canAsk()) {
        giveUp();  // the program is ending
        return false;
    }
    if (!receiver->isWidgetType()) return false;
    event->ignore();
    // Not in here: the box has to come back before the window does.
    if (receiver == m_window) emit closeRequested();
    return true;
}

void WaitingLoop::ask() {
    if (m_asking || m_closing) return;
    if (!m_waiting) {
        m_window->close();
        return;
    }
    m_asking = true;
    const bool yes = m_askToClose();
    m_asking = false;
    if (!yes) return;
    m_closing = true;
    giveUp();
}

void WaitingLoop::closeWhenOver() {
    if (std::exchange(m_closing, false)) emit closeConfirmed();
}

bool WaitingLoop::dropsInput(QObject* receiver, QEvent* event) {
    if (m_runs && event->type() == QEvent::KeyPress && static_cast<QKeyEvent*>(event)->key() == Qt::Key_Escape) {
        giveUp();
        return true;
    }
    // A window hands on to its controls.
    if (receiver->isWindowType() || receiver == m_stop || receiver->property(kWorksWhileSending).toBool()) return false;
    if (isRelease(event->type()) && waitsForRelease(receiver))
        m_releases.emplace_back(receiver, std::unique_ptr<QEvent>(event->clone()));
    return true;
}

}  // namespace kdx
