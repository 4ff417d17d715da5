#include "ui/sentvalue.h"

#include "link/instrument.h"
#include "settings/programstate.h"
#include "ui/caption.h"
#include "ui/text.h"

namespace kdx {

bool linkWorks(const PageContext& with) {
    return with.state.InstrumentOnline && !with.instrument.isSequenceStopped() && with.instrument.LastVisaStatus >= 0;
}

void SentValue::goesOut(const std::string& value) {
    if (m_with.state.InstrumentOnline && !m_with.instrument.isSequenceStopped()) m_inForce = value;
}

void SentValue::wentOut(const std::string& value) {
    if (linkWorks(m_with)) m_inForce = value;
}

Judgement SentValue::judge(const std::string& value, const QString& entry) const {
    const QString why = whyRefused(m_with, m_key, entry);
    if (m_inForce != value) {
        const QString unsent = captionText(m_with.captions, {857, "Noch nicht gesendet."});
        return {ValueState::Unsent, why.isEmpty() ? unsent : unsent + QLatin1Char('\n') + why};
    }
    return {why.isEmpty() ? ValueState::InForce : ValueState::Refused, why};
}

Judgement SentValue::judge(const std::string& value) const {
    return judge(value, toText(value));
}

}  // namespace kdx
