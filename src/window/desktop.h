#pragma once

#include <QObject>

#include "ui/pagecontext.h"
#include "window/datasetmenu.h"
#include "window/datasets.h"
#include "window/indicators.h"
#include "window/surroundings.h"

class QAction;
class QMainWindow;
class QMenu;
class QTabWidget;

namespace kdx {

class MainMenu;
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
    void showSessionOpen(bool open) { m_indicators.showSessionOpen(open); }
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

    Surroundings m_with;
    QMainWindow* m_window;
    QTabWidget& m_pages;
    DataSets m_sets;
    Indicators m_indicators;
    DataSetMenu m_setMenu;
    QMenu* Mnu_Datei = nullptr;
    QAction* Mnu_Datei_Beenden = nullptr;
    QMenu* Mnu_Ansicht = nullptr;
    QAction* Mnu_Info_Log = nullptr;  // the live view of the commands
    QAction* Mnu_Ansicht_OnAir = nullptr;
    QAction* Mnu_Ansicht_Lesen = nullptr;  // asks everything back
    QAction* Mnu_Einstellungen = nullptr;
    QMenu* Mnu_Hilfe = nullptr;
    QAction* Mnu_Hilfe_Ueber = nullptr;
};

}  // namespace kdx
