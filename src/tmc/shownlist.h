#pragma once

#include "ui/pagecontext.h"

#include "tmc/tmclist.h"

#include <QAbstractListModel>
#include <QFont>

#include <functional>
#include <initializer_list>

namespace kdx {

/// The fixed-pitch font of that name, or a twin with the same widths: the codes of the entries line up in it.
[[nodiscard]] QFont fixedPitch(const QString& family);

/// The entries of an event or location file of the data folder, for the controls that show them.
class ShownList final : public QAbstractListModel {
public:
    using QAbstractListModel::QAbstractListModel;

    /// @throws std::runtime_error naming the file, in the current language, when it is missing or cannot be read; the
    /// list is empty then.
    void load(const PageContext& with, const char* fileName);
    /// The entry as its file has it.
    [[nodiscard]] std::string line(int row) const { return std::string(m_entries.line(static_cast<std::size_t>(row))); }
    /// The row of the first entry that reads so; -1 when none does.
    [[nodiscard]] int rowOf(const QString& text) const;

    [[nodiscard]] int rowCount(const QModelIndex& parent = {}) const override;
    [[nodiscard]] QVariant data(const QModelIndex& index, int role) const override;

private:
    TmcList m_entries;
    QFont m_font = fixedPitch(QStringLiteral("Courier New"));
};

/// Takes every step even when an earlier one failed: one missing list must not cost the other.
/// @throws std::runtime_error with all that went wrong, a line each.
void takeAllSteps(std::initializer_list<std::function<void()>> steps);

}  // namespace kdx
