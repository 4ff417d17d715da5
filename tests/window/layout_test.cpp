#include "support/everyfont.h"

#include <gtest/gtest.h>

#include <QGroupBox>
#include <QTabBar>

#include <cstdlib>

#include "support/windowtest.h"

namespace kdx::test {
namespace {

class LayoutTest : public WindowTest {
protected:
    void walk(const char* language, const std::function<void(int page)>& look) {
        folder.copyShipped();
        setGeneral("Sprache", "Sprache", language);
        std::string list = "107.6";
        for (int i = 0; i < 25; ++i) list += ",107.6";
        setDataSet1("RDS", "AF_LISTE1", list);
        setDataSet1("RDS", "EON_AFB1", list);
        start();
        openSession();
        fillPages();
        for (int page = 0; page < 9; ++page) {
            showPage(page);
            QCoreApplication::processEvents();
            look(page);
        }
    }

    /// For a look at the window: KDX_SHOTS names the folder.
    void savePicture(const std::string& name) {
        if (const char* folderName = std::getenv("KDX_SHOTS")) {
            const auto file = QString::fromLocal8Bit(folderName) + QLatin1Char('/') + QString::fromStdString(name) +
                              QStringLiteral("_%1pt.png").arg(QApplication::font().pointSizeF());
            EXPECT_TRUE(window->grab().save(QString(file).replace(QLatin1Char(' '), QLatin1Char('_'))));
        }
    }

private:
    /// What needs the most room: the widest numbers, the fields that are hidden at first, a listed message.
    void fillPages() {
        scroll("FM_Hub_Scroll", 8000);
        scroll("Pilot_Hub_Scroll", 1500);
        click("EON_AFB_Opt_0");
        select("TMC_Event_Combo", 0);
        select("TMC_Loc_Combo", 0);
        click("TMC_Gr8_apply");
        click("TMCInfoOnOff");
    }
};

TEST_F(LayoutTest, NothingIsCutOffInAnyLanguageAtTheDesignSize) {
    for (const char* language : kEveryLanguage) {
        walk(language, [&](int page) {
            EXPECT_EQ(window->size(), QSize(640, 480));
            expectNothingCutOff(*window, std::string(language) + " page " + std::to_string(page));
        });
    }
}

TEST_F(LayoutTest, EveryProgrammeTypeIsShownWhole) {
    for (const char* language : kEveryLanguage) {
        walk(language, [&](int page) {
            for (auto* types : {find<QComboBox>("PTY_Combo1"), find<QComboBox>("EON_PTY_Combo")}) {
                const QSignalBlocker quiet(types);
                for (int type = 0; types->isVisible() && type < types->count(); ++type) {
                    types->setCurrentIndex(type);
                    expectNothingCutOff(*window, std::string(language) + " page " + std::to_string(page));
                }
            }
        });
    }
}

TEST_F(LayoutTest, NoPageNeedsMoreRoomThanItHasAtTheDesignSize) {
    for (const char* language : kEveryLanguage) {
        walk(language, [&](int index) {
            const QWidget* page = find<QTabWidget>("SSTab1")->widget(index);
            EXPECT_LE(page->minimumSizeHint().width(), page->width()) << language << " page " << index;
            EXPECT_LE(page->minimumSizeHint().height(), page->height()) << language << " page " << index;
            EXPECT_LE(window->minimumSizeHint().width(), 640) << language;
        });
    }
}

TEST_F(LayoutTest, EveryTabShowsItsWholeCaption) {
    for (const char* language : kEveryLanguage) {
        walk(language, [&](int page) {
            const auto* bar = find<QTabWidget>("SSTab1")->tabBar();
            const int needed = bar->fontMetrics().horizontalAdvance(bar->tabText(page)) + 8;
            EXPECT_GE(bar->tabRect(page).width(), needed) << language << " page " << page;
            EXPECT_FALSE(bar->tabText(page).isEmpty());
        });
    }
}

TEST_F(LayoutTest, EveryControlThatCanBeUsedHasANameForThoseWhoCannotSeeIt) {
    for (const char* language : kEveryLanguage) {
        walk(language, [&](int page) {
            for (const QWidget* control : find<QTabWidget>("SSTab1")->widget(page)->findChildren<QWidget*>()) {
                if (control->focusPolicy() == Qt::NoFocus || control->objectName().isEmpty() ||
                    control->objectName().startsWith(QStringLiteral("qt_")) || !control->isVisible()) {
                    continue;
                }
                const auto* button = qobject_cast<const QAbstractButton*>(control);
                const auto* shown = qobject_cast<const QLabel*>(control);
                const bool ownText =
                    (button != nullptr && !button->text().isEmpty()) || (shown != nullptr && !shown->text().isEmpty());
                bool buddy = false;
                for (const QLabel* label : window->findChildren<QLabel*>()) buddy = buddy || label->buddy() == control;
                EXPECT_TRUE(ownText || buddy || !control->accessibleName().isEmpty())
                    << language << " " << control->objectName().toStdString();
            }
        });
    }
}

TEST_F(LayoutTest, NoMnemonicIsGivenTwiceOnAPage) {
    for (const char* language : kEveryLanguage) {
        walk(language, [&](int page) {
            std::map<QString, std::string> taken;
            for (const QAbstractButton* button : window->findChildren<QAbstractButton*>()) {
                const QKeySequence key = QKeySequence::mnemonic(button->text());
                if (key.isEmpty() || !button->isVisible()) continue;
                const std::string name = button->objectName().toStdString();
                const auto [at, fresh] = taken.emplace(key.toString(), name);
                EXPECT_TRUE(fresh) << language << " page " << page << ": " << name << " and " << at->second;
            }
        });
    }
}

TEST_F(LayoutTest, TheControlsOfAllPagesBearTheSystemsNames) {
    startShipped();
    for (const char* name :
         {"Frame11",      "RDS_Frame",        "FM_Frame",        "Ari_Frame",      "Frame_stereo",
          "PS_Label",     "Label1",           "PI_Label",        "Taste_PS_Auto",  "PS_A_Label",
          "Image1",       "MS_Frame",         "Time_Frame",      "RT_Frame",       "DI_Frame",
          "PS_T",         "Frame1",           "PTY_Combo1",      "PI_T",           "Command3",
          "PS_Taste",     "PS_dyn_Check",     "Frame2",          "newList",        "Gruppe0",
          "Gruppe15",     "GS_Senden",        "Label10",         "Frame3",         "EON_PTY_LAbel",
          "EON_PS_LABEL", "gelesen",          "Command1",        "Command22",      "Store_Taste_4",
          "TMCBL3_Event", "optSingleMessage", "optMultiMessage", "txtCycleTime",   "Stop_Timer",
          "Frame5",       "Command23",        "RF_Freq_Frame",   "RF_Level_Frame", "AF_Freq_Frame",
          "HfOnOffState", "Frame8",           "Frame7",          "Image2",         "Gen1_Label",
          "Status_17",    "Adr1_VScroll",     "Label6",          "FM_Sorce_Frame", "HScroll1_Label"}) {
        EXPECT_NE(window->findChild<QWidget*>(QString::fromLatin1(name)), nullptr) << name;
    }
    for (const char* timer : {"Timer1", "PS_Timer", "TA_Timer", "TA_Rep_Timer", "EON_TA_Zeit", "TMC_Sende_Timer"}) {
        EXPECT_NE(window->findChild<QTimer*>(QString::fromLatin1(timer)), nullptr) << timer;
    }
}

/// The window with another font than the one it was designed with, in points.
class FontTest : public LayoutTest, public ::testing::WithParamInterface<int> {
protected:
    ~FontTest() override { end(); }

private:
    FontSize m_font{GetParam()};
};

TEST_P(FontTest, NothingIsCutOffOrOutOfReachAtTheLeastSize) {
    for (const char* language : kEveryLanguage) {
        walk(language, [&](int index) {
            window->resize(1, 1);  // as small as it becomes
            QCoreApplication::processEvents();
            const auto where = std::string(language) + " page " + std::to_string(index);
            expectNothingCutOff(*window, where);
            const QWidget* page = find<QTabWidget>("SSTab1")->widget(index);
            EXPECT_LE(page->minimumSizeHint().width(), page->width()) << where;
            EXPECT_LE(page->minimumSizeHint().height(), page->height()) << where;
            const auto* bar = find<QTabWidget>("SSTab1")->tabBar();
            EXPECT_TRUE(bar->usesScrollButtons() || bar->sizeHint().width() <= bar->width()) << where;
            savePicture(where);
        });
    }
}

INSTANTIATE_TEST_SUITE_P(Points, FontTest, ::testing::ValuesIn(kEveryFontSize),
                         [](const auto& tested) { return std::to_string(tested.param); });

TEST_F(LayoutTest, AMaximisedPageKeepsItsControlsTogether) {
    startShipped();
    openSession();
    window->resize(3000, 1500);
    for (int page = 0; page < 9; ++page) {
        showPage(page);
        QCoreApplication::processEvents();
        for (const QWidget* control : find<QTabWidget>("SSTab1")->widget(page)->findChildren<QWidget*>()) {
            EXPECT_LE(control->width(), 1300) << control->objectName().toStdString();
        }
    }
}

TEST_F(LayoutTest, TheWindowMayBeEnlarged) {
    startShipped();
    window->resize(1280, 960);
    QCoreApplication::processEvents();
    EXPECT_EQ(window->size(), QSize(1280, 960));
    EXPECT_GT(find("SSTab1")->width(), 1200);
}

}  // namespace
}  // namespace kdx::test
