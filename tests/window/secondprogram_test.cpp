// A second program on the same data folder.
#include "window/secondprogram.h"

#include <gtest/gtest.h>

#include <optional>

#include "support/windowtest.h"

namespace kdx::test {
namespace {

class SecondProgramTest : public WindowTest {
protected:
    SecondProgramTest() { folder.copyShipped(); }
    /// Every file below the folder with what it holds; folders with nothing.
    std::map<std::string, std::string> everything() {
        std::map<std::string, std::string> found;
        for (const auto& entry : std::filesystem::recursive_directory_iterator(folder.data())) {
            const std::string name = entry.path().lexically_relative(folder.data()).string();
            found[name] = entry.is_regular_file() ? folder.read(name) : std::string();
        }
        return found;
    }
    /// Saves what is shown from every view that saves, into the data folder: none of it comes to be there.
    void saveIntoTheFolder() {
        action("Mnu_Info_Log")->trigger();
        action("Mnu_Ansicht_OnAir")->trigger();
        clock.advance(std::chrono::seconds{10});
        ASSERT_TRUE(tick("AirTimer"));
        for (const char* button : {"Log_Sichern", "Air_Gruppen_Sichern", "Air_MPX_Sichern"}) {
            for (const char* name : {"saved.txt", "Datenset2.INI", "RDS_log.txt"}) {
                dialogs.files = {QString::fromStdString((folder.data() / name).string())};
                dialogs.expectedMessages = 1;
                click(button);
                EXPECT_EQ(dialogs.shown.back().preset.toStdString(), "Nur zum Lesen geöffnet: nichts wird gespeichert")
                    << button << " " << name;
            }
            dialogs.files = {QString::fromStdString((folder.path() / button).string())};
            click(button);
            EXPECT_TRUE(std::filesystem::exists(folder.path() / button)) << "elsewhere it may";
        }
    }
    bool goesOn() { return goesOnBesideAnother(claim, data, captions, dialogs); }

    std::optional<FolderClaim> first{std::in_place, folder.data()};
};

TEST_F(SecondProgramTest, IsToldInTheLanguageOfTheSettingsAndMayEnd) {
    dialogs.confirmations = {false, false};
    EXPECT_FALSE(goesOn());
    EXPECT_EQ(dialogs.shown[0].text.toStdString(), "Ein anderes Programm nutzt " + folder.data().string() +
                                                       ". Nur zum Lesen öffnen? \"Nein\" beendet dieses.");
    setGeneral("Sprache", "Sprache", "english");
    EXPECT_FALSE(goesOn());
    EXPECT_EQ(dialogs.shown[1].text.toStdString().find("Another program uses "), 0U);
}

TEST_F(SecondProgramTest, AloneNothingIsAskedAndAllIsWritten) {
    first.reset();
    EXPECT_TRUE(goesOn());
    EXPECT_FALSE(data.isReadOnly());
}

TEST_F(SecondProgramTest, WritesNothingWhenItGoesOn) {
    folder.write(kCommandLog, "of the first one\r\n");
    const auto before = everything();
    dialogs.confirmations = {true, true};
    ASSERT_TRUE(goesOn());
    start();
    openSession();
    type("PS_T", "ZWEITER");
    click("PS_Taste");
    EXPECT_EQ(data.ReadIni("RDS", "PS", "Datenset1.INI"), "ZWEITER") << "counts as stored meanwhile";
    dialogs.expectedMessages = 1;
    action("Mnu_Datensatz_Sichern_2")->trigger();
    EXPECT_EQ(dialogs.shown.back().text.toStdString(), "Nicht gespeichert: Datenset2.INI");
    EXPECT_NE(text("QuietLine").find("Nur zum Lesen geöffnet: nichts wird gespeichert"), std::string::npos)
        << text("QuietLine");
    saveIntoTheFolder();
    tick("UnsavedTimer");
    end();
    const auto after = everything();
    for (const auto& [name, bytes] : before) EXPECT_TRUE(after.contains(name) && after.at(name) == bytes) << name;
    for (const auto& [name, bytes] : after) EXPECT_TRUE(before.contains(name)) << name << " is new";
}

}  // namespace
}  // namespace kdx::test
