#include "window/correctionspage.h"

#include <QLabel>
#include <QScrollArea>

#include <algorithm>

#include "settings/profile.h"
#include "ui/caption.h"
#include "ui/layouts.h"
#include "ui/text.h"

namespace kdx {

namespace {

/// A title and, after ": ", the sentence; in the order of the keys.
const std::array<Caption, kCorrectionKeys.size()> kTexts = {
    Caption{935,
            "Stereo-Modus: ohne geht er um eins versetzt hinaus (\"rechts\" sendet LEFT) und mit keinem Datensatz, "
            "mit so, wie er hier heißt."},
    Caption{936,
            "Impedanz: ohne geht sie um eins versetzt hinaus (\"100k Ohm\" sendet 600), mit so, wie sie hier heißt, "
            "auch mit \"alles senden\"."},
    Caption{937,
            "EON PTY: ohne wird der Name gespeichert und als PI gesendet, mit die Nummer unter eigenem Schlüssel."},
    Caption{938, "Pegel: ohne steht am gelesenen Pegel dBm, mit dBµV."},
    Caption{939, "HF-Ausgang: ohne schaltet jede Verbindung ihn um, mit nur die erste."},
    Caption{940, "TMC-Felder: ohne fehlen dem Code die Bits nicht gewählter Felder, mit zählen diese als 0."},
    Caption{941,
            "Komma: ohne geht 98,7 hinaus, wie es dasteht, mit als 98.7; was keine Zahl ist, wird nicht gesendet."},
    Caption{942,
            "HF-Werte: ohne sind eingegebene Werte mit der nächsten Verbindung weg, mit bleiben sie in Datensatz 1."},
    Caption{943, "Anführungszeichen: ohne beendet es den Text, mit geht es verdoppelt hinaus."},
    Caption{944, "Leerzeichen: ohne verliert ein gespeicherter Text sie am Rand, mit bleiben sie."},
    Caption{945, "Mitternacht: ohne endet eine Pause über Mitternacht nie, mit endet sie."}};

/// Some on, some off shows as a third state; a click puts all on, and all off when they are.
class AllBox final : public QCheckBox {
public:
    using QCheckBox::QCheckBox;

protected:
    void nextCheckState() override { setCheckState(checkState() == Qt::Checked ? Qt::Unchecked : Qt::Checked); }
};

Place placeOf(std::size_t index) {
    return {KeptIn::General, kCorrectionSection, kCorrectionKeys.at(index).key};
}

}  // namespace

CorrectionsPage::CorrectionsPage(const PageContext& with, QWidget* parent) : QWidget(parent), m_with(with) {
    auto* all = new QWidget(this);
    auto* rows = column({});
    rows->setSpacing(1);
    for (std::size_t i = 0; i < kCorrectionKeys.size(); ++i) {
        const std::string name = std::string("Berichtigung_") + kCorrectionKeys[i].key;
        Berichtigung[i] = named<QCheckBox>(name.c_str(), all);
        connect(Berichtigung[i], &QCheckBox::clicked, this, [this, i] { Berichtigung_Click(i); });
        m_sentences[i] = new QLabel(all);
        m_sentences[i]->setWordWrap(true);
        m_sentences[i]->setIndent(fontMetrics().height() + kGap);  // under the text of its box
        add(rows, {Berichtigung[i], m_sentences[i], space(kGap)});
    }
    layOut(all, add(rows, {kRoom}));
    auto* view = new QScrollArea(this);
    view->setWidget(all);
    view->setWidgetResizable(true);
    view->setHorizontalScrollBarPolicy(Qt::ScrollBarAlwaysOff);
    Alle_Berichtigungen = named<AllBox>("Alle_Berichtigungen", this);
    Alle_Berichtigungen->setTristate(true);
    connect(Alle_Berichtigungen, &QCheckBox::clicked, this, &CorrectionsPage::Alle_Berichtigungen_Click);
    layOut(this, column({Alle_Berichtigungen, {view, 1}}), kPageMargin);
}

void CorrectionsPage::label() {
    Alle_Berichtigungen->setText(captionText(m_with.captions, {934, "&Alle Berichtigungen"}));
    Alle_Berichtigungen->setToolTip(
        captionText(m_with.captions, {1145, "Schaltet alle ein oder, wenn sie ein sind, alle aus"}));
    for (std::size_t i = 0; i < kTexts.size(); ++i) {
        const QString text = captionText(m_with.captions, kTexts[i]);
        const QString title = text.section(QStringLiteral(": "), 0, 0);
        QString sentence = text.section(QStringLiteral(": "), 1);
        if (!sentence.isEmpty()) sentence[0] = sentence[0].toUpper();
        Berichtigung[i]->setText(title);
        Berichtigung[i]->setToolTip(sentence);
        m_sentences[i]->setText(sentence);
    }
}

void CorrectionsPage::load() {
    const Corrections corrections = readCorrections(m_with.profile);
    for (std::size_t i = 0; i < kCorrectionKeys.size(); ++i)
        Berichtigung[i]->setChecked(corrections.*kCorrectionKeys[i].isOn);
    showWhetherAll();
}

void CorrectionsPage::Berichtigung_Click(std::size_t index) {
    store(index, Berichtigung[index]->isChecked());
    showWhetherAll();
    emit changed();
}

void CorrectionsPage::Alle_Berichtigungen_Click() {
    const bool on = Alle_Berichtigungen->checkState() == Qt::Checked;
    for (std::size_t i = 0; i < Berichtigung.size(); ++i) {
        if (Berichtigung[i]->isChecked() != on) store(i, on);
        Berichtigung[i]->setChecked(on);
    }
    emit changed();
}

void CorrectionsPage::store(std::size_t index, bool on) {
    m_with.profile.write(placeOf(index), on ? "1" : "0");
}

void CorrectionsPage::showWhetherAll() {
    const auto on = std::count_if(Berichtigung.begin(), Berichtigung.end(), [](auto* box) { return box->isChecked(); });
    const bool all = static_cast<std::size_t>(on) == Berichtigung.size();
    Alle_Berichtigungen->setCheckState(all ? Qt::Checked : on > 0 ? Qt::PartiallyChecked : Qt::Unchecked);
}

}  // namespace kdx
