#include "ui/keymarks.h"

#include <QWidget>

#include "coder/sendparam.h"
#include "link/instrument.h"
#include "settings/programstate.h"
#include "ui/caption.h"

namespace kdx {

KeyMarks::KeyMarks(ParamSender& params, const Instrument& instrument, const ProgramState& state,
                   const Captions& captions)
    : m_params(params), m_instrument(instrument), m_state(state), m_captions(captions) {
    m_params.onWritten(
        [this](const std::string& key, const std::string& command, bool arrived) { wentOut(key, command, arrived); });
}

KeyMarks::~KeyMarks() {
    m_params.onWritten(nullptr);
}

void KeyMarks::add(const char* key, QWidget* control) {
    watch(key, control, [control](const Judgement& judgement) { showJudgement(*control, judgement); });
}

Judgement KeyMarks::judge(std::string_view key) const {
    const auto found = m_states.find(key);
    if (found == m_states.end() || !found->second.isMarked()) return {};
    if (found->second.other) return {ValueState::Unsent, captionText(m_captions, {857, "Noch nicht gesendet."})};
    return {ValueState::Unsent, captionText(m_captions, {1080, "Nicht beim Gerät angekommen."})};
}

bool KeyMarks::has(std::string_view key, std::string value) const {
    const auto found = m_states.find(key);
    return found != m_states.end() && found->second.arrived &&
           m_params.compose(found->first, value) == found->second.command;
}

void KeyMarks::shows(const std::string& key, const std::string& value) {
    // Shown in the silence of a stopped sequence is what the instrument was found to have.
    if (m_instrument.isSequenceStopped()) return forget(key);
    leftOut(key, value);
}

void KeyMarks::leftOut(const std::string& key, const std::string& value) {
    if (!m_state.InstrumentOnline) return;
    std::string sent = value;
    const auto command = m_params.compose(key, sent);
    if (!command) return;
    State state = m_states[key];
    state.other = !state.sent || state.command != *command;
    set(key, state);
}

void KeyMarks::sentUnder(const std::string& sendKey, const std::string& key) {
    if (const auto found = m_states.find(sendKey); found != m_states.end()) set(key, State(found->second));
}

void KeyMarks::forget(const std::string& key) {
    set(key, {});
}

void KeyMarks::wentOut(const std::string& key, const std::string& command, bool arrived) {
    set(key, {command, true, arrived, false});
}

void KeyMarks::set(const std::string& key, const State& state) {
    const bool wasMarked = std::exchange(m_states[key], state).isMarked();
    if (wasMarked || state.isMarked()) show(key);
}

void KeyMarks::refresh() {
    for (const auto& [key, state] : m_states) {
        if (state.isMarked()) show(key);
    }
}

void KeyMarks::show(std::string_view key) const {
    const Judgement judgement = judge(key);
    for (const Watch& watch : m_watches) {
        if (watch.key == key && watch.owner != nullptr) watch.show(judgement);
    }
}

}  // namespace kdx
