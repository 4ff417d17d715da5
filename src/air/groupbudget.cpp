#include "air/groupbudget.h"

#include <algorithm>
#include <array>
#include <cmath>
#include <map>
#include <set>

#include "air/frequencies.h"
#include "air/groupring.h"
#include "air/networks.h"
#include "air/radiotext.h"
#include "base/numbers.h"
#include "coder/fieldsizes.h"
#include "sim/transmission.h"

namespace kdx::air {

namespace {

using What = GroupBudget::What;

constexpr std::size_t kPsSegments = 4;
constexpr std::size_t kCharactersOf2A = 4;
constexpr std::size_t kCharactersOf2B = 2;
constexpr std::size_t kLongestTextOf2B = 32;
constexpr double kNoticedSeconds = 1;
constexpr double kLongestNetworksSeconds = 120;  // IEC 62106, 6.2.1.8

/// Reckons the budget of settings that make groups go out.
class Reckoning {
public:
    explicit Reckoning(const sim::Transmission& transmission);
    void addShares(GroupBudget& budget) const;
    void addItems(GroupBudget& budget) const;
    void addWarnings(GroupBudget& budget) const;

private:
    [[nodiscard]] bool hasData(GroupType type) const;
    [[nodiscard]] bool isNamed(GroupType type) const;
    [[nodiscard]] bool isSent(GroupType type) const;
    [[nodiscard]] bool isSet(What what) const;
    [[nodiscard]] std::optional<Wait> waitFor(What what) const;
    [[nodiscard]] std::optional<Wait> trafficWait() const;

