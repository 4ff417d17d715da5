#pragma once

#include <QString>

#include <string>

class QWidget;

namespace kdx {

struct Corrections;
struct PageContext;

/// Whether a value that is shown is the one that the instrument has.
enum class ValueState {
    InForce,
    Unsent,   ///< typed or loaded, and not sent since
    Refused,  ///< sent, but the coder does not take it
};

/// Shows the state by colours, in the control's tip before what that says of itself, and in its property "zustand".
void showState(QWidget& control, ValueState state, const QString& tip);

/// What a control's tip says of the control itself, whatever its value's state is.
[[nodiscard]] QString ownTip(const QWidget& control);
void setOwnTip(QWidget& control, const QString& tip);

/// Shows by the looks of a refused value what is wrong with one before it is sent; with "" nothing is.
void showWarning(QWidget& control, const QString& tip);

/// A value with what is to be said about it.
struct Judgement {
    ValueState state = ValueState::InForce;
    QString tip = {};
};

/// Shows what is to be said of a control's value; of one that never had a state nothing is.
void showJudgement(QWidget& control, const Judgement& judgement);

/// Why the coder does not take the entry for the key, in the current language; "" when it does.
[[nodiscard]] QString whyRefused(const PageContext& with, const char* key, const QString& entry);
/// The same by other corrections than those at work: the ones that it went out under.
[[nodiscard]] QString whyRefused(const PageContext& with, const char* key, const QString& entry,
                                 const Corrections& corrections);

}  // namespace kdx
