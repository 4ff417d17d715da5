#include "settings/leftovers.h"

#include <gtest/gtest.h>
#include <sys/wait.h>
#include <unistd.h>

#include <set>

#include "settings/profilefile.h"
#include "support/tempfolder.h"
#include "support/unprivileged.h"

namespace kdx {
namespace {

namespace fs = std::filesystem;
using Names = std::set<std::string>;

class LeftoversTest : public ::testing::Test {
protected:
    [[nodiscard]] Names names() const {
        Names found;
        for (const auto& entry : fs::directory_iterator(m_folder.data())) found.insert(entry.path().filename());
        return found;
    }
    /// The momentary file of a program that was killed while it wrote the file.
    [[nodiscard]] std::string leftByAKilledProgram(const std::string& file) const {
        const pid_t child = fork();
        if (child == 0) {
            const fs::path beside = nameBeside(m_folder.data() / file);
            m_folder.write(beside.filename(), "half a fi");
            _exit(0);
        }
        ::waitpid(child, nullptr, 0);
        for (const std::string& name : names()) {
            if (name.starts_with(file + "." + std::to_string(child) + ".")) return name;
        }
        ADD_FAILURE() << "nothing was left";
        return {};
    }
    test::TempFolder m_folder;
};

TEST_F(LeftoversTest, WhatEarlierVersionsLeftIsRemovedAndNothingElse) {
    for (const char* name : {"Datenset1.INI.123456789.new", "RDS_Allg.INI.7.new", "Event.txt.12.new"})
        m_folder.write(name, "half a fi");
    const Names others = {"Datenset1.INI.new", "Datenset1.INI.a1.new", "Datenset6.INI.1.new", "notes.1.new", "1.new"};
    for (const std::string& name : others) m_folder.write(name, "the user's");
    sweepLeftovers(m_folder.data());
    EXPECT_EQ(names(), others);
}

TEST_F(LeftoversTest, WhatKilledProgramsLeftIsRemoved) {
    m_folder.write("Datenset1.INI", "[RDS]\r\n");
    EXPECT_NE(leftByAKilledProgram("Datenset1.INI"), leftByAKilledProgram("RDS_Allg.INI"));
    fs::copy_file(m_folder.data() / "Datenset1.INI", writableProbe(m_folder.data()));
    EXPECT_EQ(names().size(), 4U);
    sweepLeftovers(m_folder.data());
    EXPECT_EQ(names(), Names{"Datenset1.INI"});
}

TEST_F(LeftoversTest, AFileOfALivingProgramStays) {
    const std::string parent = "a.ini." + std::to_string(getppid()) + ".123.kdx-rds-new";
    const std::string init = "a.ini.1.123.kdx-rds-new";  // of another user, perhaps
    m_folder.write(parent, "");
    m_folder.write(init, "");
    fs::permissions(m_folder.data(), fs::perms::all);
    {
        const test::Unprivileged user;
        sweepLeftovers(m_folder.data());
    }
    EXPECT_EQ(names(), (Names{parent, init}));
}

TEST_F(LeftoversTest, TheOwnNumberOfAnEarlierProgramDoesNotCountAsLiving) {
    m_folder.write("a.ini." + std::to_string(getpid()) + ".123.kdx-rds-new", "");
    sweepLeftovers(m_folder.data());
    EXPECT_EQ(names(), Names{});
}

TEST_F(LeftoversTest, FilesOfOtherNamesAndFoldersStay) {
    const std::string left = leftByAKilledProgram("a.ini");
    const std::string numbers = left.substr(5, left.size() - 5 - std::string("kdx-rds-new").size());  // ".12.34."
    const Names others = {"a.ini",
                          "a.ini.new",
                          "a.ini.kdx-rds-new",
                          "a.ini" + numbers + "new",
                          "a.ini.99999999.kdx-rds-new",
                          "a.ini.99999999.x.kdx-rds-new",
                          "a.ini.-1.5.kdx-rds-new",
                          "a.ini.99999999999999999999999.5.kdx-rds-new",
                          left + ".bak"};
    for (const std::string& name : others) m_folder.write(name, "");
    fs::create_directory(m_folder.data() / ("b.ini" + numbers + "kdx-rds-new"));
    sweepLeftovers(m_folder.data());
    Names expected = others;
    expected.insert("b.ini" + numbers + "kdx-rds-new");
    EXPECT_EQ(names(), expected);
}

TEST_F(LeftoversTest, AMissingFolderAndOneWithoutRightsAreLeftAlone) {
    sweepLeftovers(m_folder.path() / "missing");
    EXPECT_FALSE(fs::exists(m_folder.path() / "missing"));
    const std::string left = leftByAKilledProgram("a.ini");
    fs::permissions(m_folder.data(), fs::perms::none);
    {
        const test::Unprivileged user;
        sweepLeftovers(m_folder.data());
    }
    fs::permissions(m_folder.data(), fs::perms::owner_all);
    EXPECT_EQ(names(), Names{left});
}

TEST_F(LeftoversTest, AMomentaryFileIsNamedByItsFileAndItsWriter) {
    const std::string name = nameBeside("/some/where/Datenset1.INI").string();
    EXPECT_TRUE(name.starts_with("/some/where/Datenset1.INI." + std::to_string(getpid()) + ".")) << name;
    EXPECT_TRUE(name.ends_with(".kdx-rds-new")) << name;
}

}  // namespace
}  // namespace kdx
