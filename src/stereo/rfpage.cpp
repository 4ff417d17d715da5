#include "stereo/rfpage.h"

#include <cmath>

#include "base/numbers.h"
#include "coder/sendparam.h"
#include "settings/programstate.h"
#include "settings/storedvalue.h"
#include "stereo/carrier.h"
#include "stereo/steppedlabel.h"
#include "ui/dialogs.h"
#include "ui/elided.h"
#include "ui/keymarks.h"
#include "ui/layouts.h"
#include "ui/text.h"

namespace kdx {

namespace {

constexpr const char* kLowestLevel = "0";
constexpr const char* kHighestLevel = "120";
constexpr double kValueFontScale = 1.75;
constexpr QLatin1String kNothing("-");  // before anything was sent

}  // namespace

RfPage::RfPage(const PageContext& with, Carrier& carrier, QWidget* parent) : Page(with, parent), m_carrier(carrier) {
    create();
    arrange();
    RfPage::label();
}

void RfPage::create() {
    createValue(Input_HF_Freq_Label, "Input_HF_Freq_Label", "RF_Freq_Frame", {212}, &RfPage::Input_HF_Freq_Label_Click);
    createValue(Input_HF_Pegel_Label, "Input_HF_Pegel_Label", "RF_Level_Frame", {218},
                &RfPage::Input_HF_Pegel_Label_Click);
    createValue(Input_AF_Freq_Label, "Input_AF_Freq_Label", "AF_Freq_Frame", {215}, &RfPage::Input_AF_Freq_Label_Click);
    m_outputFrame = captioned<QGroupBox>("", {630, "HF-Ausgang"}, this);
    HfOnOffState = wired<PictureSwitch>("HfOnOffState", &PictureSwitch::clicked, &RfPage::HfOnOffState_Click,
                                        m_with.data, m_outputFrame);
    m_book.describe(HfOnOffState, {632, "HF-Ausgang ein / aus"});
    m_with.marks.add(setting::kRfOutput, HfOnOffState);
}

void RfPage::createValue(Value& value, const char* name, const char* frame, const Caption& title,
                         void (RfPage::*handler)()) {
    value.frame = captioned<QGroupBox>(frame, title, this);
    value.label = wired<SteppedLabel>(name, &ClickableLabel::clicked, handler, value.frame);
    connect(static_cast<SteppedLabel*>(value.label), &SteppedLabel::stepped, this,
            [this, &value](int steps) { step(value, steps); });
    m_book.tip(value.label, {631, "Klicken, um einen neuen Wert einzugeben"});
    value.label->setText(kNothing);
    m_with.marks.watch(value.setting.sendKey, this, [this, &value](const Judgement&) { showJudged(value); });
    value.label->setAlignment(Qt::AlignCenter);
    value.label->setMargin(2 * kGap);
    QFont font = value.label->font();
    font.setPointSizeF(font.pointSizeF() * kValueFontScale);
    value.label->setFont(font);
    // A text of any length may be entered: it must not push the frames about.
    value.label->setSizePolicy(QSizePolicy::Ignored, QSizePolicy::Preferred);
    elideLongText(*value.label);
    layOut(value.frame, column({value.label}));
}

void RfPage::arrange() {
    layOut(m_outputFrame, column({{HfOnOffState, 0, Qt::AlignCenter}}));
    auto* frames =
        grid({{Input_HF_Freq_Label.frame, Input_HF_Pegel_Label.frame}, {Input_AF_Freq_Label.frame, m_outputFrame}});
    frames->setSpacing(2 * kGap);
    frames->setColumnStretch(0, 1);
    frames->setColumnStretch(1, 1);
    frames->setRowStretch(2, 1);
    layOut(this, frames, kPageMargin);
}

void RfPage::label() {
    Page::label();
    for (const Value* value : values()) {
        value->label->setToolTip(value->label->toolTip() + QLatin1Char('\n') +
                                 caption({870, "Die Pfeiltasten ändern ihn um %1, mit der Umschalttaste um %2."})
                                     .arg(value->step)
                                     .arg(10 * value->step));
        value->label->setAccessibleName(value->frame->title() + QStringLiteral(": ") + value->label->text());
        const Judgement judgement = judge(*value);
        showState(*value->label, judgement.state, judgement.tip);
    }
}

void RfPage::stepGoesOut(const Step& step) {
    if (step.kind == Step::Kind::Identify) m_carrier.everOpened = true;  // the first step of an opening
    if (step.key == setting::kRfOutput) showOutput(step.value == outputText(true));
    for (Value* value : values()) {
        if (step.key == value->setting.sendKey) showValue(*value, toText(step.value));
    }
}

void RfPage::HfOnOffState_Click() {
    showOutput(!m_carrier.outputOn);
    m_with.params.SendParam(setting::kRfOutput, outputText(m_carrier.outputOn));
}

void RfPage::enter(Value& value) {
    const std::string lowest = this->lowest(value);
    const std::string highest = this->highest(value);
    QString answer = toText(m_with.profile.read(value.setting.place));
    QString why;
    do {
        // What was typed stays in the box, so that it can be corrected.
        answer = m_with.dialogs.input(caption({value.prompt}) + why, caption({value.prompt + 1}), answer);
        if (answer.isEmpty()) return;
        if (m_with.state.corrections.decimalComma) why = checked(answer, lowest, highest);
    } while (!why.isEmpty() || !liesBetween(toBytes(answer), lowest, highest));
    take(value, answer);
}

void RfPage::take(Value& value, const QString& number) {
    showValue(value, number);
    m_with.params.SendParam(value.setting.sendKey, toBytes(number));
    // What is not kept is gone with the next opening, which sends what data set 1 holds.
    if (m_with.state.corrections.rfValues) m_with.profile.write(value.setting.place, toBytes(number));
}

/// Goes from the value that is shown, or else from the one that is kept. A step beyond the limits is none,
/// and from a value that the instrument refused there is none either: it would start from one that is not in force.
void RfPage::step(Value& value, int steps) {
    if (!refusal(value).isEmpty()) return;
    const std::string from = value.shown ? toBytes(*value.shown) : m_with.profile.read(value.setting.place);
    constexpr double kFinest = 1e6;  // what the sum of two decimal numbers has below that is no digit of theirs
    const double sum = std::round((leadingNumber(from) + steps * value.step) * kFinest) / kFinest;
    const std::string number = shortestDecimal(sum);
    if (liesBetween(number, lowest(value), highest(value))) take(value, toText(number));
}

std::string RfPage::lowest(const Value& value) const {
    return value.lowest != nullptr ? m_with.profile.read(*value.lowest) : kLowestLevel;
}

std::string RfPage::highest(const Value& value) const {
    return value.highest != nullptr ? m_with.profile.read(*value.highest) : kHighestLevel;
}

/// Makes the answer the number that it is. @returns why it is refused, to follow the question; "" when it is not.
QString RfPage::checked(QString& answer, const std::string& lowest, const std::string& highest) const {
    const auto number = decimalNumber(toBytes(answer));
    if (!number) return QLatin1Char('\n') + caption({633, "%1 ist keine Zahl."}).arg(answer);
    answer = toText(*number);
    if (liesBetween(*number, lowest, highest)) return {};
    return QLatin1Char('\n') +
           caption({634, "%1 liegt nicht zwischen %2 und %3."}).arg(answer, toText(lowest), toText(highest));
}

void RfPage::showValue(Value& value, const QString& text) {
    value.shown = text;
    value.label->setText(text);
    value.shownUnder = m_with.state.corrections;
    showJudged(value);
}

void RfPage::showJudged(const Value& value) {
    if (value.shown) m_with.status.show(value.slot, *value.shown, judge(value));
    label();
}

/// Why the instrument did not take the value that is shown. A rule that is changed later does not put it in force.
QString RfPage::refusal(const Value& value) const {
    return value.shown ? whyRefused(m_with, value.setting.sendKey, *value.shown, value.shownUnder) : QString();
}

Judgement RfPage::judge(const Value& value) const {
    if (!value.shown) return {};
    Judgement sent = m_with.marks.judge(value.setting.sendKey);
    if (sent.state != ValueState::InForce) return sent;
    const QString why = refusal(value);
    return {why.isEmpty() ? ValueState::InForce : ValueState::Refused, why};
}

void RfPage::showOutput(bool on) {
    m_carrier.outputOn = on;
    HfOnOffState->showState(on);
}

}  // namespace kdx
