#pragma once

#include "ui/clickablelabel.h"
#include "ui/form.h"

#include <QDialog>
#include <QListView>
#include <QPushButton>

class QBoxLayout;

namespace kdx {

class ShownList;

/// The editor of the TMC event and location lists: shows both files of the data folder and appends entries to them.
class TMC_Listedit : public QDialog, public Form {
    Q_OBJECT
public:
    TMC_Listedit(const PageContext& with, QWidget* parent);

    /// Captions every control in the current language.
    void label();
    /// The escape key and the window's own button: asks before a text or code that was not added is lost.
    void reject() override;

    /// Fills `List1` from the event file. @throws std::runtime_error when it cannot be read; the list is then empty.
    void Event_Laden();
    /// Appends the entry to the event file, which is created when missing, and reloads the list. False, and told in a
    /// box, when the file cannot be written; it is then as it was.
    bool Event_anhaengen();
    /// As Event_Laden, for `List2` and the location file.
    void Location_Laden();
    /// As Event_anhaengen, for the location file.
    bool Location_Anhaengen();

protected:
    void showEvent(QShowEvent* event) override;

private:
    void create();
    QListView* createList(const char* name, ShownList* entries);
    ClickableLabel* createInput(const char* name, const Caption& what, void (TMC_Listedit::*handler)());
    QBoxLayout* arrangeList(QLabel* columns, QListView* list, QLabel* text, QLabel* code, QPushButton* add);
    [[nodiscard]] QString columns(const Caption& text, const Caption& code) const;

    void Form_Load();
    void Event_Input_Nr_Click() { ask(Event_Input_Nr); }
    void Event_Input_TXT_Click() { ask(Event_Input_TXT); }
    void Loc_Input_Nr_Click() { ask(Loc_Input_Nr); }
    void Loc_INput_TXT1_Click() { ask(Loc_INput_TXT1); }
    void Event_Hinzu_Click() { take(Event_Input_TXT, Event_Input_Nr, &TMC_Listedit::Event_anhaengen); }
    void Loc_Hinzu_Click() { take(Loc_INput_TXT1, Loc_Input_Nr, &TMC_Listedit::Location_Anhaengen); }
    void Eintrag_Aendern_Click();
    void Eintrag_Loeschen_Click();
    void Zuruek_Knopf_Click() { QDialog::reject(); }

    /// The list with the chosen entry, and what it is made of; no row where none is chosen.
    struct Chosen {
        QListView* list = nullptr;
        ShownList* entries = nullptr;
        const char* fileName = nullptr;
        const QLabel *text = nullptr, *code = nullptr;
        int row = -1;
    };
    [[nodiscard]] Chosen chosen() const;
    void chooseOnlyIn(QListView* list);
    void showChange(const Chosen& where, bool changed);
    void tellUnsaved(const char* fileName);
    void ask(QLabel* label);
    bool append(QListView* list, ShownList* entries, const QLabel* text, const QLabel* code, const char* fileName);
    /// Appends a whole entry and makes room for the next one; what cannot be stored stays to be tried again.
    void take(QLabel* text, QLabel* code, bool (TMC_Listedit::*appendIt)());

    QLabel* Label1 = nullptr;
    QListView* List1 = nullptr;  // events
    ShownList* m_events = nullptr;
    ClickableLabel* Event_Input_TXT = nullptr;
    ClickableLabel* Event_Input_Nr = nullptr;
    QPushButton* Event_Hinzu = nullptr;
    QLabel* Label2 = nullptr;
    QListView* List2 = nullptr;  // locations
    ShownList* m_locations = nullptr;
    ClickableLabel* Loc_INput_TXT1 = nullptr;
    ClickableLabel* Loc_Input_Nr = nullptr;
    QPushButton* Loc_Hinzu = nullptr;
    QLabel* m_codeNote = nullptr;  // the end of the location table
    QPushButton *Eintrag_Aendern = nullptr, *Eintrag_Loeschen = nullptr;
    QPushButton* Zuruek_Knopf = nullptr;
};

}  // namespace kdx
