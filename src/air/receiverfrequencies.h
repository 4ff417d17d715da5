#pragma once

#include <array>
#include <cstddef>
#include <cstdint>
#include <optional>
#include <vector>

namespace kdx::air {

/// Frequencies where the programme is to be found too, as the codes of groups 0A and 14A tell them (IEC 62106,
/// 6.2.1.6). All in kilohertz.
struct FrequencyList {
    struct Alternative {
        int kilohertz = 0;
        bool regional = false;  ///< method B: a programme of the region, which is another one at times
        friend bool operator==(const Alternative&, const Alternative&) = default;
    };
    bool methodB = false;
    int tuned = 0;  ///< of method B: whose list it is; 0 with method A, which does not say
    std::vector<Alternative> alternatives;
    friend bool operator==(const FrequencyList&, const FrequencyList&) = default;
};

/// What a code of the VHF band stands for; 0 for one that is no frequency.
[[nodiscard]] int vhfKilohertz(unsigned code);
/// What a code of long and medium wave stands for; 0 for one that is no frequency.
[[nodiscard]] int amKilohertz(unsigned code);

/// Puts lists together of the pairs of codes, as they come.
class FrequencyLists {
public:
    /// The next pair; nothing when it came with errors, which its list does not survive.
    void take(std::optional<std::uint16_t> pair);
    /// The whole lists, in the order they were first heard. One that is no longer repeated goes.
    [[nodiscard]] std::vector<FrequencyList> lists() const;
    /// The list that became whole last; an empty one before the first.
    [[nodiscard]] const FrequencyList& latest() const { return m_latest; }

private:
    struct Heard {
        FrequencyList list;
        std::size_t count = 0;  ///< of its frequencies, and the first of them: what it begins with
        int first = 0;
        std::array<std::uint64_t, 3> turns{};  ///< the last times that it came, the newest first: counts of lists
    };
    void begin(unsigned count);
    void takeCode(unsigned code);
    void endOfList();
    void breakOff();
    void hearAgain(Heard& heard) const;

    std::vector<int> m_codes;   ///< of the list under way, in kilohertz, one behind the other as they came
    std::size_t m_awaited = 0;  ///< so many make the list whole; 0 while none is under way
    bool m_amFollows = false;
    std::vector<Heard> m_heard;
    FrequencyList m_latest;
    std::uint64_t m_count = 0;
};

}  // namespace kdx::air
