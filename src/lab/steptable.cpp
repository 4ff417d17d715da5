#include "lab/steptable.h"

#include <QFont>

#include "lab/steptext.h"
#include "lab/viewtable.h"
#include "ui/caption.h"

namespace kdx {

namespace {

enum StepColumn { Number, What, Result, StepColumnCount };

constexpr QChar kGood{u'\u2713'};
constexpr QChar kBad{u'\u2717'};

/// "4.2" of "4#3.2".
std::string withoutPasses(const std::string& step) {
    std::string plain;
    bool pass = false;
    for (const char letter : step) {
        if (letter == '#') pass = true;
        if (letter == '.') pass = false;
        if (!pass) plain += letter;
    }
    return plain;
}

bool isGood(const std::string& status) {
    return status.empty() || status == "0" || status == scenario::kMet || status == scenario::kReturn ||
           status == scenario::kNoReturn || status == scenario::kGoesOn;
}

}  // namespace

StepTable::StepTable(const char* name, const PageContext& with, QWidget* parent)
    : m_with(with), m_table(newViewTable(name, StepColumnCount, parent)) {
    m_table->setSelectionMode(QAbstractItemView::NoSelection);
    m_table->setWordWrap(
        false);  // one line a step: a long value is cut within, not left out as a word that does not fit
}

void StepTable::label() {
    const auto text = [this](const Caption& caption) { return captionText(m_with.captions, caption); };
    m_table->setHorizontalHeaderLabels({text({980, "Schritt"}), text({981, "Was"}), text({982, "Ergebnis"})});
    m_table->setAccessibleName(text({974, "Ablauf"}));
    describe();
}

void StepTable::show(const scenario::Scenario& scenario) {
    m_table->setRowCount(0);
    m_rows.clear();
    m_passes.clear();
    m_marked = m_doneRow = -1;
    m_scenario = scenario;
    if (scenario.dataSet) append(scenario::kOpening);
    append(scenario.actions, {});
    if (scenario.restore) append(scenario::kRestoring);
    describe();
}

void StepTable::append(const std::vector<scenario::Action>& actions, const std::string& within) {
    for (std::size_t at = 0; at < actions.size(); ++at) {
        const std::string step = within + std::to_string(at + 1);
        append(step);
        if (passesOf(actions[at]) > 0) m_passes[step] = passesOf(actions[at]);
        append(actions[at].actions, step + ".");
    }
}

void StepTable::append(const std::string& step) {
    const int row = m_table->rowCount();
    m_rows[step] = row;
    m_table->insertRow(row);
    const bool numbered = step != scenario::kOpening && step != scenario::kRestoring;
    showCell(m_table, row, Number, numbered ? QString::fromStdString(step) : QString(), false);
    for (const StepColumn column : {What, Result}) showCell(m_table, row, column, {}, false);
}

void StepTable::describe() {
    int row = 0;
    if (m_scenario.dataSet) showCell(m_table, row++, What, openingText(m_with, *m_scenario.dataSet), false);
    row = describe(m_scenario.actions, row, 0);
    if (m_scenario.restore) showCell(m_table, row, What, restoringText(m_with), false);
}

int StepTable::describe(const std::vector<scenario::Action>& actions, int row, int depth) {
    for (const scenario::Action& action : actions) {
        showCell(m_table, row++, What, QString(qsizetype{4} * depth, QLatin1Char(' ')) + stepText(m_with, action),
                 false);
        row = describe(action.actions, row, depth + 1);
    }
    return row;
}

int StepTable::rowOf(const std::string& step) const {
    const auto found = m_rows.find(withoutPasses(step));
    return found == m_rows.end() ? -1 : found->second;
}

void StepTable::clearResults() {
    m_doneRow = -1;
    for (int row = 0; row < m_table->rowCount(); ++row) showCell(m_table, row, Result, {}, false);
    mark({});
}

void StepTable::end(bool complete) {
    if (!complete && m_doneRow != rowOf(scenario::kRestoring)) m_doneRow = -1;
    mark({});
}

void StepTable::showDone() {
    if (m_doneRow >= 0) showCell(m_table, m_doneRow, Result, m_done, false);
    m_doneRow = -1;
}

void StepTable::mark(const std::string& step) {
    const auto setBold = [this](int row, bool bold) {
        for (int column = 0; row >= 0 && column < StepColumnCount; ++column) {
            QFont font = m_table->font();
            font.setBold(bold);
            m_table->item(row, column)->setFont(font);
        }
    };
    const int row = rowOf(step);
    if (row != m_doneRow) showDone();
    if (row != m_marked) {
        setBold(m_marked, false);
        setBold(row, true);
        if (row >= 0) m_table->scrollToItem(m_table->item(row, Number));
        m_marked = row;
    }
    // In which pass of what it stands within.
    for (std::size_t at = step.find('#'); at != std::string::npos; at = step.find('#', at + 1)) {
        const std::string around = withoutPasses(step.substr(0, at));
        const int outer = rowOf(around);
        const auto passes = m_passes.find(around);
        if (outer < 0 || passes == m_passes.end()) continue;
        const std::string pass = step.substr(at + 1, step.find('.', at) - at - 1);
        showCell(m_table, outer, Result,
                 QString::fromStdString(pass) + QLatin1Char('/') + QString::number(passes->second), false);
    }
}

void StepTable::add(const scenario::Row& row) {
    const int at = rowOf(row.step);
    if (at < 0) return;
    if (row.step.find('#') != std::string::npos || m_passes.count(withoutPasses(row.step)) != 0) mark(row.step);
    const bool good = isGood(row.status);
    if (good && m_table->item(at, Result)->text().startsWith(kBad)) return;  // what went wrong once stays to be seen
    const QString answer = QString::fromStdString(row.answer);
    if (!good) {
        const QString why = row.status == scenario::kNotMet
                                ? captionText(m_with.captions, {987, "nicht erfüllt: %1"}).arg(answer)
                                : QString::fromStdString(row.status);
        m_doneRow = m_doneRow == at ? -1 : m_doneRow;
        return showCell(m_table, at, Result, kBad + QLatin1Char(' ') + why, true);
    }
    if (answer.isEmpty() && m_passes.count(withoutPasses(row.step)) != 0) {
        QString text = m_table->item(at, Result)->text().section(QLatin1Char(':'), 0, 0);
        if (row.key != scenario::kRepeatRow) text += QLatin1String(": ") + QString::fromStdString(row.value);
        return showCell(m_table, at, Result, text, false);
    }
    if (at != m_doneRow) showDone();
    m_doneRow = at;
    m_done = answer.isEmpty() ? QString(kGood) : kGood + (QLatin1Char(' ') + answer);
}

}  // namespace kdx
