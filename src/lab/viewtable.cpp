#include "lab/viewtable.h"

#include <QHeaderView>

#include "ui/named.h"

namespace kdx {

QTableWidget* newViewTable(const char* name, int columns, QWidget* parent) {
    auto* table = named<QTableWidget>(name, 0, columns, parent);
    table->setEditTriggers(QAbstractItemView::NoEditTriggers);
    table->setSelectionBehavior(QAbstractItemView::SelectRows);
    table->setTabKeyNavigation(false);
    table->setTextElideMode(Qt::ElideRight);
    table->setWordWrap(true);
    table->verticalHeader()->hide();
    table->verticalHeader()->setDefaultSectionSize(table->fontMetrics().height() + 6);
    table->horizontalHeader()->setSectionResizeMode(QHeaderView::Stretch);
    table->horizontalHeader()->setSectionResizeMode(0, QHeaderView::ResizeToContents);
    table->horizontalHeader()->setDefaultAlignment(Qt::AlignLeft | Qt::AlignVCenter);
    table->horizontalHeader()->setHighlightSections(false);
    return table;
}

void showCell(QTableWidget* table, int row, int column, const QString& text, bool marked) {
    QTableWidgetItem* item = table->item(row, column);
    if (item == nullptr) table->setItem(row, column, item = new QTableWidgetItem);
    item->setText(text);
    item->setToolTip(text);
    item->setForeground(marked ? QBrush(markColourOn(table)) : table->palette().brush(QPalette::Text));
}

QColor markColourOn(const QWidget* on) {
    return on->palette().color(QPalette::Base).lightness() > 127 ? QColor(0xB0, 0x30, 0x00) : QColor(0xFF, 0xA0, 0x60);
}

}  // namespace kdx
