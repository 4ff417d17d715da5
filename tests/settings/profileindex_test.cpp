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

TEST(ProfileIndexTest, FindsInAnyFileWhatReadingLineByLineFinds) {
    const std::vector<std::string> pieces = {"[a]", "[ B ]", "[b", "a",  "A=1",  "b = 2", "\xFC=3", "\xDC=4", "=5",
                                             "x",   "\r\n",  "\n", "\r", "\r\n", "\n",    " ",      ";",      "[]"};
    const std::vector<std::string> names = {"a", "B", "", "\xFC", "x", "ax"};
    std::mt19937 random(20090305);
    int found = 0;
    for (int round = 0; round < 500; ++round) {
        std::string bytes;
        for (int piece = 0; piece < 40; ++piece) bytes += pieces[random() % pieces.size()];
        const ProfileText text(bytes);
        for (const std::string& section : names) {
            for (const std::string& key : names) {
                const std::string expected = plainRead(bytes, section, key);
                ASSERT_EQ(text.value(section, key), expected) << bytes << "\n: " << section << ", " << key;
                if (!expected.empty()) ++found;
            }
        }
    }
    EXPECT_GT(found, 500) << "the files have to hold something";
}

TEST(ProfileIndexTest, FindsEachOfManyKeys) {
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
