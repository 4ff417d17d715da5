#pragma once

#include <QDoubleSpinBox>
#include <QSpinBox>

#include "stereo/settingscrollbar.h"
#include "ui/pagecontext.h"
#include "ui/valuestate.h"

namespace kdx {

/// The value of a deviation's scroll bar as a number in kilohertz. A decimal comma may be typed for the point.
class KilohertzField : public QDoubleSpinBox {
public:
    explicit KilohertzField(QWidget* parent);

    /// A number out of range can be typed, else a digit would be lost and the rest go out; it is not taken.
    [[nodiscard]] QValidator::State validate(QString& text, int& at) const override;
};

/// The same for a phase in whole degrees.
class DegreeField : public QSpinBox {
public:
    using QSpinBox::QSpinBox;

    [[nodiscard]] QValidator::State validate(QString& text, int& at) const override;
};

/// Puts the field beside the bar in force: same range and step; what is entered moves the bar, which sends it. What is
/// typed is marked until then.
/// @param key under which the bar's value goes out.
void tie(const PageContext& with, KilohertzField* field, SettingScrollBar* bar, const char* key);
/// The same for whole degrees.
void tie(const PageContext& with, QSpinBox* field, SettingScrollBar* bar, const char* key);

/// Shows the bar's value, which counts tens of hertz.
void showQuietly(KilohertzField* field, int tensOfHertz, const Judgement& judgement);
void showQuietly(QSpinBox* field, int degrees, const Judgement& judgement);

}  // namespace kdx
