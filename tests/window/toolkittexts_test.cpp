// The toolkit's own menus and boxes speak the language of the window.
#include <gtest/gtest.h>

#include <QAbstractButton>
#include <QAction>
#include <QApplication>
#include <QContextMenuEvent>
#include <QDoubleSpinBox>
#include <QFileDialog>
#include <QLabel>
#include <QLineEdit>
#include <QMenu>
#include <QScrollBar>
#include <QTabWidget>
#include <QTextBrowser>
#include <QTimer>
#include <QTreeView>

#include <set>

#include "support/windowtest.h"

namespace kdx::test {
namespace {

/// Wherever the text is clicked at, there is one.
const QString kReference = QStringLiteral("<a href=\"x\">everything here is a reference</a>").repeated(50);

QStringList entriesOf(const QMenu& menu) {
    QStringList entries;
    for (const QAction* entry : menu.actions()) {
        if (!entry->isSeparator()) entries << entry->text().section(QLatin1Char('\t'), 0, 0);
    }
    return entries;
}

/// Opens its menu as a click with the right button does, reads it and closes it.
QStringList menuOf(QWidget& control) {
    QStringList entries;
    QTimer::singleShot(0, &control, [&] {
        auto* menu = qobject_cast<QMenu*>(QApplication::activePopupWidget());
        ASSERT_NE(menu, nullptr);
        entries = entriesOf(*menu);
        menu->close();
    });
    const QPoint place = control.rect().center();
    QContextMenuEvent click(QContextMenuEvent::Mouse, place, control.mapToGlobal(place));
    QApplication::sendEvent(&control, &click);
    QCoreApplication::processEvents();  // some of the menus run by themselves
    return entries;
}

/// All that a box for a file says by itself; what the program names is left out.
QStringList fileBox(QFileDialog::AcceptMode mode) {
    QFileDialog box(nullptr, QStringLiteral("box"), QDir::tempPath(), QStringLiteral("*.x"));
    box.setOption(QFileDialog::DontUseNativeDialog);
    box.setAcceptMode(mode);
    box.setViewMode(QFileDialog::Detail);
    QStringList said;
    for (const QAction* entry : box.findChildren<QAction*>()) said << entry->text();
    for (const QAbstractButton* button : box.findChildren<QAbstractButton*>()) {
        if (!button->icon().isNull()) said << button->toolTip();
    }
    const auto* tree = box.findChild<QTreeView*>(QStringLiteral("treeView"));
    for (int column = 0; column < tree->model()->columnCount(); ++column)
        said << tree->model()->headerData(column, Qt::Horizontal).toString();
    said.removeAll({});
    said.removeDuplicates();
    return said;
}

/// What the toolkit says where this program lets it speak.
QStringList said() {
    QStringList all;
    QLineEdit line;
    all << menuOf(line);
    QDoubleSpinBox number;
    all << menuOf(number);
    QTextBrowser text;
    text.setHtml(kReference);
    all << menuOf(*text.viewport());
    text.setReadOnly(false);
    all << menuOf(*text.viewport());
    for (const Qt::Orientation direction : {Qt::Horizontal, Qt::Vertical}) {
        QScrollBar bar(direction);
        bar.resize(100, 100);
        all << menuOf(bar);
    }
    return all << fileBox(QFileDialog::AcceptOpen) << fileBox(QFileDialog::AcceptSave);
}

class ToolkitTextsTest : public WindowTest {
protected:
    ToolkitTextsTest() { folder.copyShipped(); }
};

TEST_F(ToolkitTextsTest, SpeakTheLanguageOfTheWindow) {
    const QStringList own = said();
    ASSERT_GT(own.size(), 60);
    start();
    const QStringList german = said();
    action("Mnu_Info_Sprache_E")->trigger();
    const QStringList english = said();
    ASSERT_EQ(german.size(), own.size());
    ASSERT_EQ(english.size(), own.size());
    const std::set<QString> sameInBoth = {QStringLiteral("Name")};
    for (int i = 0; i < own.size(); ++i) {
        EXPECT_EQ(german[i] == own[i], sameInBoth.contains(own[i])) << own[i].toStdString();
        EXPECT_EQ(german[i] == english[i], sameInBoth.contains(own[i])) << own[i].toStdString();
        EXPECT_NE(english[i], QString()) << own[i].toStdString();
    }
}

TEST_F(ToolkitTextsTest, EveryEntryOfATextsMenuHasItsLetterOrNone) {
    for (const char* language : {"deutsch", "english", "english US"}) {
        setGeneral("Sprache", "Sprache", language);
        start();
        QDoubleSpinBox number;
        QTextBrowser text;
        text.setReadOnly(false);
        text.setHtml(kReference);
        for (QWidget* const control : {static_cast<QWidget*>(&number), text.viewport()}) {
            std::set<QString> taken;
            for (const QString& entry : menuOf(*control)) {
                const QString key = QKeySequence::mnemonic(entry).toString();
                EXPECT_TRUE(key.isEmpty() || taken.insert(key).second) << language << ' ' << entry.toStdString();
            }
        }
    }
}

TEST_F(ToolkitTextsTest, AFolderIsOpened) {
    start();
    std::filesystem::create_directory(folder.path() / "sets");
    QFileDialog box(nullptr, {}, QString::fromStdString(folder.path().string()));
    box.setOption(QFileDialog::DontUseNativeDialog);
    box.setFileMode(QFileDialog::ExistingFile);
    box.setLabelText(QFileDialog::Accept, QStringLiteral("OK"));
    box.findChild<QLineEdit*>(QStringLiteral("fileNameEdit"))->setText(QStringLiteral("sets"));
    const auto* list = box.findChild<QTreeView*>(QStringLiteral("treeView"));
    box.selectFile(QStringLiteral("sets"));
    list->selectionModel()->select(list->selectionModel()->currentIndex(), QItemSelectionModel::Select);
    EXPECT_EQ(box.labelText(QFileDialog::Accept).toStdString(), "Ö&ffnen");
}

TEST_F(ToolkitTextsTest, ADeletedFileIsAskedForByItsName) {
    start();
    const auto text = [](const char* words) {
        return QCoreApplication::translate("QFileDialog", words).arg(QStringLiteral("a.ini")).toStdString();
    };
    EXPECT_EQ(text("Are you sure you want to delete '%1'?"), "a.ini löschen?");
    EXPECT_EQ(text("%1\nFile not found.\nPlease verify the correct file name was given."),
              "Die Datei a.ini gibt es nicht.");
    EXPECT_EQ(QCoreApplication::translate("QFileDialog", "Show "), QStringLiteral("Zeigen: "));
}

TEST_F(ToolkitTextsTest, NothingOfThemStaysBehindTheWindow) {
    start();
    window.reset();
    EXPECT_EQ(QCoreApplication::translate("QLineEdit", "&Copy"), QStringLiteral("&Copy"));
}

}  // namespace
}  // namespace kdx::test
