#include "rds/dynamicps.h"

#include <QCoreApplication>

#include <algorithm>
#include <stdexcept>
#include <utility>

#include "base/clock.h"
#include "base/numbers.h"
#include "coder/sendparam.h"
#include "rds/programme.h"
#include "rds/settings.h"
#include "ui/sentvalue.h"
#include "ui/statusrow.h"
#include "ui/text.h"
#include "ui/tick.h"

namespace kdx {

namespace {

constexpr std::int16_t kStopPauseMs = 1000;

/// Toggle, scroll, page mode in this order: the first click ticks the box as its tool tip says, the third, greyed
/// state is the page mode.
class ModeBox final : public QCheckBox {
public:
    using QCheckBox::QCheckBox;

protected:
    void nextCheckState() override {
        switch (checkState()) {
            case Qt::Unchecked:
                return setCheckState(Qt::Checked);
            case Qt::Checked:
                return setCheckState(Qt::PartiallyChecked);
            case Qt::PartiallyChecked:
                return setCheckState(Qt::Unchecked);
        }
    }
};

}  // namespace

DynamicPs::DynamicPs(const PageContext& with, const Programme& programme, std::function<std::string()> typedPs,
                     QWidget* page)
    : QObject(page),
      Form(with),
      m_programme(programme),
      m_typedPs(std::move(typedPs)),
      m_running(
          with.tickers.automatics(), [this] { return PS_A_Label->text(); }, [this] { switchOff(); }) {
    Taste_PS_Auto = wired<PictureSwitch>("Taste_PS_Auto", &PictureSwitch::clicked, &DynamicPs::Taste_PS_Auto_Click,
                                         with.data, page);
    PS_A_Label = heading("PS_A_Label", {390, "PS dyn."}, Taste_PS_Auto);
    PS_dyn_Check = captioned<ModeBox>("PS_dyn_Check", {391, "Serial"}, page);
    m_book.tip(PS_dyn_Check, {392, "unchecked:  PS toggles. / checked: PS scrolls"});
    PS_Timer = timer("PS_Timer", 2500, &DynamicPs::PS_Timer_Timer);
    PS_Timer->setEnabled(true);
}

double DynamicPs::keptInterval(const Profile& profile) {
    const double interval = leadingNumber(profile.read(setting::kDynamicPsInterval));
    return std::clamp(interval, 0.0, double{Ticker::kLongestInterval});
}

void DynamicPs::Taste_PS_Auto_Click() {
    if (!m_running.runs()) {
        PS_Timer->setPeriod(keptInterval(m_with.profile));
        Taste_PS_Auto->showState(true);
        m_running.setRunning(true);
        m_failureTold = false;
        return;
    }
    switchOff();
    Taste_PS_Auto->repaint();  // at once: nothing is painted during the pause, and the switch would look dead
    WaitMs(m_with.clock, kStopPauseMs);
    restoreTypedPs();
}

void DynamicPs::switchOff() {
    Taste_PS_Auto->showState(false);
    PS_Timer->setPeriod(0);
    m_running.setRunning(false);
}

void DynamicPs::PS_Timer_Timer() {
    if (!m_running.runs() && m_restored) return;
    std::string ps;
    try {
        ps = nextStep();
        m_failureTold = false;
    } catch (const std::out_of_range&) {
        // The next steps fail alike until the radiotext is shorter or the mode another: one box, not one after the
        // other. The ticks go on, so that the steps go on by themselves then.
        if (std::exchange(m_failureTold, true)) return;
        throw;
    }
    {
        const Tick tick(m_with, PS_A_Label->text(), [this] { switchOff(); });
        m_with.params.SendParam(setting::kPs.sendKey, ps);
    }
    if (PS_Timer->period() == 0) return;  // switched off at the box of a failure: nothing more is sent
    // A click that came in meanwhile may stop the steps: it is heard before the typed PS is looked at. The timer's
    // own next tick is not let in, however short its interval is.
    QCoreApplication::processEvents();
    if (!m_running.runs()) {
        m_restored = true;
        restoreTypedPs();
    }
}

std::string DynamicPs::nextStep() {
    std::string ps;
    switch (PS_dyn_Check->checkState()) {
        case Qt::PartiallyChecked:
            return nextPagePs(m_record, m_programme.radiotext);
        case Qt::Checked:
            ps = nextScrollPs(m_record, m_programme.radiotext);
            break;
        case Qt::Unchecked:
            ps = nextTogglePs(m_record, m_typedPs());
            break;
    }
    show(toText(ps));
    return ps;
}

void DynamicPs::show(const QString& ps) {
    const bool arrives = linkWorks(m_with);  // the steps go on without a session, too
    m_with.status.show(StatusSlot::Ps, ps,
                       arrives ? Judgement{} : Judgement{ValueState::Unsent, caption({857, "Noch nicht gesendet."})});
}

void DynamicPs::restoreTypedPs() {
    show(toText(m_typedPs()));
    m_with.params.SendParam(setting::kPs.sendKey, m_typedPs());
    emit typedPsSent();
}

}  // namespace kdx
