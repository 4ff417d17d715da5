#include <functional>
#include <random>
#include <set>

#include "air/groupbudget.h"
#include "airtest.h"

namespace kdx::air {
namespace {

using What = GroupBudget::What;

/// Listens group by group; true as soon as it has what it waits for.
using Radio = std::function<bool(const Group&)>;

unsigned typeOf(const Group& group) {
    return group.blocks[1] >> 11U;
}
unsigned lastBits(const Group& group, unsigned mask) {
    return group.blocks[1] & mask;
}
bool is(const Group& group, GroupType type) {
    return typeOf(group) == static_cast<unsigned>(type);
}

/// Waits until so many different things have come, of the groups that a name of the thing is given for.
template <typename NameOf>
Radio collector(NameOf nameOfThing, std::size_t count) {
    return [nameOfThing, count, seen = std::set<std::uint64_t>()](const Group& group) mutable {
        if (const auto name = nameOfThing(group)) seen.insert(*name);
        return seen.size() >= count;
    };
}

/// Lists of method A: nothing is understood before the code that counts the frequencies.
class ListHearer {
public:
    void take(std::uint16_t pair) {
        const unsigned upper = pair >> 8U;
        if (upper > 224 && upper < 250) {
            m_list = pair;
            m_left = upper - 225;
        } else {
            m_left -= std::min(m_left, 2U);
        }
        if (m_list && m_left == 0) {
            m_whole.insert(*m_list);
            m_list.reset();
        }
    }
    [[nodiscard]] std::size_t whole() const { return m_whole.size(); }

private:
    std::optional<std::uint16_t> m_list;
    unsigned m_left = 0;
    std::set<std::uint16_t> m_whole;
};

/// What a coder that is set by chance sends, group by group, and what a radio makes of it: nothing here is reckoned.
class GroupBudgetOnTheAir : public AirTest {
protected:
    static constexpr std::size_t kTurns = 34;  ///< twice as many as the longest period of a radiotext
    static constexpr std::size_t kTurnsToEnd = 200;

    int number(int from, int to) { return std::uniform_int_distribution(from, to)(m_random); }
    bool chance() { return number(0, 1) == 1; }

    std::string frequencies() {
        std::string list = "87.6";
        const int count = number(0, 20);
        for (int i = 0; i < count; ++i) list += "," + std::to_string(88 + i) + "." + std::to_string(number(0, 9));
        return list;
    }
    void setByChance() {
        constexpr std::array kNames = {"0A", "0A", "0B", "2A", "2B", "3A", "4A", "8A", "14A", "14B", "15B", "1A"};
        m_ring = static_cast<std::size_t>(number(1, 6));
        std::string sequence;
        for (std::size_t i = 0; i < m_ring; ++i)
            sequence += (i == 0 ? "" : ",") + std::string(kNames.at(static_cast<std::size_t>(number(0, 11))));
        coder("GS=" + sequence);
        m_text = chance() ? static_cast<std::size_t>(number(1, 64)) : 0;
        if (m_text > 0) coder("RT=10,0," + std::string(m_text, 'x'));
        if (chance()) coder("AF=N," + frequencies());
        for (int i = number(0, 2); i > 0; --i) {
            const std::string pi = "D7A" + std::to_string(i);
            coder("EON-PI=" + pi);
            coder("EON-PS=" + pi + ",MESSTURM");
            if (chance()) coder("EON-AFA=" + pi + "," + frequencies());
        }
        if (chance()) coder("3A=01,106100CD46");
        if (chance()) coder("8A=01,0812345678");
    }
    void listen() {
        const std::size_t count = m_ring * (2 * kTurns + kTurnsToEnd);
        for (std::size_t i = 0; i < count; ++i) m_groups.push_back(broadcast.next().group);
    }

