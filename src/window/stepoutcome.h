#pragma once

#include <optional>
#include <vector>

#include "coder/step.h"

namespace kdx {

class Instrument;
class Page;

/// Tells the pages of the steps of a sequence that did not reach the instrument: a step is reported before it goes out,
/// so what became of it is known with the next one or the end.
class StepOutcome {
public:
    StepOutcome(const Instrument& instrument, const std::vector<Page*>& pages)
        : m_instrument(instrument), m_pages(pages) {}

    /// The next step goes out.
    void next(const Step& step);
    /// The sequence is over.
    void settle();

private:
    const Instrument& m_instrument;
    const std::vector<Page*>& m_pages;
    std::optional<Step> m_step;
};

}  // namespace kdx
