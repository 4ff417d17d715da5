#include "air/airtest.h"

namespace kdx::air {
namespace {

class BasicGroups : public AirTest {};

const Groups kBasic = {"1000 0008 E0CD 4B44", "1000 0009 E0CD 582D", "1000 000A E0CD 5834", "1000 000F E0CD 2020"};

TEST_F(BasicGroups, WithoutRadiotextTheSequenceAfterSwitchingOnIs0AAlone) {
    Groups twice = kBasic;
    twice.insert(twice.end(), kBasic.begin(), kBasic.end());
    EXPECT_EQ(next(8), twice);
    EXPECT_TRUE(warnings.empty());
}

TEST_F(BasicGroups, HaveEveryFlagInItsPlace) {
    // TP 0400, PTY 10 at the sixth bit 0140, TA 0010, speech 0000, all bits of DI 0004, segments 0 to 3.
    for (const char* command : {"PI=D3C2", "TP=1", "PTY=10", "TA=1", "MS=S", "DI=15"}) coder(command);
    EXPECT_EQ(next(4),
              (Groups{"D3C2 0554 E0CD 4B44", "D3C2 0555 E0CD 582D", "D3C2 0556 E0CD 5834", "D3C2 0557 E0CD 2020"}));
}

TEST_F(BasicGroups, SendTheHighestBitOfTheDecoderInformationFirst) {
    coder("DI=8");
    EXPECT_EQ(block(2, 4), (Groups{"000C", "0009", "000A", "000B"}));
    coder("DI=6");
    EXPECT_EQ(block(2, 4), (Groups{"0008", "000D", "000E", "000B"}));
}

TEST_F(BasicGroups, OfVersionBRepeatThePiAndShareTheSegmentsOfVersionA) {
    coder("GS=0B,0A");
    EXPECT_EQ(next(5), (Groups{"1000 0808 1000 4B44", "1000 0009 E0CD 582D", "1000 080A 1000 5834",
                               "1000 000F E0CD 2020", "1000 0808 1000 4B44"}));
}

TEST_F(BasicGroups, FastTuningRepeatsBlock2InBlock4) {
    coder("GS=15B");
    EXPECT_EQ(next(5), (Groups{"1000 F808 1000 F808", "1000 F809 1000 F809", "1000 F80A 1000 F80A",
                               "1000 F80F 1000 F80F", "1000 F808 1000 F808"}));
    coder("TP=1");
    coder("TA=1");
    coder("PTY=31");
    EXPECT_EQ(next(), "1000 FFF9 1000 FFF9");
}

TEST_F(BasicGroups, FastTuningCountsItsSegmentsAlone) {
    coder("GS=15B,0A");
    EXPECT_EQ(block(2, 4), (Groups{"F808", "0008", "F809", "0009"}));
}

TEST_F(BasicGroups, AChangedPsBeginsAtItsFirstSegmentTheSameOneGoesOn) {
    EXPECT_EQ(block(4, 2), (Groups{"4B44", "582D"}));
    coder("PS=KDX-X4");
    EXPECT_EQ(block(4, 1), (Groups{"5834"}));
    coder("PS=ABCDEFGH");
    EXPECT_EQ(next(5), (Groups{"1000 0008 E0CD 4142", "1000 0009 E0CD 4344", "1000 000A E0CD 4546",
                               "1000 000F E0CD 4748", "1000 0008 E0CD 4142"}));
}

TEST_F(BasicGroups, TextsAreInTheBasicCharacterSet) {
    // Windows-1252 E4 F6 FC DF E9 80 24 5F; the codes from the standard's table.
    coder("PS=\xE4\xF6\xFC\xDF\xE9\x80$_");
    EXPECT_EQ(block(4, 4), (Groups{"9197", "998D", "82A9", "AB5F"}));
    EXPECT_TRUE(warnings.empty());
}

TEST_F(BasicGroups, ACharacterWithoutAPlaceIsABlankAndToldOnce) {
    coder(
        "PS=A^B\x85"
        "C^");
    EXPECT_EQ(block(4, 4), (Groups{"4120", "4220", "4320", "2020"}));
    coder("PS=X^");
    EXPECT_EQ(block(4, 1), (Groups{"5820"}));
    EXPECT_EQ(warnings, (Groups{"PS: \"^\" has no place in the RDS character set and is sent as a blank",
                                "PS: \"…\" has no place in the RDS character set and is sent as a blank"}));
}

class GroupSequence : public AirTest {
protected:
    GroupSequence() { coder("RT=10,0,HI"); }
    /// Types in the order of the next groups, as the first hexadecimal digits of block 2.
    std::string types(int count) {
        std::string digits;
        for (const std::string& word : block(2, count)) digits += word.substr(0, 1);
        return digits;
    }
};

TEST_F(GroupSequence, IsARing) {
    coder("GS=2A,0A,0A");
    EXPECT_EQ(types(9), "200200200");
}

TEST_F(GroupSequence, ANewOneBeginsAtItsFirstSlotTheSameOneGoesOn) {
    coder("GS=0A,0A,2A,2A");
    EXPECT_EQ(types(3), "002");
    coder("GS=0A,0A,2A,2A");
    EXPECT_EQ(types(3), "200");
    coder("GS=2A,0A");
    EXPECT_EQ(types(3), "202");
}

TEST_F(GroupSequence, TypesWithoutDataPassTheirSlotTo0A) {
    coder("RT=0,0,");
    coder("GS=0A,1A,1B,2A,2B,3A,3B,4A,4B,5A,7A,8A,8B,9A,10A,11A,12A,13A,14A,14B,15A");
    coder("CT=12:00:00,01.01.26");
    Groups words = block(2, 21);
    for (std::size_t i = 0; i < words.size(); ++i) {
        const std::array expected = {"0008", "0009", "000A", "000F"};
        EXPECT_EQ(words[i], expected.at(i % 4)) << i;
    }
}

TEST_F(GroupSequence, NothingGoesOutWhileRdsIsOff) {
    tell(":STEREO:RDS:STATE OFF");
    EXPECT_EQ(next(3), (Groups{"-", "-", "-"}));
    tell(":STEREO:RDS:STATE ON");
    EXPECT_EQ(next(), "1000 0008 E0CD 4B44");
}

TEST_F(GroupSequence, APatternGoesOutInTestMode) {
    const std::pair<const char*, int> patterns[] = {
        {"BIN=1", 0b00000000}, {"BIN=2", 0b11111111}, {"BIN=3", 0b01010101}, {"BIN=4", 0b11001100}};
    for (const auto& [command, bits] : patterns) {
        coder(command);
        const OnAir sent = broadcast.next();
        EXPECT_EQ(sent.kind, OnAir::Kind::Pattern);
        EXPECT_EQ(sent.pattern, bits);
    }
    tell(":STEREO:RDS:STATE OFF");
    EXPECT_EQ(broadcast.next().kind, OnAir::Kind::Nothing);
    tell(":STEREO:RDS:STATE ON");
    coder("BIN=0");
    EXPECT_EQ(next(), "1000 0008 E0CD 4B44");
}

TEST_F(GroupSequence, EachGroupTakes104BitsOf1187Point5ASecond) {
    (void)next(2375);
    EXPECT_EQ(broadcast.time(), noon() + std::chrono::seconds{208});
}

TEST_F(GroupSequence, OpenDataAndTrafficMessagesAreSentAgainAsTheirSlotsCome) {
    coder("GS=3A,8A");
    coder("3A=01,106100CD46");
    coder("8A=02,08680D2345");
    EXPECT_EQ(next(4),
              (Groups{"1000 3010 6100 CD46", "1000 8008 680D 2345", "1000 3010 6100 CD46", "1000 8008 680D 2345"}));
    coder("3A=01,100066CD47");
    coder("8A=99,1fffffffff");
    coder("TP=1");
    EXPECT_EQ(next(2), (Groups{"1000 3410 0066 CD47", "1000 841F FFFF FFFF"}));
}

TEST_F(GroupSequence, ARefusedCommandIsToldAndChangesNothing) {
    coder("PI=XYZ");
    EXPECT_EQ(next(), "1000 0008 E0CD 4B44");
    EXPECT_EQ(warnings, (Groups{"refused: :STEREO:DIRECT \"PI=XYZ\" (-224,\"Illegal parameter value\")"}));
}

}  // namespace
}  // namespace kdx::air
