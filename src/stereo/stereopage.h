#pragma once

#include <QWidget>

#include <string>

#include "stereo/deviation.h"
#include "stereo/settingscrollbar.h"
#include "ui/controls.h"
#include "ui/pagecontext.h"

class QGroupBox;
class QLabel;
class QPushButton;

namespace kdx {

class PictureSwitch;

/// The page "FM / Stereo": the multiplex signal with its source, pilot tone, RDS subcarrier and ARI. Every control acts
/// at once: its handler sends the new value and stores it in section "FM" of the general settings.
class StereoPage : public QWidget {
    Q_OBJECT
public:
    /// @param testMode the frame of the test mode, made without a parent: it gets its place on this page.
    StereoPage(const PageContext& with, QWidget* testMode, QWidget* parent);

    /// Captions every control in the current language; the values stay.
    void label();
    /// Sets the controls from the general settings. Nothing is sent or stored but by the handlers of the on/off
    /// buttons, which run: afterwards flag, picture and stored value are what the file said.
    void loadSettings();
    /// Hides the RDS phase, which the program has no command for.
    void hideRdsPhase();
    /// Sends all settings of this page that belong to a data set.
    void sendSettings();
    static constexpr int kSettingsCommands = 7;  ///< how many commands that sends
    /// Total deviation as it is sent: five digits, units of 10 Hz.
    [[nodiscard]] std::string totalDeviation() const;
    /// Modulation source as it is sent: "0" to "3", or "" when none is chosen.
    [[nodiscard]] std::string sourceValue() const;
    /// Selects the first input impedance as a click would: nothing is sent or stored when it is chosen already.
    void selectFirstImpedance();
    [[nodiscard]] bool isFirstImpedanceChosen() const;

signals:
    /// `Btn_SetRdsStereo` was pressed: everything is to be sent.
    void setRdsStereoRequested();

private:
    void FM_Hub_Scroll_Change();
    void Pilot_Hub_Scroll_Change();
    void RDS_Hub_Scroll_Change();
    void Ari_hub_Scroll_Change();
    void HScroll1_Change();
    void FM_Source_Opt_Click(int index);
    void FM_Imp_Opt_Click(int index);
    void Pre_opt_Click(int index);
    void Stereo_Opt_Click(int index);
    void ARI_Mode_Opt_Click(int index);
    void BK_Opt_Click(int index);
    void Pilot_OnOff_Click();
    void RDS_OnOff_Click();
    void Ari_OnOff_Click();

    QWidget* makeFmFrame();
    QWidget* makeStereoFrame();
    QWidget* makeRdsFrame();
    QWidget* makeAriFrame();
    /// A scroll bar for a deviation, its label following it while it is dragged.
    void makeDeviation(const Deviation& deviation, SettingScrollBar* scroll, QLabel* value);

    void showDeviation(const Deviation& deviation, int tensOfHertz, QLabel* value);
    void showPilotPhase(int degrees);
    void showValues();
    void changeDeviation(const Deviation& deviation, const QScrollBar* scroll, QLabel* value);
    void chooseOption(const char* sendKey, const char* profileKey, const std::string& value);
    void toggle(PictureSwitch* button, const char* key);
    /// Sets an on/off button to its stored state by its own handler.
    void restore(PictureSwitch* button, const char* key, void (StereoPage::*handler)());
    [[nodiscard]] std::string stored(const char* key) const;
    void store(const char* key, const std::string& value);

    PageContext m_with;

    QGroupBox* FM_Frame = nullptr;
    SettingScrollBar* FM_Hub_Scroll = nullptr;
    QLabel* FM_Hub_Label2 = nullptr;
    QGroupBox* FM_Sorce_Frame = nullptr;
    OptionArray<4> FM_Source_Opt;
    QGroupBox* FM_Imp_Frame = nullptr;
    OptionArray<2> FM_Imp_Opt;
    QGroupBox* Pre_Frame = nullptr;
    OptionArray<3> Pre_opt;

    QGroupBox* Frame_stereo = nullptr;
    OptionArray<5> Stereo_Opt;
    QLabel* m_pilotHeading = nullptr;
    PictureSwitch* Pilot_OnOff = nullptr;
    SettingScrollBar* Pilot_Hub_Scroll = nullptr;
    QLabel* Pilot_hub_Label = nullptr;
    SettingScrollBar* HScroll1 = nullptr;  // pilot phase in degrees
    QLabel* HScroll1_Label = nullptr;

    QGroupBox* RDS_Frame = nullptr;
    PictureSwitch* RDS_OnOff = nullptr;
    SettingScrollBar* RDS_Hub_Scroll = nullptr;
    QLabel* RDS_Hub_Label = nullptr;
    QLabel* RDS_Phase_Label = nullptr;
    SettingScrollBar* RDS_Phase_Scroll = nullptr;

    QGroupBox* Ari_Frame = nullptr;
    PictureSwitch* Ari_OnOff = nullptr;
    SettingScrollBar* Ari_hub_Scroll = nullptr;
    QLabel* Ari_Label = nullptr;
    OptionArray<4> ARI_Mode_Opt;
    QLabel* m_areaHeading = nullptr;
    OptionArray<6> BK_Opt;  // ARI area code

    QPushButton* Btn_SetRdsStereo = nullptr;
};

}  // namespace kdx
