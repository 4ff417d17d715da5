#pragma once

#include <array>
#include <chrono>
#include <cstddef>
#include <cstdint>
#include <optional>
#include <string_view>
#include <vector>

#include "air/airtime.h"
#include "air/frequencies.h"
#include "air/group.h"
#include "air/networks.h"
#include "air/radiotext.h"
#include "air/warnings.h"
#include "sim/transmission.h"

namespace kdx::air {

/// What the coder sends for the length of a group.
struct OnAir {
    enum class Kind { Nothing, Pattern, Group };
    Kind kind = Kind::Nothing;
    Group group;
    std::uint8_t pattern = 0;  ///< eight data bits that are repeated
};

/// Makes groups of the coder's settings (IEC 62106), one at a time.
class Composer {
public:
    explicit Composer(Warn warn) : m_warnings(std::move(warn)) {}

    /// Takes over the settings: before the first group, and after every command, as each change of another network's TA
    /// is announced.
    void take(const sim::Transmission& transmission);

    /// What comes next. @param start when it goes out, by the clock that the instrument runs by.
    [[nodiscard]] OnAir next(AirTime start);

private:
    /// Five bits of block 2 and two blocks, as "3A=" and "8A=" give them.
    struct Given {
        std::uint8_t bits = 0;
        std::uint16_t block3 = 0;
        std::uint16_t block4 = 0;
    };
    [[nodiscard]] static std::optional<Given> given(std::string_view message);
    void takeProgramme(const sim::Setup& setup);
    [[nodiscard]] std::optional<Group> clockGroup(AirTime start) const;
    [[nodiscard]] Group groupOfSlot(GroupType type);
    [[nodiscard]] Group basic(GroupType type);
    [[nodiscard]] Group radiotext(GroupType type);
    [[nodiscard]] Group fastTuning();
    [[nodiscard]] Group networks14A(const Networks::Part& part) const;
    [[nodiscard]] Group networks14B(const Networks::Part& part) const;
    [[nodiscard]] Group ofGiven(GroupType type, const Given& message) const;
    [[nodiscard]] std::uint16_t block2(GroupType type, unsigned bits) const;
    [[nodiscard]] unsigned flagsOf(std::size_t segment) const;

    Warnings m_warnings;
    OnAir::Kind m_kind = OnAir::Kind::Nothing;
    bool m_begun = false;
    std::uint8_t m_pattern = 0;
    std::optional<std::chrono::milliseconds> m_clockLead;
    std::uint16_t m_pi = 0;
    std::uint16_t m_common = 0;  ///< TP and PTY at their places in block 2
    unsigned m_announcementAndMusic = 0;
    unsigned m_decoderInfo = 0;
    std::array<std::uint8_t, kPsLength> m_ps{};
    std::size_t m_psSegment = 0;
    std::size_t m_tuningSegment = 0;
    AlternativeFrequencies m_frequencies;
    Radiotext m_radiotext;
    Networks m_networks;
    std::optional<Given> m_openData;
    std::optional<Given> m_traffic;
    std::vector<GroupType> m_ring;
    std::size_t m_slot = 0;
};

}  // namespace kdx::air
