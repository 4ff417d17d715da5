// The editor on a folder that cannot be written.
#include <gtest/gtest.h>

#include "support/unprivileged.h"
#include "tmc/tmclistedittest.h"

namespace kdx::test {
namespace {

TEST_F(TmcListeditTest, AnEntryThatCannotBeSavedIsToldAndStaysInItsLabels) {
    enter("Event_Input_TXT", "Nebel");
    enter("Event_Input_Nr", "01332");
    const auto readable = std::filesystem::perms::owner_read | std::filesystem::perms::owner_exec |
                          std::filesystem::perms::others_read | std::filesystem::perms::others_exec;
    std::filesystem::permissions(folder.data(), readable);
    dialogs.expectedMessages = 1;
    {
        const Unprivileged user;
        click("Event_Hinzu");
    }
    EXPECT_EQ(dialogs.shown.back().text.toStdString(), "Event.txt kann nicht gespeichert werden.");
    EXPECT_EQ(text("Event_Input_TXT"), "Nebel");
    EXPECT_EQ(text("Event_Input_Nr"), "01332");
    EXPECT_EQ(folder.read("Event.txt"), "Stau;00101\r\nUnfall;00201\r\n");
}

}  // namespace
}  // namespace kdx::test
