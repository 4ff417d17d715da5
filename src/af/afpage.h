#pragma once

#include "af/aflistset.h"
#include "af/aflistview.h"
#include "ui/page.h"

#include <QGroupBox>
#include <QPushButton>

#include <functional>

namespace kdx {

class AfCounter;

/// The page "AF Liste": shows one of the five lists of alternative frequencies and sends them all.
class AfPage : public Page {
    Q_OBJECT
public:
    /// @param lists those of the data set at work.
    AfPage(const PageContext& with, AfListSet& lists, QWidget* parent);

    void label() override;
    /// Chooses and shows the list that the data set names.
    void load() override;
    void showDataSet() override { AfPage::load(); }
    /// Says so when a list is refused.
    void stepGoesOut(const Step& step) override;

    /// Replaces how the list editor is opened; the call returns when the editor has closed. By default the editor's
    /// window is shown, modal over this one.
    void openEditorBy(std::function<void()> openEditor) { m_openEditor = std::move(openEditor); }

private:
    void create();
    void arrange();
    void AFList_Opt_Click(int index);
    void AF_Bearbeiten_Click();
    void AFMethod_opt_Click(int index);
    void Taste_AF_Senden_Click();
    void showList(int index);
    void refuse(int number);
    /// Whether the lists, as they would be sent now, are those that were.
    void judgeLists();
    void showMarks();

    AfListSet& m_lists;
    std::function<void()> m_openEditor;
    AfMethod m_sentMethod = AfMethod::A;  ///< of the lists in force

    QGroupBox* Frame2 = nullptr;
    AfListView m_view;  // AFList_Opt, AF_TN, AF_List1
    AfCounter* AF_Zaehler = nullptr;
    OptionArray<2> AFMethod_opt;
    QPushButton* Taste_AF_Senden = nullptr;
    QPushButton* AF_Bearbeiten = nullptr;

    QGroupBox *m_choice = nullptr, *m_shown = nullptr, *m_transmission = nullptr;
};

}  // namespace kdx
