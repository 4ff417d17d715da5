#include "tmc/tmclistedit.h"

#include "settings/datafolder.h"
#include "tmc/shownlist.h"
#include "tmc/tmclist.h"
#include "ui/controls.h"
#include "ui/dialogs.h"
#include "ui/text.h"

#include <QHBoxLayout>
#include <QScrollBar>
#include <QShowEvent>
#include <QStyle>
#include <QVBoxLayout>

namespace kdx {

namespace {

constexpr int kCodeLength = 5;

}  // namespace

TMC_Listedit::TMC_Listedit(const PageContext& with, QWidget* parent) : QDialog(parent), m_with(with) {
    setObjectName(QStringLiteral("TMC_Listedit"));
    m_book.text(this, {610, "Edit TMC List"});
    create();
    arrange();
    label();
    resize(minimumSizeHint().width(), 24 * List1->fontMetrics().height());
}

void TMC_Listedit::create() {
    const Caption add{615, "Add to list"};
    Label1 = named<QLabel>("Label1", this);
    List1 = named<QListWidget>("List1", this);
    m_book.spoken(List1, {622, "Events"});
    Event_Input_TXT = named<ClickableLabel>("Event_Input_TXT", this);
    m_book.describe(Event_Input_TXT, {619, "Event Text"});
    connect(Event_Input_TXT, &ClickableLabel::clicked, this, &TMC_Listedit::Event_Input_TXT_Click);
    Event_Input_Nr = named<ClickableLabel>("Event_Input_Nr", this);
    m_book.describe(Event_Input_Nr, {618, "Event Nr"});
    connect(Event_Input_Nr, &ClickableLabel::clicked, this, &TMC_Listedit::Event_Input_Nr_Click);
    Event_Hinzu = m_book.captioned<QPushButton>("Event_Hinzu", add, this);
    connect(Event_Hinzu, &QPushButton::clicked, this, &TMC_Listedit::Event_Hinzu_Click);

    Label2 = named<QLabel>("Label2", this);
    List2 = named<QListWidget>("List2", this);
    m_book.spoken(List2, {623, "Locations"});
    Loc_INput_TXT1 = named<ClickableLabel>("Loc_INput_TXT1", this);
    m_book.describe(Loc_INput_TXT1, {621, "Location Text"});
    connect(Loc_INput_TXT1, &ClickableLabel::clicked, this, &TMC_Listedit::Loc_INput_TXT1_Click);
    Loc_Input_Nr = named<ClickableLabel>("Loc_Input_Nr", this);
    m_book.describe(Loc_Input_Nr, {620, "Location Nr"});
    connect(Loc_Input_Nr, &ClickableLabel::clicked, this, &TMC_Listedit::Loc_Input_Nr_Click);
    Loc_Hinzu = m_book.captioned<QPushButton>("Loc_Hinzu", add, this);
    connect(Loc_Hinzu, &QPushButton::clicked, this, &TMC_Listedit::Loc_Hinzu_Click);

    Zuruek_Knopf = m_book.captioned<QPushButton>("Zuruek_Knopf", {616, "Exit"}, this);
    connect(Zuruek_Knopf, &QPushButton::clicked, this, &TMC_Listedit::Zuruek_Knopf_Click);
    for (QPushButton* button : {Event_Hinzu, Loc_Hinzu, Zuruek_Knopf}) button->setAutoDefault(false);
}

void TMC_Listedit::arrange() {
    auto* lists = new QHBoxLayout;
    tighten(lists, 0);
    lists->setSpacing(3 * kGap);
    lists->addLayout(arrangeEntry(Label1, List1, Event_Input_TXT, Event_Input_Nr, Event_Hinzu));
    lists->addLayout(arrangeEntry(Label2, List2, Loc_INput_TXT1, Loc_Input_Nr, Loc_Hinzu));
    auto* layout = new QVBoxLayout(this);
    tighten(layout, 2 * kGap);
    layout->setSpacing(2 * kGap);
    layout->addLayout(lists, 1);
    layout->addWidget(Zuruek_Knopf, 0, Qt::AlignRight);
}

QLayout* TMC_Listedit::arrangeEntry(QLabel* heading, QListWidget* list, QLabel* text, QLabel* code, QPushButton* add) {
    heading->setFont(fixedPitch(QStringLiteral("Courier")));
    list->setFont(fixedPitch(QStringLiteral("Courier New")));
    // The heading's columns stand over the list's: its frame and its entries' own margin come before the text.
    heading->setIndent(list->frameWidth() + style()->pixelMetric(QStyle::PM_FocusFrameHMargin, nullptr, list) + 1);
    const QString widest(static_cast<int>(kListTextLength) + kCodeLength + 2, QLatin1Char('0'));
    list->setMinimumWidth(list->fontMetrics().horizontalAdvance(widest) + 2 * list->frameWidth() +
                          list->verticalScrollBar()->sizeHint().width());
    list->setMinimumHeight(12 * list->fontMetrics().height());
    for (QLabel* input : {text, code}) {
        input->setFont(list->font());
        input->setMinimumHeight(add->sizeHint().height());
    }
    text->setSizePolicy(QSizePolicy::Ignored, QSizePolicy::Preferred);  // a long text does not widen the window
    code->setFixedWidth(list->fontMetrics().horizontalAdvance(QStringLiteral("0000000")) + 8);

    auto* entry = new QHBoxLayout;
    tighten(entry, 0);
    entry->addWidget(text, 1);
    entry->addWidget(code);
    entry->addWidget(add);
    auto* column = new QVBoxLayout;
    tighten(column, 0);
    column->addWidget(heading);
    column->addWidget(list, 1);
    column->addLayout(entry);
    return column;
}

void TMC_Listedit::label() {
    m_book.label(m_with.captions);
    Label1->setText(heading({611, "E v e n t"}, {612, "C o d e"}));
    Label2->setText(heading({613, "L o c a t i o n"}, {614, "C o d e "}));
}

QString TMC_Listedit::heading(const Caption& text, const Caption& code) const {
    const QString column = captionText(m_with.captions, text);
    return column.leftJustified(static_cast<int>(kListTextLength), QLatin1Char(' '), true) +
           captionText(m_with.captions, code);
}

void TMC_Listedit::showEvent(QShowEvent* event) {
    QDialog::showEvent(event);
    if (!event->spontaneous()) Form_Load();
}

void TMC_Listedit::Form_Load() {
    takeAllSteps({[this] { Event_Laden(); }, [this] { Location_Laden(); }});
}

void TMC_Listedit::Event_Laden() {
    load(List1, kEventList);
}

void TMC_Listedit::Location_Laden() {
    load(List2, kLocationList);
}

void TMC_Listedit::load(QListWidget* list, const char* fileName) {
    list->clear();
    list->addItems(loadShownList(m_with, fileName));
}

bool TMC_Listedit::Event_anhaengen() {
    if (!append(Event_Input_TXT, Event_Input_Nr, kEventList)) return false;
    Event_Laden();
    List1->scrollToBottom();
    return true;
}

bool TMC_Listedit::Location_Anhaengen() {
    if (!append(Loc_INput_TXT1, Loc_Input_Nr, kLocationList)) return false;
    Location_Laden();
    List2->scrollToBottom();
    return true;
}

bool TMC_Listedit::append(const QLabel* text, const QLabel* code, const char* fileName) {
    if (appendToTmcList(m_with.data.file(fileName), toBytes(text->text()), toBytes(code->text()))) return true;
    const QString failure = captionText(m_with.captions, {624, "%1 kann nicht gespeichert werden."});
    m_with.dialogs.message(Dialogs::Icon::Exclamation, windowTitle(), failure.arg(QLatin1String(fileName)));
    return false;
}

void TMC_Listedit::Event_Input_Nr_Click() {
    ask(Event_Input_Nr);
}

void TMC_Listedit::Event_Input_TXT_Click() {
    ask(Event_Input_TXT);
}

void TMC_Listedit::Loc_Input_Nr_Click() {
    ask(Loc_Input_Nr);
}

void TMC_Listedit::Loc_INput_TXT1_Click() {
    ask(Loc_INput_TXT1);
}

void TMC_Listedit::ask(QLabel* label) {
    const QString title = captionText(m_with.captions, {617, "Eingabe"});
    const QString answer = m_with.dialogs.input(label->accessibleName(), title, label->text());
    if (!answer.isEmpty()) label->setText(answer);
}

void TMC_Listedit::Event_Hinzu_Click() {
    if (Event_Input_TXT->text().isEmpty() || Event_Input_Nr->text().isEmpty()) return;
    if (!Event_anhaengen()) return;  // the entry stays to be tried again
    Event_Input_TXT->clear();
    Event_Input_Nr->clear();
}

void TMC_Listedit::Loc_Hinzu_Click() {
    if (Loc_INput_TXT1->text().isEmpty() || Loc_Input_Nr->text().isEmpty()) return;
    if (!Location_Anhaengen()) return;
    Loc_INput_TXT1->clear();
    Loc_Input_Nr->clear();
}

void TMC_Listedit::Zuruek_Knopf_Click() {
    close();
}

}  // namespace kdx
