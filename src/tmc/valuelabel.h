#pragma once

#include <QLabel>

namespace kdx {

/// A label that shows a value: the look of a box that cannot be written in.
class ValueLabel : public QLabel {
public:
    explicit ValueLabel(QWidget* parent) : QLabel(parent) {
        setFrameStyle(QFrame::Panel | QFrame::Sunken);
        setAlignment(Qt::AlignCenter);
    }
    /// Keeps it wide enough for that many digits of its font.
    void makeRoomFor(int digits) {
        setMinimumWidth(fontMetrics().horizontalAdvance(QString(digits, QLatin1Char('0'))) + 8);
    }
};

}  // namespace kdx
