#pragma once

#include <QString>

#include <deque>
#include <vector>

#include "ui/dialogs.h"

namespace kdx::test {

/// Boxes that answer in turn; a box nobody expected fails the test, and so does one that was expected in vain.
class ScriptedDialogs final : public Dialogs {
public:
    struct Shown {
        Icon icon = Icon::None;
        QString title;
        QString text;
        QString preset;           ///< of an input box; of a message box the details
        QString aboutDetails;     ///< of the about box, shown when the user opens them
        bool offersStop = false;  ///< has a second button that stops the running sequence
        QString stop = {};        ///< its caption where it is another one
    };

    ~ScriptedDialogs() override;

    void message(Icon icon, const QString& title, const QString& text, const QString& details = {}) override;
    void about(const QString& text, const QString& madeOf, const QString& details) override;
    bool messageOrStop(const QString& title, const QString& text, const QString& details = {}, const QString& stop = {},
                       Icon icon = Icon::Critical) override;
    bool confirm(const QString& title, const QString& text) override;
    QString input(const QString& prompt, const QString& title, const QString& preset) override;
    QString fileToSave(const QString& title, const QString& preset, const QString& kind) override;
    QString fileToOpen(const QString& title, const QString& kind, const QString& folder = {}) override;
    [[nodiscard]] bool canAsk() const override { return !ending; }

    int expectedMessages = 0;        ///< how many message boxes may still come
    bool stopAtFailure = false;      ///< press the button that stops the running sequence
    std::deque<QString> inputs;      ///< answers of the input boxes, in turn; empty for Cancel
    std::deque<QString> files;       ///< answers of the boxes for a file, in turn; empty for Cancel
    bool ending = false;             ///< the program is, and nobody is there to answer
    std::deque<bool> confirmations;  ///< answers of the Yes/No boxes, in turn
    std::vector<Shown> shown;        ///< every box, in order
};

}  // namespace kdx::test
