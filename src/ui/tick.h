#pragma once

#include <QString>

#include <functional>

#include "link/commandsequence.h"
#include "ui/dialogs.h"
#include "ui/pagecontext.h"

namespace kdx {

/// While one lives a timer sends by itself. A box about what went wrong offers to stop that timer; then nothing more
/// goes out, and at its end this switches the timer's control off.
class Tick {
public:
    /// @param name of the timer, for the user. @param stop switches its control off.
    Tick(const PageContext& with, QString name, std::function<void()> stop);
    ~Tick();
    Tick(const Tick&) = delete;
    Tick& operator=(const Tick&) = delete;

    /// The user has had enough of the timer.
    void stop();
    /// Caption of the button that says so.
    [[nodiscard]] QString stopText() const;
    /// Tells the user something, with that button.
    void tell(Dialogs::Icon icon, const QString& title, const QString& text);

private:
    PageContext m_with;
    CommandSequence m_sequence;
    QString m_name;
    std::function<void()> m_stop;
    bool m_stopped = false;
    Tick* m_around;  ///< of another timer, whose box is open
};

}  // namespace kdx
