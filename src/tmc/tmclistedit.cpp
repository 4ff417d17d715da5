#include "tmc/tmclistedit.h"

#include "settings/datafolder.h"
#include "tmc/shownlist.h"
#include "tmc/tmclist.h"
#include "ui/dialogs.h"
#include "ui/elided.h"
#include "ui/layouts.h"
#include "ui/text.h"

#include <QItemSelectionModel>
#include <QShowEvent>
#include <QStyle>

#include <algorithm>

namespace kdx {

namespace {

constexpr int kCodeLength = 5;

}  // namespace

TMC_Listedit::TMC_Listedit(const PageContext& with, QWidget* parent) : QDialog(parent), Form(with) {
    setObjectName(QStringLiteral("TMC_Listedit"));
    m_book.text(this, {610, "Edit TMC List"});
    create();
    auto* lists = row({arrangeList(Label1, List1, Event_Input_TXT, Event_Input_Nr, Event_Hinzu),
                       arrangeList(Label2, List2, Loc_INput_TXT1, Loc_Input_Nr, Loc_Hinzu)});
    lists->setSpacing(3 * kGap);
    auto* whole = column(
        {{lists, 1}, row({Eintrag_Aendern, Eintrag_Loeschen, kRoom, m_codeNote, space(2 * kGap), Zuruek_Knopf})});
    whole->setSpacing(2 * kGap);
    layOut(this, whole, 2 * kGap);
    label();
    resize(minimumSizeHint().width(), 24 * List1->fontMetrics().height());
}

void TMC_Listedit::create() {
    const Caption add{615, "Add to list"};
    Label1 = named<QLabel>("Label1", this);
    m_events = new ShownList(this);
    List1 = createList("List1", m_events);
    m_book.spoken(List1, {622, "Events"});
    Event_Input_TXT = createInput("Event_Input_TXT", {619, "Event Text"}, &TMC_Listedit::Event_Input_TXT_Click);
    Event_Input_Nr = createInput("Event_Input_Nr", {618, "Event Nr"}, &TMC_Listedit::Event_Input_Nr_Click);
    Event_Hinzu = clicked<QPushButton>("Event_Hinzu", add, this, &TMC_Listedit::Event_Hinzu_Click);

    Label2 = named<QLabel>("Label2", this);
    m_locations = new ShownList(this);
    List2 = createList("List2", m_locations);
    m_book.spoken(List2, {623, "Locations"});
    Loc_INput_TXT1 = createInput("Loc_INput_TXT1", {621, "Location Text"}, &TMC_Listedit::Loc_INput_TXT1_Click);
    Loc_Input_Nr = createInput("Loc_Input_Nr", {620, "Location Nr"}, &TMC_Listedit::Loc_Input_Nr_Click);
    // ISO 14819-3: an entry of a location table beyond that cannot be sent. It is taken all the same.
    m_codeNote = captioned<QLabel>("LocationNote", {625, "Codes von Locations gehen von 1 bis 63487."}, this);
    Loc_Hinzu = clicked<QPushButton>("Loc_Hinzu", add, this, &TMC_Listedit::Loc_Hinzu_Click);

    Zuruek_Knopf = clicked<QPushButton>("Zuruek_Knopf", {616, "Exit"}, this, &TMC_Listedit::Zuruek_Knopf_Click);
    Eintrag_Aendern =
        clicked<QPushButton>("Eintrag_Aendern", {876, "Eintrag ändern"}, this, &TMC_Listedit::Eintrag_Aendern_Click);
    Eintrag_Loeschen =
        clicked<QPushButton>("Eintrag_Loeschen", {877, "Eintrag löschen"}, this, &TMC_Listedit::Eintrag_Loeschen_Click);
    for (QPushButton* button : {Event_Hinzu, Loc_Hinzu, Eintrag_Aendern, Eintrag_Loeschen, Zuruek_Knopf})
        button->setAutoDefault(false);
    m_book.tip(Zuruek_Knopf, {1146, "Zurück zum Fenster; was geändert wurde, ist schon gespeichert"});
    m_book.tip(Eintrag_Aendern, {1149, "Fragt nach neuem Text und neuer Nummer für den gewählten"});
    m_book.tip(Eintrag_Loeschen, {1150, "Nimmt den gewählten nach einer Frage aus der Datei"});
    for (QPushButton* button : {Event_Hinzu, Loc_Hinzu})
        m_book.tip(button, {1148, "Hängt Text und Nummer an die Datei an, wenn beide dastehen"});
    for (QListView* list : {List1, List2}) {
        m_book.tip(list, {1147, "Ein gewählter Eintrag lässt sich ändern oder löschen"});
        connect(list->selectionModel(), &QItemSelectionModel::selectionChanged, this,
                [this, list] { chooseOnlyIn(list); });
    }
    chooseOnlyIn(List1);
}

TMC_Listedit::Chosen TMC_Listedit::chosen() const {
    for (const Chosen& where : {Chosen{List1, m_events, kEventList, Event_Input_TXT, Event_Input_Nr},
                                Chosen{List2, m_locations, kLocationList, Loc_INput_TXT1, Loc_Input_Nr}}) {
        const auto rows = where.list->selectionModel()->selectedRows();
        if (rows.isEmpty()) continue;
        Chosen found = where;
        found.row = rows.front().row();
        return found;
    }
    return {};
}

/// One entry of both lists at most is chosen: the buttons mean that one.
void TMC_Listedit::chooseOnlyIn(QListView* list) {
    QListView* const other = list == List1 ? List2 : List1;
    if (list->selectionModel()->hasSelection() && other->selectionModel()->hasSelection()) other->clearSelection();
    const bool any = chosen().row >= 0;
    Eintrag_Aendern->setEnabled(any);
    Eintrag_Loeschen->setEnabled(any);
}

void TMC_Listedit::Eintrag_Aendern_Click() {
    const Chosen where = chosen();
    if (where.row < 0) return;
    const std::string line = where.entries->line(where.row);
    const std::size_t semicolon = line.find(';');
    const QString title = caption({617, "Eingabe"});
    const QString text = m_with.dialogs.input(where.text->accessibleName(), title, toText(line.substr(0, semicolon)));
    if (text.isEmpty()) return;
    const QString code = m_with.dialogs.input(where.code->accessibleName(), title, toText(line.substr(semicolon + 1)));
    if (code.isEmpty()) return;
    showChange(where, !m_with.data.isReadOnly() &&
                          changeInTmcList(m_with.data.file(where.fileName), static_cast<std::size_t>(where.row), line,
                                          toBytes(text), toBytes(code)));
}

void TMC_Listedit::Eintrag_Loeschen_Click() {
    const Chosen where = chosen();
    if (where.row < 0) return;
    const std::string line = where.entries->line(where.row);
    if (!m_with.dialogs.confirmLoss(windowTitle(), caption({878, "Diesen Eintrag löschen: %1?"}).arg(toText(line))))
        return;
    showChange(where, !m_with.data.isReadOnly() && removeFromTmcList(m_with.data.file(where.fileName),
                                                                     static_cast<std::size_t>(where.row), line));
}

void TMC_Listedit::showChange(const Chosen& where, bool changed) {
    if (!changed) tellUnsaved(where.fileName);
    where.entries->load(m_with, where.fileName);
    const int last = where.entries->rowCount() - 1;
    where.list->setCurrentIndex(where.entries->index(std::min(where.row, last), 0));
    chooseOnlyIn(where.list);
}

void TMC_Listedit::tellUnsaved(const char* fileName) {
    const QString failure = caption({624, "%1 kann nicht gespeichert werden."});
    m_with.dialogs.message(Dialogs::Icon::Exclamation, windowTitle(), failure.arg(QLatin1String(fileName)));
}

QListView* TMC_Listedit::createList(const char* name, ShownList* entries) {
    auto* list = named<QListView>(name, this);
    list->setUniformItemSizes(true);  // else every entry of a long list is measured before the first is shown
    list->setModel(entries);
    return list;
}

ClickableLabel* TMC_Listedit::createInput(const char* name, const Caption& what, void (TMC_Listedit::*handler)()) {
    auto* input = wired<ClickableLabel>(name, &ClickableLabel::clicked, handler, this);
    m_book.describe(input, what);
    return input;
}

QBoxLayout* TMC_Listedit::arrangeList(QLabel* columns, QListView* list, QLabel* text, QLabel* code, QPushButton* add) {
    columns->setFont(fixedPitch(QStringLiteral("Courier")));
    list->setFont(fixedPitch(QStringLiteral("Courier New")));
    // The heading's columns stand over the list's: its frame and its entries' own margin come before the text.
    columns->setIndent(list->frameWidth() + style()->pixelMetric(QStyle::PM_FocusFrameHMargin, nullptr, list) + 1);
    const QString widest(static_cast<int>(kListTextLength) + kCodeLength + 2, QLatin1Char('0'));
    list->setMinimumWidth(list->fontMetrics().horizontalAdvance(widest) + 2 * list->frameWidth() +
                          list->verticalScrollBar()->sizeHint().width());
    list->setMinimumHeight(12 * list->fontMetrics().height());
    for (QLabel* input : {text, code}) {
        input->setFont(list->font());
        input->setMinimumHeight(add->sizeHint().height());
    }
    text->setSizePolicy(QSizePolicy::Ignored, QSizePolicy::Preferred);  // a long text does not widen the window
    elideLongText(*text);
    code->setFixedWidth(list->fontMetrics().horizontalAdvance(QStringLiteral("0000000")) + 8);

    return column({columns, {list, 1}, row({{text, 1}, code, add})});
}

void TMC_Listedit::label() {
    m_book.label(m_with.captions);
    Label1->setText(columns({611, "E v e n t"}, {612, "C o d e"}));
    Label2->setText(columns({613, "L o c a t i o n"}, {614, "C o d e "}));
}

QString TMC_Listedit::columns(const Caption& text, const Caption& code) const {
    return caption(text).leftJustified(static_cast<int>(kListTextLength), QLatin1Char(' '), true) + caption(code);
}

void TMC_Listedit::showEvent(QShowEvent* event) {
    QDialog::showEvent(event);
    if (!event->spontaneous()) Form_Load();
}

void TMC_Listedit::Form_Load() {
    takeAllSteps({[this] { Event_Laden(); }, [this] { Location_Laden(); }});
}

void TMC_Listedit::Event_Laden() {
    m_events->load(m_with, kEventList);
}

void TMC_Listedit::Location_Laden() {
    m_locations->load(m_with, kLocationList);
}

bool TMC_Listedit::Event_anhaengen() {
    return append(List1, m_events, Event_Input_TXT, Event_Input_Nr, kEventList);
}

bool TMC_Listedit::Location_Anhaengen() {
    return append(List2, m_locations, Loc_INput_TXT1, Loc_Input_Nr, kLocationList);
}

bool TMC_Listedit::append(QListView* list, ShownList* entries, const QLabel* text, const QLabel* code,
                          const char* fileName) {
    if (m_with.data.isReadOnly() ||
        !appendToTmcList(m_with.data.file(fileName), toBytes(text->text()), toBytes(code->text()))) {
        tellUnsaved(fileName);
        return false;
    }
    entries->load(m_with, fileName);
    list->scrollToBottom();
    return true;
}

void TMC_Listedit::reject() {
    const bool nothing = Event_Input_TXT->text().isEmpty() && Event_Input_Nr->text().isEmpty() &&
                         Loc_INput_TXT1->text().isEmpty() && Loc_Input_Nr->text().isEmpty();
    if (nothing || m_with.dialogs.confirmLoss(windowTitle(), caption({1093, "Die Eingaben verwerfen?"})))
        QDialog::reject();
}

void TMC_Listedit::ask(QLabel* label) {
    const QString title = caption({617, "Eingabe"});
    const QString answer = m_with.dialogs.input(label->accessibleName(), title, label->text());
    if (!answer.isEmpty()) label->setText(answer);
}

void TMC_Listedit::take(QLabel* text, QLabel* code, bool (TMC_Listedit::*appendIt)()) {
    if (text->text().isEmpty() || code->text().isEmpty() || !(this->*appendIt)()) return;
    text->clear();
    code->clear();
}

}  // namespace kdx
