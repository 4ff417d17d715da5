#include "tmc/foundentries.h"

#include <algorithm>

namespace kdx {

void FoundEntries::search(const QAbstractItemModel& entries, const QString& text) {
    const QStringList words = text.split(QLatin1Char(' '), Qt::SkipEmptyParts);
    beginResetModel();
    m_entries = &entries;
    m_rows.clear();
    m_all = words.isEmpty();
    for (int row = 0; !m_all && row < entries.rowCount() && m_rows.size() < kMost; ++row) {
        const QString entry = entries.index(row, 0).data().toString();
        const bool found = std::all_of(words.begin(), words.end(),
                                       [&](const QString& word) { return entry.contains(word, Qt::CaseInsensitive); });
        if (found) m_rows.push_back(row);
    }
    // What begins so is more likely meant than what has it somewhere within a word.
    std::stable_partition(m_rows.begin(), m_rows.end(), [&](int row) {
        return entries.index(row, 0).data().toString().startsWith(words.front(), Qt::CaseInsensitive);
    });
    endResetModel();
}

int FoundEntries::rowOf(const QModelIndex& found) const {
    return m_all ? found.row() : m_rows.at(static_cast<std::size_t>(found.row()));
}

QModelIndex FoundEntries::indexOf(int entry) const {
    if (m_all) return index(entry, 0);
    const auto at = std::find(m_rows.begin(), m_rows.end(), entry);
    return at == m_rows.end() ? QModelIndex() : index(static_cast<int>(at - m_rows.begin()), 0);
}

int FoundEntries::rowCount(const QModelIndex& parent) const {
    if (parent.isValid() || m_entries == nullptr) return 0;
    return m_all ? m_entries->rowCount() : static_cast<int>(m_rows.size());
}

QVariant FoundEntries::data(const QModelIndex& index, int role) const {
    return index.isValid() ? m_entries->index(rowOf(index), 0).data(role) : QVariant();
}

}  // namespace kdx
