#include "tmc/shownlist.h"

#include "settings/datafolder.h"
#include "ui/caption.h"
#include "ui/text.h"

#include <stdexcept>
#include <string>
#include <utility>

namespace kdx {

void ShownList::load(const PageContext& with, const char* fileName) {
    auto entries = loadTmcList(with.data.file(fileName));
    beginResetModel();
    m_entries = entries ? std::move(*entries) : TmcList();
    endResetModel();
    if (entries) return;
    const QString text = captionText(with.captions, {593, "%1 kann nicht gelesen werden."});
    throw std::runtime_error(text.arg(QLatin1String(fileName)).toStdString());
}

int ShownList::rowOf(const QString& text) const {
    const std::string wanted = toBytes(text);
    for (std::size_t row = 0; row < m_entries.size(); ++row) {
        if (m_entries[row] == wanted) return static_cast<int>(row);
    }
    return -1;
}

int ShownList::rowCount(const QModelIndex& parent) const {
    return parent.isValid() ? 0 : static_cast<int>(m_entries.size());
}

QVariant ShownList::data(const QModelIndex& index, int role) const {
    // Said here: the list of a combo box does not go by the font that it was given.
    if (role == Qt::FontRole) return m_font;
    // A combo box shows the text it would edit.
    if (!index.isValid() || (role != Qt::DisplayRole && role != Qt::EditRole)) return {};
    return toText(m_entries[static_cast<std::size_t>(index.row())]);
}

QFont fixedPitch(const QString& family) {
    QFont font;
    font.setFamilies({family, QStringLiteral("Liberation Mono"), QStringLiteral("DejaVu Sans Mono")});
    font.setStyleHint(QFont::TypeWriter);
    font.setFixedPitch(true);
    return font;
}

void takeAllSteps(std::initializer_list<std::function<void()>> steps) {
    std::string failures;
    for (const auto& step : steps) {
        try {
            step();
        } catch (const std::exception& error) {
            if (!failures.empty()) failures += '\n';
            failures += error.what();
        }
    }
    if (!failures.empty()) throw std::runtime_error(failures);
}

}  // namespace kdx
