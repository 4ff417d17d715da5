// The coder's answer to the question for other networks.
#include "harness.h"

#include "af/othernetwork.h"

#include <algorithm>

int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    using kdx::fuzz::demand;
    constexpr std::size_t kPiLength = 4;
    const std::string_view answer(reinterpret_cast<const char*>(data), size);
    const auto networks = kdx::networksToDelete(answer);
    const auto commas = std::count(answer.begin(), answer.end(), ',');
    const bool noRest = answer.ends_with(',');
    demand(networks.size() == static_cast<std::size_t>(commas + (noRest ? 0 : 1)),
           "one entry a comma, one for the rest");
    for (const std::string& network : networks) demand(network.size() <= kPiLength, "an entry is no longer than a PI");
    demand(kdx::firstNetwork(answer).size() <= kPiLength, "the first is no longer than a PI");
    return 0;
}
