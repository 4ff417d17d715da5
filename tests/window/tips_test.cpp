// A tip on every control of the program.
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "support/everyfont.h"
#include "support/sourcefolder.h"
#include "support/tipcheck.h"
#include "support/windowtest.h"

namespace kdx::test {
namespace {

using ::testing::IsSupersetOf;

class TipsTest : public WindowTest {
protected:
    TipsTest() {
        folder.copyShipped();
        shipped = sourceFolder() / "docs";  // where the manual stands
    }
    void open(const char* language) {
        setGeneral("Sprache", "Sprache", language);
        start();
    }
    /// Looks at the editor that the action opens, and closes it.
    std::set<std::string> ofEditor(const std::string& where, const std::function<void()>& openIt) {
        std::set<std::string> found;
        QTimer::singleShot(0, qApp, [&] {
            QWidget* editor = QApplication::activeModalWidget();
            ASSERT_NE(editor, nullptr);
            found = expectATipOnEveryControl(*editor, where);
            editor->close();
        });
        openIt();
        return found;
    }
};

TEST_F(TipsTest, EveryControlOfTheWindowItsViewsAndDialogsHasOne) {
    for (const char* language : kEveryLanguage) {
        open(language);
        for (const char* entry : {"Mnu_Info_Log", "Mnu_Ansicht_OnAir", "Mnu_Ansicht_Vergleich", "Mnu_Ansicht_Ablauf",
                                  "Mnu_Einstellungen", "Mnu_Hilfe_Handbuch"})
            action(entry)->trigger();
        const auto found = expectATipOnEveryControl(*window, language);
        EXPECT_THAT(found,
                    IsSupersetOf({"INIT_Taste", "Ende_Taste", "Adr1_Label", "PS_T", "Store_Taste_0", "FM_Hub_Zahl",
                                  "Log_Filter", "Air_Kopieren", "Vergleich_Tabelle", "Ablauf_Liste", "NF_Olim_Zahl",
                                  "Adressen_Liste", "Alle_Berichtigungen", "Handbuch_Suche"}));
        EXPECT_GT(found.size(), 190U) << "some view was not walked";
    }
}

TEST_F(TipsTest, EveryControlOfTheEditorsHasOne) {
    for (const char* language : kEveryLanguage) {
        open(language);
        openSession();
        for (const char* button : {"AF_Bearbeiten", "EON_AF_Bearbeiten"}) {
            EXPECT_THAT(ofEditor(std::string(language) + " " + button, [&] { click(button); }),
                        IsSupersetOf({"Text2", "AF_List1", "Command1", "Rem_Freq", "AF_Sortieren", "Ende_Knopf"}));
        }
        EXPECT_THAT(ofEditor(language, [&] { action("Mnu_TMC_Edit")->trigger(); }),
                    IsSupersetOf({"List1", "List2", "Event_Input_TXT", "Event_Hinzu", "Eintrag_Aendern"}));
    }
}

}  // namespace
}  // namespace kdx::test
