#include "af/afcounter.h"

#include "af/aflist.h"
#include "ui/caption.h"
#include "ui/text.h"
#include "ui/valuestate.h"

namespace kdx {

AfCounter::AfCounter(const PageContext& with, const QListWidget* list, QWidget* parent)
    : QLabel(parent), m_with(with), m_list(list) {
    connect(list->model(), &QAbstractItemModel::rowsInserted, this, &AfCounter::count);
    connect(list->model(), &QAbstractItemModel::rowsRemoved, this, &AfCounter::count);
    connect(list->model(), &QAbstractItemModel::modelReset, this, &AfCounter::count);
}

void AfCounter::count() {
    if (m_list == nullptr) return;
    AfList list;
    for (int row = 0; row < m_list->count(); ++row) list.frequencies.push_back(toBytes(m_list->item(row)->text()));
    const std::size_t count = afCount(joined(list));  // with what a comma within an entry makes of it
    const auto say = [this](const Caption& caption) { return captionText(m_with.captions, caption); };
    setText(say({863, "%1 von %2 (A), %3 (B)"}).arg(count).arg(kMostAfsOfMethodA).arg(kMostAfsOfMethodB));
    setToolTip(count > kMostAfsOfMethodB ? say({865, "Mit Methode B kann diese Liste nicht gesendet werden."})
                                         : QString());
    showWarning(*this,
                count > kMostAfsOfMethodA ? say({864, "Mehr Frequenzen, als eine Liste haben kann."}) : QString());
}

}  // namespace kdx
