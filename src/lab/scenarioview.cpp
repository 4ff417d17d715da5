#include "lab/scenarioview.h"

#include <QDir>
#include <QFile>
#include <QFileInfo>
#include <QKeyEvent>
#include <QLabel>
#include <QPushButton>

#include "base/paths.h"
#include "base/split.h"
#include "lab/mistaketext.h"
#include "lab/scenariorun.h"
#include "rds/settings.h"
#include "scenario/reader.h"
#include "settings/datafolder.h"
#include "settings/profilefile.h"
#include "settings/programstate.h"
#include "station/session.h"
#include "station/wrongsettings.h"
#include "ui/dialogs.h"
#include "ui/layouts.h"
#include "ui/savefile.h"
#include "ui/ticker.h"

namespace kdx {

namespace {

constexpr qsizetype kMostProblems = 12;  // that a box has room for

/// "12 s", "3:20" or "1:03:20".
QString durationText(std::chrono::nanoseconds duration) {
    const auto seconds = std::chrono::ceil<std::chrono::seconds>(duration).count();
    if (seconds < 60) return QStringLiteral("%1 s").arg(seconds);
    const auto two = [](std::int64_t number) { return QStringLiteral("%1").arg(number, 2, 10, QLatin1Char('0')); };
    if (seconds < 3600) return QStringLiteral("%1:%2").arg(seconds / 60).arg(two(seconds % 60));
    return QStringLiteral("%1:%2:%3").arg(seconds / 3600).arg(two(seconds / 60 % 60), two(seconds % 60));
}

}  // namespace

ScenarioView::ScenarioView(Session& session, const PageContext& with, std::filesystem::path shipped, QWidget* parent)
    : QDialog(parent),
      m_session(session),
      m_with(with),
      m_run(new ScenarioRun(session, with, this)),
      m_automatic(
          with.tickers.automatics(),
          [this] {
              return caption({974, "Ablauf"});
          },
          [this] { m_run->stop(); }, [this] { m_run->panic(); }),
      m_steps("Ablauf_Liste", with, this),
      m_shipped(std::move(shipped)),
      m_sessionOpen(session.instrument.isOpen()) {
    setObjectName(QStringLiteral("ScenarioView"));
    m_book.text(this, {974, "Ablauf"});
    Ablauf_Titel = named<QLabel>("Ablauf_Titel", this);
    Ablauf_Stand = named<QLabel>("Ablauf_Stand", this);
    for (QLabel* line : {Ablauf_Titel, Ablauf_Stand}) line->setWordWrap(true);
    const auto button = [this](const char* name, const Caption& caption, const Caption& tip, auto handler) {
        auto* made = m_book.captioned<QPushButton>(name, caption, this);
        m_book.tip(made, tip);
        made->setAutoDefault(false);
        connect(made, &QPushButton::clicked, this, handler);
        return made;
    };
    Ablauf_Oeffnen = button("Ablauf_Oeffnen", {975, "Ö&ffnen..."},
                            {1122, "Liest und prüft eine Szenariodatei und zeigt ihre Schritte"},
                            &ScenarioView::Ablauf_Oeffnen_Click);
    Ablauf_Start =
        button("Ablauf_Start", {976, "St&art"}, {1123, "Führt die Schritte aus; dazu muss die Verbindung offen sein"},
               &ScenarioView::Ablauf_Start_Click);
    Ablauf_Pause =
        button("Ablauf_Pause", {977, "&Pause"}, {1124, "Hält die Zeit des Ablaufs an, bis noch einmal geklickt wird"},
               &ScenarioView::Ablauf_Pause_Click);
    Ablauf_Pause->setCheckable(true);
    Ablauf_Pause->setProperty(kWorksWhileSending, true);
    Ablauf_Stop =
        button("Ablauf_Stop", {978, "S&topp"},
               {1125, "Bricht ab; was vorher war, kommt wieder, wenn die Datei das vorsieht"}, &ScenarioView::stop);
    Ablauf_Stop->setProperty(kWorksWhileSending, true);
    Ablauf_Weiter =
        button("Ablauf_Weiter", {979, "&Weiter"}, {1126, "Setzt den Ablauf fort, wo ein Schritt auf Sie wartet"},
               &ScenarioView::Ablauf_Weiter_Click);
    Ablauf_Schliessen = button("Ablauf_Schliessen", {688, "&Schließen"},
                               {1121, "Schließt nur diese Ansicht; was läuft, läuft weiter"}, &QDialog::close);
    m_book.tip(m_steps.widget(), {1127, "Die Schritte der Datei und, sobald sie ausgeführt sind, ihr Ergebnis"});
    connect(m_run, &ScenarioRun::stepBegan, this, [this](const std::string& step) {
        m_step = step;
        m_steps.mark(step);
    });
    connect(m_run, &ScenarioRun::rowAdded, this, [this](const scenario::Row& row) {
        if (row.status == scenario::kNotMet) ++m_unmet;
        m_steps.add(row);
    });
    connect(m_run, &ScenarioRun::changed, this, &ScenarioView::showState);
    connect(m_run, &ScenarioRun::over, this, &ScenarioView::showEnd);
    arrange();
    label();
}

ScenarioView::~ScenarioView() {
    m_run->disconnect(this);
    m_run->finish();
}

void ScenarioView::arrange() {
    layOut(this,
           column({Ablauf_Titel,
                   {m_steps.widget(), 1},
                   Ablauf_Stand,
                   row({Ablauf_Oeffnen, Ablauf_Start, Ablauf_Pause, Ablauf_Stop, Ablauf_Weiter, kRoom,
                        Ablauf_Schliessen})}),
           6);
    // In letters, so that it is the same on every display.
    resize(fontMetrics().averageCharWidth() * 120, fontMetrics().height() * 30);
}

void ScenarioView::label() {
    m_book.label(m_with.captions);
    m_steps.label();
    showState();
}

void ScenarioView::showSessionOpen(bool open) {
    m_sessionOpen = open;
    showState();
}

bool ScenarioView::isRunning() const {
    return m_run->isRunning();
}

bool ScenarioView::isAtWork() const {
    return m_run->isAtWork();
}

void ScenarioView::stop() {
    m_run->stop();
}

void ScenarioView::finish() {
    m_run->finish();
}

bool ScenarioView::takesFailure() {
    return m_run->takesFailure();
}

void ScenarioView::keyPressEvent(QKeyEvent* event) {
    if (event->key() != Qt::Key_Escape || !m_run->isRunning()) QDialog::keyPressEvent(event);
}

bool ScenarioView::leftNothing() const {
    return m_scenario.restore && m_outcome && m_outcome->restored && m_outcome->changed.empty() &&
           m_outcome->untold.empty();
}

void ScenarioView::Ablauf_Oeffnen_Click() {
    const QString file =
        m_with.dialogs.fileToOpen(windowTitle(), caption({990, "Szenario (*.yaml *.yml)"}), folderToOpen());
    if (file.isEmpty()) return;
    m_folder = QFileInfo(file).absolutePath();
    openFile(file);
}

/// Where scenarios are to be found; a folder that is not there would be taken for the name of a file.
QString ScenarioView::folderToOpen() const {
    QStringList places{m_folder};
    for (const auto& place : {m_shipped, m_with.data.file("Scenarios")})
        places += QString::fromStdString(utf8Of(place));
    for (const QString& place : places) {
        if (!place.isEmpty() && QFileInfo(place).isDir()) return place;
    }
    return {};
}

void ScenarioView::openFile(const QString& file) {
    const auto bytes = readFile(QFileInfo(file).filesystemFilePath());
    QStringList problems;
    scenario::Reading reading;
    if (!bytes) {
        problems += caption({593, "%1 kann nicht gelesen werden."}).arg(file);
    } else {
        reading = scenario::readScenario(*bytes, false, m_with.state.corrections);
        for (const scenario::Problem& problem : reading.problems) {
            problems += caption({991, "Zeile %1, Spalte %2: %3"})
                            .arg(problem.line)
                            .arg(problem.column)
                            .arg(mistakeText(m_with, problem));
        }
        if (problems.isEmpty()) problems = problemsOf(reading.scenario);
    }
    if (!problems.isEmpty()) {
        if (problems.size() > kMostProblems)
            problems = problems.mid(0, kMostProblems) + QStringList(QStringLiteral("..."));
        m_with.dialogs.message(Dialogs::Icon::Critical, caption({313, "Fehler"}), QFileInfo(file).fileName(),
                               problems.join(QLatin1Char('\n')));
        return;
    }
    m_file = file;
    m_scenario = std::move(reading.scenario);
    m_step.clear();
    m_outcome.reset();
    m_steps.show(m_scenario);
    showState();
}

/// What keeps the data set that goes with it from being sent.
QStringList ScenarioView::problemsOf(const scenario::Scenario& scenario) const {
    if (!scenario.dataSet) return {};
    const std::string name = dataSetFile(std::to_string(*scenario.dataSet));
    const Profile source = Profile::ofFile(m_with.data, name);
    if (!source.hasSectionOf(setting::kPi.place))
        return {caption({593, "%1 kann nicht gelesen werden."}).arg(QString::fromStdString(name))};
    QStringList problems;
    for (const WrongSetting& wrong : wrongSettings(source)) problems += mistakeText(m_with, wrong);
    return problems;
}

void ScenarioView::Ablauf_Start_Click() {
    if (m_run->isRunning() || m_file.isEmpty()) return;
    std::filesystem::path report = pathFromUtf8(m_scenario.report);
    // A relative one stands beside the scenario: nobody knows what folder the window was started in.
    if (!report.empty()) report = QFileInfo(m_file).filesystemFilePath().parent_path() / report;
    m_steps.clearResults();
    m_step.clear();
    m_outcome.reset();
    m_unmet = 0;
    if (const QString why = report.empty() ? QString() : whyNotSaved(m_with, report); !why.isEmpty()) {
        m_with.dialogs.message(Dialogs::Icon::Critical, caption({313, "Fehler"}),
                               caption({312, "Nicht gespeichert: %1"}).arg(QString::fromStdString(utf8Of(report))),
                               why);
        return;
    }
    const auto fault = m_run->begin(m_scenario, report);
    if (!fault) return;
    const QString name = QString::fromStdString(utf8Of(report));
    m_with.dialogs.message(
        Dialogs::Icon::Critical, caption({313, "Fehler"}),
        *fault == scenario::ReportFault::Foreign
            ? caption({1236, "%1 ist schon da und ist kein Bericht, der neu geschrieben werden darf."}).arg(name)
            : caption({1237, "Der Bericht %1 kann nicht geschrieben werden."}).arg(name));
}

void ScenarioView::Ablauf_Pause_Click() {
    m_run->setHeld(!m_run->isHeld());
}

void ScenarioView::Ablauf_Weiter_Click() {
    m_run->goOn();
}

void ScenarioView::showEnd(const scenario::Outcome& outcome) {
    m_outcome = outcome;
    m_steps.end(outcome.complete);
}

QString ScenarioView::endText(const scenario::Outcome& outcome) const {
    QStringList end{outcome.complete ? caption({985, "zu Ende"}) : caption({986, "abgebrochen"})};
    if (outcome.unmet > 0) end += caption({987, "nicht erfüllt: %1"}).arg(outcome.unmet);
    std::vector<std::string> other = outcome.changed;
    other.insert(other.end(), outcome.untold.begin(), outcome.untold.end());
    if (other.empty() && !outcome.restored) other.emplace_back("?");
    if (!outcome.complete && leftNothing()) end += caption({1255, "wie zuvor"});
    if (!other.empty()) end += caption({988, "nicht wie zuvor: %1"}).arg(QString::fromStdString(joined(other, ", ")));
    return end.join(QStringLiteral("; "));
}

void ScenarioView::showState() {
    const bool running = m_run->isRunning();
    Ablauf_Oeffnen->setEnabled(!running);
    Ablauf_Start->setEnabled(!running && m_sessionOpen && !m_file.isEmpty());
    Ablauf_Pause->setEnabled(running);
    Ablauf_Pause->setChecked(m_run->isHeld());
    Ablauf_Stop->setEnabled(running);
    Ablauf_Weiter->setEnabled(running && m_run->asks());
    const QString title = QString::fromStdString(m_scenario.title);
    const QString name = QFileInfo(m_file).fileName();
    Ablauf_Titel->setText(title.isEmpty() ? name : title + QStringLiteral("  (%1)").arg(name));
    QStringList state;
    if (!running) {
        if (m_outcome) state += endText(*m_outcome);
    } else if (m_run->isRestoring()) {
        state += caption({1090, "was vorher war, wird wiederhergestellt"});
    } else if (m_step.empty() && m_scenario.restore) {
        state += caption({989, "was vorher war, wird gelesen und kommt danach wieder"});
    } else {
        if (!m_step.empty()) state += caption({993, "Schritt %1"}).arg(QString::fromStdString(m_step));
        if (m_run->asks()) state += caption({999, "wartet auf Weiter"});
        if (m_run->left().count() > 0) state += caption({983, "noch %1"}).arg(durationText(m_run->left()));
        if (m_run->isHeld()) state += caption({984, "angehalten"});
        if (m_unmet > 0) state += caption({987, "nicht erfüllt: %1"}).arg(m_unmet);
    }
    Ablauf_Stand->setText(state.join(QStringLiteral("; ")));
    m_automatic.setRunning(running);
    if (running != std::exchange(m_wasRunning, running)) emit runningChanged(running);
}

}  // namespace kdx
