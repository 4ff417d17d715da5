#pragma once

#include <gtest/gtest.h>

#include <filesystem>
#include <fstream>
#include <string>
#include <vector>

#include "settings/datafolder.h"
#include "settings/shippedfiles.h"
#include "support/tempfolder.h"

namespace kdx::test {

inline constexpr const char* kEarliest = "Stau;1\r\n";
inline constexpr const char* kEarlier = "Stau;101\r\n";
inline constexpr const char* kPresent = "Stau;101\r\nUnfall;201\r\n";

/// A user's data folder and the shipped one, whose event list has two earlier versions.
class ShippedFilesTest : public ::testing::Test {
protected:
    ShippedFilesTest() {
        std::filesystem::permissions(base.path(), std::filesystem::perms::all);
        std::filesystem::permissions(base.data(), std::filesystem::perms::all);
        ship("Event.txt", kPresent);
    }
    void ship(const std::string& name, const std::string& bytes) const {
        std::filesystem::create_directories(shipped);
        std::ofstream(shipped / name, std::ios::binary) << bytes;
    }
    /// A start of the program. @returns what it has to tell.
    DataNews start(bool heard = true) const {
        DataNews news;
        bringUpToDate(DataFolder(base.path()), shipped, versions, heard, news);
        return news;
    }

    TempFolder base;
    std::filesystem::path shipped = base.path() / "shipped";
    std::vector<ShippedVersion> versions{{"Event.txt", 8, digestOf(kEarliest)}, {"Event.txt", 10, digestOf(kEarlier)}};
};

}  // namespace kdx::test
