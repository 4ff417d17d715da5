#pragma once

#include "af/aflist.h"
#include "ui/controls.h"
#include "ui/pagecontext.h"

#include <QWidget>

#include <functional>
#include <string>

class QGroupBox;
class QLabel;
class QListWidget;
class QPushButton;

namespace kdx {

/// The page "AF Liste": shows one of the five lists of alternative frequencies and sends them all.
class AfPage : public QWidget {
    Q_OBJECT
public:
    AfPage(const PageContext& with, QWidget* parent);

    /// Captions every control in the current language; the list shown stays.
    void label();

    /// Start-up: chooses and shows the list that data set 1 names, method A; nothing is stored or sent.
    void loadDataSet();

    /// Sends all five lists; nothing at all when list 1 is empty.
    void Taste_AF_Senden_Click();
    /// How many commands that sends.
    [[nodiscard]] int commandsToSend() const;

    /// Replaces how the list editor is opened; the call returns when the editor has closed. By default the editor's
    /// window is shown, modal over this one.
    void openEditorBy(std::function<void()> openEditor) { m_openEditor = std::move(openEditor); }

private:
    void create();
    void arrange();
    void AFList_Opt_Click(int index);
    void AF_Bearbeiten_Click();
    [[nodiscard]] AfMethod chosenMethod() const;
    void showList(int index);
    void sendList(int number, const std::string& list);
    [[nodiscard]] std::string storedList(int number) const;

    PageContext m_with;
    std::function<void()> m_openEditor;

    QGroupBox* Frame2 = nullptr;
    OptionArray<5> AFList_Opt;
    QListWidget* AF_List1 = nullptr;
    QLabel* AF_TN = nullptr;  // tuned frequency of the list shown
    OptionArray<2> AFMethod_opt;
    QPushButton* Taste_AF_Senden = nullptr;
    QPushButton* AF_Bearbeiten = nullptr;

    QGroupBox* m_choice = nullptr;
    QGroupBox* m_shown = nullptr;
    QGroupBox* m_transmission = nullptr;
    QLabel* m_tunedHeading = nullptr;
    QLabel* m_listHeading = nullptr;
};

}  // namespace kdx
