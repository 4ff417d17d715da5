#include "groups/groupsequence.h"

#include <limits>

namespace kdx {

std::string groupText(int number) {
    return std::to_string(number) + "A,";
}

std::string sequenceToSend(std::string_view groups) {
    // The last character goes whatever it is: a sequence stored by hand without its last comma loses an "A".
    return std::string(groups.substr(0, groups.empty() ? 0 : groups.size() - 1));
}

void countUp(std::int16_t& counter) {
    if (counter < std::numeric_limits<std::int16_t>::max()) ++counter;
}

}  // namespace kdx
