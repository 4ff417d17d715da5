// The toolkit's own menus and boxes speak the language of the window.
#include <gtest/gtest.h>

#include <QAbstractButton>
#include <QAction>
#include <QApplication>
#include <QComboBox>
#include <QContextMenuEvent>
#include <QDir>
#include <QDoubleSpinBox>
#include <QFileDialog>
#include <QItemSelectionModel>
#include <QLineEdit>
#include <QMenu>
#include <QMessageBox>
#include <QScrollBar>
#include <QTextBrowser>
#include <QTimer>
#include <QTreeView>

#include <filesystem>
#include <functional>
#include <set>
#include <string>

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

/// A box for a file that stands at a folder of the name "sets".
class SetsBox : public QFileDialog {
public:
    explicit SetsBox(const std::filesystem::path& folder)
        : QFileDialog(nullptr, {}, QString::fromStdString(folder.string())) {
        std::filesystem::create_directory(folder / "sets");
        setOption(DontUseNativeDialog);
        setFileMode(ExistingFile);
        setLabelText(Accept, QStringLiteral("OK"));
        selectFile(QStringLiteral("sets"));
        auto* shown = entries();
        shown->select(shown->currentIndex(), QItemSelectionModel::Select | QItemSelectionModel::Rows);
    }
    /// Ends with a name that is typed.
    void acceptTyped(const char* name) {
        entries()->clear();
        findChild<QLineEdit*>(QStringLiteral("fileNameEdit"))->setText(QString::fromLatin1(name));
        accept();
    }
    [[nodiscard]] QItemSelectionModel* entries() const {
        return findChild<QTreeView*>(QStringLiteral("treeView"))->selectionModel();
    }
    [[nodiscard]] QAction* action(const char* name) const { return findChild<QAction*>(QString::fromLatin1(name)); }
};

/// What the box says that a handler opens, and its buttons; the last one is clicked, which is "no" if it asks.
std::string boxAfter(const std::function<void()>& handler) {
    QStringList said;
    QTimer::singleShot(0, QCoreApplication::instance(), [&] {
        auto* box = qobject_cast<QMessageBox*>(QApplication::activeModalWidget());
        ASSERT_NE(box, nullptr);
        said << box->text();
        for (const QAbstractButton* button : box->buttons()) said << button->text().remove(QLatin1Char('&'));
        box->buttons().constLast()->click();
    });
    handler();
    return said.join(QLatin1Char(' ')).toStdString();
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

TEST_F(ToolkitTextsTest, EveryEntryOfAMenuHasALetterOfItsOwnOrNone) {
    for (const char* language : {"deutsch", "english", "english US"}) {
        setGeneral("Sprache", "Sprache", language);
        start();
        QDoubleSpinBox number;
        QTextBrowser text;
        text.setReadOnly(false);
        text.setHtml(kReference);
        QStringList menuOfFiles;
        const SetsBox box(folder.path());
        for (const char* entry :
             {"qt_rename_action", "qt_delete_action", "qt_show_hidden_action", "qt_new_folder_action"})
            menuOfFiles << box.action(entry)->text();
        for (const QStringList& menu : {menuOf(number), menuOf(*text.viewport()), menuOfFiles}) {
            std::set<QString> taken;
            for (const QString& entry : menu) {
                const QString key = QKeySequence::mnemonic(entry).toString();
                EXPECT_TRUE(key.isEmpty() || taken.insert(key).second) << language << ' ' << entry.toStdString();
            }
        }
    }
}

TEST_F(ToolkitTextsTest, AFolderIsOpened) {
    start();
    const SetsBox box(folder.path());
    EXPECT_EQ(box.labelText(QFileDialog::Accept).toStdString(), "Ö&ffnen");
}

TEST_F(ToolkitTextsTest, ABoxForAFileAsksAndTellsInTheLanguageOfTheWindow) {
    start();
    SetsBox box(folder.path());
    QAction* remove = box.action("qt_delete_action");
    remove->setEnabled(true);  // as by the menu that it is in
    EXPECT_EQ(boxAfter([&] { remove->trigger(); }), "sets löschen? Ja Nein");
    EXPECT_TRUE(std::filesystem::exists(folder.path() / "sets"));
    EXPECT_EQ(boxAfter([&] { box.acceptTyped("none.INI"); }), "Die Datei none.INI gibt es nicht. OK");
    box.setFileMode(QFileDialog::Directory);
    EXPECT_EQ(boxAfter([&] { box.acceptTyped("none"); }), "Den Ordner none gibt es nicht. OK");
    box.setHistory({QString::fromStdString(folder.path().string())});
    auto* folders = box.findChild<QComboBox*>(QStringLiteral("lookInCombo"));
    folders->showPopup();
    EXPECT_GE(folders->findText(QStringLiteral("Zuletzt benutzt")), 0);
}

TEST_F(ToolkitTextsTest, WhatAnOlderLanguageFileDoesNotHaveStaysAsItIs) {
    std::string file = folder.read("Sprachen.ini");
    for (std::size_t at = 0; (at = file.find("\n1263=")) != std::string::npos;)
        file.erase(at, file.find('\n', at + 1) - at);
    folder.write("Sprachen.ini", file);
    setGeneral("Sprache", "Sprache", "english");
    start();
    EXPECT_EQ(QCoreApplication::translate("QLineEdit", "&Copy"), QStringLiteral("&Copy"));
    EXPECT_EQ(QCoreApplication::translate("QLineEdit", "Select All"), QStringLiteral("Select &all"));
}

TEST_F(ToolkitTextsTest, NothingOfThemStaysBehindTheWindow) {
    start();
    window.reset();
    EXPECT_EQ(QCoreApplication::translate("QLineEdit", "&Copy"), QStringLiteral("&Copy"));
}

}  // namespace
}  // namespace kdx::test
