#pragma once

#include "ui/dialogs.h"

class QWidget;

namespace kdx {

class Captions;

/// The real boxes, modal over the active window, their buttons in the program's language.
class QtDialogs final : public Dialogs {
public:
    explicit QtDialogs(const Captions& captions);

    void message(Icon icon, const QString& title, const QString& text, const QString& details = {}) override;
    bool messageOrStop(const QString& title, const QString& text) override;
    bool confirm(const QString& title, const QString& text) override;
    QString input(const QString& prompt, const QString& title, const QString& preset) override;

private:
    const Captions& m_captions;
};

}  // namespace kdx
