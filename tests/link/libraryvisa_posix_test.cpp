#include "link/libraryvisa.h"
#include "link/sharedlibrary.h"

#include "support/tempfolder.h"

#include <gmock/gmock.h>

#include <filesystem>
#include <string>

namespace kdx {
namespace {

using ::testing::ElementsAre;
using ::testing::IsEmpty;
using ::testing::StartsWith;

TEST(LibraryVisaNameTest, IsToldWithoutControlCharactersAndAsUtf8) {
    const VisaLibrary library = loadVisaLibrary("/nowhere/x\x1B[2J\xFF.so");
    EXPECT_EQ(library.visa, nullptr);
    EXPECT_THAT(library.reason, StartsWith("/nowhere/x\\x1B[2J\\xFF.so: "));
}

TEST(LibraryVisaList, IsEmptyWhereNothingIsConnected) {
    ::setenv("KDX_FAKE_VISA_EMPTY", "1", 1);
    EXPECT_THAT(loadVisaLibrary(KDX_FAKE_VISA).visa->findResources(), IsEmpty());
    ::unsetenv("KDX_FAKE_VISA_EMPTY");
}

/// The current folder holds a VISA library under the first of the usual names while this lives.
class CurrentFolderWithLibrary {
public:
    CurrentFolderWithLibrary() {
        std::filesystem::copy_file(KDX_FAKE_VISA, m_folder.data() / usualVisaLibraryNames().front());
        std::filesystem::current_path(m_folder.data());
    }
    CurrentFolderWithLibrary(const CurrentFolderWithLibrary&) = delete;
    CurrentFolderWithLibrary& operator=(const CurrentFolderWithLibrary&) = delete;
    ~CurrentFolderWithLibrary() { std::filesystem::current_path(m_before); }
    [[nodiscard]] bool holds(const std::string& file) const { return file.starts_with(m_folder.data().string() + "/"); }

private:
    std::filesystem::path m_before = std::filesystem::current_path();
    test::TempFolder m_folder;
};

TEST(VisaLibrarySearch, TheUsualNamesAreNotLookedForInTheCurrentFolder) {
    const CurrentFolderWithLibrary here;
    const VisaLibrary usual = loadVisaLibrary("");
    EXPECT_FALSE(here.holds(usual.file)) << usual.file;
    const VisaLibrary named = loadVisaLibrary(usualVisaLibraryNames().front());
    EXPECT_TRUE(here.holds(named.file)) << "what the user names is a file: " << named.file;
}

TEST(VisaLibrarySearch, TheUsualNamesAreThoseOfLibrariesForThisSystem) {
    EXPECT_THAT(usualVisaLibraryNames(), ElementsAre("libvisa.so", "libvisa.so.0", "libktvisa32.so", "libiovisa.so"));
}

}  // namespace
}  // namespace kdx
