#pragma once

#include <QApplication>
#include <QScrollBar>

namespace kdx {

/// A horizontal scroll bar whose every change of value goes to the instrument: `sliderMoved` follows a drag, and
/// `valueChanged` comes once for the place where the drag ends and once for each step by button, key or wheel.
class SettingScrollBar : public QScrollBar {
public:
    explicit SettingScrollBar(QWidget* parent) : QScrollBar(Qt::Horizontal, parent) {
        setTracking(false);
        setFocusPolicy(Qt::StrongFocus);
    }

    /// @param step of a click on an arrow and of a click beside the slider alike.
    void setScale(int lowest, int highest, int step) {
        setRange(lowest, highest);
        setSingleStep(step);
        setPageStep(step);
    }

protected:
    /// A step that failed opens a message box while the mouse button is still held: the box gets the button's release,
    /// so the stepping would go on behind it for ever and open a box a step.
    void timerEvent(QTimerEvent* event) override {
        if (QApplication::activeModalWidget() != nullptr) setRepeatAction(SliderNoAction);
        QScrollBar::timerEvent(event);
    }
};

}  // namespace kdx