    /// What all groups name, counted.
    template <typename NameOf>
    Radio collectorOfAll(NameOf nameOfThing) {
        std::set<std::uint64_t> all;
        for (const Group& group : m_groups) {
            if (const auto name = nameOfThing(group)) all.insert(*name);
        }
        return collector(nameOfThing, all.empty() ? 1 : all.size());
    }
    Radio radioFor(What what) {
        using Name = std::optional<std::uint64_t>;
        switch (what) {
            case What::Ps:
                return collector([](const Group& g) { return typeOf(g) < 2 ? Name(lastBits(g, 3)) : Name(); }, 4);
            case What::AfLists:
                return hearer([](const Group& g) { return is(g, GroupType::Basic0A); }, 1);
            case What::Networks: {
                const auto ofList = [](const Group& g) {
                    return is(g, GroupType::Networks14A) && lastBits(g, 15) == 4;
                };
                const auto other = collectorOfAll([ofList](const Group& g) {
                    if (!is(g, GroupType::Networks14A) || ofList(g)) return Name();
                    return Name(std::uint64_t{lastBits(g, 31)} << 32U | std::uint64_t{g.blocks[2]} << 16U |
                                g.blocks[3]);
                });
                return [lists = hearer(ofList, 0), other](const Group& g) mutable {
                    const bool isWhole = lists(g);
                    return other(g) && isWhole;
                };
            }
            case What::Radiotext:
                return radioForRadiotext();
            case What::TrafficMessage:
                return [announced = false](const Group& g) mutable {
                    announced = announced || is(g, GroupType::OpenData3A);
                    return announced && is(g, GroupType::Traffic8A);
                };
            case What::Ta:
                break;
        }
        return [](const Group& g) { return typeOf(g) < 2 || is(g, GroupType::Tuning15B); };
    }
    /// Waits for all lists that these groups carry, for so many at least.
    template <typename Carries>
    Radio hearer(Carries carries, std::size_t least) {
        ListHearer all;
        for (const Group& group : m_groups) {
            if (carries(group)) all.take(group.blocks[2]);
        }
        return [carries, count = std::max(all.whole(), least), heard = ListHearer()](const Group& group) mutable {
            if (carries(group)) heard.take(group.blocks[2]);
            return heard.whole() >= count;
        };
    }
    Radio radioForRadiotext() const {
        const std::size_t length = std::min<std::size_t>(m_text + 1, 64);
        const auto of = [length](GroupType type, std::size_t size) {
            return collector(
                [type](const Group& g) {
                    return is(g, type) ? std::optional<std::uint64_t>(lastBits(g, 15)) : std::nullopt;
                },
                std::min<std::size_t>((length + size - 1) / size, 16));
        };
        return [by2A = of(GroupType::Radiotext2A, 4), by2B = of(GroupType::Radiotext2B, 2)](const Group& g) {
            const bool isWhole2A = by2A(g);
            return by2B(g) || isWhole2A;
        };
    }

    /// How many groups radios need that tune in at one group after the other; empty when they wait in vain.
    std::vector<std::size_t> needed(const Radio& radio) const {
        std::vector<std::size_t> all;
        for (std::size_t from = kTurns * m_ring; from < 2 * kTurns * m_ring; ++from) {
            Radio fresh = radio;
            std::size_t at = from;
            while (at < m_groups.size() && !fresh(m_groups[at])) ++at;
            if (at == m_groups.size()) return {};
            all.push_back(at + 1 - from);
        }
        return all;
    }
    /// As many of them as it takes until they repeat.
    std::vector<std::size_t> period(const std::vector<std::size_t>& all) const {
        std::size_t length = m_ring;
        while (length < all.size() &&
               !std::equal(all.begin() + static_cast<std::ptrdiff_t>(length), all.end(), all.begin()))
            length += m_ring;
        return {all.begin(), all.begin() + static_cast<std::ptrdiff_t>(length)};
    }

    std::mt19937 m_random;
    std::size_t m_ring = 0;
    std::size_t m_text = 0;
    std::vector<Group> m_groups;
};

class GroupBudgetByChance : public GroupBudgetOnTheAir, public ::testing::WithParamInterface<unsigned> {};

TEST_P(GroupBudgetByChance, IsWhatRadiosFindThatTuneInAtAnyGroup) {
    m_random.seed(GetParam());
    setByChance();
    const GroupBudget budget = groupBudgetOf(broadcast.transmission());
    listen();
    for (const auto& [type, share] : budget.shares) {
        const auto count = std::count_if(m_groups.begin(), m_groups.end(), [t = type](auto& g) { return is(g, t); });
        EXPECT_NEAR(share, static_cast<double>(count) / static_cast<double>(m_groups.size()), 1e-9) << nameOf(type);
    }
    for (const auto& [what, isSet, wait] : budget.items) {
        SCOPED_TRACE(nameOf(what));
        const auto all = isSet ? needed(radioFor(what)) : std::vector<std::size_t>();
        ASSERT_EQ(wait.has_value(), !all.empty());
        if (!wait) continue;
        const Wait found = waitOver(period(all));
        EXPECT_NEAR(wait->mean, found.mean, 1e-9);
        EXPECT_NEAR(wait->worst, found.worst, 1e-9);
    }
}

INSTANTIATE_TEST_SUITE_P(Settings, GroupBudgetByChance, ::testing::Range(0U, 200U));

}  // namespace
}  // namespace kdx::air
