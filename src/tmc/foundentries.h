#pragma once

#include <QAbstractListModel>

#include <vector>

namespace kdx {

/// Those entries of a list in which all words of a text stand, whatever their case; the first ones when there are very
/// many: nobody reads them all.
class FoundEntries final : public QAbstractListModel {
public:
    static constexpr std::size_t kMost = 1000;

    using QAbstractListModel::QAbstractListModel;

    /// @param entries lent until the next search; without words all of its entries are found.
    void search(const QAbstractItemModel& entries, const QString& text);
    /// The entry's row in its list.
    [[nodiscard]] int rowOf(const QModelIndex& found) const;
    /// Where an entry of the list is; invalid when it is not among them.
    [[nodiscard]] QModelIndex indexOf(int entry) const;

    [[nodiscard]] int rowCount(const QModelIndex& parent = {}) const override;
    [[nodiscard]] QVariant data(const QModelIndex& index, int role) const override;

private:
    const QAbstractItemModel* m_entries = nullptr;
    bool m_all = false;
    std::vector<int> m_rows;  // unless all are found
};

}  // namespace kdx
