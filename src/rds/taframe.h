#pragma once

#include <QGroupBox>
#include <QScrollBar>

#include <functional>

#include "ui/controls.h"
#include "ui/pagecontext.h"

class QCheckBox;
class QLabel;
class QPushButton;

namespace kdx {

class Ticker;

/// The traffic announcement by hand or by itself: an announcement of a set duration, repeated after a set period.
/// Times are seconds since midnight in single precision and are not corrected at midnight.
class TaFrame : public QGroupBox {
    Q_OBJECT
public:
    /// @param trafficProgramme tells whether the traffic programme flag (`Check1`) is ticked.
    TaFrame(const PageContext& with, std::function<bool()> trafficProgramme, QWidget* parent);

    /// Captions everything in the current language; times keep their values.
    void label();
    /// Sets duration and period from the general settings; sends and stores nothing.
    void loadSettings();
    /// The traffic programme flag was switched: announcements can be chosen only while it is on.
    void setTrafficProgramme(bool on);

    void TA_Check_Click();

signals:
    /// Choosing manual or automatic stops a running dynamic PS.
    void optionChosen();

private:
    void TA_Option_Click(int index);
    void TA_HScroll_Change();
    void TA_Rep_HScroll_Change();
    void TA_Timer_Timer();
    void TA_Rep_Timer_Timer();
    void TA_EON_Hilfe_Click();

    [[nodiscard]] float now() const;
    void showAnnouncing(bool announcing);
    void showDuration(int seconds);
    void showPeriod(int seconds);
    void sendTa(const char* value);

    QCheckBox* TA_Check = nullptr;
    OptionArray<2> TA_Option;
    QScrollBar* TA_HScroll = nullptr;  // announcement duration
    QLabel* TA_Zeit_Label = nullptr;
    QScrollBar* TA_Rep_HScroll = nullptr;  // repetition period
    QLabel* TA_Rep_Label = nullptr;
    QPushButton* TA_EON_Hilfe = nullptr;
    QLabel* m_durationTitle = nullptr;
    QLabel* m_periodTitle = nullptr;
    Ticker* TA_Timer = nullptr;
    Ticker* TA_Rep_Timer = nullptr;

    PageContext m_with;
    std::function<bool()> m_trafficProgramme;
    bool m_automatic = false;
    bool m_offSent = false;
    bool m_statusShown = false;  ///< the TA indicator shows one of the two words
    bool m_announcing = false;
    float m_announcementStart = 0;
    float m_repetitionStart = 0;
};

}  // namespace kdx
