#pragma once

#include <QLabel>

#include <cstddef>
#include <utility>

#include "ui/caption.h"
#include "ui/controls.h"
#include "ui/pagecontext.h"
#include "ui/ticker.h"

namespace kdx {

/// What a page or an editor is made with: each control is born with the system's name ("" where it has none), its
/// caption and the handler of the page or editor that it runs.
class Form {
public:
    explicit Form(const PageContext& with) : m_with(with) {}

protected:
    ~Form() = default;

    template <typename Control>
    Control* captioned(const char* name, const Caption& caption, QWidget* parent) {
        return m_book.captioned<Control>(name, caption, parent);
    }
    template <typename Control, typename Signal, typename Self>
    Control* captioned(const char* name, const Caption& caption, QWidget* parent, Signal signal,
                       void (Self::*handler)()) {
        auto* control = captioned<Control>(name, caption, parent);
        QObject::connect(control, signal, static_cast<Self*>(this), handler);
        return control;
    }
    /// A button or check box that runs the handler at every click.
    template <typename Button, typename Self>
    Button* clicked(const char* name, const Caption& caption, QWidget* parent, void (Self::*handler)()) {
        return captioned<Button>(name, caption, parent, &Button::clicked, handler);
    }
    /// A control without a caption. @param args what it is made from.
    template <typename Control, typename Signal, typename Self, typename... Args>
    Control* wired(const char* name, Signal signal, void (Self::*handler)(), Args&&... args) {
        auto* control = named<Control>(name, std::forward<Args>(args)...);
        QObject::connect(control, signal, static_cast<Self*>(this), handler);
        return control;
    }
    /// The label that stands before a control and is its name for who cannot see the window.
    QLabel* heading(const char* name, const Caption& caption, QWidget* control) {
        auto* label = captioned<QLabel>(name, caption, control->parentWidget());
        label->stackUnder(control);  // comes before it for a screen reader too
        m_book.head(label, control);
        return label;
    }
    /// Makes option buttons that run the handler with their index at a click.
    template <std::size_t Count, typename Self>
    void createOptions(OptionArray<Count>& options, const char* name, const Caption (&captions)[Count], QWidget* parent,
                       void (Self::*handler)(int)) {
        options.create(name, parent);
        for (std::size_t i = 0; i < Count; ++i) m_book.text(options[i], captions[i]);
        options.onClick(static_cast<Self*>(this), handler);
    }
    /// A timer that runs the handler; it is not enabled yet.
    template <typename Self>
    Ticker* timer(const char* name, int periodMs, void (Self::*handler)()) {
        auto* ticker = wired<Ticker>(name, &Ticker::timeout, handler, m_with.tickers, static_cast<Self*>(this));
        ticker->setPeriod(periodMs);
        return ticker;
    }
    [[nodiscard]] QString caption(const Caption& caption) const { return captionText(m_with.captions, caption); }

    PageContext m_with;
    CaptionBook m_book;
};

}  // namespace kdx
