#pragma once

#include <array>
#include <string>
#include <string_view>
#include <vector>

#include "af/aflist.h"
#include "coder/step.h"
#include "settings/corrections.h"

namespace kdx {

class Captions;
class Profile;

/// The other network (EON) of a data set, each value as it is sent.
struct OtherNetwork {
    std::string pi;  ///< leads every command about the network
    std::string ps;
    std::string pty;       ///< as stored: a number, or the chosen type's name
    std::string tp = "0";  ///< "1" or "0"
    std::string ta = "0";  ///< "1" or "0"
    std::array<std::string, kAfLists> lists;

    void load(const Profile& profile);
    /// Only the lists, which are kept in the file and read anew whenever they go out.
    void loadLists(const Profile& profile);
    /// Adds the removal of the networks that the coder holds, then PI, TA, TP, PS and the lists; the programme
    /// type, which reaches the coder by no data set otherwise, where that is corrected and the type is a number.
    void appendSteps(Steps& steps, const Corrections& corrections = {}) const;
    /// Adds the lists that are not empty.
    void appendListSteps(Steps& steps) const;
};

/// The number of a programme type as it was stored: its number, or its name in the current list. "" when it is neither.
[[nodiscard]] std::string programmeTypeNumber(const std::string& stored, const Captions& captions);

// The coder answers "EON PI?" with the identifiers (PI codes, 4 characters each) of the other networks it holds,
// separated by commas; what leads and ends the list differs between coders. All texts are 8-bit Windows-1252.

/// The identifiers that deleting all networks of the answer takes, one command each, in order: the 4 characters before
/// every comma, then those that the rest begins with (after a double quote, when one leads it). A list that ends in a
/// comma has no rest. An answer without a comma, the empty one of a failed query included, gives exactly one entry.
[[nodiscard]] std::vector<std::string> networksToDelete(std::string_view answer);

/// The identifier the coder reports first: characters 2 to 5 of the answer, fewer when it is shorter.
[[nodiscard]] std::string firstNetwork(std::string_view answer);

}  // namespace kdx
