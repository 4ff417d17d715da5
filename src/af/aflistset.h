#pragma once

#include <array>
#include <string>
#include <string_view>

#include "af/aflist.h"
#include "coder/step.h"

namespace kdx {

class Profile;
struct Place;

/// Where list `number` (1 to 5) of the kind is kept: the other network's for the kind "EON AF", else the own
/// programme's.
[[nodiscard]] const Place& afListPlace(std::string_view kind, int number);

/// The five lists of alternative frequencies of a data set. They are kept in its file and read anew whenever they go
/// out.
struct AfListSet {
    std::array<std::string, kAfLists> lists;
    AfMethod method = AfMethod::A;  ///< chosen in the window, kept nowhere

    void load(const Profile& profile);
    /// Adds the lists that are not empty; none without the first, to which the others are added. A list that method B
    /// cannot carry is a refused step; the others are then added to the lists the coder holds, on purpose.
    void appendSteps(Steps& steps) const;
};

}  // namespace kdx
