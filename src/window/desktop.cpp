#include "window/desktop.h"

#include <QAction>
#include <QCoreApplication>
#include <QMainWindow>
#include <QMenu>
#include <QMenuBar>
#include <QSettings>
#include <QShortcut>
#include <QSignalBlocker>
#include <QTabWidget>

#include "base/paths.h"
#include "link/discovery.h"
#include "settings/programstate.h"
#include "station/session.h"
#include "ui/caption.h"
#include "ui/clickablelabel.h"
#include "ui/plaintext.h"
#include "ui/text.h"
#include "window/connectionbar.h"
#include "window/mainmenu.h"
#include "window/settingsdialog.h"
#include "window/views.h"

namespace kdx {

namespace {

constexpr const char* kPlaceKey = "window/place";
constexpr const char* kPageKey = "window/page";
constexpr const char* kAddressesKey = "addresses/used";

QString fileText(const std::filesystem::path& file) {
    return QString::fromStdString(utf8Of(file));
}

}  // namespace

Desktop::Desktop(const Surroundings& with, const PageContext& context, ConnectionBar& bar, QTabWidget& pages,
                 QMainWindow* window)
    : m_with(with),
      m_window(window),
      m_context(context),
      m_bar(bar),
      m_pages(pages),
      m_sets(context, with.session, with.shipped, nullptr),
      m_indicators(context, m_sets, bar, with.simulated, nullptr),
      m_setMenu(m_sets, window),
      m_toolkitTexts(with.captions),
      m_manual(with.shipped / "manual", context, pages, window) {
    QCoreApplication::installTranslator(&m_toolkitTexts);
    connect(&m_sets, &DataSets::loaded, this, [this] {
        m_indicators.showDataSet();
        emit dataSetLoaded();
    });
    connect(&m_sets, &DataSets::sendRequested, this, &Desktop::sendRequested);
    connect(m_indicators.Datensatz_Anzeige, &ClickableLabel::clicked, this,
            [this] { popUp(m_setMenu.menu(), m_indicators.Datensatz_Anzeige); });
}

Desktop::~Desktop() {
    if (!keepsPlace()) return;
    QSettings kept(fileText(m_with.placeFile), QSettings::IniFormat);
    kept.setValue(QLatin1String(kPlaceKey), m_window->saveGeometry());
    kept.setValue(QLatin1String(kPageKey), m_pages.currentIndex());
}

void Desktop::restorePlace() {
    if (!keepsPlace()) return;
    const QSettings kept(fileText(m_with.placeFile), QSettings::IniFormat);
    m_window->restoreGeometry(kept.value(QLatin1String(kPlaceKey)).toByteArray());
    m_pages.setCurrentIndex(kept.value(QLatin1String(kPageKey), m_pages.currentIndex()).toInt());
}

void Desktop::showSessionOpen(bool open) {
    m_sessionOpen = open;
    m_indicators.showSessionOpen(open);
    if (m_settings != nullptr) m_settings->addresses().showSessionOpen(open);
    if (open) rememberAddress();
}

/// The latest first.
void Desktop::rememberAddress() {
    if (!keepsPlace() || m_with.simulated) return;
    constexpr int kMost = 20;
    const QString used = toText(m_with.state.InterfaceKind + ' ' + m_bar.address());
    QStringList addresses = usedAddresses();
    addresses.removeAll(used);
    addresses.prepend(used);
    QSettings kept(fileText(m_with.placeFile), QSettings::IniFormat);
    kept.setValue(QLatin1String(kAddressesKey), addresses.mid(0, kMost));
}

QStringList Desktop::usedAddresses() const {
    if (!keepsPlace()) return {};
    return QSettings(fileText(m_with.placeFile), QSettings::IniFormat)
        .value(QLatin1String(kAddressesKey))
        .toStringList();
}

void Desktop::openSettings() {
    if (m_settings == nullptr) {
        const auto find = [](const std::function<bool()>& stopped) {
            Discovery how;
            how.stopped = stopped;
            return discoverLanInstruments(how);
        };
        m_settings = new SettingsDialog(m_context, find, m_window);
        connect(m_settings, &SettingsDialog::languageChanged, this, &Desktop::relabelRequested);
        connect(m_settings, &SettingsDialog::correctionsChanged, this, &Desktop::useCorrections);
        connect(&m_settings->addresses(), &AddressesPage::chosen, &m_bar, &ConnectionBar::use);
        m_settings->addresses().showSessionOpen(m_sessionOpen);
    }
    m_settings->load();
    m_settings->addresses().show(usedAddresses());
    m_settings->show();
    m_settings->raise();
    m_settings->activateWindow();
}

void Desktop::useCorrections() {
    m_with.session.readCorrections();
    m_window->setProperty(kQuotesDoubled, m_with.state.corrections.quotes);
    markQuotes(*m_window);
    // Labelling shows the first page; the user's own stays, and is not opened anew either: that reads what was stored.
    const int page = m_pages.currentIndex();
    const QSignalBlocker quiet(&m_pages);
    emit relabelRequested();
    m_pages.setCurrentIndex(page);
}

void Desktop::createMenus(MainMenu& info, Views& views) {
    Mnu_Datei = menu("Mnu_Datei");
    Mnu_Datei->addMenu(m_setMenu.menu());
    Mnu_Datei->addSeparator();
    Mnu_Datei_Beenden = entry("Mnu_Datei_Beenden", Mnu_Datei, Qt::CTRL | Qt::Key_Q);
    connect(Mnu_Datei_Beenden, &QAction::triggered, m_window, &QWidget::close);

    Mnu_Ansicht = menu("Mnu_Ansicht");
    Mnu_Info_Log = entry("Mnu_Info_Log", Mnu_Ansicht);
    connect(Mnu_Info_Log, &QAction::triggered, this, [&views] { views.openLog(); });
    Mnu_Ansicht_OnAir = entry("Mnu_Ansicht_OnAir", Mnu_Ansicht);
    connect(Mnu_Ansicht_OnAir, &QAction::triggered, this, [&views] { views.openOnAir(); });
    Mnu_Ansicht_Vergleich = entry("Mnu_Ansicht_Vergleich", Mnu_Ansicht);
    connect(Mnu_Ansicht_Vergleich, &QAction::triggered, this, [&views] { views.openCompare(); });
    Mnu_Ansicht_Ablauf = entry("Mnu_Ansicht_Ablauf", Mnu_Ansicht);
    connect(Mnu_Ansicht_Ablauf, &QAction::triggered, this, [&views] { views.openScenario(); });
    Mnu_Ansicht->addSeparator();
    Mnu_Ansicht_Lesen = entry("Mnu_Ansicht_Lesen", Mnu_Ansicht, Qt::Key_F5);
    connect(Mnu_Ansicht_Lesen, &QAction::triggered, this, &Desktop::readAllRequested);

    Mnu_Einstellungen = named<QAction>("Mnu_Einstellungen", m_window);
    connect(Mnu_Einstellungen, &QAction::triggered, this, &Desktop::openSettings);
    m_window->menuBar()->addAction(Mnu_Einstellungen);

    Mnu_Hilfe = menu("Mnu_Hilfe");
    Mnu_Hilfe_Handbuch = entry("Mnu_Hilfe_Handbuch", Mnu_Hilfe, Qt::Key_F1);
    connect(Mnu_Hilfe_Handbuch, &QAction::triggered, this, [this] { m_manual.openAt(*m_window); });
    Mnu_Hilfe_Ueber = entry("Mnu_Hilfe_Ueber", Mnu_Hilfe);
    connect(Mnu_Hilfe_Ueber, &QAction::triggered, &info, &MainMenu::Mnu_Info_Ueber_Click);
    createKeys();
}

void Desktop::createKeys() {
    for (int page = 0; page < m_pages.count(); ++page) {
        const auto* key = new QShortcut(QKeySequence(Qt::CTRL | static_cast<Qt::Key>(Qt::Key_1 + page)), m_window);
        connect(key, &QShortcut::activated, &m_pages, [this, page] { m_pages.setCurrentIndex(page); });
    }
    // The submenu's own key: so it is shown beside its title.
    QAction* save = m_setMenu.savingMenu()->menuAction();
    save->setShortcut(Qt::CTRL | Qt::Key_S);
    connect(save, &QAction::triggered, this, [this] { popUp(m_setMenu.savingMenu(), m_indicators.Datensatz_Anzeige); });
}

void Desktop::showTips() {
    m_tips.show(*m_window, m_with.captions);
}

QMenu* Desktop::menu(const char* name) {
    auto* menu = named<QMenu>(name, m_window);
    m_window->menuBar()->addMenu(menu);
    return menu;
}

QAction* Desktop::entry(const char* name, QMenu* menu, const QKeySequence& keys) {
    auto* action = named<QAction>(name, menu);
    action->setShortcut(keys);
    menu->addAction(action);
    return action;
}

/// Shows a menu above a control; the first entry can be chosen by its digit at once.
void Desktop::popUp(QMenu* menu, QWidget* at) {
    menu->popup(at->mapToGlobal(QPoint(0, -menu->sizeHint().height())));
}

void Desktop::label() {
    const auto text = [this](const Caption& caption) { return captionText(m_with.captions, caption); };
    m_setMenu.label(m_with.captions);
    m_indicators.label();
    m_manual.label();
    if (m_settings != nullptr) m_settings->label();
    Mnu_Datei->setTitle(text({890, "Da&tei"}));
    Mnu_Datei_Beenden->setText(text({906, "&Beenden"}));
    Mnu_Ansicht->setTitle(text({907, "Ansi&cht"}));
    Mnu_Info_Log->setText(text({1251, "&Log"}));
    Mnu_Ansicht_OnAir->setText(text({1252, "A&uf Sendung"}));
    Mnu_Ansicht_Vergleich->setText(text({1253, "&Vergleich"}));
    Mnu_Ansicht_Ablauf->setText(text({1254, "A&blauf"}));
    Mnu_Ansicht_Lesen->setText(text({910, "Alles &zurücklesen"}));
    Mnu_Einstellungen->setText(text({908, "Einstellun&gen..."}));
    Mnu_Hilfe->setTitle(text({909, "Hil&fe"}));
    Mnu_Hilfe_Handbuch->setText(text({1110, "&Handbuch"}));
    Mnu_Hilfe_Ueber->setText(text({1}));
}

}  // namespace kdx
