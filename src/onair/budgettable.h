#pragma once

#include <QGroupBox>

#include <cstdint>
#include <optional>
#include <vector>

#include "onair/tables.h"
#include "ui/caption.h"
#include "ui/pagecontext.h"

class QTableWidget;

namespace kdx {

namespace air {
class Shadow;
struct GroupBudget;
}  // namespace air

/// What groups and deviation are spent on, and what is wrong with that.
class BudgetTable : public QGroupBox {
public:
    BudgetTable(const PageContext& with, QWidget* parent);

    void label();
    void show(const air::Shadow& shadow);
    [[nodiscard]] QString text() const;

private:
    void addWarnings(std::vector<TableRow>& rows, const air::Shadow& shadow, const air::GroupBudget& budget) const;
    void addWaits(std::vector<TableRow>& rows, const air::GroupBudget& budget) const;
    void addShares(std::vector<TableRow>& rows, const air::GroupBudget& budget) const;
    void addDeviations(std::vector<TableRow>& rows, const air::Shadow& shadow) const;
    [[nodiscard]] QString caption(const Caption& caption) const { return captionText(m_with.captions, caption); }

    PageContext m_with;
    CaptionBook m_book;
    QTableWidget* Air_Budget = nullptr;
    std::optional<std::uint64_t> m_shown;  ///< after so many commands
};

}  // namespace kdx
