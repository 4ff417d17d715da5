#include "groups/grouppage.h"

#include "groups/settings.h"
#include "settings/programstate.h"
#include "ui/dialogs.h"
#include "ui/layouts.h"
#include "ui/text.h"

namespace kdx {

GroupPage::GroupPage(const PageContext& with, GroupSequence& sequence, QWidget* parent)
    : Page(with, parent), m_sequence(sequence) {
    create();
    arrange();
}

void GroupPage::create() {
    for (int number = 0; number < kGroups; ++number) {
        const std::string name = "Gruppe" + std::to_string(number);
        QPushButton*& button = Gruppe[static_cast<std::size_t>(number)];
        button = captioned<QPushButton>(name.c_str(), {81, "", QStringLiteral(" %1").arg(number)}, this);
        connect(button, &QPushButton::clicked, this, [this, number] { Gruppe_Click(number); });
    }
    m_sequenceView = new QScrollArea(this);
    m_book.spoken(m_sequenceView, {83});
    Label10 = named<SequenceLabel>("Label10", m_sequenceView);
    m_note = captioned<QLabel>("SequenceNote", {460, "Eine gespeicherte Folge wird nur bis zum 254. Zeichen gelesen."},
                               this);
    newList = clicked<QPushButton>("newList", {156}, this, &GroupPage::newList_Click);
    GS_Senden = clicked<QPushButton>("GS_Senden", {82}, this, &GroupPage::GS_Senden_Click);
}

void GroupPage::arrange() {
    constexpr int kColumns = 4;
    auto* page = grid({});
    for (int number = 0; number < kGroups; ++number) {
        QPushButton* button = Gruppe[static_cast<std::size_t>(number)];
        button->setSizePolicy(QSizePolicy::Preferred, QSizePolicy::Preferred);
        page->addWidget(button, number / kColumns, number % kColumns);
        page->setRowStretch(number / kColumns, 2);
        page->setColumnStretch(number % kColumns, 1);
    }

    m_sequenceView->setWidget(Label10);
    m_sequenceView->setWidgetResizable(true);
    m_sequenceView->setHorizontalScrollBarPolicy(Qt::ScrollBarAlwaysOff);
    m_sequenceView->setBackgroundRole(QPalette::Base);
    m_sequenceView->setMinimumHeight(3 * Label10->minimumSizeHint().height());
    // The group chosen last stays in view.
    QScrollBar* bar = m_sequenceView->verticalScrollBar();
    connect(bar, &QScrollBar::rangeChanged, bar, [bar](int, int maximum) { bar->setValue(maximum); });
    const int below = kGroups / kColumns;
    page->setRowMinimumHeight(below, 2 * kGap);
    page->addWidget(m_sequenceView, below + 1, 0, 1, kColumns);
    page->setRowStretch(below + 1, 7);  // as high as three and a half rows of buttons
    page->addWidget(m_note, below + 2, 0, 1, kColumns);
    page->addWidget(newList, below + 3, 0);
    page->addWidget(GS_Senden, below + 3, kColumns - 1);
    layOut(this, page, 2 * kGap);
}

void GroupPage::label() {
    Page::label();
    showSequence();
}

void GroupPage::load() {
    countAnew();
    m_with.state.storedGroupSequence = m_sequence.groups;
    showSequence();
}

void GroupPage::opened() {
    showStored();
    Gruppe[4]->setEnabled(false);
}

void GroupPage::Gruppe_Click(int number) {
    m_sequence.groups += groupText(number);
    m_sequence.composed = true;
    countUp(m_with.state.groupCount);
    if (number == kTmcGroup) countUp(m_with.state.group8ACount);
    showSequence();
}

void GroupPage::newList_Click() {
    m_sequence.startAnew();
    countAnew();
    showSequence();
}

void GroupPage::countAnew() {
    m_with.state.groupCount = 0;
    m_with.state.group8ACount = 0;
}

void GroupPage::GS_Senden_Click() {
    if (m_sequence.groups.empty()) {
        m_with.dialogs.message(Dialogs::Icon::Exclamation, QStringLiteral("Group Error"),
                               QStringLiteral("Please select a group!"));
        return;
    }
    // The TMC timing goes by this counter, so a sequence counts one TMC group even when it holds none.
    if (m_with.state.group8ACount == 0) m_with.state.group8ACount = 1;
    Gruppenfolge();
}

void GroupPage::Gruppenfolge() {
    Steps steps;
    m_sequence.appendSteps(steps);
    send(steps);
}

void GroupPage::stepGoesOut(const Step& step) {
    constexpr const Setting& kSequence = setting::kGroupSequence;
    if (step.key != kSequence.sendKey || !m_sequence.isToBeStored(m_with.profile)) return;
    m_with.profile.write(kSequence.place, step.value + ",");
}

void GroupPage::showStored() {
    // Data set 1 whatever set is at work, although sending stores in the one at work; only a set that the user chose
    // is shown itself.
    m_sequence.load(m_with.profile,
                    m_with.state.dataSetChosen ? setting::kGroupSequence.place : setting::kShownGroupSequence);
    m_with.state.storedGroupSequence = m_sequence.groups;
    showSequence();
}

void GroupPage::showSequence() {
    Label10->setText(caption({83}) + QLatin1Char(':') + toText(m_sequence.groups));
    m_note->setVisible(m_sequence.exceedsReading());
}

}  // namespace kdx
