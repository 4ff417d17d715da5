#pragma once

#include "groups/groupsequence.h"
#include "groups/sequencelabel.h"
#include "ui/page.h"

#include <QPushButton>
#include <QScrollArea>

#include <array>

namespace kdx {

/// The page "Gruppen": composes the order in which the coder sends its groups.
class GroupPage : public Page {
    Q_OBJECT
public:
    /// @param sequence what is composed; lent.
    GroupPage(const PageContext& with, GroupSequence& sequence, QWidget* parent);

    void label() override;
    /// Start-up: shows the sequence of data set 1; both counters start at 0.
    void load() override;
    void showDataSet() override { GroupPage::load(); }
    /// Shows the sequence of data set 1 again, in place of what was composed.
    void opened() override;
    /// The sequence that goes out is stored in the data set at work.
    void stepGoesOut(const Step& step) override;

private:
    void create();
    void arrange();
    void Gruppe_Click(int number);  // Gruppe0_Click to Gruppe15_Click
    void newList_Click();
    void GS_Senden_Click();
    void Gruppenfolge();
    void countAnew();
    void showStored();
    void showSequence();

    GroupSequence& m_sequence;

    std::array<QPushButton*, kGroups> Gruppe{};  // sixteen buttons of their own: Gruppe0 to Gruppe15
    QPushButton* newList = nullptr;
    QPushButton* GS_Senden = nullptr;
    SequenceLabel* Label10 = nullptr;  // heading and sequence
    QScrollArea* m_sequenceView = nullptr;
    QLabel* m_note = nullptr;  // that a sequence is longer than can be read back
};

}  // namespace kdx
