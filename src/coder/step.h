#pragma once

#include <string>
#include <string_view>
#include <vector>

namespace kdx {

/// One step on the way of settings to the instrument.
struct Step {
    enum class Kind {
        Parameter,    ///< a key and its value for the dispatcher
        Identify,     ///< asks "*IDN?"
        AskNetworks,  ///< asks the coder for the other networks it holds; the removal after it is repeated for each
        Refused,      ///< nothing goes out: the coder cannot take the value of that key
        Close,        ///< closes the session
    };
    Kind kind = Kind::Parameter;
    std::string key = {};
    std::string value = {};

    friend bool operator==(const Step&, const Step&) = default;
};

using Steps = std::vector<Step>;

/// Adds the parameter's step. A key that the dispatcher does not know is no step.
void appendStep(Steps& steps, std::string_view key, std::string_view value);

}  // namespace kdx
