#pragma once

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "air/broadcast.h"

namespace kdx::air {

using Groups = std::vector<std::string>;

/// A virtual instrument just switched on, its RDS on, at noon of the first day of 2026; its groups as four blocks in
/// hexadecimal. The settings after switching on are PI 1000, PS "KDX-X4  ", PTY 0, TP and TA off, music, DI 1.
class AirTest : public ::testing::Test {
protected:
    static AirTime day(int year, unsigned month, unsigned day) {
        return AirTime{
            std::chrono::sys_days{std::chrono::year{year} / static_cast<int>(month) / static_cast<int>(day)}};
    }
    static AirTime noon() { return day(2026, 1, 1) + std::chrono::hours{12}; }

    explicit AirTest(AirTime start = noon())
        : broadcast(start, [this](const std::string& text) { warnings.push_back(text); }) {
        tell(":STEREO:RDS:STATE ON");
    }

    void tell(const std::string& command) { broadcast.execute(command, broadcast.time()); }
    void coder(const std::string& command) { tell(":STEREO:DIRECT \"" + command + "\""); }

    /// The next group without its time; "-" when none goes out.
    std::string next() {
        const OnAir sent = broadcast.next();
        if (sent.kind != OnAir::Kind::Group) return "-";
        const std::string line = logLine(sent.group, broadcast.time());
        return line.substr(0, line.find(" @"));
    }
    Groups next(int count) {
        Groups groups;
        for (int i = 0; i < count; ++i) groups.push_back(next());
        return groups;
    }
    /// One block, 1 to 4, of each of the next groups.
    Groups block(std::size_t number, int count) {
        Groups words;
        for (const std::string& group : next(count)) words.push_back(group.substr(5 * (number - 1), 4));
        return words;
    }

    std::vector<std::string> warnings;
    Broadcast broadcast;
};

}  // namespace kdx::air
