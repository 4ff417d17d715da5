#pragma once

#include <cstdint>
#include <functional>
#include <optional>
#include <set>
#include <string>
#include <string_view>
#include <utility>

namespace kdx {

class Clock;
class Instrument;
struct ProgramState;

/// What composing a command can see besides the key and the value.
struct ParamContext {
    std::string eonIdentifier;  ///< PI of the other network: leads every per-network EON command
    std::string clockText;      ///< caption of `Uhr_Zeit`: the time that "UHR" sends
    std::string time;           ///< PC clock, hh:mm:ss
    std::string date;           ///< PC clock, DD.MM.YY
};

/// Composes the instrument command for a key and its value, exactly as it is sent.
/// @param value rewritten for "PI" only: padded with blanks or cut to 4 characters.
/// @returns nothing for a key that has no command (unknown keys, "NFShape Sinus", "DS"); an empty text for a listed
/// key with a value that is not among its choices.
/// @throws std::overflow_error when a deviation times 10 is too large for a number.
[[nodiscard]] std::optional<std::string> composeCommand(std::string_view key, std::string& value,
                                                        const ParamContext& context);

/// The coder's command as the generator passes it on: inside ":STEREO:DIRECT " and double quotes.
[[nodiscard]] std::string coderCommand(std::string_view command);

/// The command with the double quotes inside its text doubled, as IEEE 488.2 has it; others stay as they are.
[[nodiscard]] std::string quotesDoubled(std::string_view command);

/// Whether a text in the command holds a double quote that is not doubled: the coder takes the text for ended there and
/// the instrument refuses the rest, or takes it for a command of its own.
[[nodiscard]] bool endsItsTextEarly(std::string_view command);

/// Whether the command's text for the coder lacks its end, as when only the beginning was kept.
[[nodiscard]] bool leavesItsTextOpen(std::string_view command);

/// Whether the key table has a row for the key.
[[nodiscard]] bool isParameter(std::string_view key);

/// The single place where a named parameter becomes text for the instrument.
class ParamSender {
public:
    /// @param endProgram ends the application at once (key "DS").
    ParamSender(Instrument& instrument, ProgramState& state, Clock& clock, std::function<void()> endProgram);

    /// Composes the command (its quotes doubled where that is corrected), logs it, waits 50 ms and writes it. Unknown
    /// keys and "NFShape Sinus" do nothing at all.
    /// @param value see composeCommand; @param extra1 used by "DS" only; @param extra2 not used;
    /// @param mode one program-wide setting, without effect on what is sent.
    void SendParam(const std::string& key, std::string& value, const std::string& extra1, const std::string& extra2,
                   std::int16_t& mode);

    /// The same for the program's usual call: no extras, the program-wide mode. The value is rewritten for "PI" only.
    void SendParam(const std::string& key, std::string& value);
    /// The same for a value that nobody keeps.
    void SendParam(const std::string& key, std::string&& value);

    /// The command that SendParam writes now for key and value; see composeCommand.
    [[nodiscard]] std::optional<std::string> compose(const std::string& key, std::string& value) const;

    /// Logs a composed command under the key, waits 50 ms and writes it.
    void sendCommand(const std::string& key, const std::string& command);

    /// Keys whose value went out last with a double quote in it.
    [[nodiscard]] const std::set<std::string>& quotedKeys() const { return m_quotedKeys; }
    /// Hears of every command that is to be written, whether there is a session or not.
    void onComposed(std::function<void(const std::string& command)> callback) { m_composed = std::move(callback); }

    /// Hears of every command that was written in a session, and whether it arrived as far as the link can tell.
    void onWritten(std::function<void(const std::string& key, const std::string& command, bool arrived)> callback) {
        m_written = std::move(callback);
    }

    /// Called whenever quotedKeys() changes.
    void onQuotedKeysChanged(std::function<void()> callback) { m_quotedKeysChanged = std::move(callback); }

private:
    void noteQuotes(const std::string& key, std::string_view command);

    Instrument& m_instrument;
    ProgramState& m_state;
    Clock& m_clock;
    std::function<void()> m_endProgram;
    std::set<std::string> m_quotedKeys;
    std::function<void()> m_quotedKeysChanged;
    std::function<void(const std::string&)> m_composed;
    std::function<void(const std::string&, const std::string&, bool)> m_written;
};

}  // namespace kdx
