#pragma once

#include "af/aflistview.h"
#include "ui/automatics.h"
#include "ui/page.h"

#include <QCheckBox>
#include <QComboBox>
#include <QGroupBox>
#include <QPushButton>

#include <functional>
#include <string>

namespace kdx {

class PictureSwitch;
class SentEntry;
struct OtherNetwork;

/// The page "E O N": describes one other network to the coder. Its PI, which leads every EON command, is the
/// program-wide EON identifier too.
class EonPage : public Page {
    Q_OBJECT
public:
    /// @param network the one of the data set at work.
    EonPage(const PageContext& with, OtherNetwork& network, QWidget* parent);

    /// Fills the programme type list anew too; the type shown is then the one that data set 1 stores as a number.
    void label() override;
    /// The switch shows off whatever is held.
    void load() override;
    /// An announcement of the network left behind ends.
    void showDataSet() override;
    /// What goes out is what the coder has.
    void stepGoesOut(const Step& step) override;
    void stepFailed(const Step& step) override;

    /// Replaces how the list editor is opened; the call returns when the editor has closed. By default the editor's
    /// window is shown, modal over this one.
    void openEditorBy(std::function<void()> openEditor) { m_openEditor = std::move(openEditor); }

private:
    void create();
    void createProgramme();
    void createLists();
    void arrange();
    void EON_PI_Text_Change();
    void EON_PI_Taste_Click();
    void EON_PS_Text_Change();
    void EON_PS_Taste_Click();
    void EON_PTY_Combo_Change();
    void EON_TP_Check_Click();
    void EON_TA_Schalter_Click();
    void EON_TA_Zeit_Timer();
    void EON_AFB_Opt_Click(int index);
    void EON_AF_Bearbeiten_Click();
    void EON_AFB_Senden_Click();
    void holdPi(const std::string& pi);
    [[nodiscard]] bool mayAnnounce();
    void setAnnouncing(bool on);
    void showStoredProgrammeType();
    /// The coder has the network anew: nothing of it but its PI.
    void forgetNetwork();
    /// Whether the lists are those that were sent.
    void judgeLists();
    void markList();

    OtherNetwork& m_network;
    std::function<void()> m_openEditor;
    Automatic m_announcing;
    bool m_switchingTa = false;  // the switch's handler is running, perhaps waiting for a box to be closed

    QGroupBox* m_programme = nullptr;
    QLabel* EON_PI_Label = nullptr;
    SentEntry* EON_PI_Text = nullptr;
    QPushButton* EON_PI_Taste = nullptr;
    QLabel* EON_PS_LABEL = nullptr;
    SentEntry* EON_PS_Text = nullptr;
    QPushButton* EON_PS_Taste = nullptr;
    QLabel* EON_PTY_LAbel = nullptr;
    QComboBox* EON_PTY_Combo = nullptr;
    QCheckBox* EON_TP_Check = nullptr;
    QLabel* EON_TA_Label = nullptr;
    PictureSwitch* EON_TA_Schalter = nullptr;
    Ticker* EON_TA_Zeit = nullptr;  // ends the announcement one second after it was given

    QGroupBox* Frame3 = nullptr;
    AfListView m_view;  // EON_AFB_Opt, Tuned_AFB, AFB_Liste
    QPushButton* EON_AF_Bearbeiten = nullptr;
    QPushButton* EON_AFB_Senden = nullptr;
};

}  // namespace kdx
