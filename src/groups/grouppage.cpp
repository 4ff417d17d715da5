#include "groups/grouppage.h"

#include "groups/sequencelabel.h"
#include "coder/sendparam.h"
#include "settings/captions.h"
#include "settings/datafolder.h"
#include "settings/programstate.h"
#include "ui/controls.h"
#include "ui/dialogs.h"
#include "ui/text.h"

#include <QGridLayout>
#include <QPushButton>
#include <QScrollArea>

namespace kdx {

GroupPage::GroupPage(const PageContext& with, QWidget* parent) : QWidget(parent), m_with(with) {
    create();
    arrange();
}

void GroupPage::create() {
    for (int number = 0; number < kGroups; ++number) {
        QPushButton*& button = Gruppe[static_cast<std::size_t>(number)];
        button = named<QPushButton>(("Gruppe" + std::to_string(number)).c_str(), this);
        connect(button, &QPushButton::clicked, this, [this, number] { Gruppe_Click(number); });
    }
    m_sequenceView = new QScrollArea(this);
    Label10 = named<SequenceLabel>("Label10", m_sequenceView);
    newList = named<QPushButton>("newList", this);
    connect(newList, &QPushButton::clicked, this, &GroupPage::newList_Click);
    GS_Senden = named<QPushButton>("GS_Senden", this);
    connect(GS_Senden, &QPushButton::clicked, this, &GroupPage::GS_Senden_Click);
}

void GroupPage::arrange() {
    constexpr int kColumns = 4;
    auto* page = new QGridLayout(this);
    tighten(page, 2 * kGap);
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
    page->addWidget(newList, below + 2, 0);
    page->addWidget(GS_Senden, below + 2, kColumns - 1);
}

void GroupPage::label() {
    const Captions& captions = m_with.captions;
    for (int number = 0; number < kGroups; ++number) {
        Gruppe[static_cast<std::size_t>(number)]->setText(toText(captions.text(81) + " " + std::to_string(number)));
    }
    newList->setText(toText(captions.text(156)));
    GS_Senden->setText(toText(captions.text(82)));
    m_sequenceView->setAccessibleName(toText(captions.text(83)));
    showSequence();
}

void GroupPage::loadDataSet() {
    m_with.state.groupCount = 0;
    m_with.state.group8ACount = 0;
    showStored();
}

void GroupPage::pageOpened() {
    showStored();
    Gruppe[4]->setEnabled(false);
}

void GroupPage::Gruppe_Click(int number) {
    m_groups += groupText(number);
    countUp(m_with.state.groupCount);
    if (number == kTmcGroup) countUp(m_with.state.group8ACount);
    showSequence();
}

void GroupPage::newList_Click() {
    m_groups.clear();
    m_with.state.groupCount = 0;
    m_with.state.group8ACount = 0;
    showSequence();
}

void GroupPage::GS_Senden_Click() {
    if (m_groups.empty()) {
        m_with.dialogs.message(Dialogs::Icon::Exclamation, QStringLiteral("Group Error"),
                               QStringLiteral("Please select a group!"));
        return;
    }
    // The TMC timing goes by this counter, so a sequence counts one TMC group even when it holds none.
    if (m_with.state.group8ACount == 0) m_with.state.group8ACount = 1;
    Gruppenfolge();
}

void GroupPage::Gruppenfolge() {
    if (m_groups.empty()) return;
    std::string sequence = sequenceToSend(m_groups);
    m_with.data.WriteIni("RDS", "GR_Folge", sequence + ",", dataSetFile(m_with.state.CurrentDataSet));
    m_with.params.SendParam("GROUPSEQ", sequence);
}

void GroupPage::showStored() {
    // Data set 1 whatever set is current, although sending stores in the current one.
    m_groups = m_with.data.ReadIni("RDS", "GR_FOLGE", dataSetFile("1"));
    m_with.state.storedGroupSequence = m_groups;
    showSequence();
}

void GroupPage::showSequence() {
    Label10->setText(toText(m_with.captions.text(83) + ":" + m_groups));
}

}  // namespace kdx
