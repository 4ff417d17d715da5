#pragma once

#include <cstdint>
#include <functional>
#include <string>
#include <string_view>

#include "link/visa.h"

namespace kdx {

class Clock;
class DataFolder;
struct ProgramState;

/// Length of the receive buffer: an answer is read in pieces of at most this many bytes.
inline constexpr std::size_t kAnswerLength = 60;
/// Pause before every command and between a question and its answer.
inline constexpr std::int16_t kCommandPauseMs = 50;

/// What passed between the program and the instrument, for whoever wants to watch it.
struct Traffic {
    enum class Kind { Written, Read, Logged };
    Kind kind;
    std::string text;       ///< the command, the answer as read (60 characters) or the log line without its end
    VisaStatus status = 0;  ///< of the write or read
};

/// The command transport: every byte to and from the instrument and every log line passes here.
class Instrument {
public:
    /// Shows one failure: the text ("Fehler: " and the status) for a box titled "Interface Error". While a sequence
    /// runs the user may want to stop it: true then.
    using InterfaceError = std::function<bool(const std::string& text, bool sequenceRuns)>;

    Instrument(Visa& visa, ProgramState& state, DataFolder& data, Clock& clock, InterfaceError interfaceError);

    /// Writes the command byte for byte. Does nothing while no session has been opened. Any non-zero status is
    /// reported once; there is no retry.
    void Send2Gen(const std::string& command);

    /// Reads one answer: always 60 characters, the answer's bytes followed by blanks; "Error" after a failed read.
    /// While no session has been opened: kNoSessionAnswer, without touching the library.
    std::string ReadFromGen();

    /// Appends one line to the command log when logging is on: the key right-aligned in 15 characters, "= ", the
    /// value, and the note in double quotes unless it is empty. A log that cannot be written is passed over.
    void WriteLog(std::string_view key, std::string_view value, std::string_view note);

    /// Empties the command log; creates it when missing.
    void emptyLog();

    /// Asks the coder for one value; gives its text without quotes and line end, "" after a failed read.
    /// @param label the name under which the query is logged; @param key the coder's query text.
    std::string X4_Abfrage(const std::string& label, const std::string& key);

    /// Asks the generator for one value; `command` is the header without its question mark.
    std::string VRN_Abfrage(const std::string& label, const std::string& command);

    /// Hears of everything written, read and logged (logged: also while the log file is off).
    void onTraffic(std::function<void(const Traffic&)> observer) { m_observer = std::move(observer); }
    /// Where the query texts 142 ("display"), 143 ("no answer") and 144 ("empty") come from.
    void setCaptionSource(std::function<std::string(int)> captions) { m_caption = std::move(captions); }

    [[nodiscard]] Visa& visa() { return m_visa; }

    /// True when the user stopped the running sequence: until it ends nothing is written, read or logged.
    [[nodiscard]] bool isSequenceStopped() const { return m_sequenceStopped; }

    VisaHandle DefaultRm = 0;
    VisaHandle InstrSession = 0;  ///< 0 until opened; closing keeps the old value
    VisaStatus LastVisaStatus = 0;
    std::int32_t LastRetCount = 0;

private:
    friend class CommandSequence;

    void fail();
    void notify(Traffic::Kind kind, std::string text, VisaStatus status = 0) const;
    [[nodiscard]] std::string caption(int number) const;

    Visa& m_visa;
    ProgramState& m_state;
    DataFolder& m_data;
    Clock& m_clock;
    InterfaceError m_interfaceError;
    std::function<void(const Traffic&)> m_observer;
    std::function<std::string(int)> m_caption;
    int m_sequences = 0;
    bool m_sequenceStopped = false;
};

/// While one of these lives, the commands sent and the values asked belong together: a whole data set, or the questions
/// of one button. When the instrument has gone away in the middle, the user can stop the rest at the first box.
class CommandSequence {
public:
    explicit CommandSequence(Instrument& instrument);
    ~CommandSequence();
    CommandSequence(const CommandSequence&) = delete;
    CommandSequence& operator=(const CommandSequence&) = delete;

private:
    Instrument& m_instrument;
};

/// What ReadFromGen gives while no session has been opened.
inline constexpr const char* kNoSessionAnswer = "Offline";
/// What ReadFromGen gives after a failed read; callers compare with it.
inline constexpr const char* kReadError = "Error";

}  // namespace kdx
