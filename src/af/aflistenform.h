#pragma once

#include "af/aflistview.h"
#include "ui/clickablelabel.h"
#include "ui/form.h"

#include <QDialog>
#include <QGroupBox>
#include <QLineEdit>
#include <QPushButton>

namespace kdx {

class AfCounter;
struct Place;

/// The editor of the five AF lists of the current data set: the own programme's or, when ProgramState::afEditorKind is
/// "EON AF", the other network's. It edits and stores only. It opens on list 1, in the current language.
class AF_Listenform : public QDialog, public Form {
    Q_OBJECT
public:
    AF_Listenform(const PageContext& with, QWidget* parent);

    /// The escape key and the window's own button, hit by accident: asks before changes are lost. `Ende_Knopf` says so.
    void reject() override;

protected:
    /// The delete key in the list asks as `Rem_Freq` does.
    bool eventFilter(QObject* watched, QEvent* event) override;

private:
    void create();
    void createOrder();
    void arrange();
    void Form_Load();
    void AFList_Opt_Click(int index);
    void AF_TN_Click();
    void Command1_Click();
    void AF_OF_add_Click();
    void Rem_Freq_Click();
    void AF_Auf_Click() { move(-1); }
    void AF_Ab_Click() { move(1); }
    void AF_Sortieren_Click();
    void Uebernahme_Knopf_Click();
    void Ende_Knopf_Click() { QDialog::reject(); }

    /// Where the list with that option is kept.
    [[nodiscard]] const Place& place(int index) const;
    /// Number of the selected row, -1 when none is selected.
    [[nodiscard]] int selectedRow() const;
    /// What `Text2` reads when it is an allowed AF, or a list of such; else says so and gives nothing.
    [[nodiscard]] QStringList checkedEntries();
    [[nodiscard]] bool takeNumber(QString& text) const;
    /// Puts the entries before the row, shows them and makes ready for the next one.
    void add(int row, const QStringList& entries);
    void move(int rows);
    [[nodiscard]] AfList shownList() const;
    void showHint();
    void refuse(int reason, const QString& details = {});
    void refuseEntry();

    AfListView m_view;                // AFList_Opt, AF_TN, AF_List1
    ClickableLabel* AF_TN = nullptr;  // tuned frequency; a click asks for a new one
    QListWidget* AF_List1 = nullptr;
    QLineEdit* Text2 = nullptr;        // AF to be added, MHz
    QPushButton* Command1 = nullptr;   // appends it
    QPushButton* AF_OF_add = nullptr;  // inserts it before the selected row
    QPushButton* Rem_Freq = nullptr;
    QPushButton *AF_Auf = nullptr, *AF_Ab = nullptr, *AF_Sortieren = nullptr;
    AfCounter* AF_Zaehler = nullptr;
    std::string m_unchanged;   // the list as it was shown
    QLabel* m_hint = nullptr;  // what a comma in the entry does
    QPushButton* Uebernahme_Knopf = nullptr;
    QPushButton* Ende_Knopf = nullptr;

    QGroupBox *m_choice = nullptr, *m_content = nullptr, *m_change = nullptr;
    QLabel* m_entryHeading = nullptr;
};

}  // namespace kdx
