#pragma once

#include "groups/groupsequence.h"
#include "ui/pagecontext.h"

#include <QWidget>

#include <array>
#include <string>

class QPushButton;
class QScrollArea;

namespace kdx {

class SequenceLabel;

/// The page "Gruppen": composes the order in which the coder sends its groups.
class GroupPage : public QWidget {
    Q_OBJECT
public:
    GroupPage(const PageContext& with, QWidget* parent);

    /// Captions every control in the current language; the chosen groups stay.
    void label();

    /// Start-up: shows the sequence of data set 1; both counters start at 0.
    void loadDataSet();

    /// The page has been opened: shows the sequence of data set 1 again, in place of what was composed.
    void pageOpened();

    /// Stores the sequence in the current data set and sends it; does neither without a sequence.
    void Gruppenfolge();
    [[nodiscard]] bool hasSequence() const { return !m_groups.empty(); }

private:
    void create();
    void arrange();
    void Gruppe_Click(int number);  // Gruppe0_Click to Gruppe15_Click
    void newList_Click();
    void GS_Senden_Click();
    void showStored();
    void showSequence();

    PageContext m_with;
    std::string m_groups;  ///< what follows the heading and its colon; kept apart, as headings differ in length

    std::array<QPushButton*, kGroups> Gruppe{};  // sixteen buttons of their own: Gruppe0 to Gruppe15
    QPushButton* newList = nullptr;
    QPushButton* GS_Senden = nullptr;
    SequenceLabel* Label10 = nullptr;  // heading and sequence
    QScrollArea* m_sequenceView = nullptr;
};

}  // namespace kdx
