#include "app/platform.h"

#include <gtest/gtest.h>

#include <poll.h>

#include <csignal>
#include <cstdlib>
#include <filesystem>
#include <optional>
#include <string>
#include <utility>
#include <vector>

namespace kdx {
namespace {

namespace fs = std::filesystem;

class UserFolder : public ::testing::Test {
protected:
    ~UserFolder() override {
        for (const auto& [name, value] : m_before) {
            if (value) {
                setenv(name, value->c_str(), 1);
            } else {
                unsetenv(name);
            }
        }
    }

private:
    static std::optional<std::string> now(const char* name) {
        const char* value = std::getenv(name);
        return value == nullptr ? std::nullopt : std::optional<std::string>(value);
    }
    std::vector<std::pair<const char*, std::optional<std::string>>> m_before = {{"XDG_DATA_HOME", now("XDG_DATA_HOME")},
                                                                                {"HOME", now("HOME")}};
};

TEST_F(UserFolder, FollowsTheXdgStandard) {
    setenv("HOME", "/home/someone", 1);
    setenv("XDG_DATA_HOME", "/data", 1);
    EXPECT_EQ(userFolder(), fs::path("/data/kdx-rds"));
    unsetenv("XDG_DATA_HOME");
    EXPECT_EQ(userFolder(), fs::path("/home/someone/.local/share/kdx-rds"));
    setenv("XDG_DATA_HOME", "", 1);
    EXPECT_EQ(userFolder(), fs::path("/home/someone/.local/share/kdx-rds"));
    setenv("XDG_DATA_HOME", "relative", 1);
    EXPECT_EQ(userFolder(), fs::path("/home/someone/.local/share/kdx-rds"));
}

TEST_F(UserFolder, IsUnknownWithoutAnAbsoluteHome) {
    unsetenv("XDG_DATA_HOME");
    unsetenv("HOME");
    EXPECT_EQ(userFolder(), fs::path());
    setenv("HOME", "", 1);
    EXPECT_EQ(userFolder(), fs::path());
    setenv("HOME", "relative", 1);
    EXPECT_EQ(userFolder(), fs::path());
    setenv("XDG_DATA_HOME", "/data", 1);
    EXPECT_EQ(userFolder(), fs::path("/data/kdx-rds"));
}

bool isReadable(int descriptor) {
    pollfd asked{descriptor, POLLIN, 0};
    return poll(&asked, 1, 0) == 1;
}

TEST(EndRequests, OfTheSystemAreHeardAndEndNothing) {
    for (const int signal : {SIGTERM, SIGINT, SIGHUP}) {
        const int requests = endRequests();
        ASSERT_GE(requests, 0);
        EXPECT_FALSE(isReadable(requests));
        EXPECT_EQ(raise(signal), 0);
        EXPECT_TRUE(isReadable(requests)) << signal;
    }
}

TEST(EndRequests, ThatWereSwitchedOffStaySo) {
    std::signal(SIGHUP, SIG_IGN);
    const int requests = endRequests();
    EXPECT_EQ(raise(SIGHUP), 0);
    EXPECT_FALSE(isReadable(requests));
    std::signal(SIGHUP, SIG_DFL);
}

}  // namespace
}  // namespace kdx
