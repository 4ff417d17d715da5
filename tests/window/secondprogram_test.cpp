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
    std::map<std::string, std::string> before;
    for (const auto& file : std::filesystem::directory_iterator(folder.data()))
        if (file.is_regular_file())
            before[file.path().filename().string()] = folder.read(file.path().filename().string());
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
    tick("UnsavedTimer");
    end();
    for (const auto& [name, bytes] : before) EXPECT_EQ(folder.read(name), bytes) << name;
}

}  // namespace
}  // namespace kdx::test
