#pragma once

#include <chrono>
#include <fstream>
#include <functional>
#include <memory>
#include <optional>
#include <span>
#include <string>
#include <string_view>

#include "air/composer.h"
#include "air/multiplexfile.h"
#include "simserver/linewriter.h"
#include "simserver/pollloop.h"

namespace kdx {
class Clock;
namespace sim {
class VirtualInstrument;
}
}  // namespace kdx

namespace kdx::simserver {

/// What an instrument sends, in real time: its groups as lines, its multiplex as samples.
class LiveAir {
public:
    /// Where that goes: a file, which is begun anew; "-" for a stream that is lent; "" for nowhere. The samples of a
    /// stream are bare floats of this machine, those of a file a WAV file.
    struct Places {
        std::string groups;
        std::string multiplex;
    };
    using Tell = std::function<void(const std::string& problem)>;

    /// @param clock what the instrument's clock runs by; @param stream a descriptor for "-"; @param tell hears, in
    /// words, of what cannot be sent as it was given, and once of what cannot be written any more.
    /// @throws std::runtime_error when a file cannot be begun.
    LiveAir(PollLoop& loop, const sim::VirtualInstrument& instrument, const Clock& clock, const Places& places,
            int stream, Tell tell);
    LiveAir(const LiveAir&) = delete;
    LiveAir& operator=(const LiveAir&) = delete;
    ~LiveAir();

    /// The instrument has carried out a message.
    void settingsChanged();

private:
    void callAtEndOfGroup();
    void endGroup();
    void sendGroup();
    void writeLine(const std::string& line);
    void writeSamples(const air::OnAir& sent);
    void pass(std::string_view bytes, std::string& place, const char* what);
    void lost(std::string& place);
    /// When the group that is counted ends.
    [[nodiscard]] PollLoop::TimePoint endOf(std::int64_t groups) const;

    PollLoop& m_loop;
    const sim::VirtualInstrument& m_instrument;
    const Clock& m_clock;
    Places m_places;
    Tell m_tell;
    air::Composer m_composer;
    air::AirTime m_time;  ///< when the group under way began
    PollLoop::TimePoint m_begin;
    std::int64_t m_groups = 0;  ///< since then
    std::optional<PollLoop::TimerId> m_timer;
    std::unique_ptr<LineWriter> m_stream;
    std::ofstream m_groupFile;
    std::optional<air::MultiplexFile> m_multiplexFile;
    std::optional<air::Multiplex> m_multiplex;  ///< for the stream
    bool m_tellsOfGaps = true;
};

}  // namespace kdx::simserver
