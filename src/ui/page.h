#pragma once

#include <QWidget>

#include "coder/step.h"
#include "ui/caption.h"
#include "ui/pagecontext.h"

namespace kdx {

/// A page of the window, or a frame of one that lives like a page. What its controls are called is said where they are
/// made; the window calls the rest.
class Page : public QWidget {
    Q_OBJECT
public:
    Page(const PageContext& with, QWidget* parent) : QWidget(parent), m_with(with) {}

    /// Captions everything in the current language; values stay. Overridden for texts that are composed.
    virtual void label() { m_book.label(m_with.captions); }
    /// Start-up: shows what the data set and the general settings hold. Nothing is stored; nothing is sent but by
    /// handlers that are said to run.
    virtual void load() {}
    /// The page was opened by its tab.
    virtual void opened() {}
    /// A step of a running sequence goes out: shows what belongs to this page, and stores what sending it stores.
    virtual void stepGoesOut(const Step& /*step*/) {}

protected:
    /// A control that bears the system's name and its caption from its birth on.
    template <typename Control, typename... Args>
    Control* captioned(const char* name, const Caption& caption, Args&&... args) {
        return m_book.captioned<Control>(name, caption, std::forward<Args>(args)...);
    }
    /// Sends steps at once, each for itself and without a sequence around them.
    void send(const Steps& steps);
    [[nodiscard]] QString caption(const Caption& caption) const { return captionText(m_with.captions, caption); }

    PageContext m_with;
    CaptionBook m_book;
};

}  // namespace kdx
