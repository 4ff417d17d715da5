#pragma once

#include <QTableWidget>

#include <map>
#include <string>

#include "scenario/attendance.h"
#include "ui/pagecontext.h"

namespace kdx {

/// The steps of a scenario as a table, with what came of each.
class StepTable {
public:
    StepTable(const char* name, const PageContext& with, QWidget* parent);

    void label();
    void show(const scenario::Scenario& scenario);
    /// Nothing has come of anything yet.
    void clearResults();
    /// The step of that number runs now.
    void mark(const std::string& step);
    /// What went well is shown when the step is over; what an expectation was answered with that was not met, or why a
    /// command failed, at once, and it stays.
    void add(const scenario::Row& row);
    /// Nothing runs any more. @param complete whether the last step came to its end
    void end(bool complete);
    [[nodiscard]] QTableWidget* widget() const { return m_table; }

private:
    void append(const std::string& step);
    /// What the steps do, from the row on, in the current language.
    void describe();
    int describe(const std::vector<scenario::Action>& actions, int row, int depth);
    void append(const std::vector<scenario::Action>& actions, const std::string& within);
    [[nodiscard]] int rowOf(const std::string& step) const;
    void showDone();

    PageContext m_with;
    scenario::Scenario m_scenario;
    QTableWidget* m_table;
    std::map<std::string, int> m_rows;            // by their numbers without passes
    std::map<std::string, std::size_t> m_passes;  // of sweeps and repetitions
    int m_marked = -1;
    int m_doneRow = -1;  // of the step that runs: what is to be shown of it
    QString m_done;
};

}  // namespace kdx
