#include "coder/step.h"

#include "coder/sendparam.h"

namespace kdx {

void appendStep(Steps& steps, std::string_view key, std::string_view value) {
    if (isParameter(key)) steps.push_back({Step::Kind::Parameter, std::string(key), std::string(value)});
}

}  // namespace kdx
