#include "link/instrument.h"

#include <array>

#include "base/clock.h"
#include "base/numbers.h"
#include "link/coderquestion.h"
#include "link/commandsequence.h"
#include "link/resource.h"
#include "settings/captions.h"
#include "settings/programstate.h"

namespace kdx {

namespace {

constexpr std::size_t kLogKeyWidth = 15;

std::string cutAtLineFeed(const std::string& answer) {
    return answer.substr(0, answer.find('\n'));
}

}  // namespace

VisaStatus Instrument::open(const std::string& kind, const std::string& address) {
    LastVisaStatus = m_visa.viOpenDefaultRM(DefaultRm);
    std::string description;  // asked for and not shown; its status takes the place of the manager's
    LastVisaStatus = m_visa.viStatusDesc(DefaultRm, LastVisaStatus, description);
    const std::string resource = resourceText(isLan(kind) ? Resource::Kind::Lan : Resource::Kind::Gpib, address);
    LastVisaStatus = m_visa.viOpen(DefaultRm, resource, 0, 0, InstrSession);
    if (LastVisaStatus == 0) {
        m_state.InstrumentOnline = m_open = true;
    } else if (LastVisaStatus > 0 && InstrSession != 0) {
        // A warning counts as a failure here, but the library has opened it.
        m_visa.viClose(InstrSession);
        m_open = false;
    }
    return LastVisaStatus;
}

void Instrument::close() {
    m_open = false;
    LastVisaStatus = m_visa.viClose(InstrSession);
}

void Instrument::Send2Gen(const std::string& command) {
    if (!m_state.InstrumentOnline || m_sequenceStopped) return;
    LastVisaStatus = m_visa.viWrite(InstrSession, command, LastRetCount);
    notify(Traffic::Kind::Written, command, LastVisaStatus);
    // Stricter than a read: whatever is not plain success may mean that the coder did not get the command.
    if (LastVisaStatus != 0) fail();
}

std::string Instrument::ReadFromGen() {
    if (!m_state.InstrumentOnline) return kNoSessionAnswer;
    if (m_sequenceStopped) return kReadError;
    std::string answer(kAnswerLength, ' ');
    if (read(answer)) return answer;
    fail();
    return kReadError;
}

/// A completed read normally reports a positive completion code (count reached, terminator seen): no failure.
bool Instrument::read(std::string& buffer) {
    LastVisaStatus = m_visa.viRead(InstrSession, buffer, LastRetCount);
    notify(Traffic::Kind::Read, buffer, LastVisaStatus);
    return LastVisaStatus >= 0;
}

std::optional<std::string> Instrument::ask(const std::string& question, bool mayBeSilent) {
    constexpr std::size_t kLongestAnswer = 65536;  // one that never ends is none
    if (m_sequenceStopped) return std::nullopt;
    Send2Gen(question);
    WriteLog("", question, "");
    WaitMs(m_clock, kCommandPauseMs);
    std::string answer;
    do {
        if (!m_state.InstrumentOnline || m_sequenceStopped) return std::nullopt;
        std::string piece(kAnswerLength, ' ');
        if (!read(piece)) {
            if (LastVisaStatus != visa::kTimeout || !mayBeSilent) fail();
            return std::nullopt;
        }
        answer += piece.substr(0, static_cast<std::size_t>(LastRetCount));
    } while (LastVisaStatus == visa::kMaxCountReached && answer.size() < kLongestAnswer);
    answer = cutAtLineFeed(answer);
    if (answer.ends_with('\r')) answer.pop_back();
    WriteLog("", "Answer ", answer);
    return answer;
}

void Instrument::WriteLog(std::string_view key, std::string_view value, std::string_view note) {
    if (m_sequenceStopped || (!m_state.LogEnabled && m_watchers.empty())) return;
    std::string line = rightmost(std::string(20, ' ').append(key), kLogKeyWidth);
    line.append("= ").append(value);
    if (!note.empty()) line.append("\"").append(note).append("\"");
    if (m_state.LogEnabled) log.append(line);
    notify(Traffic::Kind::Logged, line);
}

std::string Instrument::X4_Abfrage(const std::string& label, const std::string& key) {
    if (m_sequenceStopped) return {};
    Send2Gen(coderQuestion(key));
    WriteLog(label, ":STEREO:DIRECT? ", key);
    WaitMs(m_clock, kCommandPauseMs);
    const std::string answer = ReadFromGen();
    WriteLog(label, "Answer ", answer);
    if (answer == kReadError) return {};
    // The empty test comes before the cut here, and after it in VRN_Abfrage: a bare line feed shows as empty text.
    std::string shown = answer.empty() ? key + " " + m_captions.text(143) : answer;
    shown = cutAtLineFeed(shown);
    if (shown.size() > 1) {
        if (shown[1] == '"') {
            shown = key + ": " + m_captions.text(144) + " | ";  // the coder answered with an empty quoted text
        } else {
            shown = shown.substr(1, shown.size() - 2);
        }
    }
    WriteLog(m_captions.text(142), shown, "");
    return shown;
}

std::string Instrument::VRN_Abfrage(const std::string& label, const std::string& command) {
    if (m_sequenceStopped) return {};
    Send2Gen(command + "?");
    WriteLog(label, ":? ", command);
    WaitMs(m_clock, kCommandPauseMs);
    const std::string answer = ReadFromGen();
    WriteLog(label, "Answer ", answer);
    if (answer == kReadError) return {};
    std::string shown = cutAtLineFeed(answer);
    if (shown.empty()) shown = command + " " + m_captions.text(143);
    WriteLog(m_captions.text(142), shown, "");
    return shown;
}

void Instrument::fail() {
    const bool sequenceRuns = m_sequences > 0;
    if (!m_interfaceError || m_sequenceStopped) return;
    const bool stop = m_interfaceError("Fehler: " + std::to_string(LastVisaStatus), sequenceRuns);
    if (stop && sequenceRuns) m_sequenceStopped = true;
}

void Instrument::notify(Traffic::Kind kind, std::string text, VisaStatus status) const {
    const Traffic traffic{kind, std::move(text), status};
    for (TrafficWatcher* watcher : m_watchers) watcher->passed(traffic);
}

CommandSequence::CommandSequence(Instrument& instrument, Kind kind) : m_instrument(instrument), m_kind(kind) {
    ++m_instrument.m_sequences;
    if (m_kind == Kind::Run && m_instrument.m_runs++ == 0 && m_instrument.m_run) m_instrument.m_run(true);
}

CommandSequence::~CommandSequence() {
    if (m_kind == Kind::Run && --m_instrument.m_runs == 0 && m_instrument.m_run) m_instrument.m_run(false);
    if (--m_instrument.m_sequences == 0) m_instrument.m_sequenceStopped = false;
}

}  // namespace kdx
