#include "ui/valuescrollbar.h"

#include <QApplication>
#include <QFocusEvent>
#include <QKeyEvent>
#include <QSignalBlocker>
#include <QWheelEvent>

#include "ui/focusframe.h"

namespace kdx {

ValueScrollBar::ValueScrollBar(QWidget* parent) : QScrollBar(Qt::Horizontal, parent) {
    setTracking(false);
    setFocusPolicy(Qt::StrongFocus);
}

void ValueScrollBar::mousePressEvent(QMouseEvent* event) {
    m_clicked = true;
    QScrollBar::mousePressEvent(event);
}

void ValueScrollBar::mouseMoveEvent(QMouseEvent* event) {
    if (!isSliderDown()) return QScrollBar::mouseMoveEvent(event);
    const int before = sliderPosition();
    QSignalBlocker quiet(this);  // the places between two steps are nobody's concern
    QScrollBar::mouseMoveEvent(event);
    const int dragged = sliderPosition();
    setSliderPosition(before);
    quiet.unblock();
    setSliderPosition(onStep(dragged));
}

int ValueScrollBar::onStep(int position) const {
    if (position == maximum()) return position;
    const int step = singleStep();
    return minimum() + (position - minimum() + step / 2) / step * step;
}

void ValueScrollBar::wheelEvent(QWheelEvent* event) {
    if (m_clicked) return QScrollBar::wheelEvent(event);
    event->ignore();
}

void ValueScrollBar::keyPressEvent(QKeyEvent* event) {
    if (event->modifiers() != Qt::NoModifier || (event->key() != Qt::Key_Up && event->key() != Qt::Key_Down))
        return QScrollBar::keyPressEvent(event);
    triggerAction(event->key() == Qt::Key_Up ? SliderSingleStepAdd : SliderSingleStepSub);
}

void ValueScrollBar::focusInEvent(QFocusEvent* event) {
    if (event->reason() == Qt::MouseFocusReason) m_clicked = true;
    QScrollBar::focusInEvent(event);
    update();
}

void ValueScrollBar::focusOutEvent(QFocusEvent* event) {
    m_clicked = false;
    QScrollBar::focusOutEvent(event);
    update();
}

void ValueScrollBar::paintEvent(QPaintEvent* event) {
    QScrollBar::paintEvent(event);
    paintFocus(*this);
}

void ValueScrollBar::timerEvent(QTimerEvent* event) {
    if (QApplication::activeModalWidget() != nullptr) setRepeatAction(SliderNoAction);
    QScrollBar::timerEvent(event);
}

}  // namespace kdx
