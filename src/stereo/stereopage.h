#pragma once

#include <array>
#include <string>

#include "stereo/multiplexcontrols.h"
#include "stereo/settings.h"
#include "ui/page.h"

class QGroupBox;
class QPushButton;
class QSpinBox;

namespace kdx {

/// The page "FM / Stereo": the multiplex signal with its source, pilot tone, RDS subcarrier and ARI. Every control acts
/// at once: its handler keeps the new value in the multiplex, sends it and stores it in the general settings.
class StereoPage : public Page {
    Q_OBJECT
public:
    /// @param testMode the frame of the test mode, made without a parent: it gets its place on this page and hears
    /// through it.
    StereoPage(const PageContext& with, Multiplex& multiplex, Page* testMode, QWidget* parent);

    void label() override;
    /// Shows the multiplex; of the handlers those of the on/off buttons run. Hides the RDS phase, as no command sets
    /// it.
    void load() override;
    void opened() override { m_testMode->opened(); }
    void stepGoesOut(const Step& step) override;

signals:
    /// `Btn_SetRdsStereo` was pressed: everything is to be sent.
    void setRdsStereoRequested();

private:
    void FM_Hub_Scroll_Change() { changeDeviation(FM_Hub_Scroll); }
    void Pilot_Hub_Scroll_Change() { changeDeviation(Pilot_Hub_Scroll); }
    void RDS_Hub_Scroll_Change() { changeDeviation(RDS_Hub_Scroll); }
    void Ari_hub_Scroll_Change() { changeDeviation(Ari_hub_Scroll); }
    void HScroll1_Change();
    void FM_Source_Opt_Click(int index) { change(FM_Source_Opt, FM_Source_Opt.text(index)); }
    void FM_Imp_Opt_Click(int index) { change(FM_Imp_Opt, FM_Imp_Opt.text(index)); }
    void Pre_opt_Click(int index) { change(Pre_opt, Pre_opt.text(index)); }
    void Stereo_Opt_Click(int index) { change(Stereo_Opt, Stereo_Opt.text(index)); }
    void ARI_Mode_Opt_Click(int index) { change(ARI_Mode_Opt, ARI_Mode_Opt.text(index)); }
    void BK_Opt_Click(int index) { change(BK_Opt, BK_Opt.text(index)); }
    void Pilot_OnOff_Click() { turn(Pilot_OnOff, Pilot_OnOff.value != "1"); }
    void RDS_OnOff_Click() { turn(RDS_OnOff, RDS_OnOff.value != "1"); }
    void Ari_OnOff_Click() { turn(Ari_OnOff, Ari_OnOff.value != "1"); }

    void change(const Adjustment& what, const std::string& value);
    void changeDeviation(const DeviationBar& bar);
    void turn(const FlagSwitch& flag, bool on);
    void showDeviation(const DeviationBar& bar, int tensOfHertz);
    void showPilotPhase(int degrees);
    [[nodiscard]] std::array<DeviationBar*, 4> deviations();

    void create();
    void createFm();
    void createStereo();
    void createSubcarriers();
    void createDeviation(DeviationBar& bar, const char* scroll, const char* label, const char* number,
                         const Caption& spoken, QWidget* frame, void (StereoPage::*handler)());
    void createSwitch(FlagSwitch& flag, const char* name, const Caption& spoken, QWidget* frame,
                      void (StereoPage::*handler)());
    void arrange();
    void arrangeFrames();

    Multiplex& m_multiplex;
    Page* m_testMode;

    QGroupBox *FM_Frame = nullptr, *Frame_stereo = nullptr, *RDS_Frame = nullptr, *Ari_Frame = nullptr;
    QGroupBox *FM_Sorce_Frame = nullptr, *FM_Imp_Frame = nullptr, *Pre_Frame = nullptr;
    QLabel *m_pilotHeading = nullptr, *m_areaHeading = nullptr;

    DeviationBar FM_Hub_Scroll{kTotalDeviation, m_multiplex.totalDeviation};     // with FM_Hub_Label2
    DeviationBar Pilot_Hub_Scroll{kPilotDeviation, m_multiplex.pilotDeviation};  // with Pilot_hub_Label
    DeviationBar RDS_Hub_Scroll{kRdsDeviation, m_multiplex.rdsDeviation};        // with RDS_Hub_Label
    DeviationBar Ari_hub_Scroll{kAriDeviation, m_multiplex.ariDeviation};        // with Ari_Label
    Choice<4> FM_Source_Opt{{setting::kSource, m_multiplex.source}};
    Choice<2> FM_Imp_Opt{{setting::kImpedance, m_multiplex.impedance}};
    Choice<3> Pre_opt{{setting::kPreemphasis, m_multiplex.preemphasis}};
    Choice<5> Stereo_Opt{{setting::kStereoMode, m_multiplex.stereoMode}};
    Choice<4> ARI_Mode_Opt{{setting::kAriType, m_multiplex.ariType}};
    Choice<6> BK_Opt{{setting::kAriArea, m_multiplex.ariArea}, areaCode};
    FlagSwitch Pilot_OnOff{{setting::kPilot, m_multiplex.pilot}};
    FlagSwitch RDS_OnOff{{setting::kRds, m_multiplex.rds}};
    FlagSwitch Ari_OnOff{{setting::kAri, m_multiplex.ari}};

    SettingScrollBar* HScroll1 = nullptr;  // pilot phase in degrees
    QSpinBox* HScroll1_Zahl = nullptr;
    SettingScrollBar* RDS_Phase_Scroll = nullptr;
    QLabel *HScroll1_Label = nullptr, *RDS_Phase_Label = nullptr;
    QPushButton* Btn_SetRdsStereo = nullptr;
};

}  // namespace kdx
