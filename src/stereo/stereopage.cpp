#include "stereo/stereopage.h"

#include <QLabel>

#include "coder/sendparam.h"
#include "settings/captions.h"
#include "settings/datafolder.h"
#include "settings/storedvalue.h"
#include "ui/pictureswitch.h"
#include "ui/text.h"

namespace kdx {

namespace {

constexpr const char* kSection = "FM";
constexpr int kDeviationCaption = 21;
constexpr int kPhaseCaption = 340;

/// What a group of options stands for: the chosen one's number, or "" when none is chosen.
template <std::size_t Count>
std::string optionValue(const OptionArray<Count>& options) {
    return options.chosen() < 0 ? std::string() : std::to_string(options.chosen());
}

/// The area code of an option: a letter, "" for none.
std::string areaCode(int index) {
    return index < 0 ? std::string() : std::string(1, static_cast<char>('A' + index));
}

std::string flag(const PictureSwitch* button) {
    return button->isChecked() ? "1" : "0";
}

}  // namespace

void StereoPage::loadSettings() {
    setQuietly(FM_Hub_Scroll, storedPosition(stored(kTotalDeviation.profileKey), 0, kTotalDeviation.highest));
    FM_Source_Opt.choose(storedOption(stored("MPX_SOURCE"), 0, 3));
    // The file counts from 1, the click stores its index from 0: settings files have always been read so.
    FM_Imp_Opt.choose(storedOption(stored("MPX_IMPEDANZ"), 1, 2));
    Stereo_Opt.choose(storedOption(stored("Stereo_Mode"), 0, 4));
    Pre_opt.choose(storedOption(stored("PREEMPHASIS"), 0, 2));
    restore(Pilot_OnOff, "PILOT", &StereoPage::Pilot_OnOff_Click);
    setQuietly(Pilot_Hub_Scroll, storedPosition(stored(kPilotDeviation.profileKey), 0, kPilotDeviation.highest));
    setQuietly(HScroll1, storedPosition(stored("PILOT_PHASE"), HScroll1->minimum(), HScroll1->maximum()));
    restore(Ari_OnOff, "ARI", &StereoPage::Ari_OnOff_Click);
    setQuietly(Ari_hub_Scroll, storedPosition(stored(kAriDeviation.profileKey), 0, kAriDeviation.highest));
    ARI_Mode_Opt.choose(storedOption(stored("ARI_ID"), 0, 3));
    // Numbers, and four of the six areas only; the click stores a letter under "ARI-BK". Nobody reads that one.
    BK_Opt.choose(storedOption(stored("ARI_BK"), 0, 3));
    restore(RDS_OnOff, "RDS", &StereoPage::RDS_OnOff_Click);
    setQuietly(RDS_Hub_Scroll, storedPosition(stored(kRdsDeviation.profileKey), 0, kRdsDeviation.highest));
    setQuietly(RDS_Phase_Scroll, storedPosition(stored("RDS_PHASE"), 0, RDS_Phase_Scroll->maximum()));
    showValues();
}

void StereoPage::hideRdsPhase() {
    RDS_Phase_Label->hide();
    RDS_Phase_Scroll->hide();
}

void StereoPage::sendSettings() {
    ParamSender& params = m_with.params;
    params.SendParam("PREEMPHASIS", optionValue(Pre_opt));
    params.SendParam("PILOT", flag(Pilot_OnOff));
    params.SendParam("PILOT_HUB", deviationSetting(kPilotDeviation, Pilot_Hub_Scroll->value()));
    params.SendParam("PILOT_PHASE", pilotPhaseSetting(HScroll1->value()));
    params.SendParam("ARI", flag(Ari_OnOff));
    // These three are spelled otherwise than the commands are ("ARI-HUB", "ARI-ID", "ARI-BK"), so none is found and
    // none sent: the whole data set leaves the ARI details of the instrument as they are.
    params.SendParam("ARI_HUB", deviationSetting(kAriDeviation, Ari_hub_Scroll->value()));
    params.SendParam("ARI_ID", optionValue(ARI_Mode_Opt));
    params.SendParam("AR_BK", areaCode(BK_Opt.chosen()));
    params.SendParam("RDS", flag(RDS_OnOff));
    params.SendParam("RDS_HUB", deviationSetting(kRdsDeviation, RDS_Hub_Scroll->value()));
}

std::string StereoPage::totalDeviation() const {
    return deviationSetting(kTotalDeviation, FM_Hub_Scroll->value());
}

std::string StereoPage::sourceValue() const {
    return optionValue(FM_Source_Opt);
}

bool StereoPage::isFirstImpedanceChosen() const {
    return FM_Imp_Opt[0]->isChecked();
}

void StereoPage::selectFirstImpedance() {
    if (isFirstImpedanceChosen()) return;
    FM_Imp_Opt.choose(0);
    FM_Imp_Opt_Click(0);
}

void StereoPage::FM_Hub_Scroll_Change() {
    changeDeviation(kTotalDeviation, FM_Hub_Scroll, FM_Hub_Label2);
}

void StereoPage::Pilot_Hub_Scroll_Change() {
    changeDeviation(kPilotDeviation, Pilot_Hub_Scroll, Pilot_hub_Label);
}

void StereoPage::RDS_Hub_Scroll_Change() {
    changeDeviation(kRdsDeviation, RDS_Hub_Scroll, RDS_Hub_Label);
}

void StereoPage::Ari_hub_Scroll_Change() {
    changeDeviation(kAriDeviation, Ari_hub_Scroll, Ari_Label);
}

void StereoPage::changeDeviation(const Deviation& deviation, const QScrollBar* scroll, QLabel* value) {
    showDeviation(deviation, scroll->value(), value);
    std::string setting = deviationSetting(deviation, scroll->value());
    m_with.params.SendParam(deviation.sendKey, setting);
    store(deviation.profileKey, setting);
}

void StereoPage::HScroll1_Change() {
    showPilotPhase(HScroll1->value());
    std::string setting = pilotPhaseSetting(HScroll1->value());
    m_with.params.SendParam("PILOT_PHASE", setting);
    store("PILOT_PHASE", setting);
}

void StereoPage::FM_Source_Opt_Click(int index) {
    chooseOption("MPX_SOURCE", "MPX_SOURCE", std::to_string(index));
}

void StereoPage::FM_Imp_Opt_Click(int index) {
    chooseOption("MPX_IMPEDANZ", "MPX_IMPEDANZ", std::to_string(index));
}

void StereoPage::Pre_opt_Click(int index) {
    chooseOption("PREEMPHASIS", "PREEMPHASIS", std::to_string(index));
}

void StereoPage::Stereo_Opt_Click(int index) {
    chooseOption("STEREO_MODE", "Stereo_Mode", std::to_string(index));
}

void StereoPage::ARI_Mode_Opt_Click(int index) {
    chooseOption("ARI-ID", "ARI_ID", std::to_string(index));
}

void StereoPage::BK_Opt_Click(int index) {
    chooseOption("ARI-BK", "ARI-BK", areaCode(index));
}

void StereoPage::Pilot_OnOff_Click() {
    toggle(Pilot_OnOff, "PILOT");
}

void StereoPage::RDS_OnOff_Click() {
    toggle(RDS_OnOff, "RDS");
}

void StereoPage::Ari_OnOff_Click() {
    toggle(Ari_OnOff, "ARI");
}

void StereoPage::chooseOption(const char* sendKey, const char* profileKey, const std::string& value) {
    m_with.params.SendParam(sendKey, std::string(value));
    store(profileKey, value);
}

void StereoPage::toggle(PictureSwitch* button, const char* key) {
    button->showState(!button->isChecked());
    m_with.params.SendParam(key, flag(button));
    store(key, flag(button));
}

void StereoPage::restore(PictureSwitch* button, const char* key, void (StereoPage::*handler)()) {
    // The handler turns the state over, so it starts from the opposite one.
    button->showState(stored(key) != "1");
    (this->*handler)();
}

void StereoPage::showDeviation(const Deviation& deviation, int tensOfHertz, QLabel* value) {
    value->setText(toText(m_with.captions.text(kDeviationCaption) + " " + deviationText(deviation, tensOfHertz)));
}

void StereoPage::showPilotPhase(int degrees) {
    const std::string phase = m_with.captions.own(kPhaseCaption, "Phase");
    HScroll1_Label->setText(toText(phase + " " + std::to_string(degrees) + " \xB0"));
}

void StereoPage::showValues() {
    showDeviation(kTotalDeviation, FM_Hub_Scroll->sliderPosition(), FM_Hub_Label2);
    showDeviation(kPilotDeviation, Pilot_Hub_Scroll->sliderPosition(), Pilot_hub_Label);
    showDeviation(kRdsDeviation, RDS_Hub_Scroll->sliderPosition(), RDS_Hub_Label);
    showDeviation(kAriDeviation, Ari_hub_Scroll->sliderPosition(), Ari_Label);
    showPilotPhase(HScroll1->sliderPosition());
}

std::string StereoPage::stored(const char* key) const {
    return m_with.data.ReadIni(kSection, key, kGeneralSettings);
}

void StereoPage::store(const char* key, const std::string& value) {
    m_with.data.WriteIni(kSection, key, value, kGeneralSettings);
}

}  // namespace kdx
