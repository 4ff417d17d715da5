#include "groups/grouppage.h"

#include "groups/sequenceedit.h"
#include "groups/settings.h"
#include "settings/programstate.h"
#include "ui/dialogs.h"
#include "ui/elided.h"
#include "ui/layouts.h"
#include "ui/text.h"

#include <algorithm>

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
    Gruppe_Zurueck =
        clicked<QPushButton>("Gruppe_Zurueck", {871, "Letzte entfernen"}, this, &GroupPage::Gruppe_Zurueck_Click);
    Gruppe_Vor = clicked<QPushButton>("Gruppe_Vor", {872, "< früher"}, this, &GroupPage::Gruppe_Vor_Click);
    Gruppe_Nach = clicked<QPushButton>("Gruppe_Nach", {873, "später >"}, this, &GroupPage::Gruppe_Nach_Click);
    for (QPushButton* button : {Gruppe_Vor, Gruppe_Nach})
        m_book.tip(button, {874, "Verschiebt die markierte Gruppe; ein Klick auf eine Gruppe markiert sie."});
    connect(Label10, &SequenceLabel::clickedAt, this, &GroupPage::choose);
    Gruppe_Anteile = named<QLabel>("Gruppe_Anteile", this);
    Gruppe_Anteile->setSizePolicy(QSizePolicy::Ignored, QSizePolicy::Preferred);  // a long line does not widen the page
    elideLongText(*Gruppe_Anteile);
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
    page->addWidget(Gruppe_Anteile, below + 2, 0, 1, kColumns);
    page->addWidget(m_note, below + 3, 0, 1, kColumns);
    page->addWidget(newList, below + 4, 0);
    page->addWidget(Gruppe_Zurueck, below + 4, 1);
    page->addLayout(row({{Gruppe_Vor, 1}, {Gruppe_Nach, 1}}), below + 4, 2);
    page->addWidget(GS_Senden, below + 4, kColumns - 1);
    layOut(this, page, 2 * kGap);
}

void GroupPage::label() {
    Page::label();
    showSequence();
}

void GroupPage::load() {
    countAnew();
    m_with.state.storedGroupSequence = m_sequence.groups;
    choose(-1);
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
    choose(-1);
}

void GroupPage::Gruppe_Zurueck_Click() {
    std::vector<std::string> groups = groupsOf(m_sequence.groups);
    if (groups.empty()) return;
    std::int16_t& tmc = m_with.state.group8ACount;
    if (groups.back() + "," == groupText(kTmcGroup) && tmc > 0) --tmc;
    if (m_with.state.groupCount > 0) --m_with.state.groupCount;
    groups.pop_back();
    m_sequence.groups = sequenceOf(groups);
    m_sequence.composed = true;
    choose(-1);
}

void GroupPage::move(int places) {
    std::vector<std::string> groups = groupsOf(m_sequence.groups);
    const std::size_t to = moveGroup(groups, m_chosen, places);
    if (to == m_chosen) return;
    m_chosen = to;
    m_sequence.groups = sequenceOf(groups);
    m_sequence.composed = true;
    showSequence();
}

void GroupPage::choose(int character) {
    const std::size_t groups = groupsOf(m_sequence.groups).size();
    m_chosen = groups == 0 ? 0 : groups - 1;
    const auto at = character - heading().size();
    if (at >= 0 && at < std::ssize(m_sequence.groups)) {
        const auto begin = m_sequence.groups.begin();
        m_chosen = std::min(m_chosen, static_cast<std::size_t>(std::count(begin, begin + at, ',')));
    }
    showSequence();
}

QString GroupPage::heading() const {
    return caption({83}) + QLatin1Char(':');
}

void GroupPage::newList_Click() {
    m_sequence.startAnew();
    countAnew();
    choose(-1);
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
    if (!linkWorks(m_with)) m_sent.forget();
    showSequence();
}

void GroupPage::stepGoesOut(const Step& step) {
    constexpr const Setting& kSequence = setting::kGroupSequence;
    if (step.key != kSequence.sendKey) return;
    m_sent.goesOut(step.value);
    showSequence();
    if (!m_sequence.isToBeStored(m_with.profile)) return;
    m_with.profile.write(kSequence.place, step.value + ",");
}

void GroupPage::stepFailed(const Step& step) {
    if (step.key != setting::kGroupSequence.sendKey) return;
    m_sent.forget();
    showSequence();
}

void GroupPage::showStored() {
    // Data set 1 whatever set is at work, although sending stores in the one at work; only a set that the user chose
    // is shown itself.
    m_sequence.load(m_with.profile,
                    m_with.state.dataSetChosen ? setting::kGroupSequence.place : setting::kShownGroupSequence);
    m_with.state.storedGroupSequence = m_sequence.groups;
    choose(-1);
}

void GroupPage::showSequence() {
    Label10->setText(heading() + toText(m_sequence.groups));
    m_note->setVisible(m_sequence.exceedsReading());
    const std::vector<std::string> groups = groupsOf(m_sequence.groups);
    const bool chosen = m_chosen < groups.size() && sequenceOf(groups) == m_sequence.groups;
    if (chosen) {
        const auto before = sequenceOf({groups.begin(), groups.begin() + static_cast<std::ptrdiff_t>(m_chosen)});
        Label10->mark(static_cast<int>(heading().size() + std::ssize(before)),
                      static_cast<int>(groups[m_chosen].size()));
    } else {
        Label10->mark(0, 0);
    }
    Gruppe_Zurueck->setEnabled(!groups.empty());
    Gruppe_Vor->setEnabled(chosen && m_chosen > 0);
    Gruppe_Nach->setEnabled(chosen && m_chosen + 1 < groups.size());
    showShares(groups);
    const Judgement judgement = groups.empty() ? Judgement{} : m_sent.judge(sequenceToSend(m_sequence.groups));
    showState(*Label10, judgement.state, judgement.tip);
}

void GroupPage::showShares(const std::vector<std::string>& groups) {
    QStringList shares;
    for (const auto& [group, count] : groupCounts(groups)) {
        const double percent = 100.0 * static_cast<double>(count) / static_cast<double>(groups.size());
        shares.append(QStringLiteral("%1 %2 %").arg(toText(group)).arg(qRound(percent)));
    }
    const QString text = shares.join(QStringLiteral(", "));
    Gruppe_Anteile->setText(text.isEmpty() ? text : caption({875, "Anteile: %1"}).arg(text));
    Gruppe_Anteile->setToolTip(Gruppe_Anteile->text());
}

}  // namespace kdx
