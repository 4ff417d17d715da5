#include "ui/layouts.h"

#include <QWidget>

#include <algorithm>

namespace kdx {

namespace {

template <typename Layout>
Layout* withGaps(Layout* layout) {
    layout->setSpacing(kGap);
    return layout;
}

}  // namespace

QBoxLayout* add(QBoxLayout* layout, Cells cells) {
    for (const Cell& cell : cells) {
        if (cell.control != nullptr) {
            layout->addWidget(cell.control, cell.count, cell.alignment);
        } else if (cell.inner != nullptr) {
            layout->addLayout(cell.inner, cell.count);
        } else if (cell.count > 0) {
            layout->addSpacing(cell.count);
        } else {
            layout->addStretch(1);
        }
    }
    return layout;
}

Cell space(int pixels) {
    Cell cell;
    cell.count = pixels;
    return cell;
}

QBoxLayout* row(Cells cells) {
    return add(withGaps(new QHBoxLayout), cells);
}

QBoxLayout* column(Cells cells) {
    return add(withGaps(new QVBoxLayout), cells);
}

QGridLayout* grid(std::initializer_list<Cells> rows) {
    auto* layout = withGaps(new QGridLayout);
    int line = 0;
    for (const Cells& cells : rows) {
        int at = 0;
        for (const Cell& cell : cells) {
            const int columns = std::max(cell.count, 1);
            if (cell.control != nullptr) layout->addWidget(cell.control, line, at, 1, columns, cell.alignment);
            if (cell.inner != nullptr) layout->addLayout(cell.inner, line, at, 1, columns);
            at += columns;
        }
        ++line;
    }
    return layout;
}

void layOut(QWidget* frame, QLayout* layout, int margin) {
    layout->setContentsMargins(margin, margin, margin, margin);
    frame->setLayout(layout);
}

}  // namespace kdx
