#pragma once

#include <functional>
#include <string>

#include "support/controltest.h"
#include "support/linkfixture.h"
#include "support/scripteddialogs.h"
#include "ui/keymarks.h"
#include "ui/pagecontext.h"
#include "ui/statusrow.h"
#include "ui/text.h"
#include "ui/ticker.h"

namespace kdx::test {

/// A page on its own with everything it works with: scripted instrument and boxes, a clock that stands still, a data
/// folder with the shipped texts and otherwise empty profile files. The session counts as open.
class PageTest : public ControlTest, protected LinkFixture {
protected:
    PageTest();

    void useLanguage(const std::string& language, const std::string& standard = "RDS");
    std::string status(StatusSlot slot) const { return statusRow.text(slot).toStdString(); }
    std::string stateOf(StatusSlot slot) const;
    using ControlTest::stateOf;
    /// What is done while the instrument does not answer: one command, whose box is closed.
    void inVain(const std::function<void()>& action);

    StatusRow statusRow{nullptr};
    ScriptedDialogs dialogs;
    TickerGroup tickers;
    KeyMarks marks{params, instrument, state, captions};
    PageContext context{params, instrument, settings, state, statusRow, captions, dialogs, data, clock, tickers, marks};
};

}  // namespace kdx::test
