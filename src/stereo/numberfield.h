#pragma once

#include <QDoubleSpinBox>
#include <QSpinBox>

#include "stereo/settingscrollbar.h"
#include "ui/pagecontext.h"

namespace kdx {

/// The value of a deviation's scroll bar as a number in kilohertz. A decimal comma may be typed for the point.
class KilohertzField : public QDoubleSpinBox {
public:
    explicit KilohertzField(QWidget* parent);

    [[nodiscard]] QValidator::State validate(QString& text, int& at) const override;
};

/// Puts the field beside the bar in force: same range and step; what is entered moves the bar, which sends it. What is
/// typed is marked until then.
void tie(const PageContext& with, KilohertzField* field, SettingScrollBar* bar);
/// The same for whole degrees.
void tie(const PageContext& with, QSpinBox* field, SettingScrollBar* bar);

/// Shows the bar's value, which counts tens of hertz.
void showQuietly(KilohertzField* field, int tensOfHertz);
void showQuietly(QSpinBox* field, int degrees);

}  // namespace kdx
