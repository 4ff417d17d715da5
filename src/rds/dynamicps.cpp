#include "rds/dynamicps.h"

#include <QCheckBox>
#include <QCoreApplication>
#include <QLabel>

#include <algorithm>
#include <stdexcept>
#include <utility>

#include "base/clock.h"
#include "base/numbers.h"
#include "coder/sendparam.h"
#include "settings/captions.h"
#include "settings/datafolder.h"
#include "ui/named.h"
#include "ui/pictureswitch.h"
#include "ui/statusrow.h"
#include "ui/text.h"
#include "ui/ticker.h"

namespace kdx {

namespace {

constexpr std::size_t kPsLength = 8;
constexpr int kMostPages = 9;
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

std::string nextScrollPs(DynamicPsRecord& record, const std::string& radiotext) {
    if (record.position > record.length) record.position = 0;
    ++record.position;
    record.length = static_cast<int>(radiotext.size());
    const std::string field = radiotext + std::string(kPsLength, ' ');
    const auto start = static_cast<std::size_t>(record.position - 1);
    return start < field.size() ? field.substr(start, kPsLength) : std::string();
}

std::string nextTogglePs(DynamicPsRecord& record, const std::string& typedPs) {
    record.ps = record.ps == kPsMarker ? typedPs : kPsMarker;
    return record.ps;
}

std::string nextPagePs(DynamicPsRecord& record, const std::string& radiotext) {
    record.length = static_cast<int>(radiotext.size() / kPsLength);
    // Pages 0 to that number would be cut out: a tenth has no place.
    if (record.length >= kMostPages) {
        throw std::out_of_range("Subscript out of range: the pages of a radiotext of 72 characters or more");
    }
    // The pages are not used any further: this mode blanks the PS on every step and is left exactly so.
    return {};
}

DynamicPs::DynamicPs(const PageContext& with, std::function<std::string()> typedPs,
                     std::function<std::string()> radiotext, QWidget* page)
    : QObject(page), m_with(with), m_typedPs(std::move(typedPs)), m_radiotext(std::move(radiotext)) {
    PS_A_Label = named<QLabel>("PS_A_Label", page);
    Taste_PS_Auto = named<PictureSwitch>("Taste_PS_Auto", with.data, page);
    connect(Taste_PS_Auto, &PictureSwitch::clicked, this, &DynamicPs::Taste_PS_Auto_Click);
    PS_A_Label->setBuddy(Taste_PS_Auto);
    PS_dyn_Check = named<ModeBox>("PS_dyn_Check", page);

    PS_Timer = named<Ticker>("PS_Timer", this);
    PS_Timer->setPeriod(2500);
    PS_Timer->setEnabled(true);
    connect(PS_Timer, &QTimer::timeout, this, &DynamicPs::PS_Timer_Timer);
}

void DynamicPs::label() {
    PS_A_Label->setText(toText(m_with.captions.own(390, "PS dyn.")));
    Taste_PS_Auto->setAccessibleName(PS_A_Label->text());
    PS_dyn_Check->setText(toText(m_with.captions.own(391, "Serial")));
    PS_dyn_Check->setToolTip(toText(m_with.captions.own(392, "unchecked:  PS toggles. / checked: PS scrolls")));
}

void DynamicPs::showStopped() {
    Taste_PS_Auto->showState(false);
}

void DynamicPs::Taste_PS_Auto_Click() {
    if (!m_running) {
        const double interval = leadingNumber(m_with.data.ReadIni("RDS", "PS_Dyn", kGeneralSettings));
        PS_Timer->setPeriod(std::clamp(interval, 0.0, double{Ticker::kLongestInterval}));
        Taste_PS_Auto->showState(true);
        m_running = true;
        m_failureTold = false;
        return;
    }
    Taste_PS_Auto->showState(false);
    Taste_PS_Auto->repaint();  // at once: nothing is painted during the pause, and the switch would look dead
    PS_Timer->setPeriod(0);
    m_running = false;
    WaitMs(m_with.clock, kStopPauseMs);
    restoreTypedPs();
}

void DynamicPs::PS_Timer_Timer() {
    if (!m_running && m_restored) return;
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
    m_with.params.SendParam("PS", ps);
    // A click that came in meanwhile may stop the steps: it is heard before the typed PS is looked at. The timer's
    // own next tick is not let in, however short its interval is.
    QCoreApplication::processEvents();
    if (!m_running) {
        m_restored = true;
        restoreTypedPs();
    }
}

std::string DynamicPs::nextStep() {
    std::string ps;
    switch (PS_dyn_Check->checkState()) {
        case Qt::PartiallyChecked:
            return nextPagePs(m_record, m_radiotext());
        case Qt::Checked:
            ps = nextScrollPs(m_record, m_radiotext());
            break;
        case Qt::Unchecked:
            ps = nextTogglePs(m_record, m_typedPs());
            break;
    }
    m_with.status.show(StatusSlot::Ps, ps);
    return ps;
}

void DynamicPs::restoreTypedPs() {
    m_with.status.show(StatusSlot::Ps, m_typedPs());
    m_with.params.SendParam("PS", toBytes(m_with.status.text(StatusSlot::Ps)));
}

}  // namespace kdx
