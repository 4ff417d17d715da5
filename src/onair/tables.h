#pragma once

#include <QString>
#include <QTableWidget>

#include <vector>

class QLabel;

namespace kdx {

// Everything here changes a control only when what it shows is another: the view is looked at while it is renewed.

void showText(QLabel* label, const QString& text);

/// A table that is read only. @param stretched the column that takes the room to spare; its texts are wrapped.
[[nodiscard]] QTableWidget* newTable(const char* name, int columns, int stretched, QWidget* parent);

/// What a row shows, and how.
struct TableRow {
    QStringList cells;       ///< a single one takes the whole row
    bool isHeading = false;  ///< of the rows under it
    QString why = {};        ///< it is marked: the tool tip says why
};
/// Shows exactly these rows.
void showRows(QTableWidget* table, const std::vector<TableRow>& rows);

/// The table as text, with tabs between its columns.
[[nodiscard]] QString textOf(const QTableWidget* table);

/// The sign of what is marked, and its colour: who does not tell colours apart sees the sign.
inline constexpr QChar kDifferenceSign{u'\u2260'};
[[nodiscard]] QColor markColour(const QWidget* on);

}  // namespace kdx
