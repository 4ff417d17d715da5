#include "af/afcounter.h"

#include <QListWidget>

#include "af/aflist.h"
#include "ui/caption.h"
#include "ui/text.h"
#include "ui/valuestate.h"

namespace kdx {

AfCounter::AfCounter(const PageContext& with, const QListWidget* list, QWidget* parent)
    : QLabel(parent), m_with(with), m_entries(list->model()) {
    connect(m_entries, &QAbstractItemModel::rowsInserted, this, &AfCounter::count);
    connect(m_entries, &QAbstractItemModel::rowsRemoved, this, &AfCounter::count);
    connect(m_entries, &QAbstractItemModel::modelReset, this, &AfCounter::count);
}

void AfCounter::count() {
    AfList list;
    for (int row = 0; row < m_entries->rowCount(); ++row)
        list.frequencies.push_back(toBytes(m_entries->index(row, 0).data().toString()));
    const std::size_t count = afCount(joined(list));  // with what a comma within an entry makes of it
    const auto say = [this](const Caption& caption) { return captionText(m_with.captions, caption); };
    setText(say({863, "%1 von %2 (A), %3 (B)"}).arg(count).arg(kMostAfsOfMethodA).arg(kMostAfsOfMethodB));
    setToolTip(count > kMostAfsOfMethodB ? say({865, "Mit Methode B kann diese Liste nicht gesendet werden."})
                                         : QString());
    showWarning(*this,
                count > kMostAfsOfMethodA ? say({864, "Mehr Frequenzen, als eine Liste haben kann."}) : QString());
}

}  // namespace kdx
