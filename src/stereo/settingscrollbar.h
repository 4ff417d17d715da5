#pragma once

#include "ui/valuescrollbar.h"

namespace kdx {

/// A scroll bar whose every change of value goes to the instrument.
class SettingScrollBar : public ValueScrollBar {
public:
    using ValueScrollBar::ValueScrollBar;

    /// @param step of a click on an arrow and of a click beside the slider alike.
    void setScale(int lowest, int highest, int step) {
        setRange(lowest, highest);
        setSingleStep(step);
        setPageStep(step);
    }
};

}  // namespace kdx
