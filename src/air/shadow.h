#pragma once

#include <cstddef>
#include <cstdint>
#include <deque>
#include <map>
#include <memory>
#include <string>
#include <string_view>
#include <vector>

#include "air/airtime.h"
#include "air/composer.h"
#include "air/receiver.h"
#include "sim/virtualinstrument.h"

namespace kdx::air {

/// What went out for the length of a group.
struct Sent {
    OnAir what;
    AirTime end;
    std::shared_ptr<const sim::InstrumentSettings> settings;  ///< that held then
};

/// A virtual instrument that is told everything that an instrument is, and a radio tuned to it. While nobody looks,
/// commands are carried out and nothing is sent; who looks then finds the radio tuned in a moment ago.
class Shadow {
public:
    /// So much is kept, some seventeen seconds.
    static constexpr std::size_t kMostKept = 200;

    /// @param clock what the instrument and the radio live by; outlives both.
    explicit Shadow(const Clock& clock);
    Shadow(const Shadow&) = delete;
    Shadow& operator=(const Shadow&) = delete;

    /// Carries a command out, refused ones included.
    void take(std::string_view command);
    /// While somebody looks, what goes out between two commands is sent with the settings that held then.
    void setWatched(bool watched) { m_watched = watched; }
    /// Sends what went out since the last time. After a long time only the end of it counts, and the radio begins anew.
    void catchUp();

    [[nodiscard]] const RadioState& radio() const { return m_radio.state(); }
    /// The latest that went out, the oldest first.
    [[nodiscard]] const std::deque<Sent>& sent() const { return m_sent; }
    /// How much went out since the program began.
    [[nodiscard]] std::uint64_t count() const { return m_count; }

    struct Type {
        std::size_t count = 0;
        Group latest;
    };
    /// The groups among what is kept, by their types.
    [[nodiscard]] const std::map<GroupType, Type>& types() const { return m_types; }

    [[nodiscard]] sim::Transmission transmission() const { return m_instrument.transmission(); }
    /// Counts the commands: what depends on the settings alone is the same while this is.
    [[nodiscard]] std::uint64_t commands() const { return m_commands; }
    /// What cannot be sent as the settings have it, and the commands that were refused and not sent better since, in
    /// words (UTF-8).
    [[nodiscard]] std::vector<std::string> warnings() const;
    /// Whether the coder refused the value when the setting was last to have it ("PI", "EON-PS D7A2").
    [[nodiscard]] bool isRefused(std::string_view setting, std::string_view value) const;

private:
    struct Refusal {
        std::string setting;
        std::string command;
        std::string text;  ///< in words
    };
    void refuse(const std::string& text);
    void forgetRefused();
    void begin(AirTime from);
    void sendOne();
    void count(const Sent& sent, bool comes);

    const Clock& m_clock;
    sim::VirtualInstrument m_instrument;
    Composer m_composer{nullptr};
    Receiver m_radio;
    AirTime m_time;  ///< when the next group begins
    bool m_watched = false;
    bool m_stale = false;  ///< commands came while nobody looked
    std::deque<Sent> m_sent;
    std::map<GroupType, Type> m_types;
    std::uint64_t m_count = 0;
    std::uint64_t m_commands = 0;
    std::size_t m_silence = 0;  ///< so long no group went out
    std::shared_ptr<const sim::InstrumentSettings> m_settings;
    std::vector<Refusal> m_refused;
    std::string m_message;  ///< under way
    bool m_isRefused = false;
};

}  // namespace kdx::air
