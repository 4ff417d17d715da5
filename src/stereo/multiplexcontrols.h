#pragma once

#include <cstddef>
#include <string>

#include "stereo/deviation.h"
#include "stereo/multiplex.h"
#include "stereo/settingscrollbar.h"
#include "ui/controls.h"
#include "ui/pictureswitch.h"

class QLabel;

namespace kdx {

class KilohertzField;

/// A setting of the multiplex and its value there.
struct Adjustment {
    const Setting& setting;
    std::string& value;
};

/// A deviation with the scroll bar and the number field that set it and the label that shows it.
struct DeviationBar : Adjustment {
    DeviationBar(const Deviation& of, std::string& kept) : Adjustment{of.setting, kept}, deviation(of) {}

    const Deviation& deviation;
    SettingScrollBar* scroll = nullptr;
    QLabel* label = nullptr;
    KilohertzField* number = nullptr;
};

/// A flag with the button that turns it over.
struct FlagSwitch : Adjustment {
    PictureSwitch* button = nullptr;
};

/// A choice with its options.
template <std::size_t Count>
struct Choice : Adjustment {
    std::string (*text)(int index) = optionText;  ///< how an option is sent
    OptionArray<Count> options = {};

    /// Chooses the option that the value stands for; none where no option does.
    void showValue() {
        int index = static_cast<int>(Count) - 1;
        while (index >= 0 && text(index) != value) --index;
        options.choose(index);
    }
};

}  // namespace kdx
