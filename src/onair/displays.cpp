#include "onair/displays.h"

#include <QPainter>
#include <QTextOption>

#include "coder/fieldsizes.h"

namespace kdx {

namespace {

// A display is one in every colour scheme.
constexpr QColor kGlass{0x1C, 0x24, 0x2B};
constexpr QColor kCell{0x28, 0x33, 0x3C};
constexpr QColor kLetters{0xE8, 0xF4, 0xD8};
constexpr int kCells = static_cast<int>(kPsLength);
constexpr int kBetween = 2;

}  // namespace

NameDisplay::NameDisplay(QWidget* parent) : QLabel(parent) {
    QFont large = font();
    large.setPointSizeF(font().pointSizeF() * 2.4);
    large.setBold(true);
    setFont(large);
    setSizePolicy(QSizePolicy::Fixed, QSizePolicy::Fixed);
    setFocusPolicy(Qt::TabFocus);
}

QSize NameDisplay::cellSize() const {
    return {fontMetrics().horizontalAdvance(QLatin1Char('W')) + 4, fontMetrics().height() + 4};
}

QSize NameDisplay::sizeHint() const {
    const QSize cell = cellSize();
    return {kCells * (cell.width() + kBetween) + kBetween, cell.height() + 2 * kBetween};
}

void NameDisplay::paintEvent(QPaintEvent* /*event*/) {
    QPainter painter(this);
    painter.fillRect(rect(), hasFocus() ? palette().color(QPalette::Highlight) : kGlass);
    painter.setPen(kLetters);
    const QSize cell = cellSize();
    for (int i = 0; i < kCells; ++i) {
        const QRect place(QPoint(kBetween + i * (cell.width() + kBetween), kBetween), cell);
        painter.fillRect(place, kCell);
        painter.drawText(place, Qt::AlignCenter, text().mid(i, 1));
    }
}

TextDisplay::TextDisplay(QWidget* parent) : QLabel(parent) {
    setWordWrap(true);
    setSizePolicy(QSizePolicy::Expanding, QSizePolicy::Fixed);
    setFocusPolicy(Qt::TabFocus);
}

QSize TextDisplay::sizeHint() const {
    // 64 wide letters in two lines.
    return {32 * fontMetrics().horizontalAdvance(QLatin1Char('W')) + 8, 2 * fontMetrics().lineSpacing() + 6};
}

void TextDisplay::paintEvent(QPaintEvent* /*event*/) {
    QPainter painter(this);
    painter.fillRect(rect(), hasFocus() ? palette().color(QPalette::Highlight) : kGlass);
    painter.fillRect(rect().adjusted(1, 1, -1, -1), kCell);
    painter.setPen(kLetters);
    QTextOption wrapped(Qt::AlignLeft | Qt::AlignVCenter);
    wrapped.setWrapMode(QTextOption::WrapAtWordBoundaryOrAnywhere);
    painter.drawText(QRectF(rect().adjusted(4, 2, -4, -2)), text(), wrapped);
}

}  // namespace kdx
