#include "stereo/rfpage.h"

#include <QGridLayout>
#include <QGroupBox>
#include <QVBoxLayout>

#include "coder/sendparam.h"
#include "settings/captions.h"
#include "settings/datafolder.h"
#include "settings/storedvalue.h"
#include "ui/clickablelabel.h"
#include "ui/controls.h"
#include "ui/dialogs.h"
#include "ui/named.h"
#include "ui/pictureswitch.h"
#include "ui/text.h"

namespace kdx {

namespace {

constexpr const char* kSection = "VRN";
constexpr double kValueFontScale = 1.75;

}  // namespace

const RfPage::Value RfPage::kFrequency{"HF_Frequenz",          "FM_Ulim", "FM_Olim", "", "", 210, "HF-Frequenz",
                                       StatusSlot::RfFrequency};
const RfPage::Value RfPage::kLevel{"HF_Pegel", "", "", "0", "120", 216, "HF-Pegel", StatusSlot::RfLevel};
const RfPage::Value RfPage::kAudioFrequency{
    "NF_Frequenz", "NF_Ulim", "NF_Olim", "", "", 213, "NF-Frequenz", StatusSlot::AudioFrequency};

RfPage::RfPage(const PageContext& with, QWidget* parent) : QWidget(parent), m_with(with) {
    RF_Freq_Frame = makeValue("RF_Freq_Frame", "Input_HF_Freq_Label", Input_HF_Freq_Label);
    RF_Level_Frame = makeValue("RF_Level_Frame", "Input_HF_Pegel_Label", Input_HF_Pegel_Label);
    AF_Freq_Frame = makeValue("AF_Freq_Frame", "Input_AF_Freq_Label", Input_AF_Freq_Label);
    connect(Input_HF_Freq_Label, &ClickableLabel::clicked, this, &RfPage::Input_HF_Freq_Label_Click);
    connect(Input_HF_Pegel_Label, &ClickableLabel::clicked, this, &RfPage::Input_HF_Pegel_Label_Click);
    connect(Input_AF_Freq_Label, &ClickableLabel::clicked, this, &RfPage::Input_AF_Freq_Label_Click);

    m_outputFrame = new QGroupBox(this);
    HfOnOffState = named<PictureSwitch>("HfOnOffState", m_with.data, m_outputFrame);
    connect(HfOnOffState, &PictureSwitch::clicked, this, &RfPage::HfOnOffState_Click);
    auto* output = new QVBoxLayout(m_outputFrame);
    tighten(output);
    output->addWidget(HfOnOffState, 0, Qt::AlignCenter);

    auto* grid = new QGridLayout(this);
    tighten(grid, kPageMargin);
    grid->setSpacing(2 * kGap);
    grid->addWidget(RF_Freq_Frame, 0, 0);
    grid->addWidget(RF_Level_Frame, 0, 1);
    grid->addWidget(AF_Freq_Frame, 1, 0);
    grid->addWidget(m_outputFrame, 1, 1);
    grid->setColumnStretch(0, 1);
    grid->setColumnStretch(1, 1);
    grid->setRowStretch(2, 1);
    label();
}

QGroupBox* RfPage::makeValue(const char* frame, const char* name, ClickableLabel*& shown) {
    auto* box = named<QGroupBox>(frame, this);
    shown = named<ClickableLabel>(name, box);
    shown->setText(QStringLiteral("-"));
    shown->setAlignment(Qt::AlignCenter);
    shown->setMargin(2 * kGap);
    QFont font = shown->font();
    font.setPointSizeF(font.pointSizeF() * kValueFontScale);
    shown->setFont(font);
    // A text of any length may be entered: it must not push the frames about.
    shown->setSizePolicy(QSizePolicy::Ignored, QSizePolicy::Preferred);
    tighten(new QVBoxLayout(box));
    box->layout()->addWidget(shown);
    return box;
}

void RfPage::label() {
    const Captions& captions = m_with.captions;
    RF_Freq_Frame->setTitle(toText(captions.text(212)));
    AF_Freq_Frame->setTitle(toText(captions.text(215)));
    RF_Level_Frame->setTitle(toText(captions.text(218)));
    m_outputFrame->setTitle(toText(captions.own(630, "HF-Ausgang")));
    const QString entry = toText(captions.own(631, "Klicken, um einen neuen Wert einzugeben"));
    for (ClickableLabel* value : {Input_HF_Freq_Label, Input_HF_Pegel_Label, Input_AF_Freq_Label}) {
        value->setToolTip(entry);
        const auto* frame = static_cast<const QGroupBox*>(value->parentWidget());
        value->setAccessibleName(frame->title() + QStringLiteral(": ") + value->text());
    }
    const QString output = toText(captions.own(632, "HF-Ausgang ein / aus"));
    HfOnOffState->setToolTip(output);
    HfOnOffState->setAccessibleName(output);
}

void RfPage::sendFrequency() {
    sendStored(kFrequency, Input_HF_Freq_Label);
}

void RfPage::sendLevel() {
    sendStored(kLevel, Input_HF_Pegel_Label);
}

void RfPage::sendAudioFrequency() {
    m_with.params.SendParam("NFShape Sinus", "");
    sendStored(kAudioFrequency, Input_AF_Freq_Label);
}

void RfPage::HfOnOffState_Click() {
    const bool on = !HfOnOffState->isChecked();
    HfOnOffState->showState(on);
    m_with.params.SendParam("HF:PEGEL:STATE", on ? "ON" : "OFF");
}

void RfPage::Input_HF_Freq_Label_Click() {
    enter(kFrequency, Input_HF_Freq_Label);
}

void RfPage::Input_HF_Pegel_Label_Click() {
    enter(kLevel, Input_HF_Pegel_Label);
}

void RfPage::Input_AF_Freq_Label_Click() {
    enter(kAudioFrequency, Input_AF_Freq_Label);
}

void RfPage::enter(const Value& value, ClickableLabel* shown) {
    const bool fixed = *value.lowerKey == '\0';
    const std::string lower = fixed ? value.fixedLower : stored(value.lowerKey);
    const std::string upper = fixed ? value.fixedUpper : stored(value.upperKey);
    const QString prompt = toText(m_with.captions.text(value.prompt));
    const QString title = toText(m_with.captions.text(value.prompt + 1));
    QString answer = toText(stored(value.profileKey));
    do {
        // What was typed stays in the box, so that it can be corrected.
        answer = m_with.dialogs.input(prompt, title, answer);
        if (answer.isEmpty()) return;
    } while (!liesBetween(toBytes(answer), lower, upper));
    showValue(value, shown, answer);
    m_with.params.SendParam(value.sendKey, toBytes(answer));
}

void RfPage::sendStored(const Value& value, ClickableLabel* shown) {
    // Data set 1 whatever set is current: the generator's own settings are kept once.
    std::string text = stored(value.profileKey);
    m_with.params.SendParam(value.sendKey, text);
    if (!text.empty()) showValue(value, shown, toText(text));
}

void RfPage::showValue(const Value& value, ClickableLabel* shown, const QString& text) {
    shown->setText(text);
    m_with.status.show(value.slot, text);
    label();
}

std::string RfPage::stored(const char* key) const {
    return m_with.data.ReadIni(kSection, key, dataSetFile("1"));
}

}  // namespace kdx
