#pragma once

#include <string>
#include <string_view>
#include <vector>

namespace kdx {

// The coder answers "EON PI?" with the identifiers (PI codes, 4 characters each) of the other networks it holds,
// separated by commas; what leads and ends the list differs between coders. All texts are 8-bit Windows-1252.

/// The identifiers that deleting all networks of the answer takes, one command each, in order: the 4 characters before
/// every comma, then those that the rest begins with (after a double quote, when one leads it). A list that ends in a
/// comma has no rest. An answer without a comma, the empty one of a failed query included, gives exactly one entry.
[[nodiscard]] std::vector<std::string> networksToDelete(std::string_view answer);

/// The identifier the coder reports first: characters 2 to 5 of the answer, fewer when it is shorter.
[[nodiscard]] std::string firstNetwork(std::string_view answer);

/// What is sent for AF list `number` (1 to 5) of the other network: "N," starts a new set with list 1, "+," adds the
/// others to it. However long the list is, it goes as it stands.
[[nodiscard]] std::string eonAfValue(std::string_view list, int number);

}  // namespace kdx
