// Going straight to a line finds what reading line by line would find.
#include "settings/profileindex.h"

#include <gtest/gtest.h>

#include <random>
#include <sstream>

#include "base/codepage.h"
#include "settings/profilefile.h"

namespace kdx {
namespace {

std::string withoutBlanks(const std::string& text) {
    const auto first = text.find_first_not_of(" \t\v");
    return first == std::string::npos ? "" : text.substr(first, text.find_last_not_of(" \t\v") - first + 1);
}

/// The reading rules, line by line. Quotes and long values are left to others.
std::string plainRead(std::string bytes, const std::string& section, const std::string& key) {
    std::replace(bytes.begin(), bytes.end(), '\r', '\n');
    std::istringstream lines(bytes);
    bool inSection = false;
    for (std::string line; std::getline(lines, line);) {
        line = withoutBlanks(line);
        if (line.empty() || line.front() == ';') continue;
        if (line.front() == '[') {
            if (inSection) return "";
            inSection = equalNoCase(withoutBlanks(line.substr(1, line.find(']') - 1)), section);
        } else if (inSection) {
            const auto equals = line.find('=');
            if (!equalNoCase(withoutBlanks(line.substr(0, equals)), key)) continue;
            return equals == std::string::npos ? "" : withoutBlanks(line.substr(equals + 1));
        }
    }
    return "";
}

const std::vector<std::string> kNames = {"a", "B", "", "\xFC", "x", "ax"};

class ProfileIndexTest : public ::testing::Test {
protected:
    std::size_t below(std::size_t count) { return m_random() % count; }
    std::string anyFile() {
        const std::vector<std::string> pieces = {"[a]", "[ B ]", "[b", "a",  "A=1",  "b = 2", "\xFC=3", "\xDC=4", "=5",
                                                 "x",   "\r\n",  "\n", "\r", "\r\n", "\n",    " ",      ";",      "[]"};
        std::string bytes;
        for (int piece = 0; piece < 40; ++piece) bytes += pieces[below(pieces.size())];
        return bytes;
    }
    void expectReadsLineByLine(const ProfileText& text) {
        for (const std::string& section : kNames) {
            for (const std::string& key : kNames) {
                const std::string expected = plainRead(text.bytes(), section, key);
                ASSERT_EQ(text.value(section, key), expected) << text.bytes() << "\n: " << section << ", " << key;
                if (!expected.empty()) ++m_found;
            }
        }
    }

    int m_found = 0;

private:
    std::mt19937 m_random{20090305};
};

TEST_F(ProfileIndexTest, FindsInAnyFileWhatReadingLineByLineFinds) {
    for (int round = 0; round < 500; ++round) expectReadsLineByLine(ProfileText(anyFile()));
    EXPECT_GT(m_found, 500) << "the files have to hold something";
}

TEST_F(ProfileIndexTest, FindsWhatIsWrittenOneAfterTheOther) {
    for (int round = 0; round < 200; ++round) {
        ProfileText text(anyFile());
        for (int written = 0; written < 6; ++written) {
            const std::string& section = kNames[below(kNames.size())];
            const std::string& key = kNames[below(kNames.size())];
            text.setValue(section, key, std::to_string(written + 10));
            ASSERT_EQ(text.value(section, key), std::to_string(written + 10)) << text.bytes();
            expectReadsLineByLine(text);
        }
    }
    EXPECT_GT(m_found, 1000);
}

TEST_F(ProfileIndexTest, FindsEachOfManyKeys) {
    std::string bytes;
    for (int section = 0; section < 20; ++section) {
        bytes += "[s" + std::to_string(section) + "]\n";
        for (int key = 0; key < 1000; ++key)
            bytes += "k" + std::to_string(key) + "=" + std::to_string(section * key) + "\n";
    }
    const ProfileText text(bytes);
    for (int section = 0; section < 20; ++section) {
        for (int key = 0; key < 1000; ++key) {
            ASSERT_EQ(text.value("S" + std::to_string(section), "K" + std::to_string(key)),
                      std::to_string(section * key));
        }
        EXPECT_EQ(text.value("s" + std::to_string(section), "k1000"), "");
    }
}

}  // namespace
}  // namespace kdx
