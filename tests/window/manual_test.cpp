// The manual in the program: F1, languages, and that all it links to is there.
#include <gtest/gtest.h>

#include <QMenu>
#include <QScrollBar>
#include <QTextBlock>
#include <QTextBrowser>

#include "support/sourcefolder.h"
#include "support/windowtest.h"
#include "window/manualview.h"

namespace kdx::test {
namespace {

class ManualTest : public WindowTest {
protected:
    ManualTest() {
        folder.copyShipped();
        shipped = sourceFolder() / "docs";  // as installed the manual stands beside the data
    }
    static void pressF1(QWidget& control) {
        QCoreApplication::processEvents();  // until the window it is in is the active one
        QKeyEvent press(QEvent::KeyPress, Qt::Key_F1, Qt::NoModifier);
        QApplication::sendEvent(&control, &press);
    }
    /// What is shown, as "de/index.md".
    std::string shown() {
        const auto file = std::filesystem::path(browser().source().toLocalFile().toStdString());
        return (file.parent_path().filename() / file.filename()).generic_string();
    }
    QTextBrowser& browser() { return *find<QTextBrowser>("Handbuch_Text"); }
    std::string plainText() { return browser().toPlainText().toStdString(); }
    bool isInView(const QString& heading) {
        for (QTextBlock block = browser().document()->begin(); block.isValid(); block = block.next()) {
            if (block.blockFormat().headingLevel() == 0 || block.text() != heading) continue;
            return browser().viewport()->rect().contains(browser().cursorRect(QTextCursor(block)).center());
        }
        return false;
    }
    void clickAt(QTextCursor text) {
        text.setPosition(text.position() - 1);
        browser().setTextCursor(text);  // scrolls there
        const QPointF place = browser().cursorRect(text).center();
        for (const auto type : {QEvent::MouseButtonPress, QEvent::MouseButtonRelease}) {
            QMouseEvent event(type, place, browser().viewport()->mapToGlobal(place), Qt::LeftButton, Qt::LeftButton,
                              Qt::NoModifier);
            QApplication::sendEvent(browser().viewport(), &event);
        }
    }
    void chooseLanguage(const char* entry) { action(entry)->trigger(); }
};

TEST_F(ManualTest, TheMenuHelpBeginsWithItAndF1IsItsKey) {
    start();
    const auto* help = window->findChild<QMenu*>(QStringLiteral("Mnu_Hilfe"));
    EXPECT_EQ(help->actions().value(0), action("Mnu_Hilfe_Handbuch"));
    EXPECT_EQ(help->actions().value(1), action("Mnu_Hilfe_Ueber"));
    EXPECT_EQ(action("Mnu_Hilfe_Handbuch")->shortcut(), QKeySequence(Qt::Key_F1));
    EXPECT_EQ(window->findChild<ManualView*>(), nullptr) << "made when it is first opened";
    action("Mnu_Hilfe_Handbuch")->trigger();
    EXPECT_EQ(shown(), "de/page-fm-stereo.md");
    EXPECT_TRUE(find<ManualView>("ManualView")->isVisible());
}

TEST_F(ManualTest, F1OpensTheSectionOfThePageInView) {
    start();
    const Lines files{"page-fm-stereo", "page-rds",   "page-af-list", "page-groups", "page-eon",
                      "page-query",     "page-store", "page-tmc",     "page-rf"};
    for (std::size_t page = 0; page < files.size(); ++page) {
        showPage(static_cast<int>(page));
        pressF1(*find("SSTab1"));
        EXPECT_EQ(shown(), "de/" + files[page] + ".md");
        const std::string tab = find<QTabWidget>("SSTab1")->tabText(static_cast<int>(page)).toStdString();
        EXPECT_NE(browser().document()->begin().text().toStdString().find(tab), std::string::npos) << tab;
    }
}

TEST_F(ManualTest, F1InAViewOpensTheSectionOfTheView) {
    start();
    const Lines expected[] = {{"Mnu_Ansicht_OnAir", "OnAirView", "on-air.md"},
                              {"Mnu_Ansicht_Vergleich", "CompareView", "compare.md"},
                              {"Mnu_Ansicht_Ablauf", "ScenarioView", "scenarios.md"},
                              {"Mnu_Info_Log", "LogView", "log.md"},
                              {"Mnu_Einstellungen", "SettingsDialog", "settings.md"}};
    for (const Lines& row : expected) {
        action(row[0].c_str())->trigger();
        pressF1(*find(row[1].c_str()));
        EXPECT_EQ(shown(), "de/" + row[2]);
        find(row[1].c_str())->close();
    }
    pressF1(browser());
    EXPECT_EQ(shown(), "de/index.md") << "in the manual itself: what it has";
}

TEST_F(ManualTest, F1InAnEditorOpensItsSectionInAWindowThatCanBeUsedBesideIt) {
    start();
    openSession();
    showPage(2);
    bool seen = false;
    const auto look = [&](const char* name, const char* file, const char* heading) {
        seen = false;
        QTimer::singleShot(0, window.get(), [&seen, this, name, file, heading] {
            QWidget* editor = QApplication::activeModalWidget();
            ASSERT_NE(editor, nullptr);
            EXPECT_EQ(editor->objectName().toStdString(), name);
            pressF1(*editor);
            QCoreApplication::processEvents();
            EXPECT_NE(editor->findChild<ManualView*>(), nullptr) << "a window of the main one could not be used";
            EXPECT_EQ(shown(), file);
            EXPECT_TRUE(isInView(QString::fromLatin1(heading))) << heading;
            EXPECT_GT(browser().verticalScrollBar()->value(), 0);
            seen = true;
            editor->close();
        });
    };
    look("AF_Listenform", "de/page-af-list.md", "Der Editor");
    click("AF_Bearbeiten");
    EXPECT_TRUE(seen);
    look("TMC_Listedit", "de/page-tmc.md", "TMC Edit");
    action("Mnu_TMC_Edit")->trigger();
    EXPECT_TRUE(seen);
}

TEST_F(ManualTest, AnotherLanguageShowsTheSameChapterInIt) {
    start();
    showPage(1);
    pressF1(*window);
    chooseLanguage("Mnu_Info_Sprache_E");
    EXPECT_EQ(shown(), "en/page-rds.md");
    EXPECT_EQ(find<ManualView>("ManualView")->windowTitle().toStdString(), "Manual");
    EXPECT_EQ(text("Handbuch_Inhalt"), "&Contents");
    chooseLanguage("Mnu_Info_Sprache_US");
    EXPECT_EQ(shown(), "en/page-rds.md");
    chooseLanguage("Mnu_Info_Sprache_D");
    EXPECT_EQ(shown(), "de/page-rds.md");
}

TEST_F(ManualTest, AMissingManualIsSaidWithTheFileThatWasLookedFor) {
    shipped = folder.path() / "nothing";
    start();
    action("Mnu_Hilfe_Handbuch")->trigger();
    const std::string file = (shipped / "manual" / "de" / "page-fm-stereo.md").string();
    EXPECT_EQ(plainText(), "Das Handbuch fehlt. Gesucht wurde " + file);
    std::filesystem::create_directories(shipped / "manual" / "de");
    std::ofstream(file) << "# Da\n";
    action("Mnu_Hilfe_Handbuch")->trigger();
    EXPECT_EQ(plainText(), "Da") << "found as soon as it is there";
}

TEST_F(ManualTest, LinksLeadToOtherChaptersAndBack) {
    start();
    action("Mnu_Hilfe_Handbuch")->trigger();
    EXPECT_FALSE(enabled("Handbuch_Zurueck"));
    click("Handbuch_Inhalt");
    EXPECT_EQ(shown(), "de/index.md");
    const QTextCursor link = browser().document()->find(QStringLiteral("Budgets"));
    ASSERT_TRUE(link.charFormat().isAnchor());
    const QString target = link.charFormat().anchorHref();
    clickAt(link);
    EXPECT_EQ(shown(), "de/" + target.toStdString());
    click("Handbuch_Zurueck");
    EXPECT_EQ(shown(), "de/index.md");
    click("Handbuch_Vor");
    EXPECT_EQ(shown(), "de/" + target.toStdString());
}

TEST_F(ManualTest, ATextIsFoundInTheChapterFromItsBeginningAgain) {
    start();
    showPage(1);
    action("Mnu_Hilfe_Handbuch")->trigger();
    type("Handbuch_Suche", "Radiotext");
    emit find<QLineEdit>("Handbuch_Suche")->returnPressed();
    const int first = browser().textCursor().position();
    EXPECT_EQ(browser().textCursor().selectedText().toStdString(), "Radiotext");
    int places = 1;
    for (click("Handbuch_Weiter"); browser().textCursor().position() != first; click("Handbuch_Weiter")) ++places;
    EXPECT_GT(places, 1);
    EXPECT_EQ(text("Handbuch_Stand"), "");
    type("Handbuch_Suche", "Xylophon");
    click("Handbuch_Weiter");
    EXPECT_EQ(text("Handbuch_Stand"), "Nicht gefunden: Xylophon");
    EXPECT_EQ(browser().textCursor().position(), first);
}

TEST_F(ManualTest, EveryLinkAndPictureOfEveryChapterIsThere) {
    start();
    action("Mnu_Hilfe_Handbuch")->trigger();
    int links = 0;
    int pictures = 0;
    for (const char* language : {"de", "en"}) {
        const auto chapters = shipped / "manual" / language;
        for (const auto& entry : std::filesystem::directory_iterator(chapters)) {
            const std::string name = entry.path().filename().string();
            browser().setSource(QUrl::fromLocalFile(QString::fromStdString(entry.path().string())));
            ASSERT_GT(plainText().size(), 100U) << name;
            for (QTextBlock block = browser().document()->begin(); block.isValid(); block = block.next()) {
                for (auto part = block.begin(); !part.atEnd(); ++part) {
                    const QTextCharFormat format = part.fragment().charFormat();
                    if (format.isImageFormat()) {
                        const QUrl picture(format.toImageFormat().name());
                        const QVariant loaded = browser().document()->resource(QTextDocument::ImageResource, picture);
                        EXPECT_TRUE(loaded.isValid()) << name << " " << picture.toString().toStdString();
                        ++pictures;
                    }
                    if (!format.isAnchor()) continue;
                    const std::string target = format.anchorHref().toStdString();
                    EXPECT_TRUE(std::filesystem::is_regular_file(chapters / target)) << name << " " << target;
                    ++links;
                }
            }
            EXPECT_TRUE(std::filesystem::exists(shipped / "manual" / (language[0] == 'd' ? "en" : "de") / name))
                << name << " in one language only";
        }
    }
    EXPECT_GT(links, 100);
    EXPECT_GE(pictures, 36);
}

}  // namespace
}  // namespace kdx::test
