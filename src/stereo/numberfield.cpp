#include "stereo/numberfield.h"

#include <QLineEdit>
#include <QRegularExpression>

#include <cmath>

#include "ui/caption.h"
#include "ui/keymarks.h"

namespace kdx {

namespace {

/// A line among labels, no larger than its widest number: the columns have no room to spare.
void keepSmall(QAbstractSpinBox* field, const QString& widest) {
    constexpr int kFrame = 10;
    field->setFixedSize(field->fontMetrics().horizontalAdvance(widest) + kFrame, field->fontMetrics().height() + 4);
}

constexpr const char* kRange = "range";  // property: the least and the greatest, as texts

/// A number that is none of the field's may be on its way to become one.
QValidator::State orUnfinished(QValidator::State state, const QString& text) {
    static const QRegularExpression kNumber(QStringLiteral("^[+-]?\\d{0,5}(\\.\\d{0,2})?\\s*\\D*$"));
    return state == QValidator::Invalid && kNumber.match(text).hasMatch() ? QValidator::Intermediate : state;
}

constexpr double kPerKilohertz = 100;  // tens of hertz

void prepare(const PageContext& with, QAbstractSpinBox* field, const char* key) {
    field->setLocale(QLocale::c());                        // a point, as everywhere in the window
    field->setButtonSymbols(QAbstractSpinBox::NoButtons);  // the bar has its own
    field->setAlignment(Qt::AlignRight);
    auto* entry = field->findChild<QLineEdit*>();
    QObject::connect(entry, &QLineEdit::textEdited, field, [&with = with.captions, field] {
        if (field->hasAcceptableInput())
            return showState(*field, ValueState::Unsent, captionText(with, {857, "Noch nicht gesendet."}));
        const auto range = field->property(kRange).toStringList();
        showState(*field, ValueState::Refused,
                  captionText(with, {1095, "Von %1 bis %2; anderes wird nicht gesendet."}).arg(range[0], range[1]));
    });
    // Entered is not yet in force: that is what became of the command.
    QObject::connect(field, &QAbstractSpinBox::editingFinished, field,
                     [&marks = with.marks, key, field] { showJudgement(*field, marks.judge(key)); });
    with.marks.add(key, field);
}

}  // namespace

KilohertzField::KilohertzField(QWidget* parent) : QDoubleSpinBox(parent) {
    setDecimals(2);
    setKeyboardTracking(false);  // one command a number, not one a key
    setSuffix(QStringLiteral(" kHz"));
}

QValidator::State KilohertzField::validate(QString& text, int& at) const {
    text.replace(QLatin1Char(','), QLatin1Char('.'));
    return orUnfinished(QDoubleSpinBox::validate(text, at), text);
}

QValidator::State DegreeField::validate(QString& text, int& at) const {
    return orUnfinished(QSpinBox::validate(text, at), text);
}

void tie(const PageContext& with, KilohertzField* field, SettingScrollBar* bar, const char* key) {
    prepare(with, field, key);
    field->setRange(bar->minimum() / kPerKilohertz, bar->maximum() / kPerKilohertz);
    field->setSingleStep(bar->singleStep() / kPerKilohertz);
    keepSmall(field, QString::number(field->maximum(), 'f', field->decimals()) + field->suffix());
    field->setProperty(kRange, QStringList{QString::number(field->minimum()), field->textFromValue(field->maximum())});
    QObject::connect(field, &QDoubleSpinBox::valueChanged, bar, [bar](double kilohertz) {
        bar->setValue(static_cast<int>(std::lround(kilohertz * kPerKilohertz)));
    });
}

void tie(const PageContext& with, QSpinBox* field, SettingScrollBar* bar, const char* key) {
    prepare(with, field, key);
    field->setKeyboardTracking(false);
    field->setSuffix(QStringLiteral(" °"));
    field->setRange(bar->minimum(), bar->maximum());
    field->setSingleStep(bar->singleStep());
    keepSmall(field, QString::number(field->minimum()) + field->suffix());
    field->setProperty(kRange, QStringList{QString::number(field->minimum()), QString::number(field->maximum())});
    QObject::connect(field, &QSpinBox::valueChanged, bar, &QScrollBar::setValue);
}

void showQuietly(KilohertzField* field, int tensOfHertz, const Judgement& judgement) {
    const QSignalBlocker quiet(field);
    field->setValue(tensOfHertz / kPerKilohertz);
    showJudgement(*field, judgement);
}

void showQuietly(QSpinBox* field, int degrees, const Judgement& judgement) {
    const QSignalBlocker quiet(field);
    field->setValue(degrees);
    showJudgement(*field, judgement);
}

}  // namespace kdx
