#include "window/settingsdialog.h"

#include <QCheckBox>
#include <QComboBox>
#include <QDoubleSpinBox>
#include <QGroupBox>
#include <QLabel>
#include <QPushButton>
#include <QSignalBlocker>
#include <QTabWidget>

#include <algorithm>

#include "base/numbers.h"
#include "rds/dynamicps.h"
#include "rds/settings.h"
#include "settings/captions.h"
#include "settings/generalsettings.h"
#include "settings/programstate.h"
#include "settings/storedvalue.h"
#include "stereo/settings.h"
#include "ui/layouts.h"
#include "ui/text.h"
#include "ui/ticker.h"
#include "window/correctionspage.h"

namespace kdx {

namespace {

constexpr std::array kLanguages = {"deutsch", "english", "english US"};
constexpr std::array kStandards = {"RDS", "RBDS"};
constexpr std::array kLimits = {setting::kRfLowest, setting::kRfHighest, setting::kAudioLowest, setting::kAudioHighest};

}  // namespace

SettingsDialog::SettingsDialog(const PageContext& with, AddressesPage::Find find, QWidget* window)
    : QDialog(window), m_with(with) {
    setObjectName(QStringLiteral("SettingsDialog"));
    m_tabs = new QTabWidget(this);
    m_tabs->addTab(createProgramPage(), QString());
    m_addresses = new AddressesPage(with, std::move(find), m_tabs);
    m_tabs->addTab(m_addresses, QString());
    m_corrections = new CorrectionsPage(with, m_tabs);
    m_tabs->addTab(m_corrections, QString());
    connect(m_corrections, &CorrectionsPage::changed, this, &SettingsDialog::correctionsChanged);
    m_close = m_book.captioned<QPushButton>("Einstellungen_Schliessen", {688, "&Schließen"}, this);
    m_book.tip(m_close, {1146, "Zurück zum Fenster; was geändert wurde, ist schon gespeichert"});
    m_close->setAutoDefault(false);
    connect(m_close, &QPushButton::clicked, this, &QDialog::close);
    layOut(this, column({{m_tabs, 1}, row({kRoom, m_close})}), 2 * kGap);
    label();
    load();
    resize(std::max(520, sizeHint().width()), std::max(400, sizeHint().height()));
}

QWidget* SettingsDialog::createProgramPage() {
    auto* page = new QWidget(m_tabs);
    Log_Schalter = m_book.captioned<QCheckBox>("Log_Schalter", {925, "Befehle in RDS_log.txt schreiben"}, page);
    m_book.tip(Log_Schalter, {1135, "Die Datei steht im Datenordner und beginnt mit jedem Start neu"});
    connect(Log_Schalter, &QCheckBox::clicked, this, &SettingsDialog::Log_Schalter_Click);
    Auto_Schalter =
        m_book.captioned<QCheckBox>("Auto_Schalter", {926, "Beim Start verbinden und den Datensatz senden"}, page);
    m_book.tip(Auto_Schalter, {1136, "Gilt ab dem nächsten Start des Programms"});
    connect(Auto_Schalter, &QCheckBox::clicked, this, &SettingsDialog::Auto_Schalter_Click);

    Sprache_Wahl = named<QComboBox>("Sprache_Wahl", page);
    connect(Sprache_Wahl, &QComboBox::activated, this, &SettingsDialog::Sprache_Wahl_Click);
    auto* language = m_book.captioned<QLabel>("", {2}, page);
    m_book.head(language, Sprache_Wahl);
    m_book.tip(Sprache_Wahl, {1137, "Sprache aller Texte; gilt sofort"});
    RDS_RBDS_Wahl = named<QComboBox>("RDS_RBDS_Wahl", page);
    for (const char* standard : kStandards) RDS_RBDS_Wahl->addItem(QString::fromLatin1(standard));
    connect(RDS_RBDS_Wahl, &QComboBox::activated, this, &SettingsDialog::RDS_RBDS_Wahl_Click);
    auto* standard = m_book.captioned<QLabel>("", {929, "Programmarten"}, page);
    m_book.head(standard, RDS_RBDS_Wahl);
    m_book.tip(RDS_RBDS_Wahl, {1138, "Namen der 32 Arten: RDS in Europa, RBDS in Nordamerika"});

    PS_Dyn_Zahl = named<QSpinBox>("PS_Dyn_Zahl", page);
    PS_Dyn_Zahl->setRange(0, Ticker::kLongestInterval);
    PS_Dyn_Zahl->setSingleStep(100);
    PS_Dyn_Zahl->setKeyboardTracking(false);  // stores what was typed, not every digit of it
    connect(PS_Dyn_Zahl, &QSpinBox::valueChanged, this, [this](int milliseconds) {
        m_with.profile.write(setting::kDynamicPsInterval, std::to_string(milliseconds));
    });
    auto* interval = m_book.captioned<QLabel>("", {927, "Abstand des dynamischen PS [ms]"}, page);
    m_book.head(interval, PS_Dyn_Zahl);
    m_book.tip(PS_Dyn_Zahl, {1139, "0 bis 65535 ms von einem Namen zum nächsten; 0 hält an"});

    auto* frame = m_book.captioned<QGroupBox>("", {922, "Grenzen der Eingabe, ausschließlich"}, page);
    constexpr std::array kNames = {"FM_Ulim_Zahl", "FM_Olim_Zahl", "NF_Ulim_Zahl", "NF_Olim_Zahl"};
    for (std::size_t i = 0; i < kLimits.size(); ++i) m_limits[i] = createLimit(kNames[i], kLimits[i], frame);
    const auto heading = [&](const Caption& caption, QWidget* control) {
        auto* label = m_book.captioned<QLabel>("", caption, frame);
        m_book.head(label, control);
        return label;
    };
    auto* limits = grid({{heading({212}, m_limits[0]), m_limits[0], heading({928, "bis"}, m_limits[1]), m_limits[1]},
                         {heading({215}, m_limits[2]), m_limits[2], heading({928, "bis"}, m_limits[3]), m_limits[3]}});
    limits->setColumnStretch(0, 1);
    layOut(frame, limits, 2 * kGap);

    auto* choices = grid({{language, Sprache_Wahl}, {standard, RDS_RBDS_Wahl}, {interval, PS_Dyn_Zahl}});
    choices->setColumnStretch(0, 1);
    auto* rows = column({Log_Schalter, Auto_Schalter, choices, frame, kRoom});
    rows->setSpacing(2 * kGap);
    layOut(page, rows, 2 * kGap);
    return page;
}

QDoubleSpinBox* SettingsDialog::createLimit(const char* name, const Place& place, QWidget* parent) {
    constexpr double kLargest = 10000;
    auto* box = named<QDoubleSpinBox>(name, parent);
    box->setLocale(QLocale::c());  // as values are written everywhere in the window
    box->setDecimals(3);
    box->setRange(0, kLargest);
    box->setKeyboardTracking(false);
    m_book.tip(box, {1140, "Bis 10000; angenommen wird nur, was zwischen beiden Grenzen liegt"});
    connect(box, &QDoubleSpinBox::valueChanged, this,
            [this, place](double value) { m_with.profile.write(place, shortestDecimal(value)); });
    return box;
}

void SettingsDialog::label() {
    const auto text = [this](const Caption& caption) { return captionText(m_with.captions, caption); };
    setWindowTitle(text({908, "Einstellun&gen..."}).remove(QLatin1Char('&')).remove(QLatin1Char('.')));
    m_book.label(m_with.captions);
    int tab = 0;
    for (const Caption& caption : {Caption{921, "Programm"}, Caption{923, "Adressen"}, Caption{924, "Berichtigungen"}})
        m_tabs->setTabText(tab++, text(caption));
    Sprache_Wahl->clear();
    for (const Caption& caption : {Caption{3}, Caption{4}, Caption{306, "english US"}})
        Sprache_Wahl->addItem(text(caption));
    m_addresses->label();
    m_corrections->label();
    const auto* chosen = std::find(kLanguages.begin(), kLanguages.end(), m_with.state.language);
    Sprache_Wahl->setCurrentIndex(chosen == kLanguages.end() ? -1 : static_cast<int>(chosen - kLanguages.begin()));
    RDS_RBDS_Wahl->setCurrentIndex(m_with.state.standard == "RBDS" ? 1 : 0);
    RDS_RBDS_Wahl->setEnabled(m_with.state.language != "deutsch");  // which has one list only
}

void SettingsDialog::load() {
    Log_Schalter->setChecked(m_with.state.LogEnabled);
    Auto_Schalter->setChecked(opensAtStart(m_with.profile.read(setting::kOpenAtStart)));
    const auto stored = [this](const Place& place) { return leadingNumber(m_with.profile.read(place)); };
    {
        const QSignalBlocker quiet(PS_Dyn_Zahl);
        PS_Dyn_Zahl->setValue(static_cast<int>(DynamicPs::keptInterval(m_with.profile)));
    }
    for (std::size_t i = 0; i < kLimits.size(); ++i) {
        const QSignalBlocker quiet(m_limits[i]);
        m_limits[i]->setValue(stored(kLimits[i]));
    }
    m_corrections->load();
}

void SettingsDialog::Log_Schalter_Click() {
    m_with.state.LogEnabled = Log_Schalter->isChecked();
    m_with.profile.write(setting::kCommandLogOn, Log_Schalter->isChecked() ? "1" : "0");
}

void SettingsDialog::Auto_Schalter_Click() {
    m_with.profile.write(setting::kOpenAtStart, Auto_Schalter->isChecked() ? "AUTO" : "MANUAL");
}

void SettingsDialog::Sprache_Wahl_Click(int index) {
    m_with.profile.write(setting::kLanguage, kLanguages.at(static_cast<std::size_t>(index)));
    emit languageChanged();
}

void SettingsDialog::RDS_RBDS_Wahl_Click(int index) {
    m_with.profile.write(setting::kStandard, kStandards.at(static_cast<std::size_t>(index)));
    emit languageChanged();
}

}  // namespace kdx
