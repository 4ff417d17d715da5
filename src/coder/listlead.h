#pragma once

#include <optional>
#include <string_view>

namespace kdx {

/// What leads a list of alternative frequencies that is sent: one that starts a new set, one that is
/// added to it.
inline constexpr std::string_view kNewListLead = "N,";
inline constexpr std::string_view kFurtherListLead = "+,";

/// The list without what leads it, as a part of the text; nothing where nothing leads it.
[[nodiscard]] constexpr std::optional<std::string_view> afterListLead(std::string_view sent) {
    for (const std::string_view lead : {kNewListLead, kFurtherListLead}) {
        if (sent.starts_with(lead)) return sent.substr(lead.size());
    }
    return std::nullopt;
}

}  // namespace kdx
