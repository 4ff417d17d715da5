#include "groups/sequencelabel.h"

#include <QMouseEvent>
#include <QPainter>
#include <QTextLayout>
#include <QTextOption>

#include <cmath>

namespace kdx {

namespace {

constexpr QChar kBreak(0x200B);  // a blank without width: lines may end there

/// Where a character of the text stands in the one with the breaks.
int withBreaks(const QString& text, int at) {
    return at + static_cast<int>(QStringView(text).left(at).count(QLatin1Char(',')));
}

}  // namespace

SequenceLabel::SequenceLabel(QWidget* parent) : QLabel(parent) {
    setWordWrap(true);
    setMargin(2);
}

void SequenceLabel::mark(int from, int length) {
    m_markedFrom = from;
    m_marked = length;
    update();
}

int SequenceLabel::heightForWidth(int width) const {
    int height = 0;
    withLayout(width - 2 * margin(),
               [&](QTextLayout&, qreal laidOut) { height = static_cast<int>(std::ceil(laidOut)); });
    return height + 2 * margin();
}

QSize SequenceLabel::minimumSizeHint() const {
    const int side = fontMetrics().height() + 2 * margin();
    return {side, side};
}

void SequenceLabel::paintEvent(QPaintEvent* /*event*/) {
    QPainter painter(this);
    painter.setPen(palette().color(foregroundRole()));
    withLayout(width() - 2 * margin(), [&](QTextLayout& layout, qreal) {
        QTextLayout::FormatRange marked;
        marked.start = withBreaks(text(), m_markedFrom);
        marked.length = m_marked;
        marked.format.setBackground(palette().brush(QPalette::Highlight));
        marked.format.setForeground(palette().brush(QPalette::HighlightedText));
        layout.draw(&painter, QPointF(margin(), margin()), m_marked > 0 ? QList{marked} : decltype(QList{marked})());
    });
}

void SequenceLabel::mousePressEvent(QMouseEvent* event) {
    const QPointF at = event->position() - QPointF(margin(), margin());
    withLayout(width() - 2 * margin(), [&](QTextLayout& layout, qreal) {
        for (int number = 0; number < layout.lineCount(); ++number) {
            const QTextLine line = layout.lineAt(number);
            if (at.y() < line.y() || at.y() >= line.y() + line.height() || at.x() > line.naturalTextWidth()) continue;
            const int place = line.xToCursor(at.x(), QTextLine::CursorOnCharacter);
            emit clickedAt(place - static_cast<int>(QStringView(layout.text()).left(place).count(kBreak)));
            return;
        }
    });
}

void SequenceLabel::withLayout(int width, const std::function<void(QTextLayout& layout, qreal height)>& look) const {
    QString breakable = text();
    breakable.replace(QLatin1Char(','), QLatin1Char(',') + QString(kBreak));
    QTextLayout layout(breakable, font());
    QTextOption option;
    option.setWrapMode(QTextOption::WrapAtWordBoundaryOrAnywhere);
    layout.setTextOption(option);
    layout.beginLayout();
    qreal height = 0;
    for (QTextLine line = layout.createLine(); line.isValid(); line = layout.createLine()) {
        line.setLineWidth(width);
        line.setPosition({0, height});
        height += line.height();
    }
    layout.endLayout();
    look(layout, height);
}

}  // namespace kdx
