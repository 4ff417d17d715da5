#include "af/aflistenform.h"

#include "af/aflist.h"
#include "af/modul2.h"
#include "settings/captions.h"
#include "settings/datafolder.h"
#include "settings/programstate.h"
#include "ui/clickablelabel.h"
#include "ui/dialogs.h"
#include "ui/text.h"

#include <QBoxLayout>
#include <QGroupBox>
#include <QLabel>
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
    m_choice = new QGroupBox(this);
    m_content = new QGroupBox(this);
    m_change = new QGroupBox(this);

    AFList_Opt.create("AFList_Opt", m_choice);
    for (int i = 0; i < kAfLists; ++i) {
        connect(AFList_Opt[static_cast<std::size_t>(i)], &QRadioButton::clicked, this,
                [this, i] { AFList_Opt_Click(i); });
    }
    m_tunedHeading = new QLabel(m_content);
    AF_TN = named<ClickableLabel>("AF_TN", m_content);
    m_tunedHeading->setBuddy(AF_TN);
    connect(AF_TN, &ClickableLabel::clicked, this, &AF_Listenform::AF_TN_Click);
    m_listHeading = new QLabel(m_content);
    AF_List1 = named<QListWidget>("AF_List1", m_content);
    m_listHeading->setBuddy(AF_List1);

    m_entryHeading = new QLabel(m_change);
    Text2 = named<QLineEdit>("Text2", m_change);
    m_entryHeading->setBuddy(Text2);
    Command1 = named<QPushButton>("Command1", m_change);
    connect(Command1, &QPushButton::clicked, this, &AF_Listenform::Command1_Click);
    AF_OF_add = named<QPushButton>("AF_OF_add", m_change);
    connect(AF_OF_add, &QPushButton::clicked, this, &AF_Listenform::AF_OF_add_Click);
    Rem_Freq = named<QPushButton>("Rem_Freq", m_change);
    connect(Rem_Freq, &QPushButton::clicked, this, &AF_Listenform::Rem_Freq_Click);
    Uebernahme_Knopf = named<QPushButton>("Uebernahme_Knopf", this);
    connect(Uebernahme_Knopf, &QPushButton::clicked, this, &AF_Listenform::Uebernahme_Knopf_Click);
    Ende_Knopf = named<QPushButton>("Ende_Knopf", this);
    connect(Ende_Knopf, &QPushButton::clicked, this, &AF_Listenform::Ende_Knopf_Click);

    // The enter key in the text box appends and never stores or closes by accident.
    for (QPushButton* button : {AF_OF_add, Rem_Freq, Uebernahme_Knopf, Ende_Knopf}) button->setAutoDefault(false);
    Command1->setDefault(true);
}

void AF_Listenform::arrange() {
    auto* choice = new QVBoxLayout(m_choice);
    tighten(choice);
    for (QRadioButton* option : AFList_Opt) choice->addWidget(option);
    choice->addStretch();

    auto* content = new QVBoxLayout(m_content);
    tighten(content);
    for (QWidget* control : std::initializer_list<QWidget*>{m_tunedHeading, AF_TN, m_listHeading, AF_List1}) {
        content->addWidget(control);
    }
    AF_List1->setMinimumWidth(fontMetrics().horizontalAdvance(QLatin1Char('0')) * 20);

    auto* change = new QVBoxLayout(m_change);
    tighten(change);
    change->addWidget(m_entryHeading);
    change->addWidget(Text2);
    change->addWidget(Command1);
    change->addWidget(AF_OF_add);
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

void AF_Listenform::label() {
    const Captions& captions = m_with.captions;
    setWindowTitle(toText(captions.text(m_with.state.afEditorKind == kEonAfKind ? 165 : 163)));
    for (std::size_t i = 0; i < AFList_Opt.size(); ++i) {
        AFList_Opt[i]->setText(toText(captions.text(74) + " " + std::to_string(i + 1)));
    }
    m_choice->setTitle(toText(captions.own(650, "Auswahl")));
    m_content->setTitle(toText(captions.own(651, "Inhalt")));
    m_change->setTitle(toText(captions.own(652, "\xC4ndern")));
    m_tunedHeading->setText(toText(captions.own(653, "Sendefrequenz [MHz]")));
    m_listHeading->setText(toText(captions.own(654, "AF [MHz]")));
    m_entryHeading->setText(toText(captions.own(655, "Frequenz [MHz]")));
    Command1->setText(toText(captions.own(656, "&Anh\xE4ngen")));
    AF_OF_add->setText(toText(captions.own(657, "Einf\xFCgen")));
    Rem_Freq->setText(toText(captions.own(658, "L\xF6schen")));
    Uebernahme_Knopf->setText(toText(captions.own(659,
                                                  "\xDC"
                                                  "ber&nehmen")));
    Ende_Knopf->setText(toText(captions.own(660,
                                            "&Schlie\xDF"
                                            "en")));
    AF_TN->setToolTip(toText(captions.own(661, "zum \xC4ndern anklicken")));
    AF_OF_add->setToolTip(toText(captions.own(662, "vor der ausgew\xE4hlten Zeile")));
    AF_TN->setAccessibleName(m_tunedHeading->text());
    AF_List1->setAccessibleName(m_listHeading->text());
    Text2->setAccessibleName(m_entryHeading->text());
}

void AF_Listenform::Form_Load() {
    label();
    AFList_Opt.choose(0);
    AFList_Opt_Click(0);
    Text2->setFocus();
}

void AF_Listenform::AFList_Opt_Click(int index) {
    // A list without AFs leaves the former one in view, as on the pages: it can so be taken over into a new list.
    FillAfLists(*AF_List1, *AF_TN, m_with.data.ReadIni("RDS", key(index), dataSetFile(m_with.state.CurrentDataSet)));
}

void AF_Listenform::AF_TN_Click() {
    QString answer = AF_TN->text();
    while (true) {
        answer = m_with.dialogs.input(toText(m_with.captions.text(162)), toText(m_with.captions.text(161)), answer);
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
    m_with.data.WriteIni("RDS", key(AFList_Opt.chosen()), joined(list), dataSetFile(m_with.state.CurrentDataSet));
    accept();
}

void AF_Listenform::Ende_Knopf_Click() {
    reject();
}

std::string AF_Listenform::key(int index) const {
    return afListKey(m_with.state.afEditorKind, index + 1);
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

void AF_Listenform::refuse(int caption) {
    m_with.dialogs.message(Dialogs::Icon::Exclamation, toText(m_with.captions.text(161)),
                           toText(m_with.captions.text(caption)));
}

}  // namespace kdx
