#include "groups/sequencelabel.h"

#include <QPainter>
#include <QTextOption>

#include <cmath>

namespace kdx {

SequenceLabel::SequenceLabel(QWidget* parent) : QLabel(parent) {
    setWordWrap(true);
    setMargin(2);
}

int SequenceLabel::heightForWidth(int width) const {
    return static_cast<int>(std::ceil(laidOut(width - 2 * margin()).size().height())) + 2 * margin();
}

QSize SequenceLabel::minimumSizeHint() const {
    const int side = fontMetrics().height() + 2 * margin();
    return {side, side};
}

void SequenceLabel::paintEvent(QPaintEvent* /*event*/) {
    QPainter painter(this);
    painter.drawStaticText(margin(), margin(), laidOut(width() - 2 * margin()));
}

QStaticText SequenceLabel::laidOut(int width) const {
    QString breakable = text();
    breakable.replace(QLatin1Char(','), QStringLiteral(",\u200B"));  // a blank without width: lines may end there
    QStaticText layout(breakable);
    layout.setTextFormat(Qt::PlainText);
    QTextOption option;
    option.setWrapMode(QTextOption::WrapAtWordBoundaryOrAnywhere);
    layout.setTextOption(option);
    layout.setTextWidth(width);
    layout.prepare({}, font());
    return layout;
}

}  // namespace kdx
