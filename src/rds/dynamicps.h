#pragma once

#include <QCheckBox>

#include <functional>
#include <string>

#include "rds/dynamicpsrule.h"
#include "ui/automatics.h"
#include "ui/form.h"
#include "ui/pictureswitch.h"

namespace kdx {

struct Programme;

/// The programme service name that changes on a timer: it takes turns with a marker or scrolls the radiotext.
class DynamicPs : public QObject, public Form {
    Q_OBJECT
public:
    /// @param programme its radiotext is scrolled; lent.
    /// @param typedPs gives the text of `PS_T`.
    DynamicPs(const PageContext& with, const Programme& programme, std::function<std::string()> typedPs, QWidget* page);

    /// The kept interval between two steps in milliseconds, as far as a timer can count; 0 for none.
    [[nodiscard]] static double keptInterval(const Profile& profile);

    void label() { m_book.label(m_with.captions); }
    /// Start-up: the switch shows its off picture.
    void showStopped() { Taste_PS_Auto->showState(false); }
    /// Stops the steps without changing the switch's picture and without sending the typed PS.
    void stopQuietly() { m_running.setRunning(false); }

    QLabel* PS_A_Label = nullptr;
    PictureSwitch* Taste_PS_Auto = nullptr;
    QCheckBox* PS_dyn_Check = nullptr;

signals:
    /// The typed PS went out again.
    void typedPsSent();

private:
    void Taste_PS_Auto_Click();
    void PS_Timer_Timer();

    /// Switches it off; the typed PS is not sent.
    void switchOff();
    [[nodiscard]] std::string nextStep();
    void show(const QString& ps);
    void restoreTypedPs();

    Ticker* PS_Timer = nullptr;
    const Programme& m_programme;
    std::function<std::string()> m_typedPs;
    DynamicPsRecord m_record;
    Automatic m_running;
    bool m_restored = false;
    bool m_failureTold = false;  ///< the last step failed and that was told
};

}  // namespace kdx
