#pragma once

#include <QObject>

#include <functional>
#include <string>

#include "ui/pagecontext.h"

class QCheckBox;
class QLabel;
class QWidget;

namespace kdx {

class PictureSwitch;
class Ticker;

/// What one step of the dynamic PS has to remember.
struct DynamicPsRecord {
    std::string ps;    ///< the text the toggle mode showed last; empty at first
    int position = 0;  ///< scroll mode: where the field starts, from 1
    int length = 0;    ///< length of the radiotext at the last step
};

/// The marker that takes turns with the typed PS.
inline constexpr const char* kPsMarker = ">--<>--<";

/// Scroll mode: the 8 characters to show next; moves the record on. A text of n characters is shown at positions 1 to
/// n + 1, the last one blank.
[[nodiscard]] std::string nextScrollPs(DynamicPsRecord& record, const std::string& radiotext);
/// Toggle mode: the marker and the typed PS in turn.
[[nodiscard]] std::string nextTogglePs(DynamicPsRecord& record, const std::string& typedPs);
/// Page mode: cuts the radiotext into pages and leaves the PS blank. @throws std::out_of_range for 72 characters and
/// more.
[[nodiscard]] std::string nextPagePs(DynamicPsRecord& record, const std::string& radiotext);

/// The programme service name that changes on a timer: it takes turns with a marker or scrolls the radiotext.
class DynamicPs : public QObject {
    Q_OBJECT
public:
    /// @param typedPs, radiotext give the texts of `PS_T` and `RT_Text1`.
    DynamicPs(const PageContext& with, std::function<std::string()> typedPs, std::function<std::string()> radiotext,
              QWidget* page);

    void label();
    /// Start-up: the switch shows its off picture.
    void showStopped();
    /// Stops the steps without changing the switch's picture and without sending the typed PS.
    void stopQuietly() { m_running = false; }

    QLabel* PS_A_Label = nullptr;
    PictureSwitch* Taste_PS_Auto = nullptr;
    QCheckBox* PS_dyn_Check = nullptr;

private:
    void Taste_PS_Auto_Click();
    void PS_Timer_Timer();

    [[nodiscard]] std::string nextStep();
    void restoreTypedPs();

    Ticker* PS_Timer = nullptr;

    PageContext m_with;
    std::function<std::string()> m_typedPs;
    std::function<std::string()> m_radiotext;
    DynamicPsRecord m_record;
    bool m_running = false;
    bool m_restored = false;
    bool m_failureTold = false;  ///< the last step failed and that was told
};

}  // namespace kdx
