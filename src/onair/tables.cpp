#include "onair/tables.h"

#include <QHeaderView>
#include <QLabel>

#include "ui/named.h"

namespace kdx {

namespace {

QTableWidgetItem* itemAt(QTableWidget* table, int row, int column) {
    QTableWidgetItem* item = table->item(row, column);
    if (item == nullptr) {
        item = new QTableWidgetItem;
        item->setFlags(Qt::ItemIsEnabled | Qt::ItemIsSelectable);
        table->setItem(row, column, item);
    }
    return item;
}

/// @returns whether the cell looks otherwise than before.
bool showCell(QTableWidget* table, int row, int column, const QString& text, const TableRow& as) {
    QTableWidgetItem* item = itemAt(table, row, column);
    QFont font = table->font();
    font.setBold(as.isHeading);
    const QBrush brush = as.why.isEmpty() ? table->palette().brush(QPalette::Text) : QBrush(markColour(table));
    if (item->text() == text && item->toolTip() == as.why && item->font() == font && item->foreground() == brush)
        return false;
    item->setText(text);
    item->setToolTip(as.why);
    item->setFont(font);
    item->setForeground(brush);
    item->setTextAlignment(Qt::AlignLeft | Qt::AlignTop);  // what belongs to a long list stays where it begins
    return true;
}

}  // namespace

void showText(QLabel* label, const QString& text) {
    if (label->text() != text) label->setText(text);
}

QTableWidget* newTable(const char* name, int columns, int stretched, QWidget* parent) {
    auto* table = named<QTableWidget>(name, 0, columns, parent);
    table->setEditTriggers(QAbstractItemView::NoEditTriggers);
    table->setSelectionBehavior(QAbstractItemView::SelectRows);
    table->setTabKeyNavigation(false);
    table->setShowGrid(false);
    table->setWordWrap(true);
    table->setTextElideMode(Qt::ElideNone);
    table->setVerticalScrollMode(QAbstractItemView::ScrollPerPixel);
    table->setHorizontalScrollBarPolicy(Qt::ScrollBarAlwaysOff);
    table->verticalHeader()->hide();
    table->verticalHeader()->setMinimumSectionSize(1);
    table->verticalHeader()->setDefaultSectionSize(table->fontMetrics().height() + 3);
    table->horizontalHeader()->setSectionResizeMode(QHeaderView::ResizeToContents);
    table->horizontalHeader()->setSectionResizeMode(stretched, QHeaderView::Stretch);
    table->horizontalHeader()->setDefaultAlignment(Qt::AlignLeft | Qt::AlignVCenter);
    table->horizontalHeader()->setHighlightSections(false);
    // What is wrapped needs other heights when its column gets another width.
    QObject::connect(table->horizontalHeader(), &QHeaderView::sectionResized, table,
                     &QTableWidget::resizeRowsToContents, Qt::QueuedConnection);
    return table;
}

void showRows(QTableWidget* table, const std::vector<TableRow>& rows) {
    const int count = static_cast<int>(rows.size());
    bool changed = table->rowCount() != count;
    if (changed) table->setRowCount(count);
    for (int row = 0; row < count; ++row) {
        const TableRow& as = rows[static_cast<std::size_t>(row)];
        const int span = as.cells.size() == 1 ? table->columnCount() : 1;
        if (table->columnSpan(row, 0) != span) table->setSpan(row, 0, 1, span);
        for (int column = 0; column < table->columnCount(); ++column)
            changed = showCell(table, row, column, as.cells.value(column), as) || changed;
    }
    if (changed) table->resizeRowsToContents();
}

QString textOf(const QTableWidget* table) {
    QString text;
    QStringList line;
    for (int column = 0; column < table->columnCount(); ++column)
        line += table->horizontalHeaderItem(column) ? table->horizontalHeaderItem(column)->text() : QString();
    text += line.join(QLatin1Char('\t')) + QLatin1Char('\n');
    for (int row = 0; row < table->rowCount(); ++row) {
        line.clear();
        for (int column = 0; column < table->columnCount(); ++column)
            line += table->item(row, column) ? table->item(row, column)->text() : QString();
        while (!line.isEmpty() && line.last().isEmpty()) line.removeLast();
        text += line.join(QLatin1Char('\t')) + QLatin1Char('\n');
    }
    return text;
}

QColor markColour(const QWidget* on) {
    return on->palette().color(QPalette::Base).lightness() > 127 ? QColor(0xB0, 0x30, 0x00) : QColor(0xFF, 0xA0, 0x60);
}

}  // namespace kdx
