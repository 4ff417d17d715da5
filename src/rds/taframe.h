#pragma once

#include <QCheckBox>
#include <QGroupBox>
#include <QPushButton>

#include "base/clock.h"
#include "ui/automatics.h"
#include "ui/page.h"

namespace kdx {

struct Programme;

/// The traffic announcement by hand or by itself: an announcement of a set duration, repeated after a set period.
/// Times are seconds since midnight in single precision and are not corrected at midnight.
class TaFrame : public Page {
    Q_OBJECT
public:
    /// @param programme its traffic flags: whether there is a traffic programme, and the announcement by hand; lent.
    TaFrame(const PageContext& with, Programme& programme, QWidget* parent);

    /// Captions everything in the current language; times keep their values.
    void label() override;
    /// Sets duration and period from the general settings; sends and stores nothing.
    void load() override;
    void stepGoesOut(const Step& step) override;
    /// The traffic programme flag was switched: announcements can be chosen only while it is on.
    void setTrafficProgramme(bool on);

signals:
    /// Choosing manual or automatic stops a running dynamic PS.
    void optionChosen();

private:
    void create();
    QScrollBar* createTime(const char* name, int shortest, int longest, void (TaFrame::*shown)(int),
                           void (TaFrame::*handler)());
    void arrange();

    void TA_Check_Click();
    void TA_Option_Click(int index);
    void TA_HScroll_Change();
    void TA_Rep_HScroll_Change();
    void TA_Timer_Timer();
    void TA_Rep_Timer_Timer();
    void TA_EON_Hilfe_Click();

    [[nodiscard]] float now() const { return static_cast<float>(m_with.clock.secondsSinceMidnight()); }
    void endAutomatic();
    /// Nothing is announced any more, on the air too.
    void endAnnouncement();
    /// The announcement by hand was switched: while it runs the automatic cannot be chosen.
    void showByHand(bool on);
    void showAnnouncing(bool announcing);
    void showDuration(int seconds);
    void showPeriod(int seconds);
    void sendTa(std::string value);

    QGroupBox* Frame1 = nullptr;
    QCheckBox* TA_Check = nullptr;
    OptionArray<2> TA_Option;
    QScrollBar* TA_HScroll = nullptr;  // announcement duration
    QLabel* TA_Zeit_Label = nullptr;
    QScrollBar* TA_Rep_HScroll = nullptr;  // repetition period
    QLabel* TA_Rep_Label = nullptr;
    QPushButton* TA_EON_Hilfe = nullptr;
    QLabel *m_durationTitle = nullptr, *m_periodTitle = nullptr;
    Ticker *TA_Timer = nullptr, *TA_Rep_Timer = nullptr;

    Programme& m_programme;
    Automatic m_automatic;
    bool m_offSent = false;
    bool m_statusShown = false;  ///< the TA indicator shows one of the two words
    bool m_announcing = false;
    float m_announcementStart = 0;
    float m_repetitionStart = 0;
};

}  // namespace kdx
