#pragma once

#include "groups/groupsequence.h"
#include "groups/sequencelabel.h"
#include "groups/settings.h"
#include "ui/page.h"
#include "ui/sentvalue.h"

#include <QPushButton>
#include <QScrollArea>

#include <array>
#include <string>
#include <vector>

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
    void stepFailed(const Step& step) override;

private:
    void create();
    void arrange();
    void Gruppe_Click(int number);  // Gruppe0_Click to Gruppe15_Click
    void newList_Click();
    void Gruppe_Zurueck_Click();
    void Gruppe_Vor_Click() { move(-1); }
    void Gruppe_Nach_Click() { move(1); }
    void GS_Senden_Click();
    void Gruppenfolge();
    void countAnew();
    void showStored();
    void showSequence();
    void showShares(const std::vector<std::string>& groups);
    [[nodiscard]] QString heading() const;
    void move(int places);
    /// The group at that character of the label is the one to be moved; the last one where there is none.
    void choose(int character);

    GroupSequence& m_sequence;

    std::array<QPushButton*, kGroups> Gruppe{};  // sixteen buttons of their own: Gruppe0 to Gruppe15
    QPushButton* newList = nullptr;
    QPushButton* Gruppe_Zurueck = nullptr;  // removes the last group
    QPushButton *Gruppe_Vor = nullptr, *Gruppe_Nach = nullptr;
    QPushButton* GS_Senden = nullptr;
    SequenceLabel* Label10 = nullptr;  // heading and sequence
    QScrollArea* m_sequenceView = nullptr;
    QLabel* Gruppe_Anteile = nullptr;  // share of each group
    std::size_t m_chosen = 0;          // the group that is moved
    SentValue m_sent{m_with, setting::kGroupSequence.sendKey};
    QLabel* m_note = nullptr;  // that a sequence is longer than can be read back
};

}  // namespace kdx
