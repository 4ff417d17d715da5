#pragma once

#include <array>
#include <chrono>
#include <cstdint>
#include <optional>
#include <string>
#include <vector>

#include "air/receiverblocks.h"
#include "air/receiverfrequencies.h"
#include "air/receivernetworks.h"
#include "air/receivertrafficchannel.h"
#include "coder/fieldsizes.h"

namespace kdx::air {

/// What a radio shows. What was not heard yet is empty. Characters are codes; shownText() has their text.
struct RadioState {
    struct ClockTime {
        std::chrono::sys_time<std::chrono::minutes> utc;
        std::chrono::minutes offset{0};  ///< of the local time
        std::uint32_t modifiedJulianDay = 0;

        [[nodiscard]] std::chrono::local_time<std::chrono::minutes> local() const {
            return std::chrono::local_time<std::chrono::minutes>{(utc + offset).time_since_epoch()};
        }
    };
    std::uint64_t groups = 0;
    std::optional<std::uint16_t> pi;
    std::array<std::uint8_t, kPsLength> ps{' ', ' ', ' ', ' ', ' ', ' ', ' ', ' '};  ///< as the display stands now
    std::optional<int> pty;
    std::optional<bool> tp, ta, music;
    std::array<std::optional<bool>, 4> decoderInfo;  ///< d3 first
    std::optional<bool> radiotextB;                  ///< the flag
    std::array<std::uint8_t, kRadiotextLength> radiotext{};
    std::uint64_t radiotextHeard = 0;  ///< a bit for each character that came since the flag changed
    std::vector<FrequencyList> frequencies;
    std::optional<ClockTime> clock;
    std::vector<ReceivedNetwork> networks;
    ReceivedTraffic traffic;

    /// The display's eight cells (UTF-8).
    [[nodiscard]] std::string psText() const;
    /// Up to the end mark, or what came so far; blanks where a part is missing (UTF-8).
    [[nodiscard]] std::string radiotextText() const;
    /// Whether all of it has come.
    [[nodiscard]] bool isRadiotextWhole() const;
    /// The number of the four bits; nothing until all have come.
    [[nodiscard]] std::optional<int> decoderInfoNumber() const;
};

/// A radio: makes of groups what it shows (IEC 62106, the receiver's side).
class Receiver {
public:
    /// Takes a group; blocks that are missing take along only what was in them. Another PI counts when it comes a
    /// second time: the radio begins anew then.
    void take(const ReceivedGroup& group);
    [[nodiscard]] const RadioState& state() const { return m_state; }

private:
    void decode(const ReceivedGroup& group);
    void decodeType(unsigned type, unsigned bits, const ReceivedGroup& group);
    void takeBasic(unsigned type, unsigned bits, const ReceivedGroup& group);
    void takeFlags(unsigned bits);
    void takeRadiotext(unsigned bits, std::size_t place, std::optional<std::uint16_t> characters);
    void takeClock(unsigned bits, const ReceivedGroup& group);
    void takeNetworks(unsigned type, unsigned bits, const ReceivedGroup& group);
    void takeOpenData(unsigned type, unsigned bits, const ReceivedGroup& group);

    RadioState m_state;
    FrequencyLists m_frequencies;
    ReceivedNetworks m_networks;
    TrafficChannel m_traffic;
    std::optional<ReceivedGroup> m_ofOtherPi;
};

}  // namespace kdx::air
