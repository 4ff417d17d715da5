#include "tmcpagetest.h"

#include <QGroupBox>

#include <set>

namespace kdx::test {
namespace {

constexpr std::array kLanguages = {"deutsch", "english", "english US"};

TEST_F(TmcPageTest, TheBoxesHoldTheEntriesOfTheFilesAndNothingIsChosen) {
    const auto* events = find<QComboBox>("TMC_Event_Combo");
    ASSERT_EQ(events->count(), 5);
    EXPECT_EQ(events->itemText(1).toStdString(), "Stau" + std::string(38, ' ') + "00101");
    EXPECT_EQ(events->currentIndex(), -1);
    EXPECT_EQ(events->placeholderText().toStdString(), "Eventauswahl");
    const auto* locations = find<QComboBox>("TMC_Loc_Combo");
    ASSERT_EQ(locations->count(), 3);
    EXPECT_EQ(locations->itemText(0).toStdString(), "Musterstadt" + std::string(31, ' ') + "12345");
    EXPECT_EQ(locations->currentIndex(), -1);
    EXPECT_EQ(locations->placeholderText().toStdString(), "Locationauswahl");
}

TEST_F(TmcPageTest, AMissingListIsToldAndTheRestIsSetUp) {
    std::filesystem::remove(folder.data() / "Event.txt");
    page = std::make_unique<TmcPage>(context, nullptr);
    try {
        page->load();
        FAIL() << "no error";
    } catch (const std::runtime_error& error) {
        EXPECT_STREQ(error.what(), "Event.txt kann nicht gelesen werden.");
    }
    EXPECT_EQ(find<QComboBox>("TMC_Event_Combo")->count(), 0);
    EXPECT_EQ(find<QComboBox>("TMC_Loc_Combo")->count(), 3);
    EXPECT_EQ(find<QComboBox>("DurationCombo")->count(), 8);
    EXPECT_EQ(text("TMCInfoOnOff"), ">");
}

TEST_F(TmcPageTest, TwoMissingListsAreToldTogetherInTheCurrentLanguage) {
    useLanguage("english");
    std::filesystem::remove(folder.data() / "Event.txt");
    std::filesystem::remove(folder.data() / "Location.txt");
    try {
        page->reloadLists();
        FAIL() << "no error";
    } catch (const std::runtime_error& error) {
        EXPECT_STREQ(error.what(), "Event.txt cannot be read.\nLocation.txt cannot be read.");
    }
    EXPECT_EQ(find<QComboBox>("TMC_Event_Combo")->count(), 0);
    EXPECT_EQ(find<QComboBox>("TMC_Loc_Combo")->count(), 0);
}

TEST_F(TmcPageTest, FileNamesMatchWithoutRegardToLetterCase) {
    std::filesystem::rename(folder.data() / "Event.txt", folder.data() / "EVENT.TXT");
    page->reloadLists();
    EXPECT_EQ(find<QComboBox>("TMC_Event_Combo")->count(), 5);
}

TEST_F(TmcPageTest, ReloadingKeepsTheMessageAndWhatIsChosen) {
    composeMessage();
    folder.write("Event.txt", "neu;00500\r\nVerkehrsproblem;00001\r\n");
    folder.write("Location.txt", "neu;00500\r\n");
    page->reloadLists();
    EXPECT_EQ(find<QComboBox>("TMC_Event_Combo")->currentIndex(), 1);
    EXPECT_EQ(find<QComboBox>("TMC_Loc_Combo")->currentIndex(), -1) << "that entry is gone";
    EXPECT_EQ(text("TMC_Gr8_Label"), "0810013039");
}

TEST_F(TmcPageTest, RelabellingKeepsWhatIsComposedListedAndShown) {
    composeMessage();
    click("TMC_Gr8_apply");
    click("TMCInfoOnOff");
    click("optMultiMessage");
    click("TMC_Senden_Taste");
    useLanguage("english");
    page->label();
    EXPECT_EQ(text("TMC_F_Check"), "F field");
    EXPECT_EQ(text("TMC_Gr8_Label"), "0810013039");
    EXPECT_EQ(text("TMCBL3_Extent"), "010");
    EXPECT_EQ(text("TMCInfoOnOff"), "<");
    EXPECT_EQ(find<QComboBox>("TMC_Event_Combo")->currentIndex(), 0);
    EXPECT_EQ(list().count(), 1);
    EXPECT_TRUE(tick("TMC_Sende_Timer"));
}

TEST_F(TmcPageTest, CaptionsComeFromTheLanguageFile) {
    for (const char* language : kLanguages) {
        useLanguage(language);
        page->label();
        const auto caption = [this](int number) { return toText(captions.text(number)).toStdString(); };
        EXPECT_EQ(text("TMC_Senden_Taste"), caption(53));
        EXPECT_EQ(text("TMC_Gr8_apply"), caption(196));
        EXPECT_EQ(text("TMC_Gr8_Remove"), caption(197));
        EXPECT_EQ(text("lblCycleTime"), caption(200));
        EXPECT_EQ(find<QGroupBox>("TMC_Frame1")->title().toStdString(), caption(201));
        EXPECT_EQ(text("Tmc_richtung_0"), caption(202));
        EXPECT_EQ(text("Tmc_richtung_1"), caption(203));
        EXPECT_EQ(text("TMC_Var_Label"), caption(204));
        EXPECT_EQ(text("Label3"), caption(205));
        EXPECT_EQ(text("Label4"), caption(206));
        EXPECT_EQ(text("optSingleMessage"), caption(229));
        EXPECT_EQ(text("optMultiMessage"), caption(230));
    }
}

TEST_F(TmcPageTest, TheGermanTextsAreTheDesignTexts) {
    EXPECT_EQ(text("TMC_Div"), "Diversion");
    EXPECT_EQ(text("TMC_DP1_Check"), "DP 1");
    EXPECT_EQ(text("TMC_DP2_Check"), "DP 2");
    EXPECT_EQ(text("TMC_DP3Check"), "DP 3");
    EXPECT_EQ(find<QGroupBox>("Frame5")->title().toStdString(), "duration / persistence");
    EXPECT_EQ(text("TMC_F_Check"), "F - Feld");
    EXPECT_EQ(text("TMC_T_Check"), "T - Feld");
    EXPECT_EQ(text("Stop_Timer"), "stop");
}

TEST_F(TmcPageTest, TheButtonWithoutBehaviourIsThereAndHidden) {
    EXPECT_TRUE(find<QAbstractButton>("Command23")->isHidden());
}

TEST_F(TmcPageTest, TheGroupCodeIsInArial) {
    EXPECT_EQ(find<QLabel>("TMC_Gr8_Label")->font().families().first().toStdString(), "Arial");
}

TEST_F(TmcPageTest, MnemonicsAreUniqueInEveryLanguage) {
    for (const char* language : kLanguages) {
        useLanguage(language);
        page->label();
        std::set<QChar> used;
        for (const auto* button : page->findChildren<QAbstractButton*>()) {
            const qsizetype mark = button->text().indexOf(QLatin1Char('&'));
            if (mark < 0) continue;
            EXPECT_TRUE(used.insert(button->text()[mark + 1].toLower()).second)
                << language << ": " << button->text().toStdString();
        }
    }
}

TEST_F(TmcPageTest, TheWholeGroupCodeOfAListedMessageIsSeen) {
    page->resize(620, 322);
    page->show();
    composeMessage();
    click("TMC_Gr8_apply");
    QApplication::processEvents();
    EXPECT_LE(list().visualItemRect(list().item(0)).right(), list().viewport()->width());
}

}  // namespace
}  // namespace kdx::test
