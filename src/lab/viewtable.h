#pragma once

#include <QColor>
#include <QTableWidget>

namespace kdx {

/// A table that is read only and selected by rows.
[[nodiscard]] QTableWidget* newViewTable(const char* name, int columns, QWidget* parent);

/// Shows the text in the cell, and in its tip, marked or not.
void showCell(QTableWidget* table, int row, int column, const QString& text, bool marked);

/// The colour of what is marked; who does not tell colours apart needs a sign beside it.
[[nodiscard]] QColor markColourOn(const QWidget* on);

}  // namespace kdx
