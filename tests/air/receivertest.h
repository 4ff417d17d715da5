#pragma once

#include <gtest/gtest.h>

#include <cstdint>
#include <string_view>

#include "air/hexword.h"
#include "air/receiver.h"

namespace kdx::air {

/// "1000 0408 E0CD 4B44" as a radio gets it; "----" for a block with errors.
inline ReceivedGroup groupOfBlocks(std::string_view line) {
    ReceivedGroup group;
    for (std::size_t block = 0; block < group.blocks.size(); ++block) {
        const std::string_view digits = line.substr(5 * block, 4);
        if (digits != "----") group.blocks.at(block) = hexWord(digits);
    }
    return group;
}

/// A radio that was just tuned in.
class ReceiverTest : public ::testing::Test {
protected:
    void hear(std::string_view line) { receiver.take(groupOfBlocks(line)); }
    void hear(std::initializer_list<const char*> lines) {
        for (const char* line : lines) hear(line);
    }
    [[nodiscard]] const RadioState& shown() const { return receiver.state(); }

    Receiver receiver;
};

}  // namespace kdx::air
