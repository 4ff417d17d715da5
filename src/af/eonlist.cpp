#include "af/eonlist.h"

#include <algorithm>

namespace kdx {

namespace {

constexpr std::size_t kPiLength = 4;

}  // namespace

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

std::string eonAfValue(std::string_view list, int number) {
    return (number == 1 ? "N," : "+,") + std::string(list);
}

}  // namespace kdx
