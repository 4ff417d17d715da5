#pragma once

#include "lab/scenarioview.h"
#include "labtest.h"

namespace kdx::test {

using namespace std::chrono_literals;

/// The window with the view of scenarios open beside it, and a clock that the test moves.
class ScenarioTest : public LabTest {
protected:
    ~ScenarioTest() override { end(); }
    void openView(const char* language = "deutsch") {
        open(language);
        action("Mnu_Ansicht_Ablauf")->trigger();
        view = window->findChild<ScenarioView*>(QStringLiteral("ScenarioView"));
        ASSERT_NE(view, nullptr);
        table = find<QTableWidget>("Ablauf_Liste");
    }
    /// Writes the scenario beside the data and opens it as a user does.
    void load(const std::string& yaml) {
        const auto file = folder.path() / "test.yaml";
        std::ofstream(file) << yaml;
        dialogs.files.push_back(QString::fromStdString(file.string()));
        click("Ablauf_Oeffnen");
    }
    /// Lets so much time pass; the run's timer ticks when its time comes.
    void pass(std::chrono::nanoseconds time) {
        const auto end = clock.steadyNow() + time;
        while (clock.steadyNow() < end) {
            auto* timer = find<QTimer>("AblaufTimer");
            const auto next = timer->isActive() ? std::chrono::nanoseconds(timer->intervalAsDuration()) : time;
            clock.advance(std::min<std::chrono::nanoseconds>(next, end - clock.steadyNow()));
            tick("AblaufTimer");
        }
    }
    /// Lets a run come to its end.
    void passAll() {
        for (int left = 100000; left > 0 && view->isRunning(); --left) pass(50ms);
        EXPECT_FALSE(view->isRunning());
    }
    std::string cell(int row, int column) const { return table->item(row, column)->text().toStdString(); }
    std::string result(int row) const { return cell(row, 2); }
    std::string value(const char* key) {
        const auto wanted = readOut(session->instrument);
        for (const Reading& reading : wanted)
            if (reading.key == key) return reading.value.value_or("none");
        return "unknown";
    }

    ScenarioView* view = nullptr;
    QTableWidget* table = nullptr;
};

}  // namespace kdx::test
