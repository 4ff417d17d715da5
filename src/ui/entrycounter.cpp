#include "ui/entrycounter.h"

#include <QLineEdit>

#include "ui/text.h"
#include "ui/valuestate.h"

namespace kdx {

EntryCounter::EntryCounter(const PageContext& with, const char* key, std::size_t most, const QLineEdit* entry,
                           QWidget* parent)
    : QLabel(parent), m_with(with), m_key(key), m_most(most), m_entry(entry) {
    setAlignment(Qt::AlignRight | Qt::AlignVCenter);
    setMinimumWidth(fontMetrics().horizontalAdvance(QStringLiteral("%1/%1").arg(most)));
    connect(entry, &QLineEdit::textChanged, this, &EntryCounter::count);
    count();
}

void EntryCounter::count() {
    const QString entry = m_entry->text();
    setText(QStringLiteral("%1/%2").arg(toBytes(entry).size()).arg(m_most));
    showWarning(*this, entry.isEmpty() ? QString() : whyRefused(m_with, m_key, entry));
}

}  // namespace kdx
