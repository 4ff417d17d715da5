#include "window/views.h"

#include <string>
#include <utility>

#include "coder/sendparam.h"
#include "lab/compareview.h"
#include "lab/scenarioview.h"
#include "onair/onairview.h"
#include "station/session.h"
#include "ui/statusrow.h"
#include "window/logview.h"
#include "window/trafficlog.h"

namespace kdx {

namespace {

const Caption kScenarioSends{1094, "Ein Ablauf sendet: Auf Sendung kann anderes sein."};

void bringToFront(QWidget& view) {
    view.show();
    view.raise();
    view.activateWindow();
}

}  // namespace

Views::Views(const PageContext& with, Session& session, QWidget* window, std::function<void()> reload,
             std::filesystem::path scenarios)
    : m_with(with),
      m_session(session),
      m_window(window),
      m_reload(std::move(reload)),
      m_scenarios(std::move(scenarios)),
      m_trafficLog(new TrafficLog(with.instrument, with.clock, window)),
      m_shadow(with.clock) {
    m_with.params.onComposed([this](const std::string& command) {
        m_trafficLog->composed(command);
        m_shadow.take(command);
    });
}

Views::~Views() {
    m_with.params.onComposed(nullptr);
}

void Views::label() {
    m_trafficLog->label(m_with.captions);
    if (m_logView != nullptr) m_logView->label();
    if (m_onAirView != nullptr) m_onAirView->label();
    if (m_compareView != nullptr) m_compareView->label();
    if (m_scenarioView != nullptr) m_scenarioView->label();
}

void Views::openLog() {
    if (m_logView == nullptr) m_logView = new LogView(*m_trafficLog, m_with, m_window);
    bringToFront(*m_logView);
}

void Views::openOnAir() {
    if (m_onAirView == nullptr)
        m_onAirView = std::make_unique<OnAirView>(m_shadow, m_session.station, m_with, m_window);
    bringToFront(*m_onAirView);
}

void Views::openCompare() {
    if (m_compareView == nullptr) {
        m_compareView = std::make_unique<CompareView>(m_session.station, m_with, m_window);
        QObject::connect(m_compareView.get(), &CompareView::takenOver, m_window, m_reload);
    }
    bringToFront(*m_compareView);
}

void Views::openScenario() {
    if (m_scenarioView == nullptr) {
        m_scenarioView = std::make_unique<ScenarioView>(m_session, m_with, m_scenarios, m_window);
        QObject::connect(m_scenarioView.get(), &ScenarioView::runningChanged, m_window, [this](bool running) {
            if (running) m_with.status.doubt(captionText(m_with.captions, kScenarioSends));
            if (!running && m_scenarioView->leftNothing()) m_with.status.trust();
        });
    }
    bringToFront(*m_scenarioView);
}

void Views::showSessionOpen(bool open) {
    if (m_compareView != nullptr) m_compareView->showSessionOpen(open);
    if (m_scenarioView != nullptr) m_scenarioView->showSessionOpen(open);
}

bool Views::scenarioSends() const {
    return m_scenarioView != nullptr && m_scenarioView->isAtWork();
}

void Views::endScenario() {
    if (m_scenarioView != nullptr) m_scenarioView->finish();
}

void Views::stopScenario() {
    if (scenarioSends()) m_scenarioView->stop();
}

bool Views::takesFailure() {
    return m_scenarioView != nullptr && m_scenarioView->takesFailure();
}

void Views::forgetTexts() {
    if (m_onAirView != nullptr) m_onAirView->forgetTexts();
}

}  // namespace kdx
