#include "support/everyfont.h"

#include <gtest/gtest.h>

#include <QAbstractSpinBox>
#include <QGroupBox>
#include <QHelpEvent>
#include <QTabBar>
#include <QToolButton>
#include <QToolTip>

#include <cstdlib>
#include <map>
#include <set>

#include "support/windowtest.h"
#include "ui/clickablelabel.h"

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

    /// Every tab shows its whole caption, if need be after presses of the buttons that scroll the tabs.
    void expectEveryTabCanBeReached(const std::string& where) {
        const auto* bar = find<QTabWidget>("SSTab1")->tabBar();
        auto* left = bar->findChild<QToolButton*>(QStringLiteral("ScrollLeftButton"));
        auto* right = bar->findChild<QToolButton*>(QStringLiteral("ScrollRightButton"));
        ASSERT_TRUE(left != nullptr && right != nullptr);
        QRect open = bar->rect();
        if (left->isVisible()) open.setRight(left->x() - 1);
        const auto press = [&](QToolButton& button) {
            for (int times = 0; times < bar->count() && button.isVisible() && button.isEnabled(); ++times)
                button.click();
        };
        press(*left);
        for (int tab = 0; tab < bar->count(); ++tab) {
            const auto inside = [&] {
                return bar->tabRect(tab).left() >= open.left() && bar->tabRect(tab).right() <= open.right();
            };
            while (!inside() && right->isVisible() && right->isEnabled()) right->click();
            EXPECT_TRUE(inside()) << where << ": tab " << tab << " cannot be reached";
            EXPECT_GE(bar->tabRect(tab).width(), bar->fontMetrics().horizontalAdvance(bar->tabText(tab)) + 8)
                << where << ": tab " << tab;
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

    /// What each label has to show at the most.
    void showLongest(const char* language) {
        type("PS_T", "WWWWWWWW");
        click("PS_Taste");
        for (int group = 0; group < 16; ++group) click(("Gruppe" + std::to_string(group)).c_str());
        dialogs.inputs.push_back(QStringLiteral("98.5 und noch viel mehr, als in den Rahmen passt"));
        emit find<ClickableLabel>("Input_HF_Freq_Label")->clicked();
        click("optMultiMessage");
        click("TMC_Senden_Taste");
        tick("TMC_Sende_Timer");
        visa.writeStatus = visa::kTimeout;
        dialogs.expectedMessages = 1;
        click("Command3");
        visa.writeStatus = 0;
        find<QLabel>("QuietLine")
            ->setText(QStringLiteral("/home/messplatz/") + QString(80, QLatin1Char('x')) +
                      QString::fromLatin1(language));
    }
    static QString tipOf(QLabel& label) {
        QToolTip::hideText();
        QHelpEvent event(QEvent::ToolTip, QPoint(1, 1), label.mapToGlobal(QPoint(1, 1)));
        QApplication::sendEvent(&label, &event);
        return QToolTip::text();
    }

    std::set<std::string> m_cut;  ///< the labels whose text did not fit in some language

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
            expectEveryTabCanBeReached(where);
            savePicture(where);
        });
    }
}

TEST_P(FontTest, ALongTextIsCutWithDotsAndWholeInTheTip) {
    const QString host = QStringLiteral("messplatz-7.ukw-labor.sendernetz.example.org");
    for (const char* language : kEveryLanguage) {
        setGeneral("ADRESSEN", "KDX_TCPIP", host.toStdString());
        walk(language, [](int) {});
        showLongest(language);
        window->resize(1, 1);
        for (const auto& [name, page] : std::map<std::string, int>{{"Verbindung_Anzeige", 1},
                                                                   {"Status_3", 1},
                                                                   {"Status_4", 1},
                                                                   {"Status_17", 8},
                                                                   {"Datensatz_Anzeige", 1},
                                                                   {"HF_Anzeige", 1},
                                                                   {"QuietLine", 1},
                                                                   {"Gruppe_Anteile", 3},
                                                                   {"TMC_Lauf", 7},
                                                                   {"Input_HF_Freq_Label", 8}}) {
            showPage(page);
            QCoreApplication::processEvents();
            auto* label = find<QLabel>(name.c_str());
            const std::string where = std::string(language) + " " + name;
            ASSERT_FALSE(label->text().isEmpty()) << where;
            if (visibleText(*label) == label->text()) continue;
            EXPECT_TRUE(elidesLongText(*label)) << where;
            EXPECT_TRUE(visibleText(*label).endsWith(QChar(0x2026))) << where;
            EXPECT_TRUE(tipOf(*label).contains(label->text())) << where << ": " << tipOf(*label).toStdString();
            m_cut.insert(name);
        }
    }
    for (const char* name : {"QuietLine", "Input_HF_Freq_Label"})
        EXPECT_EQ(m_cut.count(name), 1U) << name << " was meant to be too long";
}

TEST_F(LayoutTest, TheManualIsNotCutOff) {
    expectNothingCutOffAnywhere([this](const char* language) -> QWidget& {
        folder.copyShipped();
        setGeneral("Sprache", "Sprache", language);
        start();
        action("Mnu_Hilfe_Handbuch")->trigger();
        return *window->findChild<QWidget*>(QStringLiteral("ManualView"));
    });
}

INSTANTIATE_TEST_SUITE_P(Points, FontTest, ::testing::ValuesIn(kEveryFontSize),
                         [](const auto& tested) { return std::to_string(tested.param); });

TEST_F(LayoutTest, AMaximisedPageKeepsItsControlsTogether) {
    startShipped();
    openSession();
    window->resize(3000, 1500);
    for (int index = 0; index < 9; ++index) {
        showPage(index);
        QCoreApplication::processEvents();
        const QWidget* page = find<QTabWidget>("SSTab1")->widget(index);
        const int line = page->fontMetrics().height();
        QRect all;
        for (const QWidget* control : page->findChildren<QWidget*>()) {
            if (!control->isVisibleTo(page) || control->window() != page->window()) continue;
            all |= QRect(control->mapTo(page, QPoint()), control->size());
            const bool single = qobject_cast<const QAbstractButton*>(control) != nullptr ||
                                qobject_cast<const QAbstractSpinBox*>(control) != nullptr;
            EXPECT_LE(control->width(), (single ? 40 : 90) * line) << control->objectName().toStdString();
        }
        EXPECT_LE(all.width(), 90 * line) << "page " << index << ": the eye has to cross it";
        EXPECT_NEAR(all.center().x(), page->rect().center().x(), 4 * line) << "page " << index;
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
