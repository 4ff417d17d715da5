// What replacing a file promises where a third program can keep others from it.
#include <windows.h>

#include <gtest/gtest.h>

#include <thread>

#include "settings/profilefile.h"
#include "support/tempfolder.h"

namespace kdx::test {
namespace {

/// Reads a file as a program that looks for viruses does: nobody may put another in its place meanwhile.
class Scanner {
public:
    explicit Scanner(const std::filesystem::path& file)
        : m_file(CreateFileW(file.c_str(), GENERIC_READ, FILE_SHARE_READ, nullptr, OPEN_EXISTING, 0, nullptr)) {}
    ~Scanner() { CloseHandle(m_file); }
    Scanner(const Scanner&) = delete;
    Scanner& operator=(const Scanner&) = delete;
    [[nodiscard]] bool reads() const { return m_file != INVALID_HANDLE_VALUE; }

private:
    HANDLE m_file;
};

TEST(ReplaceFileWindowsTest, AFileThatAnotherProgramHoldsForAMomentIsReplaced) {
    const TempFolder folder;
    folder.write("a.ini", "old");
    std::optional<Scanner> scanner(std::in_place, folder.data() / "a.ini");
    ASSERT_TRUE(scanner->reads());
    std::thread end([&scanner] {
        Sleep(50);  // the system's own time: it is the system that is waited for
        scanner.reset();
    });
    EXPECT_TRUE(replaceFile(folder.data() / "a.ini", "new"));
    end.join();
    EXPECT_EQ(folder.read("a.ini"), "new");
}

TEST(ReplaceFileWindowsTest, AFileThatStaysHeldKeepsItsBytes) {
    const TempFolder folder;
    folder.write("a.ini", "old");
    {
        const Scanner scanner(folder.data() / "a.ini");
        EXPECT_FALSE(replaceFile(folder.data() / "a.ini", "new"));
    }
    EXPECT_EQ(folder.read("a.ini"), "old");
}

}  // namespace
}  // namespace kdx::test
