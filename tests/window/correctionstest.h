#pragma once

#include <algorithm>
#include <initializer_list>

#include "support/windowtest.h"
#include "ui/clickablelabel.h"

namespace kdx::test {

/// The whole window on the shipped data, with some of the corrections switched on.
class CorrectionsTest : public WindowTest {
protected:
    CorrectionsTest() { folder.copyShipped(); }

    /// Starts the program with these corrections and no others.
    void startWith(std::initializer_list<const char*> keys) {
        for (const auto& [key, isOn] : kCorrectionKeys) setGeneral("Berichtigungen", key, "0");
        for (const char* key : keys) setGeneral("Berichtigungen", key, "1");
        start();
    }
    /// The same with an open session, whose commands are given.
    Lines openWith(std::initializer_list<const char*> keys) {
        startWith(keys);
        return opened();
    }
    Lines opened() {
        sent();
        openSession();
        return sent();
    }
    Lines sentBy(const char* button) {
        sent();
        click(button);
        return sent();
    }
    void clickLabel(const char* name) { emit find<ClickableLabel>(name)->clicked(); }
    std::string dataSet1(const char* section, const char* key) const { return profile(kSet1, section, key); }

    /// The commands that begin so.
    static Lines beginning(const Lines& commands, const std::string& begin) {
        Lines some;
        std::copy_if(commands.begin(), commands.end(), std::back_inserter(some),
                     [&](const std::string& command) { return command.starts_with(begin); });
        return some;
    }
};

}  // namespace kdx::test
