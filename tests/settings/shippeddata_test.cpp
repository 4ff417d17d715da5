#include "settings/datafolder.h"
#include "support/sourcefolder.h"

#include "base/codepage.h"
#include "base/numbers.h"
#include "settings/profilefile.h"

#include <algorithm>
#include <array>
#include <charconv>
#include <filesystem>
#include <map>
#include <ostream>
#include <set>
#include <string>
#include <string_view>
#include <vector>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace kdx {
namespace {

using ::testing::IsEmpty;
using ::testing::SizeIs;

using Keys = std::map<std::string, std::string>;  // in one section: key as written, value as written
using Sections = std::map<std::string, Keys>;     // by the section's name as written
constexpr std::array kLanguages = {"deutsch", "english", "english US"};
constexpr int kOwnTexts = 300;  // from here up the texts are numbered by area, without gaps being a fault

// Numbers that captions, message boxes and indicators ask for in every language.
const std::vector<int>& captionNumbers() {
    static const std::vector<int> numbers = {
        0,   1,   2,   3,   4,   6,                                                      // menus, exit
        10,  11,  12,  13,  14,  15,  16,  17,  18,                                      // pages
        20,  21,  22,  23,  24,  25,  26,  27,  28,  29,                                 // stereo
        40,  41,  47,  48,  49,  52,  53,  54,  55,  56,  57,                            // RDS
        59,  60,  61,  62,  63,  64,  65,  66,                                           // decoder information
        71,  72,  73,  74,  75,  76,  81,  82,  83,  86,  87,  88,  89,  156,            // AF, groups, EON
        121, 122, 123, 124, 125, 126, 127, 128, 129, 130, 131, 132, 133, 134, 135, 136,  // read-back
        137, 138, 139, 142, 143, 144,                                                    //
        161, 162, 163, 164, 165, 166, 167, 168, 169,                                     // AF editor, EON TA
        192, 193, 196, 197, 200, 201, 202, 203, 204, 205, 206, 229, 230,                 // on, off, TMC
        210, 211, 212, 213, 214, 215, 216, 217, 218, 219, 220, 221, 222,                 // RF and audio
    };
    return numbers;
}

std::vector<std::string> linesOf(const std::string& bytes) {
    std::vector<std::string> lines;
    std::size_t start = 0;
    for (std::size_t end = 0; (end = bytes.find("\r\n", start)) != std::string::npos; start = end + 2)
        lines.push_back(bytes.substr(start, end - start));
    if (start < bytes.size()) lines.push_back(bytes.substr(start));
    return lines;
}

/// Quotes hold the blanks at the ends of a text.
std::string withoutQuotes(const std::string& value) {
    const bool quoted = value.size() > 1 && value.front() == '"' && value.back() == '"';
    return quoted ? value.substr(1, value.size() - 2) : value;
}

template <typename Parameter>
std::string caseName(const ::testing::TestParamInfo<Parameter>& info) {
    return info.param.caseName;
}

class ShippedData : public ::testing::Test {
protected:
    [[nodiscard]] std::string bytes(std::string_view name) const {
        const auto content = readFile(m_data.file(name));
        EXPECT_TRUE(content.has_value()) << name;
        return content.value_or("");
    }
    /// Every section and key of a profile file as it is written; a name that comes twice is a fault, for the later
    /// one could never be read.
    [[nodiscard]] Sections sections(std::string_view name) const {
        Sections all;
        std::set<std::string> seen;
        std::string section;
        for (const std::string& line : linesOf(bytes(name))) {
            if (line.empty() || line.starts_with(';')) continue;
            if (line.starts_with('[')) {
                section = line.substr(1, line.find(']') - 1);
                EXPECT_TRUE(seen.insert(upperCase(section) + "]").second) << name << ": section again: " << section;
                all[section];
                continue;
            }
            const std::size_t equals = line.find('=');
            EXPECT_NE(equals, std::string::npos) << name << ": neither header, key nor comment: " << line;
            const std::string key = line.substr(0, equals);
            EXPECT_TRUE(seen.insert(upperCase(section) + "]" + upperCase(key)).second)
                << name << " [" << section << "]: key again: " << key;
            all[section][key] = line.substr(std::min(equals, line.size() - 1) + 1);
        }
        return all;
    }
    [[nodiscard]] std::string text(std::string_view language, int number) const {
        return m_data.ReadIni(language, std::to_string(number), kLanguageFile);
    }

