#pragma once

#include <filesystem>
#include <functional>
#include <memory>

#include "air/shadow.h"
#include "ui/pagecontext.h"

class QWidget;

namespace kdx {

class CompareView;
class LogView;
class OnAirView;
class ScenarioView;
struct Session;
class TrafficLog;

/// The windows that stay open beside the main one. Each is made when it is first opened; what they show is followed
/// from the start of the program on.
class Views {
public:
    /// @param reload shows the data set anew when its files were changed.
    /// @param scenarios folder of those that come with the program.
    Views(const PageContext& with, Session& session, QWidget* window, std::function<void()> reload,
          std::filesystem::path scenarios);
    ~Views();
    Views(const Views&) = delete;
    Views& operator=(const Views&) = delete;

    void label();
    void openLog();
    void openOnAir();
    void openCompare();
    void openScenario();
    void showSessionOpen(bool open);
    /// Null before it was first opened.
    [[nodiscard]] ScenarioView* scenario() const { return m_scenarioView.get(); }
    /// Whether what goes out right now is a scenario's.
    [[nodiscard]] bool scenarioSends() const;
    /// The session is to be closed: a scenario that runs brings back what stood before.
    void endScenario();
    /// What goes out right now was given up: if it is a scenario's, the scenario is.
    void stopScenario();
    /// A command failed. @returns whether nobody need be told any more.
    bool takesFailure();
    /// The lists of events and locations were changed.
    void forgetTexts();

private:
    PageContext m_with;
    Session& m_session;
    QWidget* m_window;
    std::function<void()> m_reload;
    std::filesystem::path m_scenarios;
    TrafficLog* m_trafficLog;
    air::Shadow m_shadow;
    LogView* m_logView = nullptr;
    std::unique_ptr<OnAirView> m_onAirView;  // goes before what it shows
    std::unique_ptr<CompareView> m_compareView;
    std::unique_ptr<ScenarioView> m_scenarioView;
};

}  // namespace kdx
