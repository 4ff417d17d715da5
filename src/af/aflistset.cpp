#include "af/aflistset.h"

#include "af/settings.h"

namespace kdx {

const Place& afListPlace(std::string_view kind, int number) {
    const auto& lists = kind == kEonAfKind ? setting::kEonAfLists : setting::kAfLists;
    return lists.at(static_cast<std::size_t>(number) - 1).place;
}

void AfListSet::load(const Profile& profile) {
    for (std::size_t i = 0; i < lists.size(); ++i) lists[i] = profile.read(setting::kAfLists.at(i).place);
}

void AfListSet::appendSteps(Steps& steps) const {
    if (lists.front().empty()) return;
    for (std::size_t i = 0; i < lists.size(); ++i) {
        if (lists[i].empty()) continue;
        const char* key = setting::kAfLists.at(i).sendKey;
        if (const auto value = afValue(lists[i], static_cast<int>(i) + 1, method)) {
            appendStep(steps, key, *value);
        } else {
            steps.push_back({Step::Kind::Refused, key, lists[i]});
        }
    }
}

}  // namespace kdx
