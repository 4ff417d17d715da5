#include "sim/othernetworks.h"

#include <algorithm>
#include <array>

#include "base/codepage.h"
#include "base/numbers.h"
#include "settings/captions.h"
#include "sim/scpi.h"

namespace kdx::sim {

namespace {

ScpiError setPs(OtherNetwork& network, std::string_view value) {
    if (value.size() > kPsLength) return ScpiError::TooMuchData;
    if (hasControlCharacter(value)) return ScpiError::IllegalValue;
    network.ps = padRight(value, kPsLength);
    return ScpiError::None;
}

ScpiError setPty(OtherNetwork& network, std::string_view value) {
    const auto pty = readWhole(value);
    if (!pty) return ScpiError::IllegalValue;
    if (*pty < 0 || *pty >= kProgrammeTypes) return ScpiError::OutOfRange;
    network.pty = *pty;
    return ScpiError::None;
}

ScpiError setFlag(bool& flag, std::string_view value) {
    const auto number = readWhole(value);
    if (!number) return ScpiError::IllegalValue;
    if (*number != 0 && *number != 1) return ScpiError::OutOfRange;
    flag = *number == 1;
    return ScpiError::None;
}

ScpiError setMethodA(OtherNetwork& network, std::string_view value) {
    const ScpiError error = AfLists::check(value);
    if (error == ScpiError::None) network.methodA = value;
    return error;
}

Reply askList(const OtherNetwork& network, std::optional<std::string_view> number) {
    if (!number) return {ScpiError::MissingParameter, ""};
    const auto list = readWhole(*number);
    if (!list) return {ScpiError::IllegalValue, ""};
    if (*list < 1 || *list > static_cast<int>(AfLists::kCount)) return {ScpiError::OutOfRange, ""};
    return {ScpiError::None, network.lists.list(static_cast<std::size_t>(*list - 1))};
}

std::string flagText(bool flag) {
    return flag ? "1" : "0";
}

struct NetworkRow {
    std::string_view name;
    ScpiError (*set)(OtherNetwork& network, std::string_view value);
    Reply (*ask)(const OtherNetwork& network, std::optional<std::string_view> argument);
};

constexpr std::string_view kIdentifications = "EON-PI";
constexpr std::string_view kDelete = "EON-DEL";
constexpr std::array kNetworkRows = {
    NetworkRow{"EON-PS", setPs,
               [](const OtherNetwork& network, std::optional<std::string_view>) -> Reply {
                   return {ScpiError::None, network.ps};
               }},
    NetworkRow{"EON-PTY", setPty,
               [](const OtherNetwork& network, std::optional<std::string_view>) -> Reply {
                   return {ScpiError::None, twoDigits(network.pty)};
               }},
    NetworkRow{"EON-TP", [](OtherNetwork& network, std::string_view value) { return setFlag(network.tp, value); },
               [](const OtherNetwork& network, std::optional<std::string_view>) -> Reply {
                   return {ScpiError::None, flagText(network.tp)};
               }},
    NetworkRow{"EON-TA", [](OtherNetwork& network, std::string_view value) { return setFlag(network.ta, value); },
               [](const OtherNetwork& network, std::optional<std::string_view>) -> Reply {
                   return {ScpiError::None, flagText(network.ta)};
               }},
    NetworkRow{"EON-AFA", setMethodA,
               [](const OtherNetwork& network, std::optional<std::string_view>) -> Reply {
                   return {ScpiError::None, network.methodA};
               }},
    NetworkRow{"EON-AFB", [](OtherNetwork& network, std::string_view value) { return network.lists.receive(value); },
               askList},
};

const NetworkRow* rowOf(std::string_view name) {
    const auto row =
        std::find_if(kNetworkRows.begin(), kNetworkRows.end(), [name](const auto& r) { return r.name == name; });
    return row == kNetworkRows.end() ? nullptr : &*row;
}

// The program may send a programme type's name here, or a PI filled up with blanks: neither is a PI.
bool isPi(std::string_view pi) {
    return pi.size() == kPiLength && isHex(pi);
}

}  // namespace

bool OtherNetworks::knows(std::string_view name) {
    return name == kIdentifications || name == kDelete || rowOf(name) != nullptr;
}

ScpiError OtherNetworks::command(std::string_view name, std::string_view value) {
    if (name == kIdentifications) return add(value);
    if (name == kDelete) return remove(value);
    const NetworkRow* row = rowOf(name);
    if (row == nullptr) return ScpiError::UndefinedHeader;
    const auto [pi, rest] = cutAt(value, ',');
    if (!rest) return ScpiError::MissingParameter;
    const OtherNetwork* found = find(pi);
    if (found == nullptr) return ScpiError::IllegalValue;
    return row->set(m_networks[static_cast<std::size_t>(found - m_networks.data())], *rest);
}

Reply OtherNetworks::query(std::string_view name, std::optional<std::string_view> argument) const {
    if (name == kIdentifications) return {ScpiError::None, identifications()};
    const NetworkRow* row = rowOf(name);
    if (row == nullptr) return {ScpiError::UndefinedHeader, std::nullopt};
    const auto [pi, rest] = cutAt(argument.value_or(""), ',');
    const OtherNetwork* network = find(trimmed(pi));
    if (network == nullptr) return {ScpiError::IllegalValue, ""};
    return row->ask(*network, rest);
}

ScpiError OtherNetworks::add(std::string_view pi) {
    if (!isPi(pi)) return ScpiError::IllegalValue;
    if (find(pi) != nullptr) return ScpiError::None;
    if (m_networks.size() == kCapacity) return ScpiError::TooMuchData;
    m_networks.emplace_back().pi = upperCase(pi);
    return ScpiError::None;
}

ScpiError OtherNetworks::remove(std::string_view pi) {
    const OtherNetwork* network = find(pi);
    if (network == nullptr) return ScpiError::IllegalValue;
    m_networks.erase(m_networks.begin() + (network - m_networks.data()));
    return ScpiError::None;
}

// A blank, then each PI with a comma behind it: who takes the four characters before each comma and who takes
// characters 2 to 5 both find the PI. Without networks only the blank is left: no comma, and no text that could be
// taken for a PI.
std::string OtherNetworks::identifications() const {
    std::string answer = " ";
    for (const OtherNetwork& network : m_networks) answer += network.pi + ",";
    return answer;
}

const OtherNetwork* OtherNetworks::find(std::string_view pi) const {
    const auto network = std::find_if(m_networks.begin(), m_networks.end(),
                                      [pi](const OtherNetwork& entry) { return equalNoCase(entry.pi, pi); });
    return network == m_networks.end() ? nullptr : &*network;
}

}  // namespace kdx::sim
