#include "af/aflistenform.h"

#include "af/afcounter.h"
#include "af/aflistset.h"
#include "settings/profile.h"
#include "settings/programstate.h"
#include "settings/storedvalue.h"
#include "ui/dialogs.h"
#include "ui/layouts.h"
#include "ui/text.h"

#include <QKeyEvent>

#include <memory>

namespace kdx {

AF_Listenform::AF_Listenform(const PageContext& with, QWidget* parent) : QDialog(parent), Form(with) {
    setObjectName(QStringLiteral("AF_Listenform"));
    setModal(true);
    create();
    arrange();
    Form_Load();
}

void AF_Listenform::create() {
    m_book.text(this, {m_with.state.afEditorKind == kEonAfKind ? 165 : 163});
    m_choice = captioned<QGroupBox>("", {650, "Auswahl"}, this);
    m_content = captioned<QGroupBox>("", {651, "Inhalt"}, this);
    m_change = captioned<QGroupBox>("", {652, "Ändern"}, this);

    m_view.createOptions("AFList_Opt", 74, m_book, m_choice);
    m_view.options().onClick(this, &AF_Listenform::AFList_Opt_Click);
    AF_TN = wired<ClickableLabel>("AF_TN", &ClickableLabel::clicked, &AF_Listenform::AF_TN_Click, m_content);
    m_book.tip(AF_TN, {661, "zum Ändern anklicken"});
    m_view.createContent(AF_TN, {653, "Sendefrequenz [MHz]"}, "AF_List1", {654, "AF [MHz]"}, m_book);
    for (QWidget* option : m_view.options())
        m_book.tip(option, {1027, "Zeigt diese Liste: zuerst die eigene Frequenz, dann die anderen"});
    AF_List1 = m_view.list();
    m_book.tip(AF_List1, {1029, "Andere Frequenzen, auf denen dasselbe Programm läuft"});
    AF_List1->setMinimumWidth(fontMetrics().horizontalAdvance(QLatin1Char('0')) * 20);

    Text2 = named<QLineEdit>("Text2", m_change);
    m_entryHeading = heading("", {655, "Frequenz [MHz]"}, Text2);
    m_book.tip(Text2, {1151, "87.5 bis 108.0 MHz; mehrere mit Komma getrennt"});
    Command1 = clicked<QPushButton>("Command1", {656, "&Anhängen"}, m_change, &AF_Listenform::Command1_Click);
    m_book.tip(Command1, {1152, "Hängt die Frequenz an die Liste an; Return im Feld tut dasselbe"});
    AF_OF_add = clicked<QPushButton>("AF_OF_add", {657, "Einfügen"}, m_change, &AF_Listenform::AF_OF_add_Click);
    m_book.tip(AF_OF_add, {662, "vor der ausgewählten Zeile"});
    Rem_Freq = clicked<QPushButton>("Rem_Freq", {658, "Löschen"}, m_change, &AF_Listenform::Rem_Freq_Click);
    m_book.tip(Rem_Freq, {1153, "Nimmt die gewählte Frequenz heraus; die Taste Entf tut dasselbe"});

    createOrder();

    Uebernahme_Knopf =
        clicked<QPushButton>("Uebernahme_Knopf", {659, "Über&nehmen"}, this, &AF_Listenform::Uebernahme_Knopf_Click);
    Ende_Knopf = clicked<QPushButton>("Ende_Knopf", {660, "&Schließen"}, this, &AF_Listenform::Ende_Knopf_Click);
    m_book.tip(Uebernahme_Knopf, {1156, "Speichert die Liste und schließt; gesendet wird erst auf der Seite"});
    m_book.tip(Ende_Knopf, {1157, "Zurück zur Seite; nach nicht Übernommenem wird gefragt"});
    // The enter key in the text box appends and never stores or closes by accident.
    for (QPushButton* button : {AF_OF_add, Rem_Freq, AF_Auf, AF_Ab, AF_Sortieren, Uebernahme_Knopf, Ende_Knopf})
        button->setAutoDefault(false);
    Command1->setDefault(true);
}

void AF_Listenform::createOrder() {
    AF_Auf = clicked<QPushButton>("AF_Auf", {860, "Nach oben"}, m_change, &AF_Listenform::AF_Auf_Click);
    AF_Ab = clicked<QPushButton>("AF_Ab", {861, "Nach unten"}, m_change, &AF_Listenform::AF_Ab_Click);
    AF_Sortieren =
        clicked<QPushButton>("AF_Sortieren", {862, "Sortieren"}, m_change, &AF_Listenform::AF_Sortieren_Click);
    for (QPushButton* button : {AF_Auf, AF_Ab})
        m_book.tip(button, {1154, "Verschiebt die gewählte Frequenz um eine Zeile"});
    m_book.tip(AF_Sortieren, {1155, "Ordnet die Liste von der kleinsten zur größten Frequenz"});
    m_hint = named<QLabel>("KommaHinweis", this);
    m_hint->setWordWrap(true);
    // It takes the room that is kept for it, so that nothing moves.
    m_hint->setSizePolicy(QSizePolicy::Ignored, QSizePolicy::Fixed);
    m_hint->setFixedHeight(2 * m_hint->fontMetrics().lineSpacing());
    m_hint->setAlignment(Qt::AlignLeft | Qt::AlignTop);
    AF_Zaehler = named<AfCounter>("AF_Zaehler", m_with, AF_List1, m_content);
    connect(Text2, &QLineEdit::textChanged, this, &AF_Listenform::showHint);
    AF_List1->installEventFilter(this);
}

void AF_Listenform::arrange() {
    layOut(m_choice, m_view.optionColumn());
    layOut(m_content, kdx::add(m_view.contentColumn(), {AF_Zaehler}));
    layOut(m_change, column({m_entryHeading, Text2, Command1, AF_OF_add, space(2 * kGap), Rem_Freq, space(2 * kGap),
                             AF_Auf, AF_Ab, AF_Sortieren, kRoom}));
    auto* frames = row({m_choice, {m_content, 1}, m_change});
    layOut(this, column({{frames, 1}, m_hint, row({kRoom, Uebernahme_Knopf, Ende_Knopf})}), 2 * kGap);
}

void AF_Listenform::Form_Load() {
    m_book.label(m_with.captions);
    m_view.options().choose(0);
    AFList_Opt_Click(0);
    AF_Zaehler->count();
    Text2->setFocus();
}

void AF_Listenform::AFList_Opt_Click(int index) {
    // A list without AFs leaves the former one in view, as on the pages: it can so be taken over into a new list.
    m_view.show(m_with.profile.read(place(index)));
    m_unchanged = joined(shownList());
}

void AF_Listenform::AF_TN_Click() {
    QString answer = AF_TN->text();
    while (true) {
        answer = m_with.dialogs.input(caption({162}), caption({161}), answer);
        if (answer.isEmpty()) return;
        const bool known = takeNumber(answer);
        if (known && answer.contains(QLatin1Char(','))) {
            refuse(166);
        } else if (!known || !isTunedFrequency(toBytes(answer))) {
            refuse(164);
        } else {
            AF_TN->setText(toText(withOneDecimal(toBytes(answer))));
            return;
        }
    }
}

void AF_Listenform::Command1_Click() {
    add(AF_List1->count(), checkedEntries());
}

void AF_Listenform::AF_OF_add_Click() {
    if (selectedRow() >= 0) add(selectedRow(), checkedEntries());
}

void AF_Listenform::add(int row, const QStringList& entries) {
    if (entries.isEmpty()) return;
    AF_List1->insertItems(row, entries);
    AF_List1->scrollToItem(AF_List1->item(row + static_cast<int>(entries.size()) - 1));
    // The next one replaces it: typed on behind it, two frequencies would become one.
    Text2->setFocus();
    Text2->selectAll();
}

void AF_Listenform::move(int rows) {
    const int row = selectedRow();
    if (row < 0 || row + rows < 0 || row + rows >= AF_List1->count()) return;
    AF_List1->insertItem(row + rows, AF_List1->takeItem(row));
    AF_List1->setCurrentRow(row + rows);
}

void AF_Listenform::AF_Sortieren_Click() {
    std::vector<std::string> frequencies = shownList().frequencies;
    sortFrequencies(frequencies);
    AF_List1->clear();
    for (const std::string& frequency : frequencies) AF_List1->addItem(toText(frequency));
}

bool AF_Listenform::eventFilter(QObject* watched, QEvent* event) {
    if (event->type() == QEvent::KeyPress && static_cast<QKeyEvent*>(event)->matches(QKeySequence::Delete)) {
        Rem_Freq_Click();
        return true;
    }
    return QDialog::eventFilter(watched, event);
}

AfList AF_Listenform::shownList() const {
    AfList list{toBytes(AF_TN->text()), {}};
    for (int row = 0; row < AF_List1->count(); ++row) {
        list.frequencies.push_back(toBytes(AF_List1->item(row)->text()));
    }
    return list;
}

void AF_Listenform::showHint() {
    const QString entry = Text2->text();
    const std::string bytes = toBytes(entry);
    const std::size_t frequencies = pastedFrequencies(bytes).size();
    const bool isPoint = m_with.state.corrections.decimalComma && decimalNumber(bytes).has_value();
    QString hint;
    if (frequencies > 1 && !isPoint) {
        hint = caption({866, "%1 Frequenzen"}).arg(frequencies);
    } else if (entry.contains(QLatin1Char(',')) && !isPoint) {
        hint = caption({867, "Ein Komma trennt: Dezimalstellen stehen nach einem Punkt."});
    }
    m_hint->setText(hint);
}

void AF_Listenform::Rem_Freq_Click() {
    const int row = selectedRow();
    if (row < 0 || AF_List1->item(row)->text().isEmpty()) return;
    // The language is never stored with a capital letter, so the question is an English one in every language.
    const bool german = m_with.state.language == "Deutsch";
    const QString question = german ? QStringLiteral("Möchten Sie diese Frequenz %1 MHz aus der Liste löschen?")
                                    : QStringLiteral("Do you want to erase this %1 MHz frequency from the list?");
    const QString title = german ? QStringLiteral("Liste ändern?") : QStringLiteral("Change List?");
    if (m_with.dialogs.confirm(title, question.arg(AF_List1->item(row)->text()))) {
        const std::unique_ptr<QListWidgetItem> removed(AF_List1->takeItem(row));
    }
}

void AF_Listenform::reject() {
    const bool changed = joined(shownList()) != m_unchanged;
    if (!changed || m_with.dialogs.confirmLoss(windowTitle(), caption({1092, "Die Änderungen verwerfen?"})))
        QDialog::reject();
}

void AF_Listenform::Uebernahme_Knopf_Click() {
    m_with.profile.write(place(m_view.options().chosen()), joined(shownList()));
    accept();
}

const Place& AF_Listenform::place(int index) const {
    return afListPlace(m_with.state.afEditorKind, index + 1);
}

int AF_Listenform::selectedRow() const {
    const auto selected = AF_List1->selectedItems();
    return selected.isEmpty() ? -1 : AF_List1->row(selected.first());
}

QStringList AF_Listenform::checkedEntries() {
    // A whole list, as it is pasted, is one entry a frequency: it is stored as it would be in one.
    if (const auto frequencies = pastedFrequencies(toBytes(Text2->text()));
        frequencies.size() > 1 && !(m_with.state.corrections.decimalComma && decimalNumber(toBytes(Text2->text())))) {
        QStringList entries;
        for (const std::string& frequency : frequencies) entries.append(toText(frequency));
        return entries;
    }
    // Taken as typed unless that is corrected, a decimal comma included: "90,1" reads as 90 and becomes two entries of
    // the stored list.
    QString entry = Text2->text();
    if (takeNumber(entry) && isAlternativeFrequency(toBytes(entry))) {
        if (entry != Text2->text()) Text2->setText(entry);
        return {entry};
    }
    refuseEntry();
    return {};
}

/// What cannot be taken is selected: what is typed next replaces it.
void AF_Listenform::refuseEntry() {
    const std::string entry = toBytes(Text2->text());
    const auto wrong = wrongFrequency(entry);
    refuse(164, wrong ? caption({1250, "Nicht angenommen: %1"}).arg(toText(*wrong)) : QString());
    Text2->setFocus();
    if (!wrong) return Text2->selectAll();
    Text2->setSelection(static_cast<int>(wrong->data() - entry.data()), static_cast<int>(wrong->size()));
}

/// Where numbers are checked, makes the text the number that it is; false when it is none.
bool AF_Listenform::takeNumber(QString& text) const {
    if (!m_with.state.corrections.decimalComma) return true;
    const auto number = decimalNumber(toBytes(text));
    if (number) text = toText(*number);
    return number.has_value();
}

void AF_Listenform::refuse(int reason, const QString& details) {
    m_with.dialogs.message(Dialogs::Icon::Exclamation, caption({161}), caption({reason}), details);
}

}  // namespace kdx
