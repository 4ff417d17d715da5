// Starts on folders that the user has no right to, or whose name is no text.
#include <gtest/gtest.h>

#include "support/unprivileged.h"
#include "window/startuptest.h"

namespace kdx::test {
namespace {

TEST_F(StartUpTest, ADataFolderThatCannotBeReadIsToldAndTheWindowWorksWithoutIt) {
    folder.copyShipped();
    std::filesystem::permissions(folder.data(), std::filesystem::perms::none);
    const Unprivileged ordinary;
    start();
    EXPECT_EQ(text("QuietLine"), "Nicht gefunden / not found: " + (folder.data() / kLanguageFile).string() +
                                     "  -  Nicht lesbar: Datenset1.INI  -  "
                                     "Nicht gespeichert: RDS_Allg.INI  -  Nicht gespeichert: RDS_log.txt");
    expectToWork();
}

TEST_F(StartUpTest, ADataFolderThatCannotBeWrittenLosesNothingAndIsTold) {
    folder.copyShipped();
    const std::string before = folder.read("Datenset1.INI");
    std::filesystem::permissions(folder.path(), std::filesystem::perms::all);
    using std::filesystem::perms;
    std::filesystem::permissions(folder.data(),
                                 perms::owner_read | perms::owner_exec | perms::others_read | perms::others_exec);
    {
        const Unprivileged ordinary;
        start();
        EXPECT_EQ(text("PS_T"), "MESSTURM");
        EXPECT_EQ(text("QuietLine"), "Nicht gespeichert: RDS_log.txt");
        expectToWork();
        EXPECT_EQ(text("QuietLine"), "Nicht gespeichert: Datenset1.INI  -  Nicht gespeichert: RDS_log.txt");
    }
    EXPECT_EQ(folder.read("Datenset1.INI"), before);
}

TEST_F(StartUpTest, AMissingFolderWhoseNameIsNoUtf8IsTold) {
    DataFolder odd(folder.path() / "J\xFCrgen");
    captions.load("deutsch", "RDS");
    Session other(visa, state, odd, captions, clock, [] {});
    TickerGroup group;
    HMenue shown({other, state, odd, captions, clock, dialogs, group, claim, QString(), QString(), [] {}});
    shown.startUp();
    EXPECT_TRUE(shown.findChild<QLabel*>(QStringLiteral("QuietLine"))->text().contains(QStringLiteral("\\xFCrgen")));
}

}  // namespace
}  // namespace kdx::test
