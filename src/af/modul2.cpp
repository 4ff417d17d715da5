#include "af/modul2.h"

#include "af/aflist.h"
#include "ui/text.h"

#include <QApplication>
#include <QLabel>
#include <QListWidget>

namespace kdx {

namespace {

/// A double quote would end the list for the coder.
bool endsTheList(const std::string& frequency) {
    return frequency.find('"') != std::string::npos;
}

}  // namespace

void FillAfLists(QListWidget& list, QLabel& tuned, std::string_view listText) {
    const auto parts = splitForDisplay(listText);
    if (!parts) return;
    tuned.setText(toText(parts->tuned));
    QPalette palette = tuned.palette();
    palette.setColor(QPalette::WindowText, endsTheList(parts->tuned)
                                               ? QColor(Qt::red)
                                               : QApplication::palette(&tuned).color(QPalette::WindowText));
    tuned.setPalette(palette);
    list.clear();
    for (const std::string& frequency : parts->frequencies) {
        list.addItem(toText(frequency));
        if (endsTheList(frequency)) list.item(list.count() - 1)->setForeground(Qt::red);
    }
}

}  // namespace kdx
