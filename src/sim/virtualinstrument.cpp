#include "sim/virtualinstrument.h"

#include "sim/parameters.h"
#include "sim/scpi.h"
#include "sim/statuscommands.h"

namespace kdx::sim {

namespace {

constexpr std::size_t kLongestAnswer = 65536;

constexpr std::string_view kDirect = "STEReo:DIRect";

}  // namespace

VirtualInstrument::VirtualInstrument(const Clock& clock, std::string identification)
    : m_identification(std::move(identification)), m_coder(clock, m_settings) {}

std::string VirtualInstrument::execute(std::string_view message) {
    std::string answers;
    for (const std::string_view line : splitOutsideQuotes(message, '\n')) answers += executeLine(line);
    return answers;
}

unsigned char VirtualInstrument::statusByte(bool messageAvailable) const {
    return static_cast<unsigned char>(m_status.byte(messageAvailable));
}

std::string VirtualInstrument::executeLine(std::string_view line) {
    std::string answers;
    std::string path;
    bool deadlocked = false;
    for (const std::string_view text : splitOutsideQuotes(line, ';')) {
        if (trimmed(text).empty()) continue;
        m_status.answerBegun = !answers.empty();
        const Reply reply = executeUnit(readUnit(text), path);
        if (reply.error != ScpiError::None) m_status.report(reply.error);
        if (!reply.answer || deadlocked) continue;
        if (!answers.empty()) answers += ';';
        answers += *reply.answer;
        // Nobody can fetch an answer while its question is still being sent: room is limited, and then it is dropped.
        if (answers.size() < kLongestAnswer) continue;
        deadlocked = true;
        answers = std::string();
        m_status.report(ScpiError::QueryDeadlocked);
    }
    return answers.empty() ? answers : answers + '\n';
}

// By SCPI a header without a leading colon continues the path of the command before it on the same line.
Reply VirtualInstrument::executeUnit(const CommandUnit& unit, std::string& path) {
    const bool common = unit.header.starts_with('*');
    const bool fromTheTop = common || unit.header.starts_with(':');
    const std::string header = (fromTheTop ? std::string() : path).append(unit.header);
    const auto found = tryHeader(header, unit);
    if (found && !common) path = header.substr(0, header.rfind(':') + 1);
    Reply reply = found.value_or(Reply{ScpiError::UndefinedHeader, std::nullopt});
    if (m_observer) {
        CommandUnit inFull = unit;
        inFull.header = header;
        m_observer(inFull, reply.error);
    }
    return reply;
}

std::optional<Reply> VirtualInstrument::tryHeader(std::string_view header, const CommandUnit& unit) {
    if (auto reply = statusCommand(header, unit, m_status)) return reply;
    const bool identification = unit.query && headerMatches("*IDN", header);
    const bool resets = !unit.query && headerMatches("*RST", header);
    const bool isDirect = headerMatches(kDirect, header);
    const auto parameter = parameterOfHeader(header);
    if (!identification && !resets && !isDirect && !parameter) return std::nullopt;
    if (isDirect) return direct(unit);
    if (const ScpiError error = checkOneParameter(unit); error != ScpiError::None) return Reply{error, std::nullopt};
    if (parameter && unit.query) return generatorAnswer(*parameter, unit.parameter, m_settings);
    if (parameter) return Reply{setFromGenerator(*parameter, unit.parameter, m_settings), std::nullopt};
    if (!unit.parameter.empty()) return Reply{ScpiError::ParameterNotAllowed, std::nullopt};
    if (identification) return Reply{ScpiError::None, m_identification};
    reset();
    return Reply{};
}

Reply VirtualInstrument::direct(const CommandUnit& unit) {
    if (const ScpiError error = checkOneParameter(unit); error != ScpiError::None) return {error, std::nullopt};
    if (unit.parameter.empty()) return {ScpiError::MissingParameter, std::nullopt};
    const auto text = unquoted(unit.parameter);
    if (!text) return {errorOfString(unit.parameter), std::nullopt};
    if (!unit.query) return {m_coder.command(*text), std::nullopt};
    Reply reply = m_coder.query(*text);
    if (reply.answer) reply.answer = quoted(*reply.answer);
    return reply;
}

// Memories, errors and event bits stay, by IEEE 488.2.
void VirtualInstrument::reset() {
    m_settings = InstrumentSettings();
    m_coder.reset();
}

}  // namespace kdx::sim
