#pragma once

#include <functional>

#include "ui/dialogs.h"

namespace kdx {

class Captions;

/// The real boxes, modal over the window or editor that asks, their buttons in the program's language.
class QtDialogs final : public Dialogs {
public:
    /// @param ending whether the program is ending: then no box opens any more, and one that was open when the end came
    /// was not answered by the user. What runs is stopped, and everything else is cancelled.
    explicit QtDialogs(
        const Captions& captions, std::function<bool()> ending = [] { return false; });

    void message(Icon icon, const QString& title, const QString& text, const QString& details = {}) override;
    void about(const QString& text, const QString& madeOf, const QString& details) override;
    bool messageOrStop(const QString& title, const QString& text, const QString& details = {}, const QString& stop = {},
                       Icon icon = Icon::Critical) override;
    bool confirm(const QString& title, const QString& text) override;
    bool confirmLoss(const QString& title, const QString& text) override;
    QString input(const QString& prompt, const QString& title, const QString& preset) override;
    QString fileToSave(const QString& title, const QString& preset, const QString& kind) override;
    QString fileToOpen(const QString& title, const QString& kind, const QString& folder = {}) override;
    [[nodiscard]] bool canAsk() const override { return !m_ending(); }

private:
    [[nodiscard]] bool isConfirmed(const QString& title, const QString& text, bool yesByReturn);

    const Captions& m_captions;
    std::function<bool()> m_ending;
};

}  // namespace kdx
