#pragma once

#include <QObject>

#include "ui/pagecontext.h"
#include "window/datasetmenu.h"
#include "window/datasets.h"
#include "window/indicators.h"
#include "window/manual.h"
#include "window/surroundings.h"
#include "window/tips.h"
#include "window/toolkittexts.h"

class QAction;
class QMainWindow;
class QMenu;
class QTabWidget;

namespace kdx {

class MainMenu;
class SettingsDialog;
class Views;

/// What the window offers as every program of a desktop does, beside what is described of it: menus with their keys,
/// data sets, settings, and its place and page from one start to the next.
class Desktop : public QObject {
    Q_OBJECT
public:
    /// @param pages the window's tabs.
    Desktop(const Surroundings& with, const PageContext& context, ConnectionBar& bar, QTabWidget& pages,
            QMainWindow* window);
    ~Desktop() override;

    /// Makes the menus. @param info the described one, which keeps its place; @param views are opened from here.
    void createMenus(MainMenu& info, Views& views);
    void label();
    /// Gives every control a tip; again when some were taken off.
    void showTips();
    void showSessionOpen(bool open);
    /// The page and the place of the last time.
    void restorePlace();

signals:
    void dataSetLoaded();
    void sendRequested();
    void relabelRequested();
    void readAllRequested();

private:
    QMenu* menu(const char* name);
    QAction* entry(const char* name, QMenu* menu, const QKeySequence& keys = {});
    void createKeys();
    void popUp(QMenu* menu, QWidget* at);
    void openSettings();
    void useCorrections();
    void rememberAddress();
    [[nodiscard]] QStringList usedAddresses() const;
    [[nodiscard]] bool keepsPlace() const { return !m_with.placeFile.empty(); }

    Surroundings m_with;
    QMainWindow* m_window;
    PageContext m_context;
    ConnectionBar& m_bar;
    QTabWidget& m_pages;
    bool m_sessionOpen = false;
    DataSets m_sets;
    Indicators m_indicators;
    DataSetMenu m_setMenu;
    Tips m_tips;
    ToolkitTexts m_toolkitTexts;
    Manual m_manual;
    QMenu* Mnu_Datei = nullptr;
    QAction* Mnu_Datei_Beenden = nullptr;
    QMenu* Mnu_Ansicht = nullptr;
    QAction* Mnu_Info_Log = nullptr;  // the live view of the commands
    QAction* Mnu_Ansicht_OnAir = nullptr;
    QAction* Mnu_Ansicht_Vergleich = nullptr;
    QAction* Mnu_Ansicht_Ablauf = nullptr;
    QAction* Mnu_Ansicht_Lesen = nullptr;  // asks everything back
    QAction* Mnu_Einstellungen = nullptr;
    SettingsDialog* m_settings = nullptr;  // made when it is first opened
    QMenu* Mnu_Hilfe = nullptr;
    QAction* Mnu_Hilfe_Handbuch = nullptr;
    QAction* Mnu_Hilfe_Ueber = nullptr;
};

}  // namespace kdx
