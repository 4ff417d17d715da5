#pragma once

#include <string>
#include <vector>

namespace kdx {

class Profile;

/// What stands in a data set, the multiplex and the carrier that go with it, and cannot be sent as it stands: a
/// sentence each, in UTF-8, with what is legal, the file, the section, the key and the value. Sending makes something
/// else of some of these without a word: no command, the nearest limit, off. A value that is missing is legal, but for
/// the PI; what sending a data set leaves out may be anything.
[[nodiscard]] std::vector<std::string> wrongSettings(const Profile& source);

}  // namespace kdx
