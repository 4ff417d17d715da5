#pragma once

#include <string>

#include "support/windowtest.h"

namespace kdx::test {

class NoticeTest : public WindowTest {
protected:
    NoticeTest() { folder.copyShipped(); }
    std::string notice() { return text("QuietLine"); }
    void waitForRetry() {
        EXPECT_EQ(window->findChild<QTimer*>(QStringLiteral("UnsavedTimer"))->interval(), 10'000);
        tick("UnsavedTimer");
    }
};

}  // namespace kdx::test
