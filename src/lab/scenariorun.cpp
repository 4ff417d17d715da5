#include "lab/scenariorun.h"

#include <QScopeGuard>
#include <QScopedValueRollback>

#include <algorithm>
#include <exception>

#include "scenario/readoutrestorer.h"
#include "settings/datafolder.h"
#include "settings/profile.h"
#include "settings/programstate.h"
#include "station/session.h"
#include "ui/named.h"
#include "ui/ticker.h"

namespace kdx {

/// Brings back what can be read back; where the program is to end and the instrument has gone, nothing is tried.
class ScenarioRun::Restorer final : public scenario::Restorer {
public:
    explicit Restorer(ScenarioRun& run)
        : m_run(run), m_readout(run.m_session.instrument, run.m_with.state.corrections) {}

    bool remember() override { return m_readout.remember(); }
    std::optional<SettingCommands> commands() override { return isGivenUp() ? std::nullopt : m_readout.commands(); }
    [[nodiscard]] std::vector<std::string> untold() const override { return m_readout.untold(); }
    std::optional<std::vector<std::string>> changed() override {
        return isGivenUp() ? std::nullopt : m_readout.changed();
    }

private:
    [[nodiscard]] bool isGivenUp() const { return m_run.m_hurries && m_run.m_failed; }

    ScenarioRun& m_run;
    scenario::ReadoutRestorer m_readout;
};

ScenarioRun::ScenarioRun(Session& session, const PageContext& with, QObject* parent)
    : QObject(parent), m_session(session), m_with(with), m_clock(with.clock) {
    // One of the window's timers: it waits while a box is open.
    m_timer = named<Ticker>("AblaufTimer", with.tickers, this);
    connect(m_timer, &Ticker::timeout, this, &ScenarioRun::AblaufTimer_Timer);
}

ScenarioRun::~ScenarioRun() {
    finish();
}

std::optional<scenario::ReportFault> ScenarioRun::begin(const scenario::Scenario& scenario,
                                                        const std::filesystem::path& report) {
    m_report = scenario::Report(report);
    if (!report.empty()) {
        if (const auto fault = m_report.begin()) return fault;
    }
    m_scenario = scenario;
    m_stopped = m_failed = m_finishes = m_hurries = m_pressed = m_asks = m_asked = m_panics = false;
    m_announcements.clear();
    m_identifier = m_with.state.eonIdentifier;
    m_restorer = std::make_unique<Restorer>(*this);
    scenario::Surroundings with{m_session, m_with.state, m_clock, *this, *this};
    with.restorer = m_restorer.get();
    if (!report.empty()) with.report = &m_report;
    with.sendDataSet = [this] { sendDataSet(m_scenario.dataSet.value_or(1)); };
    m_runner = std::make_unique<scenario::Runner>(with);
    m_runner->start(m_scenario, {});
    m_until = m_clock.steadyNow();
    m_timer->setPeriod(1);
    m_timer->setEnabled(true);
    emit changed();
    return std::nullopt;
}

/// The window keeps what it shows: only the instrument gets the set, as a program that was just started would send it.
void ScenarioRun::sendDataSet(int number) {
    const Station shown = m_session.station;
    const auto back = qScopeGuard([&] {
        m_session.load();
        m_session.station = shown;
    });
    m_session.station = Station();
    m_session.load(Profile::ofFile(m_with.data, dataSetFile(std::to_string(number))));
    m_session.sendOpening();
}

void ScenarioRun::AblaufTimer_Timer() {
    if (!isRunning() || m_inside || isHeld()) return;
    const auto pause = goOnToPause();
    if (!pause) return;
    if (m_hurries && m_failed) return finish();  // given up while it went on
    const auto milliseconds = std::chrono::ceil<std::chrono::milliseconds>(*pause).count();
    m_timer->setPeriod(static_cast<double>(std::max<std::int64_t>(milliseconds, 1)));
    emit changed();
}

std::optional<std::chrono::nanoseconds> ScenarioRun::goOnToPause() {
    std::optional<std::chrono::nanoseconds> pause;
    try {
        const QScopedValueRollback inside(m_inside, true);
        m_asked = false;
        pause = m_runner->goOn();
        if (!pause && m_panics && !(m_hurries && m_failed)) endAnnouncements();
    } catch (...) {
        close();
        throw;
    }
    if (pause && pause->count() > 0) m_asks = m_asked;  // else the step is in the middle of its work
    if (!pause) close();
    return pause;
}

void ScenarioRun::happened(const scenario::Row& row) {
    const bool announces =
        row.command.find("\"TA=") != std::string::npos || row.command.find("\"EON-TA=") != std::string::npos;
    if (announces && row.status == "0") {
        std::string end = row.command;
        const char state = std::exchange(end[end.size() - 2], '0');  // before the quotation mark
        if (state == '1') m_announcements[end] = row.key;
        if (state == '0') m_announcements.erase(end);
    }
    emit rowAdded(row);
}

void ScenarioRun::endAnnouncements() {
    for (const auto& [end, key] : std::exchange(m_announcements, {})) {
        m_session.params.sendCommand(key, end);
        m_silenced.push_back(key);
    }
}

void ScenarioRun::close() {
    m_timer->setEnabled(false);
    m_clock.setHeld(false);
    m_with.state.eonIdentifier = m_identifier;
    m_asks = false;
    scenario::Outcome outcome = m_runner->outcome();
    // Panic is the last word, also over an announcement that was brought back.
    const std::vector<std::string> silenced = std::exchange(m_silenced, {});
    if (m_scenario.restore) outcome.changed.insert(outcome.changed.end(), silenced.begin(), silenced.end());
    m_runner.reset();
    emit over(outcome);
    emit changed();
}

void ScenarioRun::setHeld(bool held) {
    if (!isRunning()) return;
    m_clock.setHeld(held);
    emit changed();
}

void ScenarioRun::stop() {
    if (m_finishes) m_hurries = true;
    m_stopped = true;
    setHeld(false);
    if (m_hurries && m_failed) finish();
}

void ScenarioRun::panic() {
    if (!isRunning()) return;
    m_panics = true;
    stop();
}

void ScenarioRun::finish() {
    m_stopped = m_hurries = true;
    if (!isRunning() || m_inside) return;
    m_clock.setHeld(false);
    try {
        while (const auto pause = goOnToPause()) {
            if (!m_failed) m_clock.sleep(*pause);
        }
    } catch (const std::exception&) {  // who ends the program cannot be told any more
        return;
    }
}

bool ScenarioRun::takesFailure() {
    if (!m_inside) return false;
    return std::exchange(m_failed, true);
}

void ScenarioRun::finishes() {
    m_finishes = true;
    emit changed();
}

std::chrono::nanoseconds ScenarioRun::left() const {
    return std::max<std::chrono::nanoseconds>(m_until - m_clock.steadyNow(), std::chrono::nanoseconds(0));
}

scenario::Attendant::Return ScenarioRun::pressed() {
    m_asked = !m_pressed;
    return std::exchange(m_pressed, false) ? Return::Pressed : Return::NotYet;
}

}  // namespace kdx
