#include "coder/keyfacts.h"

#include <gtest/gtest.h>

#include <cctype>
#include <ostream>
#include <set>

#include "coder/rdscharacters.h"
#include "coder/sendparam.h"
#include "sim/virtualinstrument.h"
#include "support/fakeclock.h"

namespace kdx {
namespace {

TEST(KeyFactsTest, EveryKeyOfTheTableIsThereOnce) {
    std::set<std::string_view> keys;
    for (const KeyFacts& facts : keyFacts()) {
        EXPECT_TRUE(isParameter(facts.key)) << facts.key;
        EXPECT_TRUE(keys.insert(facts.key).second) << facts.key;
        EXPECT_FALSE(facts.meaning.empty()) << facts.key;
    }
    EXPECT_EQ(keys.size(), 60U);
}

/// Values of a key; a wrong one is wrong for the instrument too, unless it is of the kind that it cannot tell.
struct Case {
    const char* key;
    std::vector<std::string> legal;
    std::vector<std::string> wrong;
    std::vector<std::string> onlyForUs = {};
    friend void PrintTo(const Case& tried, std::ostream* out) { *out << tried.key; }
};

class LegalValues : public ::testing::TestWithParam<Case> {
protected:
    /// Whether the instrument takes the value; a network of that PI is there.
    static bool isTaken(const std::string& key, std::string value) {
        const test::FakeClock clock;
        sim::VirtualInstrument instrument(clock);
        instrument.execute(":STEREO:DIRECT \"EON-PI=D3C0\"");
        instrument.execute(":STEREO:DIRECT \"AF=N,98.5\"");
        instrument.execute("*CLS");
        const auto command = composeCommand(key, value, {"D3C0", "08:15:30", "23:59:58", "05.03.09"});
        instrument.execute(command.value());
        return !command->empty() && instrument.execute("SYST:ERR?").starts_with("0,");
    }
};

TEST_P(LegalValues, AreTheOnesThatTheInstrumentTakes) {
    const Case& tried = GetParam();
    for (const std::string& value : tried.legal) {
        EXPECT_EQ(wrongValue(tried.key, value), std::nullopt) << value;
        EXPECT_TRUE(isTaken(tried.key, value)) << value;
    }
    for (const std::string& value : tried.wrong) {
        EXPECT_NE(wrongValue(tried.key, value), std::nullopt) << value;
        EXPECT_FALSE(isTaken(tried.key, value)) << value;
    }
    for (const std::string& value : tried.onlyForUs) EXPECT_NE(wrongValue(tried.key, value), std::nullopt) << value;
}

const std::vector<std::string> kFlags = {"0", "1"};
const std::vector<std::string> kNoFlags = {"2", "", "on", "-1"};
const std::vector<std::string> kLists = {"N,98.5", "+,86.0,87.5,108.0", "N,86.0,86.0,87.6,86.0,107.9"};
const std::vector<std::string> kNoLists = {"98.5", "N,", "N", "N,98,5,", "N,108.1", "N,98.5,87.4", "N,98.5,,90.0"};
const std::vector<std::string> kPis = {"D3C0", "d3c0", "0000"};

std::string repeated(const std::string& part, int times) {
    std::string all;
    for (int i = 0; i < times; ++i) all += (i == 0 ? "" : ",") + part;
    return all;
}

INSTANTIATE_TEST_SUITE_P(
    Keys, LegalValues,
    ::testing::Values(
        Case{"PS", {"", "MESSTURM", "\xC4\xD6\xDC\xDF \x80"}, {}, {"MESSTURM1", "A\"B", "\x99", "A\nB"}},
        Case{"PI", kPis, {"D3C", "D3CG", "", "D3 0"}, {"D3C00"}},
        Case{"PTY", {"0", "31", "07"}, {"32"}, {"-1", "", "7.0", "132"}}, Case{"TP", kFlags, kNoFlags},
        Case{"TA", kFlags, {"2", "", "x", "-1"}, {"ON"}}, Case{"MS", {"M", "S"}, {"X", ""}, {"m"}},
        Case{"DI", {"0", "15"}, {"16", "-1", ""}},
        Case{"RT", {"", std::string(64, 'x')}, {std::string(65, 'x')}, {"~", "a\"b"}},
        Case{"RTA", {"", std::string(64, 'x')}, {std::string(65, 'x')}}, Case{"DEL_RT", {"", "anything"}, {}},
        Case{"UHR", {"OFF", "AUS", ""}, {}}, Case{"ZEIT", {"", "anything"}, {}}, Case{"RDS", kFlags, kNoFlags},
        Case{"RDS_HUB", {"0", "400", "12.5"}, {"400.1", "-0.1"}, {"20,5", "", "1e2"}},
        Case{"RDS_PHASE", {"0", "359"}, {"359.1", "-1", ""}}, Case{"AF1", kLists, kNoLists},
        Case{"AF5", kLists, kNoLists},
        Case{"GROUPSEQ",
             {"0A", "0A,2A,15B,0B", repeated("0A", 256)},
             {"16A", "0C", "", "0A,", "A", "001A", repeated("0A", 257)},
             {"0a"}},
        Case{"GROUPSEQ_TN", {"0A,14A"}, {"0A;2A"}}, Case{"STORE", {"1", "5"}, {"0", "6", ""}},
        Case{"ODA",
             {"00,0123456789", "31,ABCDEFabcd"},
             {"0,0123456789", "00,012345678", "00,01234567890", "00 0123456789"}},
        Case{"TMC", {"02,0B90E400CC"}, {"02,0B90E400C", "02,0B90E400CG", "02,2B90E400CC", ""}},
        Case{"TEST_M", {"0", "4"}, {"5", "-1"}}, Case{"TEST_D", {"0", "4"}, {"5", ""}},
        Case{"EON_PI", kPis, {"D3C", "D3CG", ""}, {"D3C00"}},
        Case{"EON_PS", {"", "MESSTURM"}, {}, {"MESSTURM1", "\x99"}}, Case{"EON_PTY", {"0", "31"}, {"32", "-1", ""}},
        Case{"EON_TP", kFlags, {"2", ""}}, Case{"EON_TA", kFlags, {"2", ""}},
        Case{"EON_AFA", {"98.5", "98.5,87.6,107.9"}, {"", "98.5,", "N,98.5"}}, Case{"EON_AFB1", kLists, kNoLists},
        Case{"EON_AFB5", kLists, kNoLists}, Case{"EON_DEL", {"D3C0"}, {"D3C", ""}},
        Case{"MPX_HUB", {"0", "8000", "675.5"}, {"8000.1", "-1"}, {"67,5", "abc", ""}},
        Case{"MPX_SOURCE", {"0", "1", "2", "3"}, {"4", "", "-1"}}, Case{"MPX_IMPEDANZ", {"1", "2"}, {"0", "3"}},
        Case{"STEREO_MODE", {"1", "2", "3", "4", "5"}, {"0", "6"}}, Case{"PREEMPHASIS", {"0", "1", "2"}, {"3"}},
        Case{"PILOT", kFlags, kNoFlags}, Case{"PILOT_HUB", {"0", "1500"}, {"1500.1", "-1"}},
        Case{"PILOT_PHASE", {"-180", "180", "2.5"}, {"-180.5", "180.5", ""}}, Case{"ARI", kFlags, kNoFlags},
        Case{"ARI-HUB", {"0", "800"}, {"800.1", "-1"}}, Case{"ARI-ID", {"0", "1", "2", "3"}, {"4"}},
        Case{"ARI-BK", {"A", "F"}, {"G", "", "1"}}, Case{"STEREO_EIN", {""}, {}}, Case{"FM_AUS", {"x"}, {}},
        Case{"HF:PEGEL:STATE", {"ON", "OFF"}, {"", "yes"}},
        Case{"HF-Frequenz", {"0.1", "1040", "98.5"}, {"0.09", "1040.1", "x"}, {"98,5"}},
        Case{"HF-Pegel", {"0", "120", "60.5"}, {"-0.1", "120.1"}, {"60,5"}},
        Case{"NF-Frequenz", {"0.02", "80"}, {"0.01", "80.1"}}),
    [](const auto& tested) {
        std::string name = tested.param.key;
        std::erase_if(name, [](unsigned char c) { return std::isalnum(c) == 0; });
        return name;
    });

TEST(WrongValueTest, NamesKeyValueAndTheLegalRange) {
    EXPECT_EQ(wrongValue("HF-Frequenz", "98,5"),
              "HF-Frequenz cannot be \"98,5\": it has a decimal comma. Legal: 0.1 to 1040 MHz, with a decimal point.");
    EXPECT_EQ(wrongValue("PI", "D3CG"), "PI cannot be \"D3CG\". Legal: four hexadecimal digits.");
    EXPECT_EQ(wrongValue("PS", "TRADE\x99"),
              "PS cannot be \"TRADE™\": RDS has no code for its character ™. Legal: at most 8 characters of the RDS "
              "character set, no double quote.");
    EXPECT_EQ(wrongValue("PSS", "x"), "there is no key PSS");
    EXPECT_EQ(wrongValue("ARI-BK", "G"), "ARI-BK cannot be \"G\". Legal: A, B, C, D, E or F.");
}

TEST(WrongValueTest, WhatIsCorrectedOnTheWayIsNotWrong) {
    const Corrections all{.decimalComma = true, .quotes = true};
    for (const auto& [key, value] : {std::pair("HF-Frequenz", "98,7"), std::pair("PS", "A\"B")}) {
        EXPECT_NE(wrongValue(key, value), std::nullopt);
        EXPECT_EQ(wrongValue(key, value, all), std::nullopt);
    }
    for (const auto& [key, value] : {std::pair("HF-Frequenz", "2000,5"), std::pair("HF-Frequenz", "1,0,0"),
                                     std::pair("PTY", "1,0"), std::pair("PS", "\"12345678")}) {
        EXPECT_NE(wrongValue(key, value, all), std::nullopt) << key << "=" << value;
    }
    EXPECT_EQ(correctedValue("HF-Frequenz", "98,7", all), "98.7");
    EXPECT_EQ(correctedValue("HF-Frequenz", "98,7", {}), "98,7");
    for (const char* key : {"AF1", "PS", "TMC", "XY"}) EXPECT_EQ(correctedValue(key, "98,7", all), "98,7") << key;
}

TEST(RdsCodeTest, FollowsTheBasicCharacterSet) {
    EXPECT_EQ(rdsCode('A'), 0x41);
    EXPECT_EQ(rdsCode('$'), 0xAB);
    EXPECT_EQ(rdsCode('\xE4'), 0x91);  // ä
    EXPECT_EQ(rdsCode('\xF6'), 0x97);  // ö
    EXPECT_EQ(rdsCode('\xFC'), 0x99);  // ü
    EXPECT_EQ(rdsCode('\xDF'), 0x8D);  // ß
    EXPECT_EQ(rdsCode('\xE9'), 0x82);  // é
    EXPECT_EQ(rdsCode('\x80'), 0xA9);  // euro sign
    EXPECT_EQ(rdsCode('~'), std::nullopt);
    EXPECT_EQ(rdsCode('^'), std::nullopt);
    EXPECT_EQ(rdsCode('\n'), std::nullopt);
    EXPECT_EQ(rdsCode('\x99'), std::nullopt);
}

TEST(WrongTypedValueTest, NamesTheCharacterThatTheInstrumentDoesNotHave) {
    EXPECT_EQ(
        wrongTypedValue("PS", "日本"),
        "PS cannot be \"日本\": the instrument's character set (Windows-1252) has no 日. Legal: at most 8 characters "
        "of the RDS character set, no double quote.");
    EXPECT_EQ(
        wrongTypedValue("PS", "K\xFF"),
        "PS cannot be \"K\xFF\": its byte \\xFF is no UTF-8. Legal: at most 8 characters of the RDS character set, "
        "no double quote.");
    EXPECT_EQ(wrongTypedValue("PS", "Käse?"), std::nullopt);
    EXPECT_EQ(wrongTypedValue("PTY", "32"), wrongValue("PTY", "32"));
    EXPECT_EQ(wrongTypedValue("XY", "日"), "there is no key XY");
}

}  // namespace
}  // namespace kdx
