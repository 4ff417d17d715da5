#include "af/afpage.h"

#include "af/aflist.h"
#include "af/aflistenform.h"
#include "af/modul2.h"
#include "base/numbers.h"
#include "coder/sendparam.h"
#include "settings/captions.h"
#include "settings/datafolder.h"
#include "settings/programstate.h"
#include "ui/dialogs.h"
#include "ui/text.h"

#include <QBoxLayout>
#include <QGroupBox>
#include <QLabel>
#include <QListWidget>
#include <QPushButton>

#include <initializer_list>

namespace kdx {

AfPage::AfPage(const PageContext& with, QWidget* parent) : QWidget(parent), m_with(with) {
    m_openEditor = [this] { AF_Listenform(m_with, window()).exec(); };
    create();
    arrange();
}

void AfPage::create() {
    Frame2 = named<QGroupBox>("Frame2", this);
    m_choice = new QGroupBox(Frame2);
    m_shown = new QGroupBox(Frame2);
    m_transmission = new QGroupBox(Frame2);

    AFList_Opt.create("AFList_Opt", m_choice);
    for (int i = 0; i < kAfLists; ++i) {
        connect(AFList_Opt[static_cast<std::size_t>(i)], &QRadioButton::clicked, this,
                [this, i] { AFList_Opt_Click(i); });
    }
    AF_Bearbeiten = named<QPushButton>("AF_Bearbeiten", m_choice);
    connect(AF_Bearbeiten, &QPushButton::clicked, this, &AfPage::AF_Bearbeiten_Click);

    m_tunedHeading = new QLabel(m_shown);
    AF_TN = named<QLabel>("AF_TN", m_shown);
    AF_TN->setTextFormat(Qt::PlainText);
    AF_TN->setFrameStyle(QFrame::Panel | QFrame::Sunken);
    m_listHeading = new QLabel(m_shown);
    AF_List1 = named<QListWidget>("AF_List1", m_shown);
    m_listHeading->setBuddy(AF_List1);

    AFMethod_opt.create("AFMethod_opt", m_transmission);
    Taste_AF_Senden = named<QPushButton>("Taste_AF_Senden", m_transmission);
    connect(Taste_AF_Senden, &QPushButton::clicked, this, &AfPage::Taste_AF_Senden_Click);
}

void AfPage::arrange() {
    auto* choice = new QVBoxLayout(m_choice);
    tighten(choice);
    for (QRadioButton* option : AFList_Opt) choice->addWidget(option);
    choice->addStretch();
    choice->addWidget(AF_Bearbeiten);

    auto* shown = new QVBoxLayout(m_shown);
    tighten(shown);
    for (QWidget* control : std::initializer_list<QWidget*>{m_tunedHeading, AF_TN, m_listHeading, AF_List1}) {
        shown->addWidget(control);
    }

    auto* transmission = new QVBoxLayout(m_transmission);
    tighten(transmission);
    for (QRadioButton* option : AFMethod_opt) transmission->addWidget(option);
    transmission->addStretch();
    transmission->addWidget(Taste_AF_Senden);

    // Three equal columns in the order of the work: choose a list, look at it, send them all.
    auto* frame = new QHBoxLayout(Frame2);
    tighten(frame);
    frame->addWidget(m_choice, 1);
    frame->addWidget(m_shown, 1);
    frame->addWidget(m_transmission, 1);

    auto* page = new QVBoxLayout(this);
    tighten(page, kPageMargin);
    page->addWidget(Frame2);
}

void AfPage::label() {
    const Captions& captions = m_with.captions;
    Frame2->setTitle(toText(captions.text(71)));
    AF_Bearbeiten->setText(toText(captions.text(72)));
    Taste_AF_Senden->setText(toText(captions.text(73)));
    for (std::size_t i = 0; i < AFList_Opt.size(); ++i) {
        AFList_Opt[i]->setText(toText(captions.text(74) + " " + std::to_string(i + 1)));
    }
    AFMethod_opt[0]->setText(toText(captions.text(75)));
    AFMethod_opt[1]->setText(toText(captions.text(76)));
    m_choice->setTitle(toText(captions.own(440, "Auswahl")));
    m_shown->setTitle(toText(captions.own(441, "Inhalt")));
    m_transmission->setTitle(toText(captions.own(442,
                                                 "\xDC"
                                                 "bertragung")));
    m_tunedHeading->setText(toText(captions.own(443, "Sendefrequenz [MHz]")));
    m_listHeading->setText(toText(captions.own(444, "AF [MHz]")));
    AF_TN->setAccessibleName(m_tunedHeading->text());
    AF_List1->setAccessibleName(m_listHeading->text());
}

void AfPage::loadDataSet() {
    const std::string chosen = m_with.data.ReadIni("RDS", "AF_LISTE", dataSetFile("1"));
    const double number = chosen.empty() ? 1 : leadingNumber(chosen);
    AFList_Opt.choose(-1);
    for (int i = 0; i < kAfLists; ++i) {
        if (number != i + 1) continue;
        AFList_Opt.choose(i);
        showList(i);
    }
    AFMethod_opt.choose(0);
}

void AfPage::AFList_Opt_Click(int index) {
    m_with.data.WriteIni("RDS", "AF_LISTE", std::to_string(index + 1), dataSetFile(m_with.state.CurrentDataSet));
    showList(index);
}

void AfPage::AF_Bearbeiten_Click() {
    m_with.state.afEditorKind = kAfKind;
    m_openEditor();
    if (AFList_Opt.chosen() >= 0) AFList_Opt_Click(AFList_Opt.chosen());
}

void AfPage::Taste_AF_Senden_Click() {
    const std::string first = storedList(1);
    if (first.empty()) return;  // without a first list there is no set that the others could be added to
    sendList(1, first);
    // Also when list 1 was refused: the others are then added to the lists the coder holds. It is left so on purpose.
    for (int number = 2; number <= kAfLists; ++number) {
        if (const std::string list = storedList(number); !list.empty()) sendList(number, list);
    }
}

int AfPage::commandsToSend() const {
    int commands = 0;
    for (int number = 1; number <= kAfLists; ++number) {
        const std::string list = storedList(number);
        if (number == 1 && list.empty()) return 0;
        if (!list.empty() && afValue(list, number, chosenMethod())) ++commands;
    }
    return commands;
}

AfMethod AfPage::chosenMethod() const {
    return AFMethod_opt.chosen() == 1 ? AfMethod::B : AfMethod::A;
}

void AfPage::sendList(int number, const std::string& list) {
    if (auto value = afValue(list, number, chosenMethod())) {
        m_with.params.SendParam("AF" + std::to_string(number), std::move(*value));
        return;
    }
    // "english" alone counts as English here; "english US" gets the German text.
    const bool english = m_with.state.language == "english";
    m_with.dialogs.message(
        Dialogs::Icon::None,
        (english ? QStringLiteral("List Nr.%1 invalid") : QStringLiteral("Liste Nr.%1 ungültig")).arg(number),
        english ? QStringLiteral("It is not possible to transmit more than 12 AFs with Method B")
                : QStringLiteral("Es ist nicht möglich mehr als 12 AFs mit Methode B zu übertragen"));
}

void AfPage::showList(int index) {
    FillAfLists(*AF_List1, *AF_TN, storedList(index + 1));
}

std::string AfPage::storedList(int number) const {
    return m_with.data.ReadIni("RDS", afListKey(kAfKind, number), dataSetFile(m_with.state.CurrentDataSet));
}

}  // namespace kdx
