#include "window/desktop.h"

#include <QAction>
#include <QMainWindow>
#include <QMenu>
#include <QMenuBar>
#include <QSettings>
#include <QShortcut>
#include <QTabWidget>

#include "station/session.h"
#include "ui/caption.h"
#include "ui/clickablelabel.h"
#include "window/mainmenu.h"
#include "window/views.h"

namespace kdx {

namespace {

constexpr const char* kPlaceKey = "window/place";
constexpr const char* kPageKey = "window/page";

}  // namespace

Desktop::Desktop(const Surroundings& with, const PageContext& context, ConnectionBar& bar, QTabWidget& pages,
                 QMainWindow* window)
    : m_with(with),
      m_window(window),
      m_pages(pages),
      m_sets(context, with.session, with.shipped, nullptr),
      m_indicators(context, m_sets, bar, with.simulated, nullptr),
      m_setMenu(m_sets, window) {
    connect(&m_sets, &DataSets::loaded, this, [this] {
        m_indicators.showDataSet();
        emit dataSetLoaded();
    });
    connect(&m_sets, &DataSets::sendRequested, this, &Desktop::sendRequested);
    connect(m_indicators.Datensatz_Anzeige, &ClickableLabel::clicked, this,
            [this] { popUp(m_setMenu.menu(), m_indicators.Datensatz_Anzeige); });
}

Desktop::~Desktop() {
    if (m_with.placeFile.empty()) return;
    QSettings kept(QString::fromStdString(m_with.placeFile.string()), QSettings::IniFormat);
    kept.setValue(QLatin1String(kPlaceKey), m_window->saveGeometry());
    kept.setValue(QLatin1String(kPageKey), m_pages.currentIndex());
}

void Desktop::restorePlace() {
    if (m_with.placeFile.empty()) return;
    const QSettings kept(QString::fromStdString(m_with.placeFile.string()), QSettings::IniFormat);
    m_window->restoreGeometry(kept.value(QLatin1String(kPlaceKey)).toByteArray());
    m_pages.setCurrentIndex(kept.value(QLatin1String(kPageKey), m_pages.currentIndex()).toInt());
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
    Mnu_Ansicht->addSeparator();
    Mnu_Ansicht_Lesen = entry("Mnu_Ansicht_Lesen", Mnu_Ansicht, Qt::Key_F5);
    connect(Mnu_Ansicht_Lesen, &QAction::triggered, this, &Desktop::readAllRequested);

    Mnu_Einstellungen = named<QAction>("Mnu_Einstellungen", m_window);
    m_window->menuBar()->addAction(Mnu_Einstellungen);

    Mnu_Hilfe = menu("Mnu_Hilfe");
    Mnu_Hilfe_Ueber = entry("Mnu_Hilfe_Ueber", Mnu_Hilfe);
    connect(Mnu_Hilfe_Ueber, &QAction::triggered, &info, &MainMenu::Mnu_Info_Ueber_Click);
    createKeys();
}

void Desktop::createKeys() {
    for (int page = 0; page < m_pages.count(); ++page) {
        const auto* key = new QShortcut(QKeySequence(Qt::CTRL | static_cast<Qt::Key>(Qt::Key_1 + page)), m_window);
        connect(key, &QShortcut::activated, &m_pages, [this, page] { m_pages.setCurrentIndex(page); });
    }
    const auto* save = new QShortcut(QKeySequence(Qt::CTRL | Qt::Key_S), m_window);
    connect(save, &QShortcut::activated, this,
            [this] { popUp(m_setMenu.savingMenu(), m_indicators.Datensatz_Anzeige); });
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
    Mnu_Datei->setTitle(text({890, "Da&tei"}));
    Mnu_Datei_Beenden->setText(text({906, "&Beenden"}));
    Mnu_Ansicht->setTitle(text({907, "Ansi&cht"}));
    Mnu_Info_Log->setText(text({680, "Log"}));
    Mnu_Ansicht_OnAir->setText(text({720, "Auf Sendung"}));
    Mnu_Ansicht_Lesen->setText(text({910, "Alles &zurücklesen"}));
    Mnu_Einstellungen->setText(text({908, "Einstellun&gen..."}));
    Mnu_Hilfe->setTitle(text({909, "Hil&fe"}));
    Mnu_Hilfe_Ueber->setText(text({1}));
}

}  // namespace kdx
