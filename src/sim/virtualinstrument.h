#pragma once

#include <functional>
#include <optional>
#include <string>
#include <string_view>
#include <utility>

#include "sim/coder.h"
#include "sim/errorqueue.h"
#include "sim/messagedevice.h"
#include "sim/setup.h"
#include "sim/status.h"

namespace kdx {
class Clock;
}

namespace kdx::sim {

struct CommandUnit;

inline constexpr const char* kDefaultIdentification = "KDX,KDX-X4,100001,1.00";

/// The virtual generator with its stereo/RDS coder: reads program messages as the instrument does, keeps its state,
/// answers its queries. Used inside the program and, over VXI-11, by the kdx-sim program. One call at a time: threads
/// that share it take turns.
class VirtualInstrument : public MessageDevice {
public:
    /// @param clock what the coder's clock time runs by; must outlive the instrument.
    /// @param identification the answer to "*IDN?", without its line end.
    explicit VirtualInstrument(const Clock& clock, std::string identification = kDefaultIdentification);
    VirtualInstrument(const VirtualInstrument&) = delete;
    VirtualInstrument& operator=(const VirtualInstrument&) = delete;

    /// Carries out one program message (several commands may be joined by ";"), its line end left off or not.
    /// @returns the answer with its line feed, or "" when the message asked nothing. Errors go to the error queue.
    /// Several answers of one line are joined by ";"; beyond 64 KiB there are none at all, and -430. A message of
    /// several lines is several messages.
    std::string execute(std::string_view message) override;

    /// What goes on the air.
    [[nodiscard]] Transmission transmission() const { return m_coder.transmission(); }

    /// Hears of every command once it has been carried out or refused, its header in full.
    using UnitObserver = std::function<void(const CommandUnit& unit, ScpiError error)>;
    void onUnit(UnitObserver observer) { m_observer = std::move(observer); }

    /// A device clear: ends whatever the instrument is still doing for its clients, and by IEEE 488.2 leaves settings,
    /// memories, errors and event bits alone. Every command is complete when execute returns, so nothing is left to
    /// end here; unread answers and half-received messages are the transport's to drop.
    void clear() override {}

    /// Queues an error, also one that only the transport notices (a client reads though nothing was asked: -420).
    void report(ScpiError error) override { m_status.report(error); }

    /// The status byte of IEEE 488.2, see Status.
    [[nodiscard]] unsigned char statusByte(bool messageAvailable) const override;

private:
    std::string executeLine(std::string_view line);
    Reply executeUnit(const CommandUnit& unit, std::string& path);
    std::optional<Reply> tryHeader(std::string_view header, const CommandUnit& unit);
    Reply direct(const CommandUnit& unit);
    void reset();

    std::string m_identification;
    InstrumentSettings m_settings;
    Coder m_coder;
    Status m_status;
    UnitObserver m_observer;
};

}  // namespace kdx::sim
