#pragma once

#include <QPainter>
#include <QWidget>

namespace kdx {

/// Draws a frame round the control that has the focus: the style shows none on those it does not know as entries.
inline void paintFocus(QWidget& control) {
    if (!control.hasFocus()) return;
    constexpr int kWidth = 2;
    QPainter painter(&control);
    painter.setPen(
        QPen(control.palette().color(QPalette::Highlight), kWidth, Qt::SolidLine, Qt::SquareCap, Qt::MiterJoin));
    painter.drawRect(control.rect().adjusted(kWidth / 2, kWidth / 2, -kWidth / 2, -kWidth / 2));
}

}  // namespace kdx
