#include <gtest/gtest.h>

#include <QGroupBox>
#include <QMenu>

#include "support/windowtest.h"
#include "ui/caption.h"

namespace kdx::test {
namespace {

/// The window with a language file in which every text says its number: caption 53 reads "T53".
class LabellingTest : public WindowTest {
protected:
    LabellingTest() {
        std::string file = "[deutsch]\r\n";
        for (int number = 0; number < 300; ++number) {
            file += std::to_string(number) + "=T" + std::to_string(number) + "\r\n";
        }
        folder.copyShipped();
        folder.write(kLanguageFile, file);
        start();
    }
    std::string caption(const char* name) {
        if (const auto* frame = window->findChild<QGroupBox*>(QString::fromLatin1(name))) {
            return frame->title().toStdString();
        }
        return text(name);
    }
};

TEST_F(LabellingTest, EveryControlIsCaptionedByItsNumber) {
    const std::pair<const char*, const char*> controls[] = {{"Ende_Taste", "T6"},
                                                            {"FM_Sorce_Frame", "T20"},
                                                            {"FM_Source_Opt_0", "T22"},
                                                            {"FM_Source_Opt_1", "T23"},
                                                            {"FM_Source_Opt_2", "T24"},
                                                            {"FM_Source_Opt_3", "T25"},
                                                            {"FM_Imp_Frame", "T26"},
                                                            {"Pre_Frame", "T27"},
                                                            {"Pre_opt_0", "T28"},
                                                            {"Frame_stereo", "T29"},
                                                            {"Frame1", "T47"},
                                                            {"TA_Option_0", "T48"},
                                                            {"RT_Frame", "T49"},
                                                            {"RT_clear1", "T52"},
                                                            {"Command3", "T53"},
                                                            {"PS_Taste", "T53"},
                                                            {"RT_Taste1", "T53"},
                                                            {"TMC_Senden_Taste", "T53"},
                                                            {"Time_Frame", "T54"},
                                                            {"MS_Frame", "T55"},
                                                            {"MS_opt_0", "T56"},
                                                            {"MS_opt_1", "T57"},
                                                            {"DI_Opt_0", "T59"},
                                                            {"DI_Opt_1", "T60"},
                                                            {"DI_Opt_2", "T61"},
                                                            {"DI_Opt_3", "T62"},
                                                            {"DI_Opt_4", "T63"},
                                                            {"DI_Opt_5", "T64"},
                                                            {"DI_Opt_6", "T65"},
                                                            {"DI_Opt_7", "T66"},
                                                            {"DI_Opt_8", "8"},
                                                            {"DI_Opt_15", "15"},
                                                            {"Frame2", "T71"},
                                                            {"AF_Bearbeiten", "T72"},
                                                            {"Taste_AF_Senden", "T73"},
                                                            {"AFList_Opt_0", "T74 1"},
                                                            {"AFList_Opt_4", "T74 5"},
                                                            {"AFMethod_opt_0", "T75"},
                                                            {"AFMethod_opt_1", "T76"},
                                                            {"Gruppe0", "T81 0"},
                                                            {"Gruppe15", "T81 15"},
                                                            {"GS_Senden", "T82"},
                                                            {"EON_PI_Taste", "T86"},
                                                            {"EON_PS_Taste", "T86"},
                                                            {"EON_AFB_Senden", "T86"},
                                                            {"Frame3", "T87"},
                                                            {"EON_AFB_Opt_0", "T88 1"},
                                                            {"EON_AFB_Opt_4", "T88 5"},
                                                            {"EON_AF_Bearbeiten", "T89"},
                                                            {"Command19", "T121"},
                                                            {"Command17", "T122"},
                                                            {"Command5", "T123"},
                                                            {"Command7", "T124"},
                                                            {"Command8", "T125"},
                                                            {"Command4", "T126"},
                                                            {"Command6", "T127"},
                                                            {"Command21", "T128"},
                                                            {"Command20", "T129"},
                                                            {"Command9", "T130"},
                                                            {"Command16", "T131"},
                                                            {"Command14", "T132"},
                                                            {"Command15", "T133"},
                                                            {"Command1", "T134"},
                                                            {"Command11", "T135"},
                                                            {"Command12", "T136"},
                                                            {"Command13", "T137"},
                                                            {"Command18", "T138"},
                                                            {"gelesen", "T139"},
                                                            {"newList", "T156"},
                                                            {"ARI_Mode_Opt_0", "T193"},
                                                            {"Uhr_Zeit", "T193"},
                                                            {"TMC_Gr8_apply", "T196"},
                                                            {"TMC_Gr8_Remove", "T197"},
                                                            {"lblCycleTime", "T200"},
                                                            {"TMC_Frame1", "T201"},
                                                            {"Tmc_richtung_0", "T202"},
                                                            {"Tmc_richtung_1", "T203"},
                                                            {"TMC_Var_Label", "T204"},
                                                            {"Label3", "T205"},
                                                            {"Label4", "T206"},
                                                            {"RF_Freq_Frame", "T212"},
                                                            {"AF_Freq_Frame", "T215"},
                                                            {"RF_Level_Frame", "T218"},
                                                            {"Status_16", "T220"},
                                                            {"Status_12", "T221"},
                                                            {"Status_15", "T222"},
                                                            {"optSingleMessage", "T229"},
                                                            {"optMultiMessage", "T230"}};
    for (const auto& [control, expected] : controls) EXPECT_EQ(caption(control), expected) << control;
}

TEST_F(LabellingTest, TextsThatGoOnBeginWithTheirCaption) {
    EXPECT_EQ(text("Pilot_hub_Label"), "T21 6.75 kHz");
    EXPECT_EQ(text("TA_Zeit_Label").substr(text("TA_Zeit_Label").rfind(' ')), " T40");
    EXPECT_EQ(text("TA_Rep_Label").substr(text("TA_Rep_Label").rfind(' ')), " T41");
    EXPECT_EQ(text("Label10").substr(0, 4), "T83:");
}

TEST_F(LabellingTest, MenusAndPagesAreCaptionedByTheirNumber) {
    EXPECT_EQ(window->findChild<QMenu*>(QStringLiteral("Mnu_Info"))->title(), QStringLiteral("T0"));
    EXPECT_EQ(action("Mnu_Info_Ueber")->text(), QStringLiteral("T1"));
    EXPECT_EQ(window->findChild<QMenu*>(QStringLiteral("Mnu_Info_Sprache"))->title(), QStringLiteral("T2"));
    EXPECT_EQ(action("Mnu_Info_Sprache_D")->text(), QStringLiteral("T3"));
    EXPECT_EQ(action("Mnu_Info_Sprache_E")->text(), QStringLiteral("T4"));
    for (int page = 0; page < 9; ++page) {
        EXPECT_EQ(find<QTabWidget>("SSTab1")->tabText(page), QStringLiteral("T%1").arg(page + 10));
    }
}

TEST_F(LabellingTest, ThePagesHoldTheirControls) {
    const std::vector<std::vector<const char*>> pages = {
        {"Frame11", "RDS_Frame", "FM_Frame", "Ari_Frame", "Frame_stereo", "Btn_SetRdsStereo"},
        {"PS_Label", "Label1",   "PI_Label",   "Taste_PS_Auto", "PS_A_Label", "Image1",   "MS_Frame",
         "RT_Frame", "DI_Frame", "Time_Frame", "Timer1",        "PS_T",       "Frame1",   "PTY_Combo1",
         "PS_Timer", "PI_T",     "Command3",   "PS_Taste",      "Check1",     "TA_Check", "PS_dyn_Check"},
        {"Frame2", "AFList_Opt_0", "AFMethod_opt_1", "AF_Bearbeiten", "Taste_AF_Senden"},
        {"newList", "Gruppe0", "Gruppe15", "GS_Senden", "Label10"},
        {"EON_PI_Text", "EON_PS_Text", "EON_PTY_Combo", "Frame3", "EON_TA_Zeit", "EON_TA_Schalter"},
        {"Command1", "Command4", "Command10", "Command22", "gelesen"},
        {"Store_Taste_0", "Store_Taste_4"},
        {"TMCBL3_Event", "TMC_Event_Combo", "optSingleMessage", "optMultiMessage", "txtCycleTime", "Stop_Timer",
         "Frame5", "Command23"},
        {"RF_Freq_Frame", "RF_Level_Frame", "AF_Freq_Frame", "HfOnOffState"}};
    for (std::size_t page = 0; page < pages.size(); ++page) {
        const auto* widget = find<QTabWidget>("SSTab1")->widget(static_cast<int>(page));
        for (const char* name : pages[page]) {
            EXPECT_NE(widget->findChild<QObject*>(QString::fromLatin1(name)), nullptr) << page << " " << name;
        }
    }
}

TEST_F(LabellingTest, ATextThatTheLanguageLacksIsEmpty) {
    folder.write(kLanguageFile, "[deutsch]\r\n0=T0\r\n");
    start();
    EXPECT_EQ(text("PS_Taste"), "");
    EXPECT_EQ(caption("RT_Frame"), "");
    EXPECT_EQ(find<QComboBox>("PTY_Combo1")->count(), 32);  // the position is the code, with or without a name
    EXPECT_EQ(find<QComboBox>("PTY_Combo1")->itemText(3), QString());
}

TEST_F(LabellingTest, WithoutALanguageFileEveryDesignTextIsWhole) {
    folder.copyShipped();
    std::filesystem::remove(folder.data() / kLanguageFile);
    start();
    action("Mnu_Info_Log")->trigger();
    QStringList texts;
    for (const QWidget* widget : window->findChildren<QWidget*>()) {
        texts << shownText(widget) << widget->toolTip() << widget->accessibleName();
    }
    for (const QAction* entry : window->findChildren<QAction*>()) texts << entry->text();
    EXPECT_TRUE(texts.contains(QStringLiteral("&Schließen")));
    EXPECT_TRUE(texts.contains(QStringLiteral("RF [dBµV]")));
    for (const QString& shown : texts) {
        // A question mark stands alone after a blank, as on the buttons that ask; a letter that is none has none.
        EXPECT_FALSE(QString(shown).replace(QLatin1String(" ?"), QString()).contains(QLatin1Char('?')))
            << shown.toStdString();
    }
}

}  // namespace
}  // namespace kdx::test
