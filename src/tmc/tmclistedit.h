#pragma once

#include "ui/caption.h"
#include "ui/clickablelabel.h"
#include "ui/pagecontext.h"

#include <QDialog>
#include <QLabel>
#include <QListWidget>
#include <QPushButton>

class QLayout;

namespace kdx {

/// The editor of the TMC event and location lists: shows both files of the data folder and appends entries to them.
class TMC_Listedit : public QDialog {
    Q_OBJECT
public:
    TMC_Listedit(const PageContext& with, QWidget* parent);

    /// Captions every control in the current language.
    void label();

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
    void arrange();
    QLayout* arrangeEntry(QLabel* heading, QListWidget* list, QLabel* text, QLabel* code, QPushButton* add);
    [[nodiscard]] QString heading(const Caption& text, const Caption& code) const;

    void Form_Load();
    void Event_Input_Nr_Click();
    void Event_Input_TXT_Click();
    void Loc_Input_Nr_Click();
    void Loc_INput_TXT1_Click();
    void Event_Hinzu_Click();
    void Loc_Hinzu_Click();
    void Zuruek_Knopf_Click();

    void ask(QLabel* label);
    void load(QListWidget* list, const char* fileName);
    bool append(const QLabel* text, const QLabel* code, const char* fileName);

    PageContext m_with;
    CaptionBook m_book;
    QLabel* Label1 = nullptr;
    QListWidget* List1 = nullptr;  // events
    ClickableLabel* Event_Input_TXT = nullptr;
    ClickableLabel* Event_Input_Nr = nullptr;
    QPushButton* Event_Hinzu = nullptr;
    QLabel* Label2 = nullptr;
    QListWidget* List2 = nullptr;  // locations
    ClickableLabel* Loc_INput_TXT1 = nullptr;
    ClickableLabel* Loc_Input_Nr = nullptr;
    QPushButton* Loc_Hinzu = nullptr;
    QPushButton* Zuruek_Knopf = nullptr;
};

}  // namespace kdx
