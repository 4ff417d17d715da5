#include "lab/compareview.h"

#include <QCheckBox>
#include <QEvent>
#include <QHeaderView>
#include <QLabel>
#include <QPushButton>
#include <QTableWidget>

#include <algorithm>

#include "base/printable.h"
#include "coder/listlead.h"
#include "coder/sendparam.h"
#include "lab/settingnames.h"
#include "lab/viewtable.h"
#include "link/commandsequence.h"
#include "settings/programstate.h"
#include "settings/storedvalue.h"
#include "station/station.h"
#include "ui/keymarks.h"
#include "ui/layouts.h"
#include "ui/statusrow.h"
#include "ui/text.h"

namespace kdx {

namespace {

enum Column { NameColumn, WindowColumn, FileColumn, InstrumentColumn, ColumnCount };

constexpr QChar kDifferenceSign{u'\u2260'};  // who does not tell colours apart sees the sign

}  // namespace

CompareView::CompareView(const Station& station, const PageContext& with, QWidget* parent)
    : QDialog(parent), m_station(station), m_with(with) {
    setObjectName(QStringLiteral("CompareView"));
    m_book.text(this, {957, "Vergleich"});
    Vergleich_Tabelle = newViewTable("Vergleich_Tabelle", ColumnCount, this);
    Vergleich_Tabelle->verticalHeader()->setSectionResizeMode(QHeaderView::ResizeToContents);
    Vergleich_Stand = named<QLabel>("Vergleich_Stand", this);
    Vergleich_Nur_Unterschiede =
        m_book.captioned<QCheckBox>("Vergleich_Nur_Unterschiede", {966, "&Nur Unterschiede"}, this);
    m_book.tip(Vergleich_Nur_Unterschiede, {1158, "Blendet aus, was in allen Spalten gleich ist"});
    connect(Vergleich_Nur_Unterschiede, &QCheckBox::toggled, this, [this] { show({}); });
    const auto button = [this](const char* name, const Caption& caption, auto handler) {
        auto* made = m_book.captioned<QPushButton>(name, caption, this);
        made->setAutoDefault(false);
        connect(made, &QPushButton::clicked, this, handler);
        return made;
    };
    Vergleich_Lesen = button("Vergleich_Lesen", {963, "&Lesen"}, &CompareView::Vergleich_Lesen_Click);
    m_book.tip(Vergleich_Lesen, {970, "Alles fragen, was sich aus dem Gerät lesen lässt"});
    Vergleich_Senden = button("Vergleich_Senden", {964, "S&enden"}, &CompareView::Vergleich_Senden_Click);
    m_book.tip(Vergleich_Senden, {971, "Fenster an Gerät: die ausgewählten Zeilen, ohne Auswahl alle Unterschiede"});
    Vergleich_Uebernehmen =
        button("Vergleich_Uebernehmen", {965, "&Übernehmen"}, &CompareView::Vergleich_Uebernehmen_Click);
    m_book.tip(Vergleich_Uebernehmen,
               {972, "Gerät an Fenster und Datei: die ausgewählten Zeilen, ohne Auswahl alle Unterschiede"});
    Vergleich_Schliessen = button("Vergleich_Schliessen", {688, "&Schließen"}, &QDialog::close);
    m_book.tip(Vergleich_Schliessen, {1121, "Schließt nur diese Ansicht; was läuft, läuft weiter"});
    m_book.tip(Vergleich_Tabelle, {1159, "Gewählte Zeilen werden gesendet oder übernommen"});
    arrange();
    showSessionOpen(with.instrument.isOpen());
    label();
}

void CompareView::arrange() {
    auto* note = m_book.captioned<QLabel>(
        "Vergleich_Hinweis",
        {958, "Fenster und Datei: was das Gerät hätte, wenn sie gesendet würden. Gerät: was es hat."}, this);
    layOut(this,
           column({note,
                   {Vergleich_Tabelle, 1},
                   row({{Vergleich_Stand, 1}, Vergleich_Nur_Unterschiede}),
                   row({Vergleich_Lesen, Vergleich_Senden, Vergleich_Uebernehmen, kRoom, Vergleich_Schliessen})}),
           6);
    // In letters, so that it is the same on every display.
    resize(fontMetrics().averageCharWidth() * 120, fontMetrics().height() * 40);
}

void CompareView::label() {
    m_book.label(m_with.captions);
    const auto text = [this](const Caption& caption) { return captionText(m_with.captions, caption); };
    Vergleich_Tabelle->setHorizontalHeaderLabels(
        {text({959, "Einstellung"}), text({960, "Fenster"}), text({961, "Datei"}), text({962, "Gerät"})});
    Vergleich_Tabelle->setAccessibleName(windowTitle());
    if (isVisible()) show({});
}

void CompareView::showSessionOpen(bool open) {
    if (!open) m_present.clear();
    for (QPushButton* button : {Vergleich_Lesen, Vergleich_Senden, Vergleich_Uebernehmen}) button->setEnabled(open);
    if (isVisible()) compare();
}

void CompareView::showEvent(QShowEvent* event) {
    compare();
    QDialog::showEvent(event);
}

bool CompareView::event(QEvent* event) {
    // Who comes back from the window may have entered something there.
    if (event->type() == QEvent::WindowActivate) compare();
    return QDialog::event(event);
}

void CompareView::Vergleich_Lesen_Click() {
    read();
    compare();
}

void CompareView::Vergleich_Senden_Click() {
    if (m_present.empty()) read();
    compare();
    const SettingCommands commands = commandsForWindow(chosen(), m_compared.window, m_with.state.corrections);
    if (!commands.empty()) {
        const CommandSequence sequence(m_with.instrument);
        for (const auto& [key, command] : commands) m_with.params.sendCommand(key, command);
        read();
    }
    compare();
}

void CompareView::Vergleich_Uebernehmen_Click() {
    if (m_present.empty()) read();
    compare();
    const std::vector<SettingSideBySide> taken = chosen();
    const std::size_t left = takeOver(taken, m_with.profile);
    for (const SettingSideBySide& setting : taken) m_with.marks.forget(setting.key);
    emit takenOver();
    compare();
    if (left == 0) return;
    show(captionText(m_with.captions, {969, "nicht übernommen, da keine Datei sie hält: %1"}).arg(left));
}

void CompareView::read() {
    m_present = readOut(m_with.instrument);
}

void CompareView::compare() {
    m_compared = sideBySide(m_with.data, m_with.captions, m_with.profile, entered(), m_present);
    show({});
}

/// What stands in the window, also what was typed and not sent yet.
Station CompareView::entered() const {
    Station station = m_station;
    station.reload(m_with.profile);
    station.programme.ps = station.programme.psField.substr(0, kPsLength);
    // The opening turns the output over, but it is to stay as it is.
    const Corrections& corrections = m_with.state.corrections;
    if (!corrections.rfOutput || !station.carrier.everOpened) station.carrier.outputOn = !station.carrier.outputOn;
    if (!m_with.instrument.isOpen()) return station;
    // The generator's values are shown there alone until they are kept.
    const auto shown = [this](StatusSlot slot, std::string& value) {
        const auto number = decimalNumber(toBytes(m_with.status.text(slot)));
        if (number) value = *number;
    };
    shown(StatusSlot::RfFrequency, station.carrier.rfFrequency);
    shown(StatusSlot::RfLevel, station.carrier.rfLevel);
    shown(StatusSlot::AudioFrequency, station.carrier.audioFrequency);
    return station;
}

/// The settings of the selected rows; without a selection all that differ.
std::vector<SettingSideBySide> CompareView::chosen() const {
    const auto rows = Vergleich_Tabelle->selectionModel()->selectedRows();
    std::vector<SettingSideBySide> settings;
    for (std::size_t at = 0; at < m_compared.settings.size(); ++at) {
        const SettingSideBySide& setting = m_compared.settings[at];
        const bool selected = std::any_of(
            rows.begin(), rows.end(), [&](const QModelIndex& index) { return index.row() == static_cast<int>(at); });
        if (rows.isEmpty() ? setting.differs : selected) settings.push_back(setting);
    }
    return settings;
}

void CompareView::show(const QString& also) {
    const std::vector<SettingSideBySide>& settings = m_compared.settings;
    Vergleich_Tabelle->setRowCount(static_cast<int>(settings.size()));
    for (std::size_t at = 0; at < settings.size(); ++at) showRow(static_cast<int>(at), settings[at]);
    const auto text = [this](const Caption& caption) { return captionText(m_with.captions, caption); };
    const auto differing = std::count_if(settings.begin(), settings.end(),
                                         [](const SettingSideBySide& setting) { return setting.differs; });
    QStringList state{text({967, "%1 von %2 Einstellungen weichen ab"}).arg(differing).arg(settings.size())};
    if (m_present.empty()) state += text({968, "das Gerät ist nicht gelesen"});
    if (!also.isEmpty()) state += also;
    Vergleich_Stand->setText(state.join(QStringLiteral("; ")));
}

void CompareView::showRow(int row, const SettingSideBySide& setting) {
    const QString network = setting.network.empty() ? QString() : QLatin1String("  ") + toText(setting.network);
    const auto shown = [](const std::optional<std::string>& value) {
        if (!value) return QStringLiteral("\u2013");
        // How a list is sent is no part of it.
        return toText(printableLine(afterListLead(*value).value_or(*value), '\xB7'));
    };
    const bool silent = !setting.instrument && !m_present.empty() && setting.network.empty();
    const QStringList cells{
        settingName(setting.key, m_with.captions) + network +
            (setting.differs ? QStringLiteral("  ") + kDifferenceSign : QString()),
        setting.refused ? shown(setting.window) + QStringLiteral("  (%1)").arg(captionText(
                                                      m_with.captions, {855, "Der Coder nimmt diesen Wert nicht an."}))
                        : shown(setting.window),
        shown(setting.file), silent ? captionText(m_with.captions, {143}) : shown(setting.instrument)};
    for (int column = 0; column < ColumnCount; ++column)
        showCell(Vergleich_Tabelle, row, column, cells[column], setting.differs);
    Vergleich_Tabelle->setRowHidden(row, Vergleich_Nur_Unterschiede->isChecked() && !setting.differs);
}

}  // namespace kdx
