#include "tmc/messagelist.h"

#include "base/numbers.h"
#include "tmc/groupcode.h"

#include <cmath>

namespace kdx {

std::string messageEntry(std::string_view location, std::string_view event, std::string_view code) {
    std::string entry = padRight(location, kMessageTextLength);
    entry += kAfterLocation;
    entry += padRight(event, kMessageTextLength);
    entry += kAfterEvent;
    entry += code;
    return entry;
}

std::string codeOfMessage(std::string_view entry) {
    return rightmost(entry, kGroupCodeLength);
}

int nextPosition(int position, int messageCount) {
    const int next = position % 20 + 1;
    return next == messageCount ? 0 : next;
}

double cycleTimeMs(std::string_view seconds) {
    return std::nearbyint(leadingNumber(seconds) * 1000);
}

}  // namespace kdx
