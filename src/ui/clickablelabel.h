#pragma once

#include <QKeyEvent>
#include <QLabel>
#include <QMouseEvent>

#include "ui/focusframe.h"

namespace kdx {

/// A label that can be clicked, double-clicked and, by the space or enter key, reached without the mouse.
class ClickableLabel : public QLabel {
    Q_OBJECT
public:
    explicit ClickableLabel(QWidget* parent) : QLabel(parent) {
        setCursor(Qt::PointingHandCursor);
        setFocusPolicy(Qt::StrongFocus);
        setFrameStyle(QFrame::Panel | QFrame::Sunken);
    }

signals:
    void clicked();
    void doubleClicked();

protected:
    void mouseReleaseEvent(QMouseEvent* event) override {
        if (event->button() == Qt::LeftButton && rect().contains(event->pos())) emit clicked();
    }
    void mouseDoubleClickEvent(QMouseEvent* event) override {
        if (event->button() == Qt::LeftButton) emit doubleClicked();
    }
    void keyPressEvent(QKeyEvent* event) override {
        if (event->key() == Qt::Key_Space || event->key() == Qt::Key_Return || event->key() == Qt::Key_Enter) {
            emit clicked();
            emit doubleClicked();
        } else {
            QLabel::keyPressEvent(event);
        }
    }
    void paintEvent(QPaintEvent* event) override {
        QLabel::paintEvent(event);
        paintFocus(*this);
    }
    void focusInEvent(QFocusEvent* event) override {
        setFrameShadow(QFrame::Raised);
        QLabel::focusInEvent(event);
    }
    void focusOutEvent(QFocusEvent* event) override {
        setFrameShadow(QFrame::Sunken);
        QLabel::focusOutEvent(event);
    }
};

}  // namespace kdx
