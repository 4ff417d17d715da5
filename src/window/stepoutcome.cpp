#include "window/stepoutcome.h"

#include <utility>

#include "link/instrument.h"
#include "ui/page.h"

namespace kdx {

void StepOutcome::next(const Step& step) {
    settle();
    m_step = step;
}

void StepOutcome::settle() {
    const std::optional<Step> step = std::exchange(m_step, std::nullopt);
    if (!step || m_instrument.LastVisaStatus >= 0) return;
    for (Page* page : m_pages) page->stepFailed(*step);
}

}  // namespace kdx
