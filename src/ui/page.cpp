#include "ui/page.h"

#include "coder/sendparam.h"

namespace kdx {

void Page::send(const Steps& steps) {
    for (const Step& step : steps) {
        stepGoesOut(step);
        if (step.kind == Step::Kind::Parameter) m_with.params.SendParam(step.key, std::string(step.value));
    }
}

}  // namespace kdx
