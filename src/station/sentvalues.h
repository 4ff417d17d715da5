#pragma once

#include <set>
#include <string>

#include "settings/corrections.h"

namespace kdx {

class Profile;
struct Station;

/// Which values sending a data set sets, whatever it sets them to.
class SentValues {
public:
    explicit SentValues(const Profile& source);
    SentValues(const Station& station, const Corrections& corrections);

    /// @param network PI of the other network that the value belongs to, or "".
    [[nodiscard]] bool hold(const std::string& key, const std::string& network) const;

private:
    std::set<std::string> m_keys;
};

}  // namespace kdx
