#pragma once

#include <QWidget>

#include <string>

#include "ui/pagecontext.h"
#include "ui/statusrow.h"

class QGroupBox;

namespace kdx {

class ClickableLabel;
class PictureSwitch;

/// The page "* * *": RF frequency, RF level, audio frequency and RF output of the generator. The values are entered
/// by a click on the label that shows them; nothing is stored, limits and presets come from data set 1.
class RfPage : public QWidget {
    Q_OBJECT
public:
    RfPage(const PageContext& with, QWidget* parent);

    /// Captions the page in the current language; the values stay.
    void label();
    /// Sends the RF frequency of data set 1 and shows it. An empty one is sent too, but not shown.
    void sendFrequency();
    /// The same for the RF level.
    void sendLevel();
    /// Chooses the sine for the audio generator, then the same for the audio frequency.
    void sendAudioFrequency();
    /// Turns the RF output over; off at first.
    void HfOnOffState_Click();

private:
    /// One value of the generator and where it comes from, goes to and is shown.
    struct Value {
        const char* profileKey;
        const char* lowerKey;  ///< key of the limit, or the empty text for a fixed one
        const char* upperKey;
        const char* fixedLower;
        const char* fixedUpper;
        int prompt;  ///< caption number of the box's text; the title has the next one
        const char* sendKey;
        StatusSlot slot;
    };
    static const Value kFrequency;
    static const Value kLevel;
    static const Value kAudioFrequency;

    void Input_HF_Freq_Label_Click();
    void Input_HF_Pegel_Label_Click();
    void Input_AF_Freq_Label_Click();

    QGroupBox* makeValue(const char* frame, const char* name, ClickableLabel*& shown);
    void enter(const Value& value, ClickableLabel* shown);
    void sendStored(const Value& value, ClickableLabel* shown);
    void showValue(const Value& value, ClickableLabel* shown, const QString& text);
    [[nodiscard]] std::string stored(const char* key) const;

    PageContext m_with;

    QGroupBox* RF_Freq_Frame = nullptr;
    ClickableLabel* Input_HF_Freq_Label = nullptr;
    QGroupBox* RF_Level_Frame = nullptr;
    ClickableLabel* Input_HF_Pegel_Label = nullptr;
    QGroupBox* AF_Freq_Frame = nullptr;
    ClickableLabel* Input_AF_Freq_Label = nullptr;
    QGroupBox* m_outputFrame = nullptr;
    PictureSwitch* HfOnOffState = nullptr;
};

}  // namespace kdx
