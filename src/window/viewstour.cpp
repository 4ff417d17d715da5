#include "window/viewstour.h"

#include <QAction>
#include <QApplication>
#include <QCheckBox>
#include <QComboBox>
#include <QLineEdit>
#include <QListWidget>
#include <QMenu>
#include <QMenuBar>
#include <QPainter>
#include <QPushButton>
#include <QTabWidget>
#include <QTimer>
#include <QTimerEvent>

#include <array>

#include "settings/shownpath.h"
#include "window/hmenue.h"
#include "window/tour.h"

namespace kdx {

namespace {

using namespace std::chrono_literals;

constexpr int kAfPage = 2;
constexpr int kTmcPage = 7;
constexpr double kNoon = 12 * 3600.0;

/// A user who looks into everything.
class Visitor {
public:
    Visitor(HMenue& window, Clock& clock, std::filesystem::path folder,
            const std::function<void(const std::string&)>& print)
        : m_window(window), m_clock(clock), m_folder(std::move(folder)), m_print(print) {}

    void showPages();
    void sendMessages();
    void openEditors();
    void openViews();
    void openMenus();

    [[nodiscard]] int failures() const { return m_failures; }
    [[nodiscard]] int pictures() const { return m_pictures; }

private:
    template <typename Control>
    Control& control(const char* name) const {
        return *m_window.findChild<Control*>(QString::fromLatin1(name));
    }
    void click(const char* name) const { control<QPushButton>(name).click(); }
    void choose(const char* entry) const { control<QAction>(entry).trigger(); }
    void showPage(int page) const { control<QTabWidget>("SSTab1").setCurrentIndex(page); }
    void save(const char* name, const QPixmap& picture);
    void saveView(const char* name, const char* view) { save(name, control<QWidget>(view).grab()); }
    void saveEditor(const char* name, const std::function<void()>& open);
    void composeMessage(int event, int location, int extent) const;
    void listen() const;
    void runScenario() const;

