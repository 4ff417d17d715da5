// What a radio hears: bits, or groups with blocks missing. It shows something that can be shown whatever comes, holds
// no more than it has room for, and listens on.
#include "harness.h"

#include "air/receiver.h"
#include "air/receivercharacters.h"
#include "air/receivertrafficwords.h"
#include "base/codepage.h"

namespace {

using kdx::fuzz::demand;
using namespace kdx::air;

void hearBits(FuzzedDataProvider& input, BlockReceiver& blocks, Receiver& radio) {
    for (const std::uint8_t byte : input.ConsumeRemainingBytes<std::uint8_t>()) {
        for (unsigned bit = 8; bit-- > 0;) {
            const auto group = blocks.take((byte >> bit & 1U) != 0);
            if (!group) continue;
            demand(*group != ReceivedGroup{}, "a group has a block at least");
            radio.take(*group);
        }
    }
}

/// Four blocks of each group, behind a byte that says which of them are missing; the first group's PI goes for most.
void hearGroups(FuzzedDataProvider& input, Receiver& radio) {
    constexpr unsigned kOwnPi = 0x80;
    const auto pi = input.ConsumeIntegral<std::uint16_t>();
    while (input.remaining_bytes() > 0) {
        const unsigned missing = input.ConsumeIntegral<std::uint8_t>();
        ReceivedGroup group;
        for (unsigned block = 0; block < 4; ++block) {
            if ((missing >> block & 1U) != 0) continue;
            const bool isPi = block == 0 && (missing & kOwnPi) == 0;
            group.blocks.at(block) = isPi ? pi : input.ConsumeIntegral<std::uint16_t>();
        }
        radio.take(group);
    }
}

void look(const RadioState& state) {
    const auto isShown = [](const std::string& text) { return kdx::isUtf8(text); };
    demand(isShown(state.psText()) && state.psText().size() >= state.ps.size(), "the PS has eight cells");
    demand(isShown(state.radiotextText()), "a radiotext can be shown");
    for (const FrequencyList& list : state.frequencies)
        demand(!list.alternatives.empty() && list.methodB == (list.tuned != 0), "a list is one of its method");
    for (const ReceivedNetwork& network : state.networks) demand(isShown(shownText(network.ps)), "networks have names");
    demand(state.networks.size() <= 256, "the networks are bounded");
    demand(state.traffic.messages.size() <= 300, "the messages are bounded");
    for (const auto& [message, times, lastGroup] : state.traffic.messages) {
        demand(inWords(message, {}).starts_with("event "), "every message has words");
        demand(times > 0 && lastGroup <= state.groups, "every message was heard");
        demand(message.details.size() <= 28, "the contents are bounded");
    }
    for (const TrafficGroup& tuning : state.traffic.tuning)
        demand(isShown(inWords(tuning, {})), "tuning information has words");
    if (!state.clock) return;
    const auto minutes = state.clock->utc.time_since_epoch() % std::chrono::days{1};
    demand(minutes < std::chrono::days{1}, "a time is one of its day");
}

}  // namespace

int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    FuzzedDataProvider input(data, size);
    BlockReceiver blocks;
    Receiver radio;
    const bool bits = input.ConsumeBool();
    if (bits) {
        hearBits(input, blocks, radio);
    } else {
        hearGroups(input, radio);
    }
    look(radio.state());
    demand(blocks.wrongBlocks() <= blocks.blocks(), "errors are errors of blocks");
    // Two groups with another PI make another programme of it.
    const auto pi = static_cast<std::uint16_t>(radio.state().pi.value_or(0) ^ 1U);
    for (int i = 0; i < 2; ++i) radio.take({{pi, 0x0408, 0xE0CD, 0x4142}});
    demand(radio.state().pi == pi && radio.state().psText().starts_with("AB"), "it listens on");
    return 0;
}
