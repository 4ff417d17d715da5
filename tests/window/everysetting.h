#pragma once

#include <set>
#include <string>
#include <utility>
#include <vector>

#include "support/networkinstrument.h"
#include "support/observer.h"
#include "support/windowtest.h"

namespace kdx::test {

inline const Lines kNoErrors;
inline const Lines kIllegalValue = {R"(-224,"Illegal parameter value")"};

/// Every control of the pages is used as a user does, over the network and with nothing replaced but the clock and the
/// boxes; a second client of the same instrument reads back what has arrived.
class EverySetting : public WindowTest {
protected:
    ~EverySetting() override { end(); }
    void SetUp() override;
    void TearDown() override { EXPECT_EQ(observer.errors(), kNoErrors); }

    // What is used is written down.
    void click(const std::string& name);
    void type(const char* name, const char* utf8);
    void scroll(const char* name, int value);
    void select(const char* name, int index);
    void clickLabel(const char* name);
    static std::string numbered(const char* name, int index) { return std::string(name) + "_" + std::to_string(index); }

    /// Moves a scroll bar to each value and compares what the instrument then has.
    void expectScroll(const char* name, const char* query, const std::vector<std::pair<int, const char*>>& values);
    /// Chooses the options in turn and compares what the instrument then has.
    void expectOptions(const char* name, const std::string& query, const Lines& answers);
    /// Turns a switch over and over again.
    void expectSwitch(const char* name, const char* query);
    void expectCoder(const char* name, const std::string& answer) { EXPECT_EQ(observer.askCoder(name), answer); }

    /// Edits a list in the editor's own window, which the button opens: a list of the tuned frequency 99.9 with the
    /// AFs 88.1, 92.0 and 94.<number>.
    void editList(const char* button, int number);
    static std::string edited(int number) { return "99.9,88.1,92.0,94." + std::to_string(number); }
    static std::string editedPairs(int number) { return "99.9,99.9,88.1,99.9,92.0,99.9,94." + std::to_string(number); }

    /// Whether every control of the page that a user could change has been used, but for those named.
    void expectAllUsed(int page, const std::set<std::string>& others = {});

    Visa& instrumentLink() override { return lan; }

    FakeClock coderClock;  // stands still: the coder answers the very time it was given
    NetworkInstrument instrument{coderClock};
    LanVisa lan{instrument.reachedBy()};
    Observer observer{instrument.reachedBy()};

private:
    std::set<std::string> m_used;
};

}  // namespace kdx::test
