#include "af/aflistenform.h"

#include "af/aflistset.h"
#include "settings/profile.h"
#include "settings/programstate.h"
#include "ui/clickablelabel.h"
#include "ui/dialogs.h"
#include "ui/text.h"

#include <QBoxLayout>
#include <QGroupBox>
#include <QLineEdit>
#include <QListWidget>
#include <QPushButton>

#include <initializer_list>
#include <memory>

namespace kdx {

AF_Listenform::AF_Listenform(const PageContext& with, QWidget* parent) : QDialog(parent), m_with(with) {
    setObjectName(QStringLiteral("AF_Listenform"));
    setModal(true);
    create();
    arrange();
    Form_Load();
}

void AF_Listenform::create() {
    m_book.text(this, {m_with.state.afEditorKind == kEonAfKind ? 165 : 163});
    m_choice = new QGroupBox(this);
    m_content = new QGroupBox(this);
    m_change = new QGroupBox(this);
    m_book.text(m_choice, {650, "Auswahl"});
    m_book.text(m_content, {651, "Inhalt"});
    m_book.text(m_change, {652, "Ändern"});

    m_view.createOptions("AFList_Opt", 74, m_book, m_choice);
    m_view.options().onClick(this, &AF_Listenform::AFList_Opt_Click);
    AF_TN = m_view.createContent<ClickableLabel>({"AF_TN", {653, "Sendefrequenz [MHz]"}},
                                                 {"AF_List1", {654, "AF [MHz]"}}, m_book, m_content);
    m_book.tip(AF_TN, {661, "zum Ändern anklicken"});
    connect(AF_TN, &ClickableLabel::clicked, this, &AF_Listenform::AF_TN_Click);
    AF_List1 = m_view.list();
    createChange();

    Uebernahme_Knopf = m_book.captioned<QPushButton>("Uebernahme_Knopf", {659, "Über&nehmen"}, this);
    connect(Uebernahme_Knopf, &QPushButton::clicked, this, &AF_Listenform::Uebernahme_Knopf_Click);
    Ende_Knopf = m_book.captioned<QPushButton>("Ende_Knopf", {660, "&Schließen"}, this);
    connect(Ende_Knopf, &QPushButton::clicked, this, &AF_Listenform::Ende_Knopf_Click);

    // The enter key in the text box appends and never stores or closes by accident.
    for (QPushButton* button : {AF_OF_add, Rem_Freq, Uebernahme_Knopf, Ende_Knopf}) button->setAutoDefault(false);
    Command1->setDefault(true);
}

void AF_Listenform::createChange() {
    m_entryHeading = new QLabel(m_change);
    m_book.text(m_entryHeading, {655, "Frequenz [MHz]"});
    Text2 = named<QLineEdit>("Text2", m_change);
    m_entryHeading->setBuddy(Text2);
    m_book.spokenAs(Text2, m_entryHeading);
    Command1 = m_book.captioned<QPushButton>("Command1", {656, "&Anhängen"}, m_change);
    connect(Command1, &QPushButton::clicked, this, &AF_Listenform::Command1_Click);
    AF_OF_add = m_book.captioned<QPushButton>("AF_OF_add", {657, "Einfügen"}, m_change);
    m_book.tip(AF_OF_add, {662, "vor der ausgewählten Zeile"});
    connect(AF_OF_add, &QPushButton::clicked, this, &AF_Listenform::AF_OF_add_Click);
    Rem_Freq = m_book.captioned<QPushButton>("Rem_Freq", {658, "Löschen"}, m_change);
    connect(Rem_Freq, &QPushButton::clicked, this, &AF_Listenform::Rem_Freq_Click);
}

void AF_Listenform::arrange() {
    auto* choice = new QVBoxLayout(m_choice);
    tighten(choice);
    m_view.arrangeOptions(choice);

    auto* content = new QVBoxLayout(m_content);
    tighten(content);
    m_view.arrangeContent(content);
    AF_List1->setMinimumWidth(fontMetrics().horizontalAdvance(QLatin1Char('0')) * 20);

    auto* change = new QVBoxLayout(m_change);
    tighten(change);
    for (QWidget* control : std::initializer_list<QWidget*>{m_entryHeading, Text2, Command1, AF_OF_add}) {
        change->addWidget(control);
    }
    change->addSpacing(2 * kGap);
    change->addWidget(Rem_Freq);
    change->addStretch();

    auto* frames = new QHBoxLayout;
    frames->setSpacing(kGap);
    frames->addWidget(m_choice);
    frames->addWidget(m_content, 1);
    frames->addWidget(m_change);

    auto* closing = new QHBoxLayout;
    closing->setSpacing(kGap);
    closing->addStretch();
    closing->addWidget(Uebernahme_Knopf);
    closing->addWidget(Ende_Knopf);

    auto* window = new QVBoxLayout(this);
    tighten(window, 2 * kGap);
    window->addLayout(frames, 1);
    window->addLayout(closing);
}

void AF_Listenform::Form_Load() {
    m_book.label(m_with.captions);
    m_view.options().choose(0);
    AFList_Opt_Click(0);
    Text2->setFocus();
}

void AF_Listenform::AFList_Opt_Click(int index) {
    // A list without AFs leaves the former one in view, as on the pages: it can so be taken over into a new list.
    m_view.show(m_with.profile.read(place(index)));
}

void AF_Listenform::AF_TN_Click() {
    QString answer = AF_TN->text();
    while (true) {
        answer = m_with.dialogs.input(captionText(m_with.captions, {162}), captionText(m_with.captions, {161}), answer);
        if (answer.isEmpty()) return;
        if (answer.contains(QLatin1Char(','))) {
            refuse(166);
        } else if (!isTunedFrequency(toBytes(answer))) {
            refuse(164);
        } else {
            AF_TN->setText(toText(withOneDecimal(toBytes(answer))));
            return;
        }
    }
}

void AF_Listenform::Command1_Click() {
    if (const QString entry = checkedEntry(); !entry.isEmpty()) AF_List1->addItem(entry);
}

void AF_Listenform::AF_OF_add_Click() {
    if (selectedRow() < 0) return;
    if (const QString entry = checkedEntry(); !entry.isEmpty()) AF_List1->insertItem(selectedRow(), entry);
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

void AF_Listenform::Uebernahme_Knopf_Click() {
    AfList list{toBytes(AF_TN->text()), {}};
    for (int row = 0; row < AF_List1->count(); ++row) {
        list.frequencies.push_back(toBytes(AF_List1->item(row)->text()));
    }
    m_with.profile.write(place(m_view.options().chosen()), joined(list));
    accept();
}

void AF_Listenform::Ende_Knopf_Click() {
    reject();
}

const Place& AF_Listenform::place(int index) const {
    return afListPlace(m_with.state.afEditorKind, index + 1);
}

int AF_Listenform::selectedRow() const {
    const auto selected = AF_List1->selectedItems();
    return selected.isEmpty() ? -1 : AF_List1->row(selected.first());
}

QString AF_Listenform::checkedEntry() {
    // Taken as typed, a decimal comma included: "90,1" reads as 90 and becomes two entries of the stored list.
    if (isAlternativeFrequency(toBytes(Text2->text()))) return Text2->text();
    refuse(164);
    return {};
}

void AF_Listenform::refuse(int reason) {
    m_with.dialogs.message(Dialogs::Icon::Exclamation, captionText(m_with.captions, {161}),
                           captionText(m_with.captions, {reason}));
}

}  // namespace kdx
