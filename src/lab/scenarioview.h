#pragma once

#include <QDialog>

#include <filesystem>
#include <optional>

#include "lab/steptable.h"
#include "scenario/attendance.h"
#include "scenario/scenario.h"
#include "ui/automatics.h"
#include "ui/caption.h"
#include "ui/pagecontext.h"

class QLabel;
class QPushButton;

namespace kdx {

class ScenarioRun;
struct Session;

/// The view that opens a scenario, lists its steps and runs it, with the step that runs, what is left of it, and what
/// came of each. Stays open beside the main window, which stays in use.
class ScenarioView : public QDialog {
    Q_OBJECT
public:
    /// @param shipped folder of the scenarios that come with the program.
    ScenarioView(Session& session, const PageContext& with, std::filesystem::path shipped, QWidget* parent);
    ~ScenarioView() override;

    void label();
    void showSessionOpen(bool open);
    [[nodiscard]] bool isRunning() const;
    /// Whether what goes out right now is the scenario's, which the window does not show as its own.
    [[nodiscard]] bool isAtWork() const;
    /// Ends a run after its running command; what stood before comes back.
    void stop();
    /// Ends a run at once, as the session is to be closed.
    void finish();
    /// A command failed. @returns whether nobody need be told any more.
    bool takesFailure();

    /// Whether after the last run everything stands as before it.
    [[nodiscard]] bool leftNothing() const;

signals:
    void runningChanged(bool running);

protected:
    /// Esc ends what runs elsewhere: the view stays while it shows a run.
    void keyPressEvent(QKeyEvent* event) override;

private:
    void Ablauf_Oeffnen_Click();
    void Ablauf_Start_Click();
    void Ablauf_Pause_Click();
    void Ablauf_Weiter_Click();
    void arrange();
    void openFile(const QString& file);
    void showState();
    void showEnd(const scenario::Outcome& outcome);
    [[nodiscard]] QString folderToOpen() const;
    [[nodiscard]] QString endText(const scenario::Outcome& outcome) const;
    [[nodiscard]] QStringList problemsOf(const scenario::Scenario& scenario) const;
    [[nodiscard]] QString caption(const Caption& caption) const { return captionText(m_with.captions, caption); }

    Session& m_session;
    PageContext m_with;
    CaptionBook m_book;
    ScenarioRun* m_run = nullptr;
    Automatic m_automatic;
    StepTable m_steps;  // Ablauf_Liste
    QLabel* Ablauf_Titel = nullptr;
    QLabel* Ablauf_Stand = nullptr;
    QPushButton* Ablauf_Oeffnen = nullptr;
    QPushButton* Ablauf_Start = nullptr;
    QPushButton* Ablauf_Pause = nullptr;
    QPushButton* Ablauf_Stop = nullptr;
    QPushButton* Ablauf_Weiter = nullptr;  // what Return is at the command line
    QPushButton* Ablauf_Schliessen = nullptr;
    std::filesystem::path m_shipped;
    QString m_folder;  // of the file that was chosen last
    QString m_file;
    scenario::Scenario m_scenario;
    std::string m_step;                          // that runs
    std::optional<scenario::Outcome> m_outcome;  // of the last run
    std::size_t m_unmet = 0;
    bool m_sessionOpen = false, m_wasRunning = false;
};

}  // namespace kdx
