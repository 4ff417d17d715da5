#include "onair/budgettable.h"

#include <QHeaderView>
#include <QTableWidget>

#include <array>

#include "air/deviationbudget.h"
#include "air/groupbudget.h"
#include "air/shadow.h"
#include "onair/warningtexts.h"
#include "ui/layouts.h"

namespace kdx {

namespace {

// As GroupBudget::What and the rows of the deviation budget count.
const std::array kWaits = {Caption{723, "PS"},  Caption{764, "AF-Listen"},       Caption{49},
                           Caption{766, "EON"}, Caption{767, "Verkehrsmeldung"}, Caption{728, "TA"}};
const std::array kParts = {Caption{771, "Ton"}, Caption{772, "Pilot"}, Caption{773, "RDS"}, Caption{774, "ARI"},
                           Caption{775, "zusammen"}};

QString seconds(double value) {
    return QString::number(value, 'f', 2) + QStringLiteral(" s");
}

QString percent(double share) {
    return QString::number(100 * share, 'f', 1) + QStringLiteral(" %");
}

}  // namespace

BudgetTable::BudgetTable(const PageContext& with, QWidget* parent) : QGroupBox(parent), m_with(with) {
    m_book.text(this, {755, "Budgets"});
    Air_Budget = newTable("Air_Budget", 3, 0, this);
    Air_Budget->horizontalHeader()->hide();
    m_book.spokenAs(Air_Budget, this);
    layOut(this, column({{Air_Budget, 1}}), 2);
}

void BudgetTable::label() {
    m_book.label(m_with.captions);
    m_shown.reset();
}

void BudgetTable::show(const air::Shadow& shadow) {
    if (m_shown == shadow.commands()) return;
    m_shown = shadow.commands();
    std::vector<TableRow> rows;
    const air::GroupBudget budget = air::groupBudgetOf(shadow.transmission());
    addWarnings(rows, shadow, budget);
    addWaits(rows, budget);
    addShares(rows, budget);
    addDeviations(rows, shadow);
    showRows(Air_Budget, rows);
}

void BudgetTable::addWarnings(std::vector<TableRow>& rows, const air::Shadow& shadow,
                              const air::GroupBudget& budget) const {
    const auto add = [&](const std::vector<std::string>& warnings) {
        for (const std::string& warning : warnings) {
            const QString text = warningText(warning, m_with.captions, m_with.state);
            rows.push_back({{QStringLiteral("! ") + text}, false, text});
        }
    };
    add(budget.warnings);
    add(air::deviationBudgetOf(shadow.transmission().settings).warnings);
    add(shadow.warnings());
}

void BudgetTable::addWaits(std::vector<TableRow>& rows, const air::GroupBudget& budget) const {
    rows.push_back(
        {{caption({759, "Ein Radio wartet auf"}), caption({757, "im Mittel"}), caption({758, "höchstens"})}, true});
    for (const auto& item : budget.items) {
        const QString name = caption(kWaits.at(static_cast<std::size_t>(item.what)));
        if (!item.isSet) {
            rows.push_back({{name, caption({769, "nicht gesetzt"}), QString()}});
        } else if (!item.wait) {
            rows.push_back({{name, caption({770, "nie"}), QString()}});
        } else {
            rows.push_back({{name, seconds(item.wait->mean), seconds(item.wait->worst)}});
        }
    }
}

void BudgetTable::addShares(std::vector<TableRow>& rows, const air::GroupBudget& budget) const {
    if (budget.shares.empty()) return;
    rows.push_back({{caption({751, "Gruppen"}), caption({754, "Anteil"}), QString()}, true});
    for (const auto& [type, share] : budget.shares) {
        rows.push_back({{QString::fromStdString(air::nameOf(type)), percent(share), QString()}});
    }
}

void BudgetTable::addDeviations(std::vector<TableRow>& rows, const air::Shadow& shadow) const {
    rows.push_back({{caption({760, "Hub"}), QStringLiteral("kHz"), caption({762, "von 75 kHz"})}, true});
    const air::DeviationBudget budget = air::deviationBudgetOf(shadow.transmission().settings);
    for (std::size_t i = 0; i < kParts.size(); ++i) {
        const auto& part = budget.rows.at(i);
        rows.push_back({{caption(kParts.at(i)), QString::number(part.hertz / 1000, 'f', 2), percent(part.ofHighest)}});
    }
}

QString BudgetTable::text() const {
    return textOf(Air_Budget);
}

}  // namespace kdx
