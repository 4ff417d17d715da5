// The whole program, killed while its user changes settings, leaves every file whole.
#include <gtest/gtest.h>
#include <sys/wait.h>

#include <array>
#include <csignal>
#include <cstdio>
#include <cstdlib>
#include <random>
#include <set>

#include "settings/leftovers.h"
#include "settings/profilefile.h"
#include "support/windowtest.h"

namespace kdx::test {
namespace {

constexpr int kKills = 30;
constexpr int kMostKills = 10 * kKills;
constexpr const char* kFolderToWorkOn = "KDX_TEST_KILLED_FOLDER";  // set for the program that is to be killed
constexpr const char* kAtWork = "at work";
constexpr unsigned kLongestWorkMicroseconds = 60000;

/// What the user changes, and the two values he changes it between.
struct Changed {
    const char* file;
    const char* section;
    const char* key;
    std::array<const char*, 2> values;
};
constexpr std::array kChanged = {
    Changed{"Datenset1.INI", "RDS", "PS", {"RADIO A", "B"}},
    Changed{"Datenset1.INI", "RDS", "RTA", {"short", "a radiotext that is a good deal longer than the other one"}},
    Changed{"RDS_Allg.INI", "Sprache", "Sprache", {"deutsch", "english US"}},
    Changed{"RDS_Allg.INI", "FM", "MPX_DEV", {"00100", "07500"}},
};

class KilledWindowTest : public WindowTest {
protected:
    void SetUp() override {
        if (const char* killed = std::getenv(kFolderToWorkOn)) workForever(killed);
        folder.copyShipped();
        setGeneral("ADRESSEN", "Log_Key", "0");
        start();
        openSession();
        change(0);  // from here on only the values change
        end();
        for (std::size_t i = 0; i < kFiles.size(); ++i) m_first.at(i) = folder.read(kFiles.at(i));
    }

    void change(std::size_t choice) {
        type("PS_T", kChanged[0].values.at(choice));
        click("PS_Taste");
        type("RT_Text1", kChanged[1].values.at(choice));
        click("RT_Taste1");
        action(choice == 0 ? "Mnu_Info_Sprache_D" : "Mnu_Info_Sprache_US")->trigger();
        scroll("FM_Hub_Scroll", choice == 0 ? 100 : 7500);
    }
    void runAndKill() {
        std::array<int, 2> started{};
        ASSERT_EQ(::pipe(started.data()), 0);
        const pid_t child = fork();
        ASSERT_GE(child, 0);
        if (child == 0) {
            // The same program anew: a copy of a running window would miss its threads.
            ::dup2(started[1], STDOUT_FILENO);
            ::setenv(kFolderToWorkOn, folder.path().c_str(), 1);
            ::execl("/proc/self/exe", "user", "--gtest_filter=KilledWindowTest.*", "--gtest_brief=1", nullptr);
            ::_exit(1);
        }
        ::close(started[1]);
        std::string told;
        for (char byte = 0; told.find(kAtWork) == std::string::npos; told += byte)
            ASSERT_EQ(::read(started[0], &byte, 1), 1) << told;
        ::usleep(m_random() % kLongestWorkMicroseconds);
        ::kill(child, SIGKILL);
        int status = 0;
        ASSERT_EQ(::waitpid(child, &status, 0), child);
        ASSERT_TRUE(WIFSIGNALED(status)) << "it ended by itself";
        ::close(started[0]);
        // The folder that its own fixture had made.
        std::filesystem::remove_all(std::filesystem::temp_directory_path() /
                                    ("kdx-test-" + std::to_string(child) + "-0"));
    }
    /// What the killed program does.
    void workForever(const char* programFolder) {
        DataFolder killed(programFolder);
        Session work(visa, state, killed, captions, clock, [] {});
        window = std::make_unique<HMenue>(Surroundings{work, state, killed, captions, clock, dialogs, tickers, claim,
                                                       QStringLiteral("scripted"), QString(), [] {}});
        window->startUp();
        window->show();
        openSession();
        std::puts(kAtWork);
        std::fflush(stdout);
        for (std::size_t times = 1;; ++times) change(times % 2);
    }
    /// With what the user changed put back, the file is to the byte what it was; each value is one of his two.
    void expectWhole(std::size_t file) {
        ProfileText text(folder.read(kFiles.at(file)));
        for (const Changed& changed : kChanged) {
            if (std::string(changed.file) != kFiles.at(file)) continue;
            const std::string value = text.value(changed.section, changed.key);
            EXPECT_TRUE(value == changed.values[0] || value == changed.values[1]) << changed.key << " = " << value;
            m_seen.insert(changed.key + ("=" + value));
            text.setValue(changed.section, changed.key, changed.values[0]);
        }
        EXPECT_EQ(text.bytes(), m_first.at(file)) << kFiles.at(file);
    }

    static constexpr std::array kFiles = {"Datenset1.INI", "RDS_Allg.INI"};
    std::array<std::string, kFiles.size()> m_first;
    std::set<std::string> m_seen;
    std::mt19937 m_random{20090305};
};

TEST_F(KilledWindowTest, EveryFileIsWholeAndEachValueOldOrNew) {
    // On a busy machine more are needed until each value was seen at work.
    const auto enough = [this](int kills) { return kills >= kKills && m_seen.size() == 2 * kChanged.size(); };
    for (int kill = 0; kill < kMostKills && !enough(kill) && !HasFailure(); ++kill) {
        runAndKill();
        for (std::size_t file = 0; file < kFiles.size(); ++file) expectWhole(file);
    }
    EXPECT_EQ(m_seen.size(), 2 * kChanged.size()) << "the kills have to have come at work, or they show nothing";

    sweepLeftovers(folder.data());
    for (const auto& entry : std::filesystem::directory_iterator(folder.data())) {
        EXPECT_TRUE(std::filesystem::exists(sourceFolder() / "Daten" / entry.path().filename()) ||
                    entry.path().filename() == kCommandLog)
            << entry.path();
    }
}

}  // namespace
}  // namespace kdx::test
