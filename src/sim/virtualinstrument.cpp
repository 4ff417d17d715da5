#include "sim/virtualinstrument.h"

#include <algorithm>
#include <array>

#include "sim/parameters.h"
#include "sim/scpi.h"

namespace kdx::sim {

namespace {

// IEEE 488.2, standard event status register.
constexpr unsigned char kOperationComplete = 1;
constexpr unsigned char kQueryError = 4;
constexpr unsigned char kDeviceError = 8;
constexpr unsigned char kExecutionError = 16;
constexpr unsigned char kCommandError = 32;
constexpr unsigned char kPowerOn = 128;

// Status byte.
constexpr unsigned char kErrorsQueued = 4;
constexpr unsigned char kMessageAvailable = 16;
constexpr unsigned char kEventSummary = 32;
constexpr unsigned char kErrorEvents = kQueryError | kDeviceError | kExecutionError | kCommandError;

constexpr std::size_t kLongestAnswer = 65536;

constexpr std::string_view kDirect = "STEReo:DIRect";

unsigned char eventOf(ScpiError error) {
    const int hundreds = -static_cast<int>(error) / 100;
    constexpr std::array<unsigned char, 5> kEvents = {0, kCommandError, kExecutionError, kDeviceError, kQueryError};
    return kEvents[static_cast<std::size_t>(hundreds)];
}

}  // namespace

/// A command or query about the instrument itself, without parameters.
struct VirtualInstrument::SystemRow {
    std::string_view header;
    bool query;
    std::optional<std::string> (*run)(VirtualInstrument& self);
};

const VirtualInstrument::SystemRow* VirtualInstrument::systemRow(std::string_view header, bool query) {
    using Self = VirtualInstrument&;
    using Answer = std::optional<std::string>;
    static constexpr std::array kRows = {
        SystemRow{"*IDN", true, [](Self self) -> Answer { return self.m_identification; }},
        SystemRow{"*RST", false, [](Self self) -> Answer { return self.reset(), std::nullopt; }},
        SystemRow{"*CLS", false, [](Self self) -> Answer { return self.clearStatus(), std::nullopt; }},
        SystemRow{"*OPC", false, [](Self self) -> Answer { return self.m_events |= kOperationComplete, std::nullopt; }},
        SystemRow{"*OPC", true, [](Self) -> Answer { return "1"; }},
        SystemRow{"*ESR", true, [](Self self) -> Answer { return self.takeEvents(); }},
        SystemRow{"*STB", true, [](Self self) -> Answer { return std::to_string(self.statusByte()); }},
        SystemRow{"SYSTem:ERRor", true, [](Self self) -> Answer { return self.m_errors.pop(); }},
        SystemRow{"SYSTem:ERRor:NEXT", true, [](Self self) -> Answer { return self.m_errors.pop(); }},
    };
    const auto row = std::find_if(kRows.begin(), kRows.end(), [&](const SystemRow& r) {
        return r.query == query && headerMatches(r.header, header);
    });
    return row == kRows.end() ? nullptr : &*row;
}

VirtualInstrument::VirtualInstrument(const Clock& clock, std::string identification)
    : m_identification(std::move(identification)), m_coder(clock, m_settings), m_events(kPowerOn) {}

std::string VirtualInstrument::execute(std::string_view message) {
    std::string answers;
    for (const std::string_view line : splitOutsideQuotes(message, '\n')) answers += executeLine(line);
    return answers;
}

unsigned char VirtualInstrument::statusByte(bool messageAvailable) const {
    return static_cast<unsigned char>((m_errors.empty() ? 0 : kErrorsQueued) |
                                      (messageAvailable ? kMessageAvailable : 0) |
                                      ((m_events & kErrorEvents) == 0 ? 0 : kEventSummary));
}

std::string VirtualInstrument::executeLine(std::string_view line) {
    std::string answers;
    std::string path;
    bool deadlocked = false;
    for (const std::string_view text : splitOutsideQuotes(line, ';')) {
        if (trimmed(text).empty()) continue;
        const Reply reply = executeUnit(readUnit(text), path);
        if (reply.error != ScpiError::None) report(reply.error);
        if (!reply.answer || deadlocked) continue;
        if (!answers.empty()) answers += ';';
        answers += *reply.answer;
        // Nobody can fetch an answer while its question is still being sent: room is limited, and then it is dropped.
        if (answers.size() < kLongestAnswer) continue;
        deadlocked = true;
        answers = std::string();
        report(ScpiError::QueryDeadlocked);
    }
    return answers.empty() ? answers : answers + '\n';
}

// By SCPI a header without a leading colon continues the path of the command before it on the same line. Where that
// leads nowhere it is taken from the top: the generator's commands come with and without the colon.
Reply VirtualInstrument::executeUnit(const CommandUnit& unit, std::string& path) {
    const std::string header(unit.header);
    std::string found = path + header;
    std::optional<Reply> reply;
    if (!path.empty() && !header.empty() && header.front() != ':' && header.front() != '*') {
        reply = tryHeader(found, unit);
    }
    if (!reply) {
        found = header;
        reply = tryHeader(found, unit);
    }
    if (!reply) return {ScpiError::UndefinedHeader, std::nullopt};
    if (found.front() != '*') path = found.substr(0, found.rfind(':') + 1);
    return *reply;
}

std::optional<Reply> VirtualInstrument::tryHeader(std::string_view header, const CommandUnit& unit) {
    if (const SystemRow* row = systemRow(header, unit.query)) {
        if (!unit.parameter.empty()) return Reply{ScpiError::ParameterNotAllowed, std::nullopt};
        return Reply{ScpiError::None, row->run(*this)};
    }
    if (headerMatches(kDirect, header)) return direct(unit);
    const auto parameter = parameterOfHeader(header);
    if (!parameter) return std::nullopt;
    if (!unit.query) return Reply{setFromGenerator(*parameter, unit.parameter, m_settings), std::nullopt};
    if (!unit.parameter.empty()) return Reply{ScpiError::ParameterNotAllowed, std::nullopt};
    return Reply{ScpiError::None, generatorAnswer(*parameter, m_settings)};
}

Reply VirtualInstrument::direct(const CommandUnit& unit) {
    if (unit.parameter.empty()) return {ScpiError::MissingParameter, std::nullopt};
    const auto text = unquoted(unit.parameter);
    if (!text) return {ScpiError::InvalidString, std::nullopt};
    if (!unit.query) return {m_coder.command(*text), std::nullopt};
    Reply reply = m_coder.query(*text);
    if (reply.answer) reply.answer = quoted(*reply.answer);
    return reply;
}

void VirtualInstrument::report(ScpiError error) {
    m_errors.push(error);
    m_events |= eventOf(error);
}

// Memories, errors and event bits stay, by IEEE 488.2.
void VirtualInstrument::reset() {
    m_settings = InstrumentSettings();
    m_coder.reset();
}

void VirtualInstrument::clearStatus() {
    m_errors.clear();
    m_events = 0;
}

std::string VirtualInstrument::takeEvents() {
    std::string events = std::to_string(m_events);
    m_events = 0;
    return events;
}

}  // namespace kdx::sim
