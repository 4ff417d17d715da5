#pragma once

#include <QGroupBox>

#include <array>
#include <optional>

#include "settings/corrections.h"
#include "stereo/settings.h"
#include "ui/clickablelabel.h"
#include "ui/page.h"
#include "ui/pictureswitch.h"
#include "ui/statusrow.h"

namespace kdx {

struct Carrier;

/// The page "* * *": RF frequency, RF level, audio frequency and RF output of the generator. The values are entered by
/// a click on the label that shows them; they are sent and kept nowhere, limits and presets come from data set 1.
class RfPage : public Page {
    Q_OBJECT
public:
    RfPage(const PageContext& with, Carrier& carrier, QWidget* parent);

    void label() override;
    void stepGoesOut(const Step& step) override;

private:
    /// One value of the generator: where it comes from, goes to and is shown.
    struct Value {
        const Setting& setting;
        double step;  ///< of an arrow key, in the value's unit
        int prompt;   ///< caption number of the box's text; the title has the next one
        StatusSlot slot;
        const Place* lowest = nullptr;  ///< where the limits are kept; nullptr for fixed ones
        const Place* highest = nullptr;
        Corrections shownUnder = {};        ///< what was corrected when the value that is shown went out
        std::optional<QString> shown = {};  ///< nothing before one went out
        ClickableLabel* label = nullptr;
        QGroupBox* frame = nullptr;
    };

    void Input_HF_Freq_Label_Click() { enter(Input_HF_Freq_Label); }
    void Input_HF_Pegel_Label_Click() { enter(Input_HF_Pegel_Label); }
    void Input_AF_Freq_Label_Click() { enter(Input_AF_Freq_Label); }
    void HfOnOffState_Click();

    void create();
    void createValue(Value& value, const char* name, const char* frame, const Caption& title,
                     void (RfPage::*handler)());
    void arrange();
    void enter(Value& value);
    void step(Value& value, int steps);
    void take(Value& value, const QString& number);
    [[nodiscard]] std::string lowest(const Value& value) const;
    [[nodiscard]] std::string highest(const Value& value) const;
    [[nodiscard]] QString checked(QString& answer, const std::string& lowest, const std::string& highest) const;
    void showValue(Value& value, const QString& text);
    void showJudged(const Value& value);
    [[nodiscard]] QString refusal(const Value& value) const;
    [[nodiscard]] Judgement judge(const Value& value) const;
    void showOutput(bool on);
    [[nodiscard]] std::array<Value*, 3> values() {
        return {&Input_HF_Freq_Label, &Input_HF_Pegel_Label, &Input_AF_Freq_Label};
    }

    Carrier& m_carrier;

    Value Input_HF_Freq_Label{setting::kRfFrequency, 0.1, 210, StatusSlot::RfFrequency, &setting::kRfLowest,
                              &setting::kRfHighest};
    Value Input_HF_Pegel_Label{setting::kRfLevel, 1, 216, StatusSlot::RfLevel};
    Value Input_AF_Freq_Label{setting::kAudioFrequency, 0.1, 213, StatusSlot::AudioFrequency, &setting::kAudioLowest,
                              &setting::kAudioHighest};
    QGroupBox* m_outputFrame = nullptr;
    PictureSwitch* HfOnOffState = nullptr;
};

}  // namespace kdx
