#pragma once

#include <QScrollBar>

namespace kdx {

/// A horizontal scroll bar that sets a value: `sliderMoved` follows a drag, in small steps, and `valueChanged` comes
/// once for the place where the drag ends and once for each step by button or key. The wheel scrolls what the bar
/// stands on; only who has clicked the bar turns its value.
class ValueScrollBar : public QScrollBar {
    Q_OBJECT
public:
    explicit ValueScrollBar(QWidget* parent);

protected:
    void mousePressEvent(QMouseEvent* event) override;
    void mouseMoveEvent(QMouseEvent* event) override;
    void wheelEvent(QWheelEvent* event) override;
    /// Up is more, as in every field that shows a number.
    void keyPressEvent(QKeyEvent* event) override;
    void focusInEvent(QFocusEvent* event) override;
    void focusOutEvent(QFocusEvent* event) override;
    void paintEvent(QPaintEvent* event) override;
    /// A step that failed opens a message box while the mouse button is still held: the box gets the button's release,
    /// so the stepping would go on behind it for ever and open a box a step.
    void timerEvent(QTimerEvent* event) override;

private:
    [[nodiscard]] int onStep(int position) const;

    bool m_clicked = false;  ///< has the focus by a click
};

}  // namespace kdx
