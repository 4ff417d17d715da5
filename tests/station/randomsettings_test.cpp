#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <random>

#include "base/numbers.h"
#include "readoutfixture.h"
#include "station/comparison.h"

namespace kdx::test {
namespace {

using ::testing::IsEmpty;

/// Values within the instrument's limits, other ones each time, the same ones in each run.
class RandomValues {
public:
    explicit RandomValues(unsigned seed) : m_engine(seed) {}

    void sendTo(Laboratory& lab) {
        for (const char* flag : {"PILOT", "ARI", "RDS", "TP", "TA"}) lab.send(flag, whole(0, 1));
        lab.send("MPX_HUB", whole(0, 8000));
        lab.send("MPX_SOURCE", whole(0, 3));
        lab.send("MPX_IMPEDANZ", whole(1, 2));
        lab.send("STEREO_MODE", whole(1, 5));
        lab.send("PREEMPHASIS", whole(0, 2));
        lab.send("PILOT_HUB", whole(0, 1500));
        lab.send("PILOT_PHASE", whole(-180, 180));
        lab.send("ARI-HUB", whole(0, 800));
        lab.send("ARI-ID", whole(0, 3));
        lab.send("ARI-BK", std::string(1, static_cast<char>('A' + number(0, 5))));
        lab.send("RDS_HUB", whole(0, 400));
        lab.send("RDS_PHASE", whole(0, 359));
        lab.send("PI", pi());
        lab.send("PS", text(0, 8));
        lab.send("PTY", whole(0, 31));
        lab.send("MS", number(0, 1) == 0 ? "M" : "S");
        lab.send("DI", whole(0, 15));
        lab.send(number(0, 1) == 0 ? "RT" : "RTA", text(0, 64));
        lab.send("TEST_M", whole(0, 4));
        sendLists(lab, "AF");
        sendNetworks(lab);
        lab.send("GROUPSEQ", groups());
        lab.send("HF-Frequenz", shortestDecimal(number(1, 10400) / 10.0));
        lab.send("HF-Pegel", shortestDecimal(number(0, 1200) / 10.0));
        lab.send("NF-Frequenz", shortestDecimal(number(2, 8000) / 100.0));
        lab.send("HF:PEGEL:STATE", number(0, 1) == 0 ? "OFF" : "ON");
        lab.send(number(0, 1) == 0 ? "FM_EIN" : "FM_AUS", "");
    }

private:
    int number(int lowest, int highest) { return std::uniform_int_distribution<>(lowest, highest)(m_engine); }
    std::string whole(int lowest, int highest) { return std::to_string(number(lowest, highest)); }
    std::string text(int shortest, int longest) {
        std::string result;
        for (int length = number(shortest, longest); length > 0; --length) {
            const int code = number(0x20, 0xFF);
            result += static_cast<char>(code == '"' || code == 0x7F ? ' ' : code);
        }
        return result;
    }
    std::string pi() {
        std::string result;
        for (int i = 0; i < 4; ++i) result += "0123456789ABCDEF"[number(0, 15)];
        return result;
    }
    std::string frequencies() {
        std::string list = shortestDecimal(number(876, 1079) / 10.0);
        for (int count = number(0, 25); count > 0; --count) list += "," + shortestDecimal(number(876, 1079) / 10.0);
        return list;
    }
    void sendLists(Laboratory& lab, const std::string& key) {
        const int lists = number(0, 5);
        for (int list = 1; list <= lists; ++list)
            lab.send(key + std::to_string(list), (list == 1 ? "N," : "+,") + frequencies());
    }
    void sendNetworks(Laboratory& lab) {
        const int networks = number(0, 2);
        for (int network = 0; network < networks; ++network) {
            lab.send("EON_PI", pi());
            lab.send("EON_PS", text(0, 8));
            lab.send("EON_PTY", whole(0, 31));
            lab.send("EON_TP", whole(0, 1));
            lab.send("EON_TA", whole(0, 1));
            if (number(0, 1) == 0) lab.send("EON_AFA", frequencies());
            sendLists(lab, "EON_AFB");
        }
    }
    std::string groups() {
        std::string sequence;
        for (int count = number(1, 60); count > 0; --count)
            sequence += (sequence.empty() ? "" : ",") + whole(0, 15) + (number(0, 1) == 0 ? "A" : "B");
        return sequence;
    }

    std::mt19937 m_engine;
};

/// The read-out with what becomes of it when it is kept in a file.
Readout withChanges(Readout readout, const Differences& changed) {
    for (const auto& [key, network, wanted, present] : changed) {
        for (Reading& reading : readout) {
            if (reading.key == key && reading.network == network && wanted) reading.value = wanted;
        }
        if (!wanted) std::erase_if(readout, [&pi = network](const Reading& reading) { return reading.network == pi; });
    }
    return readout;
}

class RandomSettings : public ReadoutTest, public ::testing::WithParamInterface<unsigned> {};

TEST_P(RandomSettings, ReadThenAppliedDifferInNothing) {
    RandomValues values(GetParam());
    for (int round = 0; round < 125; ++round) {
        SCOPED_TRACE(round);
        Laboratory bench{data, captions};
        values.sendTo(bench);
        const Readout readout = bench.readout();
        ASSERT_THAT(unanswered(readout), IsEmpty());
        const Profile file = kept(readout);
        const NotKept lost = notKept(data, captions, file, readout);
        bench.apply(file);
        const Readout applied = bench.readout();
        ASSERT_EQ(names(compared(data, captions, file, applied).differing), "");
        // What is not named comes back, and what is named becomes what was said.
        ASSERT_EQ(names(differences(withChanges(readout, lost.changed), applied)), "");
        // Whatever the file cannot keep, the way back from it is known.
        bench.become(readout);
        ASSERT_EQ(names(differences(readout, bench.readout())), "");
    }
}

// A thousand in all, in parts that run side by side.
INSTANTIATE_TEST_SUITE_P(Seeds, RandomSettings, ::testing::Range(1U, 9U));

}  // namespace
}  // namespace kdx::test
