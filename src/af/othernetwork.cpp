#include "af/othernetwork.h"

#include <algorithm>

#include "af/settings.h"
#include "base/numbers.h"
#include "coder/fieldsizes.h"
#include "settings/captions.h"
#include "settings/storedvalue.h"

namespace kdx {

void OtherNetwork::load(const Profile& profile) {
    pi = profile.read(setting::kEonPi.place);
    ps = profile.read(setting::kEonPs.place);
    pty = profile.read(setting::kEonPty.place);
    tp = storedFlag(profile.read(setting::kEonTp.place));
    ta = storedFlag(profile.read(setting::kEonTa.place));
    loadLists(profile);
}

void OtherNetwork::loadLists(const Profile& profile) {
    for (std::size_t i = 0; i < lists.size(); ++i) lists[i] = profile.read(setting::kEonAfLists.at(i).place);
}

void OtherNetwork::appendSteps(Steps& steps, const Corrections& corrections) const {
    steps.push_back({Step::Kind::AskNetworks});
    appendStep(steps, setting::kEonRemoval, "");
    appendStep(steps, setting::kEonPi.sendKey, pi);
    appendStep(steps, setting::kEonTa.sendKey, ta);
    appendStep(steps, setting::kEonTp.sendKey, tp);
    appendStep(steps, setting::kEonPs.sendKey, ps);
    if (corrections.eonType && isDecimal(pty)) appendStep(steps, setting::kEonType, pty);
    appendListSteps(steps);
}

void OtherNetwork::appendListSteps(Steps& steps) const {
    for (std::size_t i = 0; i < lists.size(); ++i) {
        if (lists[i].empty()) continue;
        // However long the list is, it goes as it stands, and an empty first one does not keep the others back.
        appendStep(steps, setting::kEonAfLists.at(i).sendKey, newOrFurtherList(static_cast<int>(i) + 1) + lists[i]);
    }
}

std::string programmeTypeNumber(const std::string& stored, const Captions& captions) {
    if (isDecimal(stored)) {
        const int entry = storedEntry(stored, kProgrammeTypes);
        return entry < 0 ? std::string() : std::to_string(entry);
    }
    for (std::size_t type = 0; type < kProgrammeTypes; ++type) {
        if (!stored.empty() && captions.programmeType(type) == stored) return std::to_string(type);
    }
    return {};
}

std::vector<std::string> networksToDelete(std::string_view answer) {
    std::vector<std::string> networks;
    for (auto comma = answer.find(','); comma != std::string_view::npos; comma = answer.find(',')) {
        const std::size_t length = std::min(comma, kPiLength);
        networks.emplace_back(answer.substr(comma - length, length));
        answer.remove_prefix(comma + 1);
        if (answer.empty()) return networks;
    }
    if (answer.starts_with('"')) answer.remove_prefix(1);
    networks.emplace_back(answer.substr(0, kPiLength));
    return networks;
}

std::string firstNetwork(std::string_view answer) {
    return answer.empty() ? std::string() : std::string(answer.substr(1, kPiLength));
}

}  // namespace kdx
