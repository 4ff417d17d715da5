#include "ui/page.h"

#include <QComboBox>

#include <algorithm>
#include <optional>

#include "coder/sendparam.h"
#include "link/commandsequence.h"
#include "settings/captions.h"
#include "settings/profile.h"
#include "settings/programstate.h"
#include "settings/storedvalue.h"
#include "ui/text.h"

namespace kdx {

void Page::resizeEvent(QResizeEvent* event) {
    QWidget::resizeEvent(event);
    constexpr int kWidest = 90;  // lines of the font
    const int spare = std::max(0, width() - kWidest * fontMetrics().height());
    setContentsMargins(spare / 2, 0, spare - spare / 2, 0);
}

void Page::send(const Steps& steps) {
    std::optional<CommandSequence> sequence;  // a single command is none
    if (steps.size() > 1) sequence.emplace(m_with.instrument);
    for (const Step& step : steps) {
        if (m_with.instrument.isSequenceStopped()) return;
        stepGoesOut(step);
        if (step.kind == Step::Kind::Parameter) m_with.params.SendParam(step.key, std::string(step.value));
    }
}

void Page::sendAndStore(const Setting& setting, const std::string& value) {
    m_with.params.SendParam(setting.sendKey, std::string(value));
    m_with.profile.write(setting.place, value);
}

void Page::storeText(const Setting& setting, const std::string& text) {
    m_with.profile.write(setting.place, m_with.state.corrections.edgeBlanks ? quotedWhereNeeded(text) : text);
}

void Page::showProgrammeTypes(QComboBox* box, const Place& stored) {
    const QSignalBlocker quiet(box);
    box->clear();
    for (std::size_t type = 0; type < kProgrammeTypes; ++type) {
        box->addItem(toText(m_with.captions.programmeType(type)));
    }
    box->setCurrentIndex(storedEntry(m_with.profile.read(stored), kProgrammeTypes));
}

}  // namespace kdx
