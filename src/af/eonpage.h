#pragma once

#include "ui/controls.h"
#include "ui/pagecontext.h"

#include <QWidget>

#include <functional>
#include <string>

class QCheckBox;
class QComboBox;
class QGroupBox;
class QLabel;
class QLineEdit;
class QListWidget;
class QPushButton;

namespace kdx {

class PictureSwitch;
class Ticker;

/// The page "E O N": describes one other network to the coder. Its PI, which leads every EON command, is the
/// program-wide EON identifier; what else is known of it is held here.
class EonPage : public QWidget {
    Q_OBJECT
public:
    EonPage(const PageContext& with, QWidget* parent);

    /// Captions every control in the current language and fills the programme type list anew; the type shown is then
    /// the one that data set 1 stores as a number.
    void label();

    /// Start-up: brings the controls into the state that data set 1 holds; nothing is stored or sent.
    void loadDataSet();

    /// Asks the coder for the other networks it holds and deletes them one by one. @returns how many deletions went out.
    int removeNetworks();

    /// Sends the network's PI, TA, TP and PS, then its AF lists.
    void sendNetwork();

    /// Sends the AF lists of the current data set that are not empty.
    void EON_AFB_Senden_Click();
    /// How many commands that sends.
    [[nodiscard]] int listsToSend() const;

    /// Replaces how the list editor is opened; the call returns when the editor has closed. By default the editor's
    /// window is shown, modal over this one.
    void openEditorBy(std::function<void()> openEditor) { m_openEditor = std::move(openEditor); }

private:
    void create();
    void arrange();
    void arrangeProgramme();
    void arrangeLists();
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
    [[nodiscard]] bool mayAnnounce();
    void chooseStoredProgrammeType();
    void store(const char* key, const std::string& value);
    [[nodiscard]] std::string storedList(int number) const;

    PageContext m_with;
    std::function<void()> m_openEditor;
    std::string m_eonPs;
    std::string m_eonPty;        // the chosen type's name; as stored until one is chosen
    std::string m_eonTp = "0";   // "1" or "0"
    std::string m_eonTa = "0";   // "1" or "0"
    bool m_switchingTa = false;  // the switch's handler is running, perhaps waiting for a box to be closed

    QGroupBox* m_programme = nullptr;
    QLabel* EON_PI_Label = nullptr;
    QLineEdit* EON_PI_Text = nullptr;
    QPushButton* EON_PI_Taste = nullptr;
    QLabel* EON_PS_LABEL = nullptr;
    QLineEdit* EON_PS_Text = nullptr;
    QPushButton* EON_PS_Taste = nullptr;
    QLabel* EON_PTY_LAbel = nullptr;
    QComboBox* EON_PTY_Combo = nullptr;
    QCheckBox* EON_TP_Check = nullptr;
    QLabel* EON_TA_Label = nullptr;
    PictureSwitch* EON_TA_Schalter = nullptr;
    Ticker* EON_TA_Zeit = nullptr;  // ends the announcement one second after it was given

    QGroupBox* Frame3 = nullptr;
    OptionArray<5> EON_AFB_Opt;
    QLabel* m_tunedHeading = nullptr;
    QLabel* Tuned_AFB = nullptr;  // tuned frequency of the list shown
    QLabel* m_listHeading = nullptr;
    QListWidget* AFB_Liste = nullptr;
    QPushButton* EON_AF_Bearbeiten = nullptr;
    QPushButton* EON_AFB_Senden = nullptr;
};

}  // namespace kdx
