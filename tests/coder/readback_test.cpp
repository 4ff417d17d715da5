#include "coder/readback.h"

#include <gtest/gtest.h>

#include <ostream>
#include <set>
#include <string>
#include <vector>

#include "support/linkfixture.h"

namespace kdx {
namespace {

/// Captions that show their number.
struct NumberedCaptions {
    NumberedCaptions() {
        std::string section = "[numbers]\r\n";
        for (int number = 1; number < 300; ++number) {
            section += std::to_string(number) + "=<" + std::to_string(number) + ">\r\n";
        }
        bench.folder.write(kLanguageFile, section);
        bench.captions.load("numbers", "RDS");
    }
    test::Bench bench;
};

const ReadBack& readBack(const std::string& button) {
    for (const ReadBack& candidate : readBacks()) {
        if (candidate.button == button) return candidate;
    }
    throw std::out_of_range(button);
}

struct Words {
    const char* name;
    const char* button;
    std::vector<std::string> answers;
    std::string shown;
};

void PrintTo(const Words& words, std::ostream* out) {
    *out << words.button << " " << words.name;
}

class ReadBackWords : public ::testing::TestWithParam<Words> {};

TEST_P(ReadBackWords, AreMadeOfTheAnswers) {
    const NumberedCaptions numbered;
    EXPECT_EQ(readBack(GetParam().button).words(GetParam().answers, numbered.bench.captions), GetParam().shown);
}

std::string wordsName(const ::testing::TestParamInfo<Words>& info) {
    return std::string(info.param.button) + info.param.name;
}

INSTANTIATE_TEST_SUITE_P(
    DecoderInfo, ReadBackWords,
    ::testing::Values(Words{"Mono", "Command21", {"0"}, "Mono"}, Words{"Stereo", "Command21", {"1"}, "Stereo"},
                      Words{"Two", "Command21", {"2"}, "NN"}, Words{"Head", "Command21", {"3"}, "Stereo Kunstkopf"},
                      Words{"MonoCompressed", "Command21", {"4"}, "Mono compressed"},
                      Words{"StereoCompressed", "Command21", {"5"}, "Stereo compressed"},
                      // The quote at the end has always been shown.
                      Words{"QuoteStays", "Command21", {"6"}, "Stereo compressed Kunstkopf\""},
                      Words{"Seven", "Command21", {"7"}, "NN"}, Words{"Eight", "Command21", {"8"}, "<143>"},
                      Words{"ComparedAsText", "Command21", {"01"}, "<143>"},
                      Words{"FailedRead", "Command21", {""}, "<143>"}),
    wordsName);

INSTANTIATE_TEST_SUITE_P(
    Single, ReadBackWords,
    ::testing::Values(
        Words{"Speech", "Command20", {"S"}, "<57>"}, Words{"Music", "Command20", {"M"}, "<56>"},
        Words{"FailedRead", "Command20", {""}, "<143>"}, Words{"Unknown", "Command20", {"m"}, "m"},
        Words{"Off", "Command13", {"0"}, "<22>"}, Words{"Fifty", "Command13", {"1"}, "50\xB5s"},
        Words{"SeventyFive", "Command13", {"2"}, "75\xB5s"}, Words{"FailedRead", "Command13", {""}, "<143>"},
        Words{"Unknown", "Command13", {"3"}, "3"}, Words{"HundredKiloohm", "Command18", {"2"}, "Impedanz 100k "},
        Words{"SixHundredOhm", "Command18", {"1"}, "Impedanz 600 "}, Words{"Unknown", "Command18", {"0"}, ""},
        Words{"FailedRead", "Command18", {""}, ""}, Words{"Number", "Command11", {"4000"}, "FM <21>: 40000 Hz"},
        Words{"Fraction", "Command11", {"67.55"}, "FM <21>: 675.5 Hz"},
        Words{"NoNumber", "Command11", {"abc"}, "FM <21>: 0 Hz"}, Words{"FailedRead", "Command11", {""}, ""},
        Words{"Unit", "Command10", {"98.5"}, "98.5 MHz"}, Words{"FailedRead", "Command10", {""}, " MHz"},
        Words{"Unit", "Command22", {"-30"}, "-30 dBm"}, Words{"Prefix", "Command12", {"2"}, "Mod Quelle: 2"}),
    wordsName);

INSTANTIATE_TEST_SUITE_P(
    AsItStands, ReadBackWords,
    ::testing::Values(Words{"Text", "Command5", {"RADIO  1"}, "RADIO  1"}, Words{"Text", "Command6", {"D3C2"}, "D3C2"},
                      Words{"Text", "Command7", {"05"}, "05"}, Words{"Text", "Command8", {"10,0,News"}, "10,0,News"},
                      Words{"Text", "Command9", {"12:00:00"}, "12:00:00"}, Words{"Text", "Command15", {"3"}, "3"},
                      Words{"Text", "Command17", {"0A,2A"}, "0A,2A"}, Words{"FailedRead", "Command5", {""}, ""}),
    wordsName);

INSTANTIATE_TEST_SUITE_P(
    Several, ReadBackWords,
    ::testing::Values(
        Words{"On", "Command1", {"1", "350", "1", "A"}, "ARI <192>\nARI <21>: 3500 Hz\nDK\nA"},
        Words{"Off", "Command1", {"0", "350", "0", "A"}, "ARI <193>\nARI <21>: 3500 Hz\n<193>\nA"},
        Words{"AreaType", "Command1", {"1", "1", "2", ""}, "ARI <192>\nARI <21>: 10 Hz\nBK\n"},
        Words{"BothTypes", "Command1", {"1", "1", "3", ""}, "ARI <192>\nARI <21>: 10 Hz\nBK + DK\n"},
        Words{"UnknownType", "Command1", {"x", "1", "4", "F"}, "ARI x\nARI <21>: 10 Hz\n4\nF"},
        Words{"FailedReadsLeavePartsEmpty", "Command1", {"", "", "", ""}, "ARI \nARI \n<143>\n"},
        Words{"On", "Command14", {"1", "675", "10"}, "Pilot <192>\n<21>: 6750 Hz\nPhase: 10\xB0"},
        Words{"Off", "Command14", {"0", "2.5", "0"}, "Pilot <193>\n<21>: 25 Hz\nPhase: 0\xB0"},
        Words{"FailedReadsLeavePartsEmpty", "Command14", {"", "", ""}, "Pilot \n\nPhase: \xB0"},
        Words{"On", "Command16", {"1", "200"}, "RDS <192>\n<21>: 2000 Hz"},
        Words{"FailedReadsLeavePartsEmpty", "Command16", {"", ""}, "RDS \n"},
        Words{"FiveLists", "Command4", {"98.5", "", "c", "d", "e"}, "AF1: 98.5\nAF2: \nAF3: c\nAF4: d\nAF5: e"},
        Words{"NineParts",
              "Command19",
              {"D3C2", "OTHER", "1", "0", "a", "b", "c", "d", ""},
              "EON-PI:  D3C2 / EON-PS:  OTHER / EON-TP:  1 / EON-TA:  0 / \nEON-AFB1:  a / \nEON-AFB2:  b / "
              "\nEON-AFB3:  c / \nEON-AFB4:  d / \nEON-AFB5:  "}),
    wordsName);

TEST(ReadBackButtons, AreTwentyWithNamesAndCaptionsOfTheirOwn) {
    std::set<std::string> names;
    std::set<int> captions;
    for (const ReadBack& one : readBacks()) {
        names.insert(one.button);
        captions.insert(one.caption);
    }
    EXPECT_EQ(readBacks().size(), 20U);
    EXPECT_EQ(names.size(), 20U);
    EXPECT_EQ(captions.size(), 20U);
    for (int caption = 121; caption <= 138; ++caption) EXPECT_TRUE(captions.contains(caption)) << caption;
}

}  // namespace
}  // namespace kdx
