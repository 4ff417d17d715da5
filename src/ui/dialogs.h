#pragma once

#include <QString>

namespace kdx {

/// All boxes of the program: pages ask through this and open none themselves.
class Dialogs {
public:
    enum class Icon { None, Information, Exclamation, Critical };

    virtual ~Dialogs() = default;
    /// Shows a text with an OK button, details in smaller print under it, and waits for it.
    virtual void message(Icon icon, const QString& title, const QString& text, const QString& details = {}) = 0;
    /// Shows what the program is, in a box without a title: the text, what it is made of in smaller print, and details
    /// that the user may open.
    virtual void about(const QString& text, const QString& madeOf, const QString& /*details*/) {
        message(Icon::Exclamation, {}, text, madeOf);
    }
    /// Shows a failure with an OK button and one that stops what failed; true for the latter.
    /// @param details in smaller print under the text. @param stop caption of the second button; by default it stops
    /// the rest of a sequence.
    virtual bool messageOrStop(const QString& title, const QString& text, const QString& details = {},
                               const QString& stop = {}, Icon icon = Icon::Critical) = 0;
    /// Asks with Yes and No; true for Yes.
    virtual bool confirm(const QString& title, const QString& text) = 0;
    /// The same where Yes loses something: No is the answer that a hurried Return gives.
    virtual bool confirmLoss(const QString& title, const QString& text) { return confirm(title, text); }
    /// Asks for a text; an empty answer is given for Cancel too.
    virtual QString input(const QString& prompt, const QString& title, const QString& preset) = 0;
    /// Asks for a file to write to, of a kind like "Text (*.txt)"; an empty answer is given for Cancel too. Nobody is
    /// there to choose one unless the boxes can ask.
    virtual QString fileToSave(const QString& /*title*/, const QString& /*preset*/, const QString& /*kind*/) {
        return {};
    }
    /// Asks for a file to read; else the same. @param folder where to look first; "" where the last one was.
    virtual QString fileToOpen(const QString& /*title*/, const QString& /*kind*/, const QString& /*folder*/ = {}) {
        return {};
    }
    /// Whether somebody is there to answer: not when the program is ending.
    [[nodiscard]] virtual bool canAsk() const { return true; }
};

}  // namespace kdx