    const sim::Transmission& m_transmission;
    AlternativeFrequencies m_frequencies;
    Radiotext m_radiotext;
    Networks m_networks;
    std::vector<GroupType> m_named;  ///< the slots as the sequence has them
    std::vector<GroupType> m_ring;   ///< what goes out in them
};

Reckoning::Reckoning(const sim::Transmission& transmission) : m_transmission(transmission) {
    const sim::Setup& setup = transmission.settings;
    Warnings toldElsewhere(nullptr);  // what cannot be sent as it is given is not the budget's business
    m_frequencies.take(setup.afLists, toldElsewhere);
    m_radiotext.take(setup.radiotext, setup.radiotextNumbers, toldElsewhere);
    m_networks.take(setup.otherNetworks.networks(), false, toldElsewhere);
    m_ring = groupRing(setup.groupSequence);
    m_named = namedSlots(setup.groupSequence).value_or(m_ring);
    std::replace_if(
        m_ring.begin(), m_ring.end(), [this](GroupType type) { return !hasData(type); }, GroupType::Basic0A);
}

bool Reckoning::hasData(GroupType type) const {
    switch (type) {
        case GroupType::Basic0A:
        case GroupType::Basic0B:
        case GroupType::Tuning15B:
            return true;
        case GroupType::Radiotext2A:
        case GroupType::Radiotext2B:
            return !m_radiotext.empty();
        case GroupType::OpenData3A:
            return m_transmission.openData.size() >= kGroupDigits;
        case GroupType::Traffic8A:
            return m_transmission.trafficMessage.size() >= kGroupDigits;
        case GroupType::Networks14A:
        case GroupType::Networks14B:
            return !m_networks.empty();
        case GroupType::Clock4A:  // never by slot
            break;
    }
    return false;
}

bool Reckoning::isNamed(GroupType type) const {
    return std::find(m_named.begin(), m_named.end(), type) != m_named.end();
}

bool Reckoning::isSent(GroupType type) const {
    return std::find(m_ring.begin(), m_ring.end(), type) != m_ring.end();
}

void Reckoning::addShares(GroupBudget& budget) const {
    const double ofClock =
        m_transmission.clockLead ? static_cast<double>(kGroupTime.count()) / Ticks{std::chrono::minutes{1}}.count() : 0;
    std::map<GroupType, double> shares;
    for (const GroupType type : m_ring) shares[type] += (1 - ofClock) / static_cast<double>(m_ring.size());
    if (m_transmission.clockLead) shares[GroupType::Clock4A] = ofClock;
    for (const auto& [type, share] : shares) budget.shares.push_back({type, share});
}

bool Reckoning::isSet(What what) const {
    switch (what) {
        case What::AfLists:
            return !m_frequencies.lengths().empty();
        case What::Radiotext:
            return !m_radiotext.empty();
        case What::Networks:
            return !m_networks.empty();
        case What::TrafficMessage:
            return hasData(GroupType::Traffic8A);
        case What::Ps:
        case What::Ta:
            break;
    }
    return true;
}

std::optional<Wait> Reckoning::waitFor(What what) const {
    switch (what) {
        case What::Ps:
            return Places(m_ring, {GroupType::Basic0A, GroupType::Basic0B}).waitFor(kPsSegments);
        case What::AfLists:
            return Places(m_ring, {GroupType::Basic0A}).waitForLists(m_frequencies.lengths());
        case What::Radiotext:
            return radiotextWait(m_ring, m_radiotext.segments(kCharactersOf2A), m_radiotext.segments(kCharactersOf2B));
        case What::Networks:
            return Places(m_ring, {GroupType::Networks14A}).waitForLists(m_networks.lengths());
        case What::TrafficMessage:
            return trafficWait();
        case What::Ta:
            break;
    }
    return Places(m_ring, {GroupType::Basic0A, GroupType::Basic0B, GroupType::Tuning15B}).waitFor(1);
}

/// What 8A holds a radio knows from 3A on; what came before means nothing to it.
std::optional<Wait> Reckoning::trafficWait() const {
    const Places announcements(m_ring, {GroupType::OpenData3A});
    const Places messages(m_ring, {GroupType::Traffic8A});
    if (announcements.empty() || messages.empty()) return std::nullopt;
    std::vector<std::size_t> groups;
    for (std::size_t slot = 0; slot < m_ring.size(); ++slot) {
        const std::size_t known = announcements.groupsUntil(slot, 1);
        groups.push_back(known + messages.groupsUntil((slot + known) % m_ring.size(), 1));
    }
    return waitOver(groups);
}

void Reckoning::addItems(GroupBudget& budget) const {
    for (const What what : {What::Ps, What::AfLists, What::Radiotext, What::Networks, What::TrafficMessage, What::Ta}) {
        const bool set = isSet(what);
        budget.items.push_back({what, set, set ? waitFor(what) : std::nullopt});
    }
}

/// With a tenth that is not below the measured time.
std::string secondsText(double seconds) {
    constexpr double kRounding = 1e-6;
    return fixedDecimal(std::ceil(seconds * 10 - kRounding) / 10, 1) + " s";
}

void Reckoning::addWarnings(GroupBudget& budget) const {
    const auto warn = [&budget](bool condition, const std::string& text) {
        if (condition) budget.warnings.push_back(text);
    };
    const auto waitOf = [&budget](What what) { return budget.items.at(static_cast<std::size_t>(what)).wait; };
    const bool has2A = isNamed(GroupType::Radiotext2A);
    const bool has2B = isNamed(GroupType::Radiotext2B);

    warn(isSet(What::Networks) && !isNamed(GroupType::Networks14A), "EON is set but 14A has no slot");
    // While there is no message yet the announcement may not be there either.
    const bool isAnnounced =
        isSet(What::TrafficMessage) ? isSent(GroupType::OpenData3A) : isNamed(GroupType::OpenData3A);
    warn(isNamed(GroupType::Traffic8A) && !isAnnounced, "8A without 3A");
    warn(isSet(What::TrafficMessage) && !isNamed(GroupType::Traffic8A), "a traffic message is set but 8A has no slot");
    const auto ps = waitOf(What::Ps);
    warn(!ps, "PS is never sent: neither 0A nor 0B has a slot");
    if (ps) warn(ps->worst > kNoticedSeconds, "PS takes " + secondsText(ps->worst) + ": more than 1 s is noticed");
    warn(isSet(What::AfLists) && !isSent(GroupType::Basic0A), "AF lists are set but 0A has no slot");
    warn(isSet(What::Radiotext) && !has2A && !has2B, "radiotext is set but neither 2A nor 2B has a slot");
    warn(has2B && m_transmission.settings.radiotext.size() > kLongestTextOf2B,
         "2B in the sequence with a radiotext above 32 characters");
    if (has2A && has2B && isSet(What::Radiotext)) {
        warn(true, waitOf(What::Radiotext) ? "2A and 2B in one sequence: their segments have different lengths"
                                           : "2A and 2B in one sequence: neither ever sends the whole radiotext");
    }
    if (const auto networks = waitOf(What::Networks)) {
        warn(networks->worst > kLongestNetworksSeconds,
             "EON takes " + secondsText(networks->worst) + ": all networks should come within 2 minutes");
    }
    for (const GroupType type : std::set(m_named.begin(), m_named.end())) {
        warn(!hasData(type), nameOf(type) + (type == GroupType::Clock4A
                                                 ? " in the sequence: the clock comes at the full minute, the slot "
                                                   "sends 0A"
                                                 : " in the sequence has nothing to send: the slot sends 0A"));
    }
}

}  // namespace

GroupBudget groupBudgetOf(const sim::Transmission& transmission) {
    const Reckoning reckoning(transmission);
    GroupBudget budget;
    reckoning.addItems(budget);
    const sim::Setup& setup = transmission.settings;
    if (setup.rdsOn && setup.testPattern == 0) {
        reckoning.addShares(budget);
        reckoning.addWarnings(budget);
        return budget;
    }
    for (GroupBudget::Item& item : budget.items) item.wait.reset();
    budget.warnings.emplace_back(setup.rdsOn ? "a test pattern goes out instead of groups"
                                             : "RDS is off: no groups go out");
    return budget;
}

std::string nameOf(GroupType type) {
    const auto code = static_cast<unsigned>(type);
    return std::to_string(code / 2) + (code % 2 == 0 ? "A" : "B");
}

std::string_view nameOf(GroupBudget::What what) {
    switch (what) {
        case What::Ps:
            return "PS";
        case What::AfLists:
            return "AF lists";
        case What::Radiotext:
            return "radiotext";
        case What::Networks:
            return "EON networks";
        case What::TrafficMessage:
            return "traffic message";
        case What::Ta:
            break;
    }
    return "TA";
}

}  // namespace kdx::air
