#pragma once

#include <QCheckBox>
#include <QComboBox>
#include <QGroupBox>
#include <QLineEdit>
#include <QPushButton>

#include <optional>

#include "rds/programme.h"
#include "ui/clickablelabel.h"
#include "ui/page.h"
#include "ui/pictureswitch.h"
#include "ui/sententry.h"
#include "ui/statusrow.h"
#include "ui/text.h"

namespace kdx {

class DynamicPs;
class EntryCounter;
class TaFrame;

/// The page "R D S": what the own programme says of itself, and the clock time.
class RdsPage : public Page {
    Q_OBJECT
public:
    /// @param programme the own programme of the data set; lent.
    RdsPage(const PageContext& with, Programme& programme, QWidget* parent);

    /// Fills the programme type list anew as well, and selects the type stored in data set 1.
    void label() override;
    /// The first time the clock is switched on.
    void load() override;
    void showDataSet() override;
    void stepGoesOut(const Step& step) override;
    void stepFailed(const Step& step) override;

private:
    void create();
    void createService();
    QPushButton* sendButton(const char* name, const char* what, SentEntry* entry, void (RdsPage::*handler)());
    void arrange();

    void PS_Taste_Click();
    void PI_T_Change() { m_programme.pi = toBytes(PI_T->text()); }
    void Command3_Click();
    void PTY_Combo1_Click();
    void Check1_Click();
    void MS_opt_Click(int index);
    void DI_Opt_Click(int index);
    void RT_Text1_Change() { m_programme.radiotext = toBytes(RT_Text1->text()); }
    void RT_Taste1_Click();
    void RT_clear1_Click();
    void Zeit_Taste_Click();
    void Timer1_Timer();
    void Uhr_Zeit_DblClick();

    void showProgramme();
    void fillProgrammeTypes();
    void showProgrammeType();
    void showMusicSpeech();
    void showValue(StatusSlot slot, const SentEntry* entry, const std::string& value);
    void setTrafficProgramme(bool on);
    void showTrafficProgramme(bool on);
    void showClock(const QString& text);

    Programme& m_programme;

    QLabel *PS_Label = nullptr, *PI_Label = nullptr;
    SentEntry *PS_T = nullptr, *PI_T = nullptr;
    EntryCounter *PS_Zaehler = nullptr, *PI_Zaehler = nullptr, *RT_Zaehler = nullptr;
    QPushButton* PS_Taste = nullptr;
    QPushButton* Command3 = nullptr;  // sends the PI
    QLabel* Label1 = nullptr;         // heading of the programme type list
    QComboBox* PTY_Combo1 = nullptr;
    DynamicPs* m_dynamicPs = nullptr;
    QCheckBox* Check1 = nullptr;  // traffic programme (TP)
    TaFrame* m_ta = nullptr;
    QLabel* Image1 = nullptr;  // picture of the page
    QGroupBox* MS_Frame = nullptr;
    OptionArray<2> MS_opt;
    QGroupBox* Time_Frame = nullptr;
    PictureSwitch* Zeit_Taste = nullptr;
    ClickableLabel* Uhr_Zeit = nullptr;
    Ticker* Timer1 = nullptr;  // sends the clock
    QGroupBox *DI_Frame = nullptr, *RT_Frame = nullptr;
    OptionArray<16> DI_Opt;
    SentEntry* RT_Text1 = nullptr;
    QPushButton *RT_Taste1 = nullptr, *RT_clear1 = nullptr;

    SentValue m_sentMusicSpeech, m_sentPty;
    bool m_loaded = false, m_clockOn = false;
    bool m_clockShowsWord = true;                 ///< `Uhr_Zeit` shows the off word, not a time
    std::optional<bool> m_shownTrafficProgramme;  ///< what the TP indicator says; nothing at first
};

}  // namespace kdx
