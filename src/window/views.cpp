#include "window/views.h"

#include <string>

#include "coder/sendparam.h"
#include "onair/onairview.h"
#include "window/logview.h"
#include "window/trafficlog.h"

namespace kdx {

namespace {

void bringToFront(QWidget& view) {
    view.show();
    view.raise();
    view.activateWindow();
}

}  // namespace

Views::Views(const PageContext& with, const Station& station, QWidget* window)
    : m_with(with),
      m_station(station),
      m_window(window),
      m_trafficLog(new TrafficLog(with.instrument, with.clock, window)),
      m_shadow(with.clock) {
    m_with.params.onComposed([this](const std::string& command) { m_shadow.take(command); });
}

Views::~Views() {
    m_with.params.onComposed(nullptr);
}

void Views::label() {
    m_trafficLog->label(m_with.captions);
    if (m_logView != nullptr) m_logView->label(m_with.captions);
    if (m_onAirView != nullptr) m_onAirView->label();
}

void Views::openLog() {
    if (m_logView == nullptr) m_logView = new LogView(*m_trafficLog, m_with.captions, m_window);
    bringToFront(*m_logView);
}

void Views::openOnAir() {
    if (m_onAirView == nullptr) m_onAirView = std::make_unique<OnAirView>(m_shadow, m_station, m_with, m_window);
    bringToFront(*m_onAirView);
}

void Views::forgetTexts() {
    if (m_onAirView != nullptr) m_onAirView->forgetTexts();
}

}  // namespace kdx
