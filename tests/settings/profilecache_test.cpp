#include "settings/profilecache.h"

#include <gtest/gtest.h>

#include "support/sourcefolder.h"
#include "support/tempfolder.h"

namespace kdx {
namespace {

namespace fs = std::filesystem;

class ProfileCacheTest : public ::testing::Test {
protected:
    [[nodiscard]] std::string value() {
        const auto text = m_cache.load(m_folder.data() / "a.ini");
        return text ? text->value("M", "a") : "(none)";
    }
    void write(char content) { m_folder.write("a.ini", std::string("[M]\r\na=") + content + "\r\n"); }

    test::TempFolder m_folder;
    ProfileCache m_cache;
};

TEST_F(ProfileCacheTest, AFileThatStaysTheSameIsReadOnce) {
    const fs::path shipped = test::sourceFolder() / "Daten" / "Sprachen.ini";
    const auto text = m_cache.load(shipped);
    ASSERT_NE(text, nullptr);
    EXPECT_EQ(m_cache.load(shipped), text);
}

TEST_F(ProfileCacheTest, EveryChangeOfAnotherProgramIsSeenHoweverQuicklyItFollows) {
    for (int round = 0; round < 300; ++round) {
        const char content = static_cast<char>('A' + round % 26);
        write(content);  // in its place: the size stays, the times perhaps too
        ASSERT_EQ(value(), std::string(1, content)) << round;
    }
}

TEST_F(ProfileCacheTest, AFilePutInItsPlaceIsSeen) {
    for (int round = 0; round < 300; ++round) {
        const char content = static_cast<char>('A' + round % 26);
        m_folder.write("b.ini", std::string("[M]\r\na=") + content + "\r\n");
        fs::rename(m_folder.data() / "b.ini", m_folder.data() / "a.ini");
        ASSERT_EQ(value(), std::string(1, content)) << round;
    }
}

TEST_F(ProfileCacheTest, AChangeThatHidesItsTimeIsSeen) {
    write('1');
    const fs::path file = m_folder.data() / "a.ini";
    const auto longAgo = fs::last_write_time(file) - std::chrono::hours(1);
    fs::last_write_time(file, longAgo);
    EXPECT_EQ(value(), "1");
    write('2');
    fs::last_write_time(file, longAgo);
    EXPECT_EQ(value(), "2");
}

TEST_F(ProfileCacheTest, AMissingFileIsNothingUntilItIsThere) {
    EXPECT_EQ(value(), "(none)");
    write('1');
    EXPECT_EQ(value(), "1");
    fs::remove(m_folder.data() / "a.ini");
    EXPECT_EQ(value(), "(none)");
    write('2');
    EXPECT_EQ(value(), "2");
}

TEST_F(ProfileCacheTest, WhatWasHandedOutStaysAsItIs) {
    write('1');
    const auto before = m_cache.load(m_folder.data() / "a.ini");
    write('2');
    EXPECT_EQ(value(), "2");
    EXPECT_EQ(before->value("M", "a"), "1");
}

TEST_F(ProfileCacheTest, WhatWasWrittenIsGivenOutAsLongAsTheFileHoldsIt) {
    write('1');
    const fs::path file = m_folder.data() / "a.ini";
    const auto written = std::make_shared<const ProfileText>("[M]\r\na=1\r\n");
    m_cache.written(file, written);
    EXPECT_EQ(m_cache.load(file), written);
    write('2');
    EXPECT_EQ(value(), "2");
    m_cache.written(file, written);
    EXPECT_EQ(value(), "2") << "another program was quicker";
}

TEST_F(ProfileCacheTest, Utf16TextIsNothing) {
    using namespace std::string_literals;
    m_folder.write("a.ini", "\xFF\xFE[\0M\0]\0\n\0a\0=\0"s + "1\0\n\0"s);
    EXPECT_EQ(value(), "(none)");
}

TEST(FileIdentityTest, SettlesWithTime) {
    using namespace std::chrono;
    const std::int64_t now = duration_cast<nanoseconds>(system_clock::now().time_since_epoch()).count();
    constexpr std::int64_t kSecond = 1'000'000'000;
    const std::int64_t aSecondAgo = now - kSecond;
    FileIdentity identity{1, 2, 3, aSecondAgo - aSecondAgo % 1000 + 1, aSecondAgo};
    EXPECT_TRUE(isSettled(identity));
    identity.changed = now;
    EXPECT_FALSE(isSettled(identity)) << "changed just now";
    identity.changed = now + 3600 * kSecond;
    EXPECT_FALSE(isSettled(identity)) << "changed in the future: the clock was set back";
    identity.changed = identity.modified = now / kSecond * kSecond - kSecond;
    EXPECT_FALSE(isSettled(identity)) << "whole seconds only";
    identity.changed = identity.modified -= 2 * kSecond;
    EXPECT_TRUE(isSettled(identity));
}

}  // namespace
}  // namespace kdx
