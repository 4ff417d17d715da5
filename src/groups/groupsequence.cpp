#include "groups/groupsequence.h"

#include <limits>

#include "groups/settings.h"
#include "settings/profilefile.h"

namespace kdx {

std::string groupText(int number) {
    return std::to_string(number) + "A,";
}

std::string sequenceToSend(std::string_view groups) {
    // The last character goes whatever it is: a sequence stored by hand without its last comma loses an "A".
    return std::string(groups.substr(0, groups.empty() ? 0 : groups.size() - 1));
}

void GroupSequence::load(const Profile& profile) {
    load(profile, setting::kGroupSequence.place);
}

void GroupSequence::load(const Profile& profile, const Place& place) {
    groups = profile.read(place);
    composed = false;
    cut = groups.size() == kLongestValue && profile.holdsMore(place);  // looked up only where it can be
}

void GroupSequence::startAnew() {
    groups.clear();
    composed = true;
    cut = false;
}

bool GroupSequence::exceedsReading() const {
    return cut || groups.size() > kLongestValue;
}

bool GroupSequence::isToBeStored(const Profile& profile) const {
    return !cut && (composed || profile.read(setting::kGroupSequence.place) != groups);
}

void GroupSequence::appendSteps(Steps& steps) const {
    if (!groups.empty()) appendStep(steps, setting::kGroupSequence.sendKey, sequenceToSend(groups));
}

void countUp(std::int16_t& counter) {
    if (counter < std::numeric_limits<std::int16_t>::max()) ++counter;
}

}  // namespace kdx
