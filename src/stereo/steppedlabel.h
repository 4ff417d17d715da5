#pragma once

#include "ui/clickablelabel.h"

namespace kdx {

/// A label that shows a number, which the arrow keys change: by a step, with the shift key by ten.
class SteppedLabel : public ClickableLabel {
    Q_OBJECT
public:
    using ClickableLabel::ClickableLabel;

signals:
    void stepped(int steps);

protected:
    void keyPressEvent(QKeyEvent* event) override {
        const int steps = (event->modifiers() & Qt::ShiftModifier) != 0 ? 10 : 1;
        switch (event->key()) {
            case Qt::Key_Up:
            case Qt::Key_Right:
                return emit stepped(steps);
            case Qt::Key_Down:
            case Qt::Key_Left:
                return emit stepped(-steps);
            default:
                ClickableLabel::keyPressEvent(event);
        }
    }
};

}  // namespace kdx
