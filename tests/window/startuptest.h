#pragma once

#include <gtest/gtest.h>

#include "support/windowtest.h"

namespace kdx::test {

class StartUpTest : public WindowTest {
protected:
    /// Opens the session, sends a new PS, asks something back, shows every page and closes.
    void expectToWork() {
        visa.answersTo[":STEREO:DIRECT? \"PS\""] = "\"ANDERES \"\n";
        openSession();
        EXPECT_EQ(window->windowTitle().trimmed(), QStringLiteral("KDX,TEST"));
        for (int page = 0; page < 9; ++page) {
            showPage(page);
            QCoreApplication::processEvents();
        }
        sent();
        type("PS_T", "ANDERES");
        click("PS_Taste");
        click("Command5");
        EXPECT_EQ(sent(), (Lines{":STEREO:DIRECT \"PS=ANDERES \"", ":STEREO:DIRECT? \"PS\""}));
        EXPECT_NE(text("gelesen").find("ANDERES"), std::string::npos);
        click("GTL_Taste");
        EXPECT_TRUE(find("INIT_Taste")->isEnabled());
    }
};

}  // namespace kdx::test
