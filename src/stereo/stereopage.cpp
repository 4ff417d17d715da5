#include "stereo/stereopage.h"

#include <QLabel>

#include "coder/sendparam.h"
#include "settings/programstate.h"
#include "settings/storedvalue.h"
#include "stereo/numberfield.h"
#include "ui/keymarks.h"
#include "ui/text.h"

namespace kdx {

StereoPage::StereoPage(const PageContext& with, Multiplex& multiplex, Page* testMode, QWidget* parent)
    : Page(with, parent), m_multiplex(multiplex), m_testMode(testMode) {
    create();
    arrange();
    StereoPage::label();
}

void StereoPage::label() {
    Page::label();
    for (const DeviationBar* bar : deviations()) showDeviation(*bar, bar->scroll->sliderPosition());
    showPilotPhase(HScroll1->sliderPosition());
    m_testMode->label();
}

void StereoPage::load() {
    for (const DeviationBar* bar : deviations()) {
        setQuietly(bar->scroll, storedPosition(bar->value, 0, bar->deviation.highest));
        showDeviation(*bar, bar->scroll->value());
    }
    setQuietly(HScroll1, storedPosition(m_multiplex.pilotPhase, kLowestPilotPhase, kHighestPilotPhase));
    showPilotPhase(HScroll1->value());
    FM_Source_Opt.showValue();
    FM_Imp_Opt.showValue();
    Stereo_Opt.showValue();
    Pre_opt.showValue();
    ARI_Mode_Opt.showValue();
    BK_Opt.showValue();
    for (const FlagSwitch* flag : {&Pilot_OnOff, &Ari_OnOff, &RDS_OnOff}) turn(*flag, flag->value == "1");
    setQuietly(RDS_Phase_Scroll,
               storedPosition(m_with.profile.read(setting::kRdsPhase), 0, RDS_Phase_Scroll->maximum()));
    RDS_Phase_Label->hide();
    RDS_Phase_Scroll->hide();
    m_testMode->load();
}

void StereoPage::stepGoesOut(const Step& step) {
    if (step.key == setting::kImpedance.sendKey) {
        m_multiplex.impedance = indexOfSent(setting::kImpedance, step.value, m_with.state.corrections);
        FM_Imp_Opt.showValue();
        m_with.profile.write(setting::kImpedance.place, m_multiplex.impedance);
    }
    m_testMode->stepGoesOut(step);
}

void StereoPage::HScroll1_Change() {
    showPilotPhase(HScroll1->value());
    change({setting::kPilotPhase, m_multiplex.pilotPhase}, pilotPhaseSetting(HScroll1->value()));
}

void StereoPage::change(const Adjustment& what, const std::string& value) {
    what.value = value;
    m_with.params.SendParam(what.setting.sendKey, sentOption(what.setting, value, m_with.state.corrections));
    m_with.profile.write(what.setting.place, value);
}

void StereoPage::changeDeviation(const DeviationBar& bar) {
    showDeviation(bar, bar.scroll->value());
    change(bar, deviationSetting(bar.deviation, bar.scroll->value()));
}

void StereoPage::turn(const FlagSwitch& flag, bool on) {
    flag.button->showState(on);
    change(flag, on ? "1" : "0");
}

void StereoPage::showDeviation(const DeviationBar& bar, int tensOfHertz) {
    bar.label->setText(caption({21}) + QLatin1Char(' ') + toText(deviationText(bar.deviation, tensOfHertz)));
    showQuietly(bar.number, tensOfHertz, m_with.marks.judge(bar.setting.sendKey));
}

void StereoPage::showPilotPhase(int degrees) {
    HScroll1_Label->setText(caption({340, "Phase"}) + QStringLiteral(" %1 °").arg(degrees));
    showQuietly(HScroll1_Zahl, degrees, m_with.marks.judge(setting::kPilotPhase.sendKey));
}

std::array<DeviationBar*, 4> StereoPage::deviations() {
    return {&FM_Hub_Scroll, &Pilot_Hub_Scroll, &RDS_Hub_Scroll, &Ari_hub_Scroll};
}

}  // namespace kdx
