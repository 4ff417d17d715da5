// A program that is killed while it writes settings leaves every file whole.
#include <gtest/gtest.h>
#include <sys/mman.h>
#include <sys/wait.h>

#include <array>
#include <atomic>
#include <csignal>
#include <random>
#include <set>
#include <string>

#include "settings/datafolder.h"
#include "settings/leftovers.h"
#include "settings/profilefile.h"
#include "support/tempfolder.h"

namespace kdx {
namespace {

constexpr int kKills = 1000;
constexpr std::array kFiles = {"Datenset1.INI", "RDS_Allg.INI"};
constexpr std::size_t kKeys = 4;
constexpr unsigned kLongestLifeMicroseconds = 12000;

/// What the writing program says of itself; it survives the kill.
struct Progress {
    std::atomic<bool> running;
    std::atomic<std::uint32_t> written;
    struct Key {
        std::atomic<std::uint32_t> begun;
        std::atomic<std::uint32_t> done;
    };
    std::array<std::array<Key, kKeys>, kFiles.size()> keys;
};

class SharedProgress {
public:
    SharedProgress()
        : m_memory(::mmap(nullptr, sizeof(Progress), PROT_READ | PROT_WRITE, MAP_SHARED | MAP_ANONYMOUS, -1, 0)) {
        if (m_memory == MAP_FAILED) std::abort();
        m_progress = new (m_memory) Progress{};
    }
    ~SharedProgress() { ::munmap(m_memory, sizeof(Progress)); }
    SharedProgress(const SharedProgress&) = delete;
    SharedProgress& operator=(const SharedProgress&) = delete;
    Progress* operator->() { return m_progress; }

private:
    void* m_memory;
    Progress* m_progress = nullptr;
};

std::string keyName(std::size_t key) {
    return "Key" + std::to_string(key);
}

/// Of very different lengths, so that no value fits over another by chance; 0 is the value at first.
std::string valueOf(std::uint32_t number) {
    return std::to_string(number) + std::string(number * 37 % 3000, 'x') + std::to_string(number);
}

class KillTest : public ::testing::Test {
protected:
    KillTest() {
        for (const char* file : kFiles) m_folder.write(file, content({0, 0, 0, 0}));
    }
    static std::string content(const std::array<std::uint32_t, kKeys>& numbers) {
        std::string bytes = "; settings\r\n[RDS]\r\n";
        for (std::size_t key = 0; key < kKeys; ++key) bytes += keyName(key) + "=" + valueOf(numbers.at(key)) + "\r\n";
        return bytes + "\r\n[other]\r\nKey0=stays\r\n";
    }

    [[noreturn]] void writeForever() {
        DataFolder data(m_folder.path());
        m_progress->running = true;
        for (std::size_t at = 0;; ++at) {
            const std::size_t file = at % kFiles.size();
            const std::size_t key = at / kFiles.size() % kKeys;
            Progress::Key& progress = m_progress->keys.at(file).at(key);
            const std::uint32_t number = progress.begun + 1;
            progress.begun = number;
            data.WriteIni("RDS", keyName(key), valueOf(number), kFiles.at(file));
            if (data.unsavedFile()) _exit(1);
            progress.done = number;
            ++m_progress->written;
        }
    }
    void runAndKill() {
        m_progress->running = false;
        const pid_t child = fork();
        ASSERT_GE(child, 0);
        if (child == 0) writeForever();
        while (!m_progress->running) ::usleep(50);
        ::usleep(m_random() % kLongestLifeMicroseconds);
        ::kill(child, SIGKILL);
        int status = 0;
        ASSERT_EQ(::waitpid(child, &status, 0), child);
        ASSERT_TRUE(WIFSIGNALED(status)) << "a write failed";
    }
    /// The file is, to the byte, one that holds for each key the value last written or the one being written.
    void expectWhole(std::size_t file) {
        const std::string bytes = m_folder.read(kFiles.at(file));
        const ProfileText text(bytes);
        std::array<std::uint32_t, kKeys> numbers{};
        for (std::size_t key = 0; key < kKeys; ++key) {
            Progress::Key& progress = m_progress->keys.at(file).at(key);
            const std::string value = text.value("RDS", keyName(key), bytes.size());
            if (progress.begun != progress.done) ++m_caughtWriting;
            const bool isNew = value == valueOf(progress.begun);
            ASSERT_TRUE(isNew || value == valueOf(progress.done)) << keyName(key) << " = " << value;
            numbers.at(key) = isNew ? progress.begun : progress.done;
            progress.done = progress.begun = numbers.at(key);
        }
        ASSERT_EQ(bytes, content(numbers));
    }

    test::TempFolder m_folder;
    SharedProgress m_progress;
    std::mt19937 m_random{20090305};
    int m_caughtWriting = 0;
};

TEST_F(KillTest, EveryFileIsWholeAndEachValueOldOrNew) {
    for (int kill = 0; kill < kKills; ++kill) {
        runAndKill();
        for (std::size_t file = 0; file < kFiles.size(); ++file) expectWhole(file);
        if (HasFatalFailure()) FAIL() << "after kill " << kill;
    }
    // The kills have to have come at work, or they show nothing.
    EXPECT_GT(m_progress->written, 10U);
    EXPECT_GT(m_caughtWriting, kKills / 10);

    sweepLeftovers(m_folder.data());
    std::set<std::string> left;
    for (const auto& entry : std::filesystem::directory_iterator(m_folder.data())) left.insert(entry.path().filename());
    EXPECT_EQ(left, std::set<std::string>(kFiles.begin(), kFiles.end()));
    RecordProperty("written", static_cast<int>(m_progress->written));
    RecordProperty("caughtWriting", m_caughtWriting);
}

}  // namespace
}  // namespace kdx
