#include "station/transmitter.h"

#include <algorithm>

#include "af/othernetwork.h"
#include "af/settings.h"
#include "coder/sendparam.h"
#include "link/commandsequence.h"

namespace kdx {

namespace {

bool isSent(const Step& step) {
    return step.kind != Step::Kind::Refused && step.kind != Step::Kind::Close;
}

std::size_t countSent(const Steps& steps) {
    return static_cast<std::size_t>(std::count_if(steps.begin(), steps.end(), isSent));
}

}  // namespace

/// Says the end of the outermost sequence, however it comes.
class Transmitter::Run {
public:
    explicit Run(Transmitter& transmitter) : m_transmitter(transmitter) { ++m_transmitter.m_depth; }
    ~Run() {
        if (--m_transmitter.m_depth == 0 && m_transmitter.m_watcher != nullptr) m_transmitter.m_watcher->stepsEnded();
    }
    Run(const Run&) = delete;
    Run& operator=(const Run&) = delete;

private:
    Transmitter& m_transmitter;
};

bool Transmitter::run(Steps steps) {
    const CommandSequence sequence(m_instrument);
    const Run running(*this);
    std::size_t number = 0;
    std::size_t at = 0;
    for (; at < steps.size() && !m_instrument.isSequenceStopped(); ++at) {
        const Step step = steps[at];
        const bool sent = isSent(step);
        if (sent) ++number;
        if (m_watcher != nullptr) m_watcher->stepGoesOut(step, sent ? number : 0, sent ? countSent(steps) : 0);
        const bool stopped = m_instrument.isSequenceStopped();  // meanwhile: the step itself is left out
        if (step.kind == Step::Kind::AskNetworks) {
            askNetworks(steps, at);
        } else {
            runStep(step);
        }
        if (stopped) break;
    }
    for (; at < steps.size() && m_watcher != nullptr; ++at) m_watcher->stepLeftOut(steps[at]);
    return !m_instrument.isSequenceStopped();
}

void Transmitter::stop() {
    m_instrument.stopSequence();
}

void Transmitter::runStep(const Step& step) {
    switch (step.kind) {
        case Step::Kind::Parameter:
            m_params.SendParam(step.key, std::string(step.value));
            break;
        case Step::Kind::Identify: {
            m_instrument.Send2Gen("*IDN?");
            const std::string answer = m_instrument.ReadFromGen();
            if (m_watcher != nullptr) m_watcher->stepAnswered(step, answer);
            break;
        }
        case Step::Kind::Close:
            m_instrument.close();
            break;
        case Step::Kind::AskNetworks:
        case Step::Kind::Refused:
            break;
    }
}

/// Asks the question of step `at` and repeats the removal after it for each network of the answer.
void Transmitter::askNetworks(Steps& steps, std::size_t at) {
    const std::string answer = m_instrument.X4_Abfrage(setting::kHeldNetworks.label, setting::kHeldNetworks.key);
    if (m_watcher != nullptr) m_watcher->stepAnswered(steps[at], answer);
    const auto removal = steps.begin() + static_cast<std::ptrdiff_t>(at) + 1;
    if (removal == steps.end()) return;
    Steps removals;
    for (const std::string& network : networksToDelete(answer)) {
        removals.push_back({Step::Kind::Parameter, removal->key, network});
    }
    steps.insert(steps.erase(removal), removals.begin(), removals.end());
}

}  // namespace kdx
