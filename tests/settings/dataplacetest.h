#pragma once

#include <gtest/gtest.h>

#include <filesystem>
#include <fstream>
#include <optional>
#include <string>

#include "settings/dataplace.h"
#include "settings/profilefile.h"
#include "support/tempfolder.h"

namespace kdx::test {

/// The program's folder, the user's and the shipped one; the first two have no "Daten" at first.
class DataPlaceTest : public ::testing::Test {
protected:
    DataPlaceTest() {
        std::filesystem::permissions(base.path(), std::filesystem::perms::all);
        std::filesystem::remove(base.data());
        put(shipped / "Daten" / "RDS_Allg.INI", "[BUS]\r\nINTERFACE=IEC\r\n");
        put(shipped / "Daten" / "Datenset1.INI", "[RDS]\r\nPS=SHIPPED\r\n");
        std::filesystem::create_directories(program);
    }
    static void put(const std::filesystem::path& file, const std::string& bytes) {
        std::filesystem::create_directories(file.parent_path());
        std::ofstream(file, std::ios::binary) << bytes;
    }
    static std::string get(const std::filesystem::path& file) { return readFile(file).value_or("(none)"); }
    std::filesystem::path choose() { return chooseAppFolder(places, news); }

    TempFolder base;
    std::filesystem::path program = base.path() / "program";
    std::filesystem::path user = base.path() / "home" / "kdx-rds";
    std::filesystem::path shipped = base.path() / "share";
    DataPlaces places{std::nullopt, program, user, shipped};
    DataNews news;
    std::string& problem = news.problem;
};

}  // namespace kdx::test
