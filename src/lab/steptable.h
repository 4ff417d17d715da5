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
    StepTable(const char* name, const Captions& captions, QWidget* parent);

    void label();
    void show(const scenario::Scenario& scenario);
    /// Nothing has come of anything yet.
    void clearResults();
    /// The step of that number runs now.
    void mark(const std::string& step);
    void add(const scenario::Row& row);
    /// What an expectation was answered with that was not met, or why a command failed, stays.
    [[nodiscard]] QTableWidget* widget() const { return m_table; }

private:
    void append(const std::string& step, int depth, const std::string& what);
    void append(const std::vector<scenario::Action>& actions, const std::string& within, int depth);
    [[nodiscard]] int rowOf(const std::string& step) const;
    void showResult(int row, const QString& text, bool bad);

    const Captions& m_captions;
    QTableWidget* m_table;
    std::map<std::string, int> m_rows;            // by their numbers without passes
    std::map<std::string, std::size_t> m_passes;  // of sweeps and repetitions
    int m_marked = -1;
};

}  // namespace kdx
