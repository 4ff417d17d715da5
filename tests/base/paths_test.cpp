#include "base/paths.h"

#include <gtest/gtest.h>

#include <fstream>

namespace kdx {
namespace {

constexpr const char* kName =
    "J\xC3\xBCrgen \xC5\x81\xC3\xB3"
    "d\xC5\xBA.txt";

TEST(Paths, ANameComesBackFromItsPath) {
    for (const std::string name : {"", "a", kName, "Daten/\xE2\x82\xAC/\xF0\x9F\x93\xBB"})
        EXPECT_EQ(utf8Of(pathFromUtf8(name)), name);
}

TEST(Paths, APathIsMadeOfTheCharactersOfItsName) {
    EXPECT_EQ(pathFromUtf8(kName), std::filesystem::path(u8"J\u00FCrgen \u0141\u00F3d\u017A.txt"));
    EXPECT_EQ(pathFromUtf8("a") / pathFromUtf8("b"), std::filesystem::path("a") / "b");
}

TEST(Paths, AFileIsFoundByItsName) {
    const std::filesystem::path file = std::filesystem::temp_directory_path() / pathFromUtf8(kName);
    std::ofstream(file) << "here";
    const std::filesystem::path again = pathFromUtf8(utf8Of(file));
    EXPECT_TRUE(std::filesystem::exists(again));
    EXPECT_EQ(utf8Of(again.filename()), kName);
    std::filesystem::remove(file);
}

TEST(Paths, BytesThatAreNoTextAreNoFailure) {
    EXPECT_NO_THROW((void)pathFromUtf8("B\xFCro"));
    EXPECT_NE(utf8Of(pathFromUtf8("B\xFCro")), "");
}

}  // namespace
}  // namespace kdx
