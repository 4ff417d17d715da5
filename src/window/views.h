#pragma once

#include <memory>

#include "air/shadow.h"
#include "ui/pagecontext.h"

class QWidget;

namespace kdx {

class LogView;
class OnAirView;
struct Station;
class TrafficLog;

/// The windows that stay open beside the main one. Each is made when it is first opened; what they show is followed
/// from the start of the program on.
class Views {
public:
    Views(const PageContext& with, const Station& station, QWidget* window);
    ~Views();
    Views(const Views&) = delete;
    Views& operator=(const Views&) = delete;

    void label();
    void openLog();
    void openOnAir();
    /// The lists of events and locations were changed.
    void forgetTexts();

private:
    PageContext m_with;
    const Station& m_station;
    QWidget* m_window;
    TrafficLog* m_trafficLog;
    air::Shadow m_shadow;
    LogView* m_logView = nullptr;
    std::unique_ptr<OnAirView> m_onAirView;  // goes before what it shows
};

}  // namespace kdx
