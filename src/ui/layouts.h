#pragma once

#include <QBoxLayout>
#include <QGridLayout>

#include <initializer_list>

namespace kdx {

/// Spacing of all pages, in pixels at 96 dpi: tight enough for 640 x 480, the same everywhere.
inline constexpr int kGap = 4;
inline constexpr int kPageMargin = 4;

/// What stands in a row, a column or a grid: a control or a further layout.
struct Cell {
    constexpr Cell() = default;
    constexpr Cell(QWidget* placed, int number = 0, Qt::Alignment aligned = {})
        : control(placed), count(number), alignment(aligned) {}
    constexpr Cell(QLayout* placed, int number = 0) : inner(placed), count(number) {}

    QWidget* control = nullptr;
    QLayout* inner = nullptr;
    int count = 0;  ///< in a row or column its share of the room to spare, in a grid the columns it takes (at least 1)
    Qt::Alignment alignment = {};
};
using Cells = std::initializer_list<Cell>;

/// The room to spare of a row or column; a place of a grid that stays empty.
inline constexpr Cell kRoom{};
/// So many pixels between two cells, beside the gap.
[[nodiscard]] Cell space(int pixels);

/// Adds the cells at the end. @returns the layout.
QBoxLayout* add(QBoxLayout* layout, Cells cells);

/// Layouts with the pages' gaps and no margins.
[[nodiscard]] QBoxLayout* row(Cells cells);
[[nodiscard]] QBoxLayout* column(Cells cells);
[[nodiscard]] QGridLayout* grid(std::initializer_list<Cells> rows);

/// All controls of an array, one beside or under the other.
template <typename Controls>
[[nodiscard]] QBoxLayout* row(const Controls& controls) {
    QBoxLayout* layout = row({});
    for (QWidget* control : controls) layout->addWidget(control);
    return layout;
}
template <typename Controls>
[[nodiscard]] QBoxLayout* column(const Controls& controls) {
    QBoxLayout* layout = column({});
    for (QWidget* control : controls) layout->addWidget(control);
    return layout;
}

/// Lays a frame or page out, with the same margin on all sides.
void layOut(QWidget* frame, QLayout* layout, int margin = kGap);

}  // namespace kdx