    DataFolder m_data{test::sourceFolder()};
};

TEST_F(ShippedData, EveryNumberHasATextInEveryLanguage) {
    for (const char* language : kLanguages) {
        for (const int number : captionNumbers())
            EXPECT_THAT(text(language, number), Not(IsEmpty())) << language << " " << number;
    }
}

TEST_F(ShippedData, TheThreeLanguagesHaveTheSameNumbers) {
    const Sections all = sections(kLanguageFile);
    const auto keys = [&](const char* language) {
        std::set<std::string> found;
        for (const auto& [key, value] : all.at(language)) {
            found.insert(key);
            EXPECT_THAT(value, Not(IsEmpty())) << language << " " << key;
        }
        return found;
    };
    EXPECT_EQ(keys("deutsch"), keys("english"));
    EXPECT_EQ(keys("deutsch"), keys("english US"));
}

TEST_F(ShippedData, ANumberBelowTheOwnTextsIsOneThatIsAskedFor) {
    const std::set<int> known(captionNumbers().begin(), captionNumbers().end());
    const Sections all = sections(kLanguageFile);
    for (const auto& [key, value] : all.at("deutsch")) {
        int number = -1;
        const auto [end, error] = std::from_chars(key.data(), key.data() + key.size(), number);
        EXPECT_TRUE(error == std::errc{} && end == key.data() + key.size()) << key;
        EXPECT_EQ(std::to_string(number), key) << "leading zeros would hide the text";
        EXPECT_TRUE(number >= kOwnTexts || known.contains(number)) << key;
    }
}

TEST_F(ShippedData, EveryTextSurvivesReading) {
    const Sections all = sections(kLanguageFile);
    for (const auto& [section, keys] : all) {
        for (const auto& [key, value] : keys)
            EXPECT_EQ(m_data.ReadIni(section, key, kLanguageFile), withoutQuotes(value)) << section << " " << key;
    }
}

TEST_F(ShippedData, TheGroupHeadingFitsTheFixedCutOfEveryLanguage) {
    EXPECT_EQ(text("deutsch", 83), "Gruppenfolge");
    EXPECT_THAT(text("english", 83), SizeIs(13));
    EXPECT_THAT(text("english US", 83), SizeIs(12));  // is cut as the German one is
    for (const char* language : kLanguages)
        EXPECT_EQ(text(language, 83).find(':'), std::string::npos) << "the colon is put behind it";
}

TEST_F(ShippedData, TheOnAndOffWordsAreBare) {
    EXPECT_EQ(text("deutsch", 192), "ein");
    EXPECT_EQ(text("deutsch", 193), "aus");
    for (const char* language : {"english", "english US"}) {
        EXPECT_EQ(text(language, 192), "on");
        EXPECT_EQ(text(language, 193), "off");
    }
}

TEST_F(ShippedData, TextsShownInLabelsAndBoxesHaveNoMnemonicMark) {
    for (const char* language : kLanguages) {
        for (const int number : {21,  22,  40,  41,  56,  57,  74,  81,  83,  88,  139, 142, 143, 144, 161, 162,
                                 163, 164, 165, 166, 167, 168, 169, 192, 193, 210, 211, 213, 214, 216, 217, 220})
            EXPECT_EQ(text(language, number).find('&'), std::string::npos) << language << " " << number;
    }
}

TEST_F(ShippedData, NineTabsFitBesideEachOther) {
    for (const char* language : kLanguages)
        for (int page = 10; page <= 18; ++page) EXPECT_LE(text(language, page).size(), 11U) << language << " " << page;
}

TEST_F(ShippedData, MessagesWithAPlaceForAFileOrAnErrorNameIt) {
    for (const char* language : kLanguages) {
        EXPECT_NE(text(language, 312).find("%1"), std::string::npos) << language;
        EXPECT_NE(text(language, 314).find("%1"), std::string::npos) << language;
        EXPECT_NE(text(language, 314).find("%2"), std::string::npos) << language;
    }
}

TEST_F(ShippedData, EveryProgrammeTypeHasANameThatFitsItsIndicator) {
    const Sections all = sections(kLanguageFile);
    for (const char* list : {"PTY-Liste_D", "PTY-Liste_E", "PTY-Liste_US"}) {
        EXPECT_THAT(all.at(list), SizeIs(32)) << list;
        for (int type = 0; type < 32; ++type) {
            const std::string number = std::to_string(type);
            const std::string name = m_data.ReadIni(list, std::string(3 - number.size(), '0') + number, kLanguageFile);
            EXPECT_THAT(name, Not(IsEmpty())) << list << " " << type;
            EXPECT_LE(name.size(), 17U) << list << " " << type;
        }
    }
}

struct TextFile {
    const char* name;
    const char* caseName;
};
void PrintTo(const TextFile& file, std::ostream* out) {
    *out << file.name;
}

class ShippedTextFile : public ShippedData, public ::testing::WithParamInterface<TextFile> {};

TEST_P(ShippedTextFile, IsCodePageTextInCompleteLinesThatReadsDoNotCut) {
    const std::string content = bytes(GetParam().name);
    ASSERT_TRUE(content.ends_with("\r\n"));
    for (const std::string& line : linesOf(content)) {
        EXPECT_LE(line.size(), kLongestValue) << line;
        for (const char character : line) {
            const auto byte = static_cast<unsigned char>(character);
            EXPECT_GE(byte, 0x20) << line;
            const bool open =
                byte == 0x7F || byte == 0x81 || byte == 0x8D || byte == 0x8F || byte == 0x90 || byte == 0x9D;
            EXPECT_FALSE(open) << "no character of the code page: " << int{byte} << " in " << line;
        }
        // UTF-8 written by mistake: every accented letter, degree and micro sign would start with one of these.
        EXPECT_EQ(line.find_first_of("\xC2\xC3"), std::string::npos) << line;
    }
}

INSTANTIATE_TEST_SUITE_P(Files, ShippedTextFile,
                         ::testing::Values(TextFile{"Sprachen.ini", "Language"}, TextFile{"RDS_Allg.INI", "General"},
                                           TextFile{"Datenset1.INI", "Set1"}, TextFile{"Datenset2.INI", "Set2"},
                                           TextFile{"Datenset3.INI", "Set3"}, TextFile{"Datenset4.INI", "Set4"},
                                           TextFile{"Datenset5.INI", "Set5"}, TextFile{"Event.txt", "Events"},
                                           TextFile{"Location.txt", "Locations"}),
                         caseName<TextFile>);

TEST_F(ShippedData, TheGeneralSettingsAreComplete) {
    const Sections all = sections(kGeneralSettings);
    const auto read = [&](const char* section, const char* key) {
        return m_data.ReadIni(section, key, kGeneralSettings);
    };
    EXPECT_EQ(read("BUS", "INTERFACE"), "TCPIP");
    EXPECT_NE(upperCase(read("BUS", "IECBUS")), "AUTO") << "a first start must not reach for an instrument";
    EXPECT_EQ(read("ADRESSEN", "KDX_IEEE"), "28");
    EXPECT_EQ(read("ADRESSEN", "KDX_TCPIP"), "127.0.0.1");
    EXPECT_EQ(read("ADRESSEN", "Log_Key"), "1");
    EXPECT_EQ(read("Sprache", "Sprache"), "deutsch");
    EXPECT_EQ(read("Sprache", "RDS_RBDS"), "RDS");
    for (const char* key : {"MPX_DEV", "MPX_SOURCE", "MPX_IMPEDANZ", "Stereo_Mode", "PREEMPHASIS", "PILOT", "PILOT_HUB",
                            "PILOT_PHASE", "ARI", "ARI_HUB", "ARI_ID", "ARI_BK", "RDS", "RDS_HUB", "RDS_PHASE"})
        EXPECT_THAT(read("FM", key), Not(IsEmpty())) << key;
    // In units of 10 Hz, as long as the scroll bars store them.
    EXPECT_THAT(read("FM", "MPX_DEV"), SizeIs(5));
    EXPECT_LE(leadingNumber(read("FM", "MPX_DEV")), 8000);
    for (const auto& [key, most] : {std::pair{"PILOT_HUB", 1500}, {"RDS_HUB", 400}, {"ARI_HUB", 800}}) {
        EXPECT_THAT(read("FM", key), SizeIs(4)) << key;
        EXPECT_LE(leadingNumber(read("FM", key)), most) << key;
    }
    EXPECT_LT(leadingNumber(read("RDS", "TA_ON")), leadingNumber(read("RDS", "TA_REP")));
    EXPECT_GT(leadingNumber(read("RDS", "PS_Dyn")), 0);
}

class ShippedDataSet : public ShippedData, public ::testing::WithParamInterface<int> {
protected:
    [[nodiscard]] std::string read(const char* section, const std::string& key) const {
        return m_data.ReadIni(section, key, dataSetFile(std::to_string(GetParam())));
    }
};

/// True for a tuned frequency and at least one other, decimal MHz with one decimal, separated by single commas. Each
/// must have an AF code of RDS, which counts from 87.6 to 107.9 in steps of 0.1 MHz.
bool isAfList(const std::string& list) {
    std::size_t frequencies = 0;
    for (std::size_t start = 0; start <= list.size(); ++frequencies) {
        const std::size_t end = std::min(list.find(',', start), list.size());
        const std::string frequency = list.substr(start, end - start);
        const std::size_t point = frequency.find('.');
        if (point == std::string::npos || point + 2 != frequency.size() ||
            frequency.find_first_not_of("0123456789.") != std::string::npos)
            return false;
        if (leadingNumber(frequency) < 87.6 || leadingNumber(frequency) > 107.9) return false;
        start = end + 1;
    }
    return frequencies >= 2;
}

TEST_P(ShippedDataSet, IsAWholeStation) {
    for (const char* identification : {"PI", "EON_PI"}) {
        const std::string pi = read("RDS", identification);
        EXPECT_THAT(pi, SizeIs(4));
        EXPECT_EQ(pi.find_first_not_of("0123456789ABCDEF"), std::string::npos) << pi;
    }
    for (const char* name : {"PS", "EON_PS"}) {
        EXPECT_THAT(read("RDS", name), Not(IsEmpty()));
        EXPECT_LE(read("RDS", name).size(), 8U);
    }
    for (const char* type : {"PTY", "EON_PTY"}) {
        // The list position: a name would be read as 0.
        EXPECT_EQ(std::to_string(static_cast<int>(leadingNumber(read("RDS", type)))), read("RDS", type));
        EXPECT_LE(leadingNumber(read("RDS", type)), 31);
    }
    EXPECT_TRUE(read("RDS", "MS") == "M" || read("RDS", "MS") == "S");
    for (const char* key : {"DI", "AF_LISTE", "EON_TP", "EON_TA", "EON_AFB", "TMC"})
        EXPECT_THAT(read("RDS", key), Not(IsEmpty())) << key;
    for (const char* radiotext : {"RTA", "RTB"}) {
        EXPECT_THAT(read("RDS", radiotext), Not(IsEmpty()));
        EXPECT_LE(read("RDS", radiotext).size(), 57U) << "one answer with its quotes and line feed has 60 bytes";
    }
    EXPECT_TRUE(read("RDS", "GR_FOLGE").ends_with("A,"));
}

TEST_P(ShippedDataSet, HasFiveWellFormedListsOfEachKind) {
    for (const char* kind : {"AF_LISTE", "EON_AFB"}) {
        for (int list = 1; list <= 5; ++list) {
            const std::string text = read("RDS", kind + std::to_string(list));
            EXPECT_TRUE(isAfList(text)) << kind << list << "=" << text;
            EXPECT_LE(std::ranges::count(text, ','), 12) << "method B refuses more: " << text;
        }
    }
}

TEST_P(ShippedDataSet, HasRfAndAudioValuesInsideItsLimits) {
    const auto number = [this](const char* key) { return leadingNumber(read("VRN", key)); };
    EXPECT_LT(number("FM_Ulim"), number("HF_Frequenz"));
    EXPECT_LT(number("HF_Frequenz"), number("FM_Olim"));
    EXPECT_LT(number("NF_Ulim"), number("NF_Frequenz"));
    EXPECT_LT(number("NF_Frequenz"), number("NF_Olim"));
    EXPECT_GT(number("HF_Pegel"), 0);
    EXPECT_LT(number("HF_Pegel"), 120);
}

INSTANTIATE_TEST_SUITE_P(Sets, ShippedDataSet, ::testing::Range(1, 6));

TEST_F(ShippedData, TheDataSetsDiffer) {
    std::set<std::string> contents;
    for (int set = 1; set <= 5; ++set) {
        EXPECT_THAT(sections(dataSetFile(std::to_string(set))), SizeIs(2));
        contents.insert(bytes(dataSetFile(std::to_string(set))));
    }
    EXPECT_THAT(contents, SizeIs(5));
}

struct TmcList {
    const char* file;
    std::size_t longestText;
    std::size_t atLeast;
    int highestCode;
    const char* caseName;
};
void PrintTo(const TmcList& list, std::ostream* out) {
    *out << list.file;
}

class ShippedTmcList : public ShippedData, public ::testing::WithParamInterface<TmcList> {};

TEST_P(ShippedTmcList, EveryLineIsATextAndAFiveDigitCodeOfItsOwn) {
    const TmcList& list = GetParam();
    const std::vector<std::string> lines = linesOf(bytes(list.file));
    EXPECT_GE(lines.size(), list.atLeast);
    std::set<std::string> codes;
    std::set<std::string> texts;
    for (const std::string& line : lines) {
        const std::size_t semicolon = line.find(';');
        ASSERT_NE(semicolon, std::string::npos) << line;
        const std::string code = line.substr(semicolon + 1);
        EXPECT_GT(semicolon, 0U) << line;
        EXPECT_LE(semicolon, list.longestText) << line;
        EXPECT_THAT(code, SizeIs(5)) << line;
        EXPECT_EQ(code.find_first_not_of("0123456789"), std::string::npos) << line;
        EXPECT_GT(leadingNumber(code), 0) << line;
        EXPECT_LE(leadingNumber(code), list.highestCode) << line;
        EXPECT_TRUE(codes.insert(code).second) << line;
        EXPECT_TRUE(texts.insert(line.substr(0, semicolon)).second) << line;
    }
}

// Event codes have 11 bits. Location codes have 16, but tables of locations end at 63487: the codes above it mean no
// place of a table. A message list shows 35 characters of either text.
INSTANTIATE_TEST_SUITE_P(Lists, ShippedTmcList,
                         ::testing::Values(TmcList{kEventList, 42, 400, 2047, "Events"},
                                           TmcList{kLocationList, 35, 60, 63487, "Locations"}),
                         caseName<TmcList>);

TEST_F(ShippedData, ThePicturesAreIconsForOneAndTwoScreenScales) {
    for (const char* name : {kPictureOn, kPictureOff}) {
        const std::string icon = bytes(name);
        ASSERT_GE(icon.size(), 6U) << name;
        EXPECT_EQ(icon.substr(0, 4), std::string("\0\0\1\0", 4)) << name;
        const auto count = static_cast<unsigned char>(icon[4]);
        ASSERT_GE(icon.size(), 6U + 16U * count) << name;
        std::set<std::pair<int, int>> sizes;
        for (std::size_t at = 6; at < 6U + 16U * count; at += 16) {
            sizes.insert({static_cast<unsigned char>(icon[at]), static_cast<unsigned char>(icon[at + 1])});
        }
        EXPECT_TRUE(sizes.contains({32, 16}) && sizes.contains({64, 32})) << name;
    }
    EXPECT_NE(bytes(kPictureOn), bytes(kPictureOff));
}

}  // namespace
}  // namespace kdx