    HMenue& m_window;
    Clock& m_clock;
    std::filesystem::path m_folder;
    const std::function<void(const std::string&)>& m_print;
    int m_failures = 0;
    int m_pictures = 0;
};

/// Until everything that was asked for has been shown.
void settle(std::chrono::milliseconds time = 300ms) {
    QEventLoop loop;
    QTimer end;
    end.setSingleShot(true);
    QObject::connect(&end, &QTimer::timeout, &loop, &QEventLoop::quit);
    end.start(time);
    loop.exec();
}

void Visitor::save(const char* name, const QPixmap& picture) {
    const auto file = m_folder / (std::string(name) + ".png");
    if (savePicture(picture, file)) {
        ++m_pictures;
    } else {
        ++m_failures;
        m_print("!! cannot save " + shownPath(file));
    }
}

void Visitor::showPages() {
    for (int page = 0; page < control<QTabWidget>("SSTab1").count(); ++page) {
        showPage(page);
        settle();
        save(("page-" + std::to_string(page)).c_str(), m_window.grab());
    }
}

/// An editor lets nothing else be used until it is closed.
void Visitor::saveEditor(const char* name, const std::function<void()>& open) {
    bool seen = false;
    QTimer look;
    look.setSingleShot(true);
    QObject::connect(&look, &QTimer::timeout, &m_window, [&] {
        QWidget* editor = QApplication::activeModalWidget();
        if (editor == nullptr) return;
        seen = true;
        save(name, editor->grab());
        editor->close();
    });
    look.start(300ms);
    open();
    if (!seen) ++m_failures;
}

void Visitor::openEditors() {
    showPage(kAfPage);
    saveEditor("af-editor", [this] { click("AF_Bearbeiten"); });
    saveEditor("tmc-list-editor", [this] { choose("Mnu_TMC_Edit"); });
}

void Visitor::composeMessage(int event, int location, int extent) const {
    const auto select = [this](const char* name, int index) {
        auto& combo = control<QComboBox>(name);
        combo.setCurrentIndex(index);
        emit combo.activated(index);
    };
    select("TMC_Event_Combo", event);
    select("TMC_Loc_Combo", location);
    select("TMC_Var_Combo", extent);
    click("TMC_Gr8_apply");
}

void Visitor::sendMessages() {
    showPage(kTmcPage);
    control<QAbstractButton>("Tmc_richtung_0").click();
    for (const char* box : {"TMC_DP2_Check", "TMC_DP3Check", "TMC_Div", "TMC_F_Check"})
        control<QCheckBox>(box).setChecked(true);
    control<QCheckBox>("TMC_T_Check").setChecked(true);
    control<QCheckBox>("TMC_T_Check").setChecked(false);  // chosen, too
    composeMessage(3, 12, 1);
    composeMessage(1, 40, 0);
    composeMessage(20, 30, 2);
    control<QAbstractButton>("optMultiMessage").click();
    click("TMCInfoOnOff");
    control<QLineEdit>("txtCycleTime").setText(QStringLiteral("1"));
    click("TMC_Senden_Taste");
    settle(1300ms);  // one message has gone out
    save("tmc-in-use", control<QTabWidget>("SSTab1").currentWidget()->grab());
    click("Stop_Timer");
}

/// Lets the radio of the view hear some seconds, with room for every part of what is set.
void Visitor::listen() const {
    for (const char* button : {"Gruppe3", "Gruppe14", "GS_Senden"}) click(button);
    auto& timer = control<QTimer>("AirTimer");
    for (int look = 0; look < 100; ++look) {
        m_clock.sleep(200ms);
        QTimerEvent event(timer.timerId());
        QCoreApplication::sendEvent(&timer, &event);
    }
}

void Visitor::runScenario() const {
    click("Ablauf_Oeffnen");
    click("Ablauf_Start");
    settle(1s);
    click("Ablauf_Weiter");  // its first pause
    settle(1s);
}

void Visitor::openViews() {
    choose("Mnu_Ansicht_OnAir");
    listen();
    settle();
    saveView("on-air", "OnAirView");
    control<QWidget>("OnAirView").close();

    auto& ps = control<QLineEdit>("PS_T");
    const QString before = ps.text();
    ps.setText(QStringLiteral("KDX TEST"));  // typed and not sent
    choose("Mnu_Ansicht_Vergleich");
    click("Vergleich_Lesen");
    settle();
    saveView("compare", "CompareView");
    control<QWidget>("CompareView").close();
    ps.setText(before);

    choose("Mnu_Ansicht_Ablauf");
    runScenario();
    saveView("scenario", "ScenarioView");
    click("Ablauf_Stop");
    settle();
    control<QWidget>("ScenarioView").close();

    choose("Mnu_Info_Log");
    settle();
    saveView("log", "LogView");
    control<QWidget>("LogView").close();

    choose("Mnu_Einstellungen");
    settle();
    saveView("settings", "SettingsDialog");
    control<QWidget>("SettingsDialog").close();
}

/// Menus are windows of their own: they are painted where they would stand.
void Visitor::openMenus() {
    showPage(0);
    auto& file = control<QMenu>("Mnu_Datei");
    auto& sets = control<QMenu>("Mnu_Datensatz");
    const QRect title = m_window.menuBar()->actionGeometry(file.menuAction());
    const QPoint below = m_window.menuBar()->mapTo(&m_window, title.bottomLeft());
    file.popup(m_window.mapToGlobal(below));
    file.setActiveAction(sets.menuAction());
    sets.popup(file.mapToGlobal(file.actionGeometry(sets.menuAction()).topRight()));
    settle();
    QPixmap picture = m_window.grab();
    {
        QPainter painter(&picture);
        painter.drawPixmap(below, file.grab());
        painter.drawPixmap(below + file.actionGeometry(sets.menuAction()).topRight(), sets.grab());
    }
    save("data-sets", picture);
    sets.hide();
    file.hide();
}

}  // namespace

double TourClock::secondsSinceMidnight() const {
    return kNoon + std::chrono::duration<double>(m_passed.load()).count();
}

Date TourClock::today() const {
    return {2026, 1, 1};
}

std::chrono::steady_clock::time_point TourClock::steadyNow() const {
    return std::chrono::steady_clock::time_point(m_passed.load());
}

void TourClock::sleep(std::chrono::nanoseconds duration) {
    m_passed = m_passed.load() + duration;
}

int makeViewsTour(HMenue& window, Clock& clock, TourDialogs& dialogs, const std::filesystem::path& scenario,
                  const std::filesystem::path& folder, const std::function<void(const std::string&)>& print) {
    const int boxes = dialogs.count();
    dialogs.chooseToOpen(scenario);
    Visitor visitor(window, clock, folder, print);
    visitor.showPages();
    visitor.sendMessages();
    visitor.openEditors();
    visitor.openViews();
    visitor.openMenus();
    const int failures = visitor.failures() + dialogs.count() - boxes;
    print(std::to_string(visitor.pictures()) + " more pictures, " + std::to_string(failures) + " failures");
    return failures == 0 ? 0 : 1;
}

}  // namespace kdx
