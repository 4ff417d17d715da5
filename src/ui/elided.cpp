#include "ui/elided.h"

#include <QHelpEvent>
#include <QLabel>
#include <QPainter>
#include <QStyle>
#include <QStyleOptionFrame>
#include <QToolTip>

#include <algorithm>

#include "ui/focusframe.h"

namespace kdx {

namespace {

QRect placeOfText(const QLabel& label) {
    const int margin = label.margin() + std::max(label.indent(), 0);
    return label.contentsRect().adjusted(margin, 0, -margin, 0);
}

class Elider final : public QObject {
public:
    explicit Elider(QLabel& label) : QObject(&label), m_label(label) { label.installEventFilter(this); }

protected:
    bool eventFilter(QObject* watched, QEvent* event) override {
        if (watched != &m_label || visibleText(m_label) == m_label.text()) return false;
        if (event->type() == QEvent::Paint) {
            paint();
            return true;
        }
        if (event->type() != QEvent::ToolTip || m_label.toolTip().startsWith(m_label.text())) return false;
        const QString tip = m_label.text() + QLatin1Char('\n') + m_label.toolTip();
        QToolTip::showText(static_cast<QHelpEvent*>(event)->globalPos(), tip.trimmed(), &m_label);
        return true;
    }

private:
    void paint() {
        QPainter painter(&m_label);
        QStyleOptionFrame frame;
        frame.initFrom(&m_label);
        frame.frameShape = m_label.frameShape();
        frame.lineWidth = m_label.lineWidth();
        frame.midLineWidth = m_label.midLineWidth();
        if (m_label.frameShadow() == QFrame::Sunken) frame.state |= QStyle::State_Sunken;
        if (m_label.frameShadow() == QFrame::Raised) frame.state |= QStyle::State_Raised;
        m_label.style()->drawControl(QStyle::CE_ShapedFrame, &frame, &painter, &m_label);
        m_label.style()->drawItemText(&painter, placeOfText(m_label), static_cast<int>(m_label.alignment()),
                                      m_label.palette(), m_label.isEnabled(), visibleText(m_label),
                                      m_label.foregroundRole());
        painter.end();
        if (m_label.focusPolicy() != Qt::NoFocus) paintFocus(m_label);
    }

    QLabel& m_label;
};

}  // namespace

void elideLongText(QLabel& label) {
    if (!elidesLongText(label)) (new Elider(label))->setObjectName(QStringLiteral("Elider"));
}

bool elidesLongText(const QLabel& label) {
    return label.findChild<QObject*>(QStringLiteral("Elider"), Qt::FindDirectChildrenOnly) != nullptr;
}

QString visibleText(const QLabel& label) {
    return label.fontMetrics().elidedText(label.text(), Qt::ElideRight, placeOfText(label).width());
}

}  // namespace kdx
