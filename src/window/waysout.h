#pragma once

#include <QObject>

#include <functional>
#include <string>
#include <utility>

#include "link/visa.h"
#include "ui/caption.h"
#include "window/surroundings.h"
#include "window/waitingloop.h"

class QMainWindow;

namespace kdx {

class ProgressLine;

/// What ends what runs: the buttons "Stop" and "Panik", the second buttons of error boxes, the closing of the window.
class WaysOut : public QObject {
    Q_OBJECT
public:
    /// @param lowerEdge where the buttons stand.
    WaysOut(const Surroundings& surroundings, const ProgressLine& lowerEdge, QMainWindow* window);
    ~WaysOut() override;

    void label();
    /// @param taker asked first at every failure; true from it, and no box is shown and the sequence stops.
    void letTakeFailures(std::function<bool()> taker) { m_taker = std::move(taker); }
    /// Tells that a session did not open, unless the user stopped that.
    void tellOpening(VisaStatus status);
    /// Whether the window may close. With an open session the user is asked when something runs by itself, that is
    /// stopped, and the session is closed.
    [[nodiscard]] bool mayClose();

signals:
    void localRequested();
    /// The user has had enough of what goes out.
    void givenUp();
    /// Everything is to stop as soon as nobody is waited for.
    void panicWanted();

private:
    bool tellFailure(const std::string& text, bool sequenceRuns);
    void runBegins(bool begins);
    void panic();
    [[nodiscard]] bool askToClose(const Caption& question) const;
    [[nodiscard]] QString caption(const Caption& caption) const { return captionText(m_s.captions, caption); }
    [[nodiscard]] QString hint(VisaStatus status) const;

    Surroundings m_s;
    const ProgressLine& m_lowerEdge;
    CaptionBook m_book;
    WaitingLoop m_waiting;
    std::function<bool()> m_taker;
    bool m_sure = false;  ///< the user was asked about the closing already
};

}  // namespace kdx
