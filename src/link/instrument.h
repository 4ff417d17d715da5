#pragma once

#include <cstdint>
#include <functional>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "link/commandlog.h"
#include "link/traffic.h"
#include "link/visa.h"

namespace kdx {

class Captions;
class Clock;
struct ProgramState;

inline constexpr std::size_t kAnswerLength = 60;     ///< receive buffer: an answer is read in pieces of at most this
inline constexpr std::int16_t kCommandPauseMs = 50;  ///< before every command, between a question and its answer
inline constexpr const char* kNoSessionAnswer = "Offline";  ///< of ReadFromGen while no session has been opened
inline constexpr const char* kReadError = "Error";          ///< of ReadFromGen after a failed read; callers compare

/// The instrument session: every byte to and from the instrument and every log line passes here.
class Instrument {
public:
    /// Shows one failure: the text ("Fehler: " and the status) for a box titled "Interface Error". While a sequence
    /// runs the user may want to stop it: true then. What fails because the user has stopped the sequence is not shown.
    using InterfaceError = std::function<bool(const std::string& text, bool sequenceRuns)>;
    /// @param captions gives the texts 142 ("display"), 143 ("no answer") and 144 ("empty").
    Instrument(Visa& visa, ProgramState& state, const DataFolder& data, const Captions& captions, Clock& clock)
        : log(data), m_visa(visa), m_state(state), m_captions(captions), m_clock(clock) {}

    /// Who shows failures; without one they pass silently.
    void onFailure(InterfaceError interfaceError) { m_interfaceError = std::move(interfaceError); }
    /// Who hears that a run of commands begins (true) and that the outermost one is over (false).
    void onRun(std::function<void(bool begins)> run) { m_run = std::move(run); }
    void addWatcher(TrafficWatcher& watcher) { m_watchers.push_back(&watcher); }
    void removeWatcher(TrafficWatcher& watcher) { std::erase(m_watchers, &watcher); }

    /// Opens the session anew, with a resource manager of its own each time; with 0 it counts as online from here on.
    /// @param kind kLanInterface, anything else for GPIB; @param address exactly as typed.
    VisaStatus open(const std::string& kind, const std::string& address);
    /// Closes the session; a failure stays silent. The handle keeps its value and the instrument counts as online
    /// still: whoever closes keeps commands away from it.
    void close();
    /// Whether a session was opened and not closed since.
    [[nodiscard]] bool isOpen() const { return m_open; }

    /// Writes the command byte for byte. Does nothing while no session has been opened. Any non-zero status is
    /// reported once; there is no retry.
    void Send2Gen(const std::string& command);
    /// Reads one answer: always 60 characters, the answer's bytes followed by blanks; "Error" after a failed read.
    /// While no session has been opened: kNoSessionAnswer, without touching the library.
    std::string ReadFromGen();
    /// Appends a line to the command log when logging is on: the key right-aligned in 15 characters, "= ", the value,
    /// and the note in double quotes unless it is empty. A log that cannot be written is passed over.
    void WriteLog(std::string_view key, std::string_view value, std::string_view note);

    /// Asks the coder for one value; gives its text without quotes and line end, "" after a failed read.
    /// @param label the name under which the query is logged; @param key the coder's query text.
    std::string X4_Abfrage(const std::string& label, const std::string& key);
    /// The same of the generator; `command` is the header without its question mark.
    std::string VRN_Abfrage(const std::string& label, const std::string& command);

    /// Asks with the question as it goes to the instrument; gives the whole answer without line end, or nothing.
    /// @param mayBeSilent no answer in time is no failure: not every instrument knows every question.
    std::optional<std::string> ask(const std::string& question, bool mayBeSilent);
    /// True when the user stopped the running sequence: until it ends nothing is written, read or logged.
    [[nodiscard]] bool isSequenceStopped() const { return m_sequenceStopped; }
    void stopSequence() { m_sequenceStopped = m_sequences > 0; }

    CommandLog log;
    VisaHandle DefaultRm = 0;
    VisaHandle InstrSession = 0;  ///< 0 until opened; closing keeps the old value
    VisaStatus LastVisaStatus = 0;
    std::int32_t LastRetCount = 0;

private:
    friend class CommandSequence;

    void fail();
    [[nodiscard]] bool read(std::string& buffer);
    void notify(Traffic::Kind kind, std::string text, VisaStatus status = 0) const;

    Visa& m_visa;
    ProgramState& m_state;
    const Captions& m_captions;
    Clock& m_clock;
    InterfaceError m_interfaceError;
    std::function<void(bool)> m_run;
    std::vector<TrafficWatcher*> m_watchers;
    bool m_open = false;
    int m_sequences = 0, m_runs = 0;  ///< all, and those that are runs
    bool m_sequenceStopped = false;
};

}  // namespace kdx
