#pragma once

#include <QWidget>

#include <string>

#include "ui/controls.h"
#include "ui/pagecontext.h"

class QCheckBox;
class QComboBox;
class QGroupBox;
class QLabel;
class QLineEdit;
class QPushButton;

namespace kdx {

class ClickableLabel;
class DynamicPs;
class PictureSwitch;
class TaFrame;
class Ticker;

/// The page "R D S": programme service name, identification and type, traffic flags, music/speech, decoder
/// information, radiotext and clock time.
class RdsPage : public QWidget {
    Q_OBJECT
public:
    RdsPage(const PageContext& with, QWidget* parent);

    /// Captions everything in the current language; entries, times and indicators keep their values.
    void label();
    /// Fills the programme type list in the current language and standard and selects the one stored in data set 1.
    void fillProgrammeTypes();

    /// Start-up: duration and period of the traffic announcements.
    void loadTaSettings();
    /// Start-up: PS, PI, radiotext, music/speech and decoder information of data set 1; nothing is sent or stored.
    void loadDataSet();
    /// Start-up: the programme type of data set 1 and its indicator.
    void loadProgrammeType();
    void Zeit_Taste_Click();

    /// Sends the traffic programme and traffic announcement flags as the window shows them.
    void sendTrafficFlags();
    /// Sends PI, PS, music/speech, radiotext or programme type as they stand.
    void sendPi();
    void sendPs();
    void sendMusicSpeech();
    void sendRadiotext();
    void sendProgrammeType();

    /// Caption of `Uhr_Zeit`: the time that is sent to the coder.
    [[nodiscard]] std::string clockText() const;

private:
    // In the order in which the tab key walks the page.
    void createServiceControls();
    void createTraffic();
    void createMusicSpeech();
    void createClock();
    void createDecoderInfo();
    void createRadiotext();
    void arrange();

    void PS_Taste_Click();
    void PI_T_Change();
    void Command3_Click();
    void PTY_Combo1_Click();
    void Check1_Click();
    void MS_opt_Click(int index);
    void DI_Opt_Click(int index);
    void RT_Taste1_Click();
    void RT_clear1_Click();
    void Timer1_Timer();
    void Uhr_Zeit_DblClick();

    void store(const char* key, const std::string& value);
    void showMusicSpeech();
    void showTrafficProgramme();
    [[nodiscard]] QString pcTime() const;

    QLabel* PS_Label = nullptr;
    QLineEdit* PS_T = nullptr;
    QPushButton* PS_Taste = nullptr;
    QLabel* PI_Label = nullptr;
    QLineEdit* PI_T = nullptr;
    QPushButton* Command3 = nullptr;  // sends the PI
    QLabel* Label1 = nullptr;         // heading of the programme type list
    QComboBox* PTY_Combo1 = nullptr;
    QCheckBox* Check1 = nullptr;  // traffic programme (TP)
    QLabel* Image1 = nullptr;     // picture of the page
    TaFrame* m_ta = nullptr;
    DynamicPs* m_dynamicPs = nullptr;

    QGroupBox* MS_Frame = nullptr;
    OptionArray<2> MS_opt;
    QGroupBox* DI_Frame = nullptr;
    OptionArray<16> DI_Opt;
    QGroupBox* RT_Frame = nullptr;
    QLineEdit* RT_Text1 = nullptr;
    QPushButton* RT_Taste1 = nullptr;
    QPushButton* RT_clear1 = nullptr;
    QGroupBox* Time_Frame = nullptr;
    PictureSwitch* Zeit_Taste = nullptr;
    ClickableLabel* Uhr_Zeit = nullptr;
    Ticker* Timer1 = nullptr;  // sends the clock

    PageContext m_with;
    bool m_clockOn = false;
    bool m_clockShowsWord = true;  ///< `Uhr_Zeit` shows the off word, not a time
    bool m_trafficProgrammeShown = false;
};

}  // namespace kdx
