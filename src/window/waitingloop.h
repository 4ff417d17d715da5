#pragma once

#include <QObject>
#include <QPointer>
#include <QTimer>

#include <functional>
#include <memory>
#include <vector>

#include "link/workervisa.h"

class QWidget;

namespace kdx {

class Dialogs;

/// The window while the instrument is busy: it is painted, and the Stop button can be pressed; the window's timers are
/// held back, and whatever else the user does is dropped. A single command that is answered at once lets nobody wait:
/// there the user's doings are kept for after it.
class WaitingLoop : public QObject, public CallWaiter {
    Q_OBJECT
public:
    /// @param stop the button that is let through; it stays with the window. @param askToClose whether the window is to
    /// be closed although something is being sent.
    WaitingLoop(const Dialogs& dialogs, QWidget* window, QWidget* stop, std::function<bool()> askToClose);
    ~WaitingLoop() override;

    /// A run of commands begins, or is over.
    void setRun(bool runs);
    /// Ends the wait, and any other until the run is over.
    void giveUp();
    /// Whether the wait that was the last was given up.
    [[nodiscard]] bool wasGivenUp() const { return m_givenUp; }
    [[nodiscard]] bool isWaiting() const { return m_waiting; }

    void waitUntil(const std::function<bool()>& over) override;
    void wake() override;
    bool eventFilter(QObject* receiver, QEvent* event) override;

signals:
    void givenUp();
    /// The user wants the window closed, and what was being sent is over. To be heard queued.
    void closeConfirmed();
    void woken();
    void closeRequested();

private:
    void process(bool wait);
    void endWait();
    void becomeSlow();
    void showBusy(bool busy);
    void closeWhenOver();
    void ask();
    bool holdsTimer(QObject* receiver, QEvent* event);
    bool meetsClose(const QObject* receiver, QEvent* event);
    bool dropsInput(QObject* receiver, QEvent* event);

    const Dialogs& m_dialogs;
    QWidget* m_window;
    QWidget* m_stop;
    std::function<bool()> m_askToClose;
    QTimer m_patience;  ///< until a single call counts as slow

    bool m_runs = false;
    bool m_waiting = false;
    bool m_slow = false;
    bool m_givenUp = false;
    bool m_busy = false;     ///< it is to be seen that the instrument is
    bool m_blocked = false;  ///< by a box
    bool m_asking = false;
    bool m_closing = false;
    std::vector<std::pair<QPointer<QTimer>, int>> m_held;  ///< timers whose time came, with the identification then
    std::vector<std::pair<QPointer<QObject>, std::unique_ptr<QEvent>>> m_releases;  ///< of what was pressed before
};

}  // namespace kdx
