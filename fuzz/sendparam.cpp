// The dispatcher's keys with values as the window's controls give them: the instrument understands every command.
#include "harness.h"

#include "base/numbers.h"
#include "coder/sendparam.h"
#include "sim/virtualinstrument.h"
#include "support/fakeclock.h"

#include <array>

namespace {

using kdx::fuzz::demand;
using Pick = std::string (*)(FuzzedDataProvider& input);

template <int lowest, int highest>
std::string whole(FuzzedDataProvider& input) {
    return std::to_string(input.ConsumeIntegralInRange(lowest, highest));
}

template <int tenthsLowest, int tenthsHighest>
std::string tenths(FuzzedDataProvider& input) {
    return kdx::fixedDecimal(input.ConsumeIntegralInRange(tenthsLowest, tenthsHighest) / 10.0, 1);
}

std::string one(FuzzedDataProvider& input, std::string_view letters) {
    return {letters[input.ConsumeIntegralInRange<std::size_t>(0, letters.size() - 1)]};
}

template <std::size_t count>
std::string hexDigits(FuzzedDataProvider& input) {
    std::string digits;
    while (digits.size() < count) digits += one(input, "0123456789ABCDEFabcdef");
    return digits;
}

/// Entries have no control characters; a double quote would end the coder's text.
std::string text(FuzzedDataProvider& input) {
    std::string entry = input.ConsumeRandomLengthString(64);
    std::erase_if(entry, [](char c) { return static_cast<unsigned char>(c) < 0x20 || c == '"'; });
    return entry;
}

template <const char* lead>
std::string list(FuzzedDataProvider& input) {
    std::string value = lead + tenths<860, 1080>(input);
    for (int more = input.ConsumeIntegralInRange(0, 25); more > 0; --more) value += "," + tenths<875, 1080>(input);
    return value;
}
constexpr char kNew[] = "N,", kBare[] = "";

std::string sequence(FuzzedDataProvider& input) {
    std::string groups = whole<0, 15>(input) + "A";
    for (int more = input.ConsumeIntegralInRange(0, 40); more > 0; --more) groups += "," + whole<0, 15>(input) + "A";
    return groups;
}

std::string trafficMessage(FuzzedDataProvider& input) {
    return "02," + whole<0, 1>(input) + hexDigits<9>(input);
}

std::string openData(FuzzedDataProvider& input) {
    return "01," + hexDigits<10>(input);
}

struct Row {
    const char* key;
    Pick pick;
};
constexpr std::array kRows = {Row{"PS", text},
                              Row{"PI", hexDigits<4>},
                              Row{"PTY", whole<0, 31>},
                              Row{"TP", whole<0, 1>},
                              Row{"TA", whole<0, 1>},
                              Row{"MS", [](FuzzedDataProvider& input) { return one(input, "MS"); }},
                              Row{"DI", whole<0, 15>},
                              Row{"RT", text},
                              Row{"RTA", text},
                              Row{"DEL_RT", text},
                              Row{"UHR", text},
                              Row{"ZEIT", text},
                              Row{"RDS", whole<0, 1>},
                              Row{"RDS_HUB", whole<0, 400>},
                              Row{"RDS_PHASE", whole<0, 359>},
                              Row{"AF1", list<kNew>},
                              Row{"AF5", list<kNew>},
                              Row{"GROUPSEQ", sequence},
                              Row{"GROUPSEQ_TN", sequence},
                              Row{"STORE", whole<1, 5>},
                              Row{"ODA", openData},
                              Row{"TMC", trafficMessage},
                              Row{"TEST_M", whole<0, 4>},
                              Row{"TEST_D", whole<0, 4>},
                              Row{"EON_PS", text},
                              Row{"EON_PTY", whole<0, 31>},
                              Row{"EON_TP", whole<0, 1>},
                              Row{"EON_TA", whole<0, 1>},
                              Row{"EON_AFA", list<kBare>},
                              Row{"EON_AFB1", list<kNew>},
                              Row{"EON_AFB5", list<kNew>},
                              Row{"MPX_HUB", tenths<0, 80000>},
                              Row{"MPX_SOURCE", whole<0, 3>},
                              Row{"MPX_IMPEDANZ", whole<1, 2>},
                              Row{"STEREO_MODE", whole<1, 5>},
                              Row{"PREEMPHASIS", whole<0, 2>},
                              Row{"PILOT", whole<0, 1>},
                              Row{"PILOT_HUB", tenths<0, 15000>},
                              Row{"PILOT_PHASE", whole<-180, 180>},
                              Row{"ARI", whole<0, 1>},
                              Row{"ARI-HUB", tenths<0, 8000>},
                              Row{"ARI-ID", whole<0, 3>},
                              Row{"ARI-BK", [](FuzzedDataProvider& input) { return one(input, "ABCDEF"); }},
                              Row{"STEREO_EIN", text},
                              Row{"STEREO_AUS", text},
                              Row{"FM_EIN", text},
                              Row{"FM_AUS", text},
                              Row{"AM_AUS", text},
                              Row{"HF:PEGEL:STATE", whole<0, 1>},
                              Row{"HF-Frequenz", tenths<1, 10400>},
                              Row{"HF-Pegel", tenths<0, 1200>},
                              Row{"NF-Frequenz", tenths<1, 800>}};

}  // namespace

int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    FuzzedDataProvider input(data, size);
    const kdx::test::FakeClock clock;
    kdx::sim::VirtualInstrument instrument(clock);
    const kdx::ParamContext context{hexDigits<4>(input), "08:15:30", "23:59:58", "05.03.09"};
    const auto send = [&](const char* key, std::string value) {
        const auto command = kdx::composeCommand(key, value, context);
        demand(command && !command->empty(), "there is a command");
        demand(instrument.execute(*command).empty(), "a command asks nothing");
        const std::string error = instrument.execute("SYST:ERR?");
        demand(error.starts_with("0,"), (*command + " is understood: " + error).c_str());
    };
    send("EON_PI", context.eonIdentifier);
    for (int left = 20; left > 0 && input.remaining_bytes() > 0; --left) {
        const Row& row = input.PickValueInArray(kRows);
        send(row.key, row.pick(input));
    }
    send("EON_DEL", context.eonIdentifier);
    return 0;
}
