#include "af/modul2.h"

#include "af/aflist.h"
#include "ui/text.h"

#include <QLabel>
#include <QListWidget>

namespace kdx {

void FillAfLists(QListWidget& list, QLabel& tuned, std::string_view listText) {
    const auto parts = splitForDisplay(listText);
    if (!parts) return;
    tuned.setText(toText(parts->tuned));
    list.clear();
    for (const std::string& frequency : parts->frequencies) {
        list.addItem(toText(frequency));
        // A double quote would end the list for the coder.
        if (frequency.find('"') != std::string::npos) list.item(list.count() - 1)->setForeground(Qt::red);
    }
}

}  // namespace kdx
