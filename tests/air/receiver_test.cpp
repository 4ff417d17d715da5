#include <chrono>

#include "air/receivercharacters.h"
#include "air/receivertest.h"

namespace kdx::air {
namespace {

using namespace std::chrono_literals;
using Lists = std::vector<FrequencyList>;

class ReceivedProgramme : public ReceiverTest {};

TEST_F(ReceivedProgramme, IsUnknownBeforeTheFirstGroup) {
    EXPECT_FALSE(shown().pi);
    EXPECT_EQ(shown().psText(), "        ");
    EXPECT_EQ(shown().radiotextText(), "");
    EXPECT_FALSE(shown().isRadiotextWhole());
    EXPECT_FALSE(shown().tp || shown().ta || shown().music || shown().pty || shown().clock);
    EXPECT_FALSE(shown().decoderInfoNumber());
}

TEST_F(ReceivedProgramme, ShowsThePsSegmentBySegment) {
    // IEC 62106, 6.1.5.1: 0A, segment in the last two bits, two characters in block 4.
    hear("D3C2 0409 E0CD 444F");
    EXPECT_EQ(shown().psText(), "  DO    ");
    hear({"D3C2 0408 E0CD 5241", "D3C2 040B E0CD 2D35", "D3C2 040A E0CD 4920"});
    EXPECT_EQ(shown().psText(), "RADOI -5");
    hear("D3C2 0C09 D3C2 4449");
    EXPECT_EQ(shown().psText(), "RADII -5") << "0B has the same segments";
}

TEST_F(ReceivedProgramme, HasItsFlagsAndTypeInBlock2) {
    // 0000 0 1 10001 1 1 0 00: 0A, TP, PTY 17, TA, music, segment 0.
    hear("D3C2 0638 E0CD 2020");
    EXPECT_EQ(shown().pi, 0xD3C2);
    EXPECT_EQ(shown().tp, true);
    EXPECT_EQ(shown().pty, 17);
    EXPECT_EQ(shown().ta, true);
    EXPECT_EQ(shown().music, true);
    // 0000 0 0 00011 0 0 0 00: no TP, PTY 3, no TA, speech.
    hear("D3C2 0060 E0CD 2020");
    EXPECT_EQ(shown().tp, false);
    EXPECT_EQ(shown().pty, 3);
    EXPECT_EQ(shown().ta, false);
    EXPECT_EQ(shown().music, false);
}

TEST_F(ReceivedProgramme, TakesTheDecoderInformationBitByBit) {
    // 6.2.1.5, table 9: d3 in segment 0 to d0 in segment 3; 15B has them too.
    hear({"D3C2 0004 E0CD 2020", "D3C2 0001 E0CD 2020", "D3C2 0006 E0CD 2020"});
    EXPECT_FALSE(shown().decoderInfoNumber());
    hear("D3C2 F803 D3C2 F803");
    EXPECT_EQ(shown().decoderInfoNumber(), 0b1010);
    hear("D3C2 F817 D3C2 F817");
    EXPECT_EQ(shown().decoderInfoNumber(), 0b1011);
    EXPECT_EQ(shown().ta, true) << "15B, 6.1.5.21";
}

TEST_F(ReceivedProgramme, WithErrorsGivesWhatTheOtherBlocksHold) {
    hear("---- 0638 E0CD 4142");
    EXPECT_FALSE(shown().pi);
    EXPECT_EQ(shown().pty, 17);
    EXPECT_EQ(shown().psText(), "AB      ");
    hear("D3C2 ---- E0CD 4344");
    EXPECT_EQ(shown().pi, 0xD3C2);
    EXPECT_EQ(shown().psText(), "AB      ") << "which segment it was is not known";
    hear("D3C2 0629 ---- ----");
    EXPECT_EQ(shown().ta, false);
    EXPECT_EQ(shown().psText(), "AB      ");
    hear("D3C2 062A ---- 4546");
    EXPECT_EQ(shown().psText(), "AB  EF  ");
}

TEST_F(ReceivedProgramme, IsAlsoKnownFromBlock3OfVersionB) {
    hear("---- 0C08 D3C2 4142");
    EXPECT_EQ(shown().pi, 0xD3C2);
}

TEST_F(ReceivedProgramme, IsAnotherOneWhenItsPiCameTwice) {
    hear({"D3C2 0408 E0CD 4142", "D3C2 2410 5445 5854"});
    hear("1000 0409 E0CD 4344");
    EXPECT_EQ(shown().pi, 0xD3C2);
    EXPECT_EQ(shown().psText(), "AB      ");
    hear("1000 040A E0CD 4546");
    EXPECT_EQ(shown().pi, 0x1000);
    EXPECT_EQ(shown().psText(), "  CDEF  ");
    EXPECT_EQ(shown().radiotextText(), "");
    EXPECT_EQ(shown().groups, 4U);
}

TEST_F(ReceivedProgramme, StaysWhenAnotherPiCameOnlyOnce) {
    hear({"D3C2 0408 E0CD 4142", "1000 0409 E0CD 4344", "D3C2 0409 E0CD 4344", "1000 040A E0CD 4546"});
    EXPECT_EQ(shown().pi, 0xD3C2);
    EXPECT_EQ(shown().psText(), "ABCD    ");
}

class ReceivedRadiotext : public ReceiverTest {};

TEST_F(ReceivedRadiotext, EndsWithItsEndMark) {
    // 6.1.5.3: 2A, flag and segment in the last five bits, four characters.
    hear("D3C2 2400 4865 6C6C");
    EXPECT_EQ(shown().radiotextText(), "Hell");
    EXPECT_FALSE(shown().isRadiotextWhole());
    EXPECT_EQ(shown().radiotextB, false);
    hear("D3C2 2401 6F0D 2020");
    EXPECT_EQ(shown().radiotextText(), "Hello");
    EXPECT_TRUE(shown().isRadiotextWhole());
}

TEST_F(ReceivedRadiotext, OfVersionBHasTwoCharactersInAGroup) {
    hear({"D3C2 2C10 D3C2 4865", "D3C2 2C11 D3C2 790D"});
    EXPECT_EQ(shown().radiotextText(), "Hey");
    EXPECT_EQ(shown().radiotextB, true);
    EXPECT_TRUE(shown().isRadiotextWhole());
}

TEST_F(ReceivedRadiotext, HasBlanksWhereNothingCameYet) {
    hear("D3C2 2402 4142 ----");
    EXPECT_EQ(shown().radiotextText(), "        AB");
    EXPECT_FALSE(shown().isRadiotextWhole());
}

TEST_F(ReceivedRadiotext, IsClearedWhenTheFlagChanges) {
    hear({"D3C2 2400 4142 4344", "D3C2 2401 4546 4748"});
    hear("D3C2 2400 7879 7A7A");
    EXPECT_EQ(shown().radiotextText(), "xyzzEFGH") << "written over while the flag stays";
    hear("D3C2 2411 ---- ----");
    EXPECT_EQ(shown().radiotextText(), "");
    EXPECT_EQ(shown().radiotextB, true);
}

TEST_F(ReceivedRadiotext, Of64CharactersNeedsNoEndMark) {
    for (unsigned segment = 0; segment < 16; ++segment) {
        EXPECT_FALSE(shown().isRadiotextWhole());
        receiver.take({{0xD3C2, static_cast<std::uint16_t>(0x2400 + segment), 0x6162, 0x6364}});
    }
    EXPECT_TRUE(shown().isRadiotextWhole());
    EXPECT_EQ(shown().radiotextText().size(), 64U);
}

class ReceivedFrequencies : public ReceiverTest {
protected:
    void hearPairs(std::initializer_list<const char*> pairs) {
        for (const char* pair : pairs) hear(std::string("D3C2 0408 ") + pair + " 2020");
    }
};

TEST_F(ReceivedFrequencies, OfMethodAAreOneListWithItsCount) {
    // 6.2.1.6.3, example A of five frequencies: 89.3, 88.0, 100.0, 101.9, 107.9.
    hearPairs({"E512", "057D"});
    EXPECT_TRUE(shown().frequencies.empty());
    hearPairs({"90CC"});
    EXPECT_EQ(shown().frequencies, (Lists{{false, 0, {{89300}, {88000}, {100000}, {101900}, {107900}}}}));
}

TEST_F(ReceivedFrequencies, OfAnEvenCountEndWithAFiller) {
    hearPairs({"E405", "1944", "7DCD"});
    EXPECT_EQ(shown().frequencies, (Lists{{false, 0, {{88000}, {90000}, {94300}, {100000}}}}));
}

TEST_F(ReceivedFrequencies, OfMethodBArePairsWithTheTunedOne) {
    // 6.2.1.6.4: 89.3 tuned, 99.5 the same programme, 101.7 likewise, 88.8 and 102.6 regional variants, as their
    // pairs fall.
    hearPairs({"E912", "1278", "128E", "120D", "9712"});
    EXPECT_EQ(shown().frequencies, (Lists{{true, 89300, {{99500}, {101700}, {88800, true}, {102600, true}}}}));
}

TEST_F(ReceivedFrequencies, OfSeveralTransmittersAreSeveralLists) {
    hearPairs({"E312", "1278", "E378", "1278"});
    EXPECT_EQ(shown().frequencies, (Lists{{true, 89300, {{99500}}}, {true, 99500, {{89300}}}}));
}

TEST_F(ReceivedFrequencies, OfLongAndMediumWaveStandBehind250) {
    // 6.2.1.6.1, table 12: code 1 is 153 kHz, 16 is 531 kHz, 135 is 1602 kHz.
    hearPairs({"E412", "FA01", "FA10", "FA87"});
    EXPECT_EQ(shown().frequencies, (Lists{{false, 0, {{89300}, {153}, {531}, {1602}}}}));
}

TEST_F(ReceivedFrequencies, AreNoneWhereTheCountSaysSo) {
    hearPairs({"E112", "E0CD"});
    EXPECT_TRUE(shown().frequencies.empty());
}

TEST_F(ReceivedFrequencies, OfAListWithAnErrorWaitForTheNext) {
    hearPairs({"E312", "----", "1278"});
    EXPECT_TRUE(shown().frequencies.empty());
    hear("D3C2 ---- 1278 2020");
    hearPairs({"E312"});
    hear("D3C2 ---- 1278 2020");
    hearPairs({"1278"});
    EXPECT_TRUE(shown().frequencies.empty());
    hearPairs({"E312", "1278"});
    EXPECT_EQ(shown().frequencies.size(), 1U);
}

TEST_F(ReceivedFrequencies, ThatAreNoLongerRepeatedGo) {
    hearPairs({"E105", "E106", "E107"});
    for (int i = 0; i < 2; ++i) hearPairs({"E106", "E107"});
    EXPECT_EQ(shown().frequencies.size(), 3U) << "it may have been missed";
    hearPairs({"E106"});
    EXPECT_EQ(shown().frequencies, (Lists{{false, 0, {{88100}}}, {false, 0, {{88200}}}}));
}

TEST_F(ReceivedFrequencies, OfAListThatIsNeverHeardToItsEndAgainStay) {
    hearPairs({"E312", "1278", "E106"});
    for (int i = 0; i < 5; ++i) hearPairs({"E312", "----", "E106"});
    EXPECT_EQ(shown().frequencies, (Lists{{true, 89300, {{99500}}}, {false, 0, {{88100}}}}));
}

TEST_F(ReceivedFrequencies, OfAListThatBeginsAsBeforeGo) {
    hearPairs({"E312", "1278"});
    for (int i = 0; i < 4; ++i) hearPairs({"E312", "1279"});
    EXPECT_EQ(shown().frequencies, (Lists{{true, 89300, {{99600}}}}));
}

class ReceivedClock : public ReceiverTest {
protected:
    using Minutes = std::chrono::minutes;
    static std::chrono::sys_time<Minutes> utc(std::chrono::year_month_day day, Minutes sinceMidnight) {
        return std::chrono::sys_days{day} + sinceMidnight;
    }
    static std::chrono::local_time<Minutes> local(std::chrono::year_month_day day, Minutes sinceMidnight) {
        return std::chrono::local_days{day} + sinceMidnight;
    }
};

TEST_F(ReceivedClock, IsTheModifiedJulianDayAndUtc) {
    using namespace std::chrono;
    // 6.1.5.6; the day is the example of annex G, 45218 for the 6th of September 1982: B0A2, of which 01 is
    // in block 2 and 30A2 before the hour's upper bit in block 3. 01101 is the hour, 011110 the minute, 0 00010 one
    // hour ahead.
    hear("D3C2 4401 6144 D782");
    ASSERT_TRUE(shown().clock);
    EXPECT_EQ(shown().clock->modifiedJulianDay, 45218U);
    EXPECT_EQ(shown().clock->utc, utc(1982y / September / 6, 13h + 30min));
    EXPECT_EQ(shown().clock->local(), local(1982y / September / 6, 14h + 30min));
}

TEST_F(ReceivedClock, MayBeADayOffAtTheListener) {
    using namespace std::chrono;
    // 23:45 UTC: 1 0111, 101101, 45218. Ahead half an hour it is the next day; 12 hours (011000) behind at 00:15 the
    // day before.
    hear("D3C2 4401 6145 7B41");
    EXPECT_EQ(shown().clock->utc, utc(1982y / September / 6, 23h + 45min));
    EXPECT_EQ(shown().clock->local(), local(1982y / September / 7, 0h + 15min));
    hear("D3C2 4401 6144 03F8");
    EXPECT_EQ(shown().clock->utc, utc(1982y / September / 6, 15min));
    EXPECT_EQ(shown().clock->local(), local(1982y / September / 5, 12h + 15min));
}

TEST_F(ReceivedClock, GoesOverTheChangeOfDay) {
    using namespace std::chrono;
    // The last day of 2026 is 61405, EFDD: 01, then 6FDD and the hour's upper bit.
    hear("D3C2 4401 DFBB 7EC0");
    EXPECT_EQ(shown().clock->utc, utc(2026y / December / 31, 23h + 59min));
    hear("D3C2 4401 DFBC 0000");
    EXPECT_EQ(shown().clock->utc, utc(2027y / January / 1, 0min));
}

TEST_F(ReceivedClock, StaysWhenATimeIsNone) {
    hear("D3C2 4401 6144 D782");
    const auto before = shown().clock->utc;
    hear({"D3C2 4401 6145 8000", "D3C2 4401 6144 DF00", "D3C2 4401 ---- 0000", "D3C2 4401 6144 ----"});
    EXPECT_EQ(shown().clock->utc, before);
}

class ReceivedOtherNetworks : public ReceiverTest {
protected:
    const ReceivedNetwork& network(std::size_t index) { return shown().networks.at(index); }
};

TEST_F(ReceivedOtherNetworks, HaveTheirNameInVariants0To3) {
    // 6.1.5.20: 14A, TP of the other network, variant, its PI in block 4.
    hear({"D3C2 E010 5241 1234", "D3C2 E013 2D35 1234", "D3C2 E000 4F54 5678"});
    ASSERT_EQ(shown().networks.size(), 2U);
    EXPECT_EQ(network(0).pi, 0x1234);
    EXPECT_EQ(shownText(network(0).ps), "RA    -5");
    EXPECT_EQ(network(0).tp, true);
    EXPECT_EQ(network(1).pi, 0x5678);
    EXPECT_EQ(shownText(network(1).ps), "OT      ");
    EXPECT_EQ(network(1).tp, false);
    EXPECT_EQ(shown().psText(), "        ");
}

TEST_F(ReceivedOtherNetworks, HaveAListOfMethodAInVariant4) {
    hear({"D3C2 E004 E305 1234", "D3C2 E004 E119 5678", "D3C2 E004 197D 1234"});
    EXPECT_EQ(network(0).frequencies, (FrequencyList{false, 0, {{88000}, {90000}, {100000}}}));
    EXPECT_EQ(network(1).frequencies, (FrequencyList{false, 0, {{90000}}}));
}

TEST_F(ReceivedOtherNetworks, HaveMappedFrequenciesInVariants5To9) {
    hear({"D3C2 E005 011A 1234", "D3C2 E006 0144 1234", "D3C2 E007 01CC 1234", "D3C2 E008 0519 1234",
          "D3C2 E009 0110 1234", "D3C2 E005 011A 1234"});
    using Mapped = std::vector<ReceivedNetwork::Mapped>;
    EXPECT_EQ(network(0).mapped,
              (Mapped{{87600, 90100}, {87600, 94300}, {87600, 107900}, {88000, 90000}, {87600, 531}}));
}

TEST_F(ReceivedOtherNetworks, LoseAPairThatThreeTurnsWentWithout) {
    hear({"D3C2 E000 2020 1234", "D3C2 E005 011A 1234", "D3C2 E000 2020 1234", "D3C2 E005 0144 1234",
          "D3C2 E000 2020 1234", "D3C2 E005 0144 1234", "D3C2 E000 2020 1234", "D3C2 E005 0144 1234"});
    EXPECT_EQ(network(0).mapped.size(), 2U);
    hear("D3C2 E000 2020 1234");
    EXPECT_EQ(network(0).mapped, (std::vector<ReceivedNetwork::Mapped>{{87600, 94300}}));
}

TEST_F(ReceivedOtherNetworks, HaveTypeAndTaInVariant13) {
    hear("D3C2 E00D 1801 1234");
    EXPECT_EQ(network(0).pty, 3);
    EXPECT_EQ(network(0).ta, true);
    hear("D3C2 E00D F800 1234");
    EXPECT_EQ(network(0).pty, 31);
    EXPECT_EQ(network(0).ta, false);
}

TEST_F(ReceivedOtherNetworks, HaveLinkageAndItemNumberInVariants12And14) {
    hear({"D3C2 E00C 8123 1234", "D3C2 E00E 2D7B 1234"});
    EXPECT_EQ(network(0).linkage, 0x8123);
    EXPECT_EQ(network(0).itemNumber, 0x2D7B);
}

TEST_F(ReceivedOtherNetworks, SwitchByGroup14B) {
    // 6.2.1.8: TP and TA of the other network in front of three reserved bits.
    hear({"D3C2 E818 D3C2 1234"});
    EXPECT_EQ(network(0).tp, true);
    EXPECT_EQ(network(0).ta, true);
    hear({"D3C2 E810 D3C2 1234"});
    EXPECT_EQ(network(0).ta, false);
    EXPECT_EQ(network(0).lastGroup, 2U);
}

TEST_F(ReceivedOtherNetworks, AreNotToldApartWithoutBlock4) {
    hear({"D3C2 E010 5241 ----", "D3C2 E818 D3C2 ----"});
    EXPECT_TRUE(shown().networks.empty());
    hear("D3C2 E010 ---- 1234");
    EXPECT_EQ(network(0).tp, true);
    EXPECT_EQ(shownText(network(0).ps), "        ");
}

}  // namespace
}  // namespace kdx::air
