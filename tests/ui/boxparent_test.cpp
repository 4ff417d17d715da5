#include "ui/qtdialogs.h"

#include <gtest/gtest.h>

#include <QAbstractButton>
#include <QApplication>
#include <QDialog>
#include <QFileDialog>
#include <QInputDialog>
#include <QMainWindow>
#include <QMessageBox>
#include <QTimer>

#include <functional>

#include "settings/captions.h"
#include "settings/datafolder.h"
#include "support/tempfolder.h"

namespace kdx::test {
namespace {

class BoxParentTest : public ::testing::Test {
protected:
    /// Opens a box, gives the window that it belongs to, and closes it.
    static const QWidget* parentOf(const std::function<void()>& open) {
        const QWidget* parent = nullptr;
        QTimer::singleShot(0, qApp, [&] {
            auto* box = qobject_cast<QDialog*>(QApplication::activeModalWidget());
            ASSERT_NE(box, nullptr);
            parent = box->parentWidget();
            box->reject();
        });
        open();
        return parent;
    }

    TempFolder folder;
    DataFolder data{folder.path()};
    Captions captions{data};
    QtDialogs dialogs{captions};
    QMainWindow window;
};

TEST_F(BoxParentTest, EveryBoxBelongsToTheMainWindowAlsoWhenItIsNotActive) {
    window.show();
    ASSERT_EQ(QApplication::activeWindow(), nullptr) << "as just after another box was closed";
    const QString text;
    EXPECT_EQ(parentOf([&] { dialogs.message(Dialogs::Icon::None, text, text); }), &window);
    EXPECT_EQ(parentOf([&] { dialogs.messageOrStop(text, text); }), &window);
    EXPECT_EQ(parentOf([&] { dialogs.confirm(text, text); }), &window);
    EXPECT_EQ(parentOf([&] { dialogs.confirmLoss(text, text); }), &window);
    EXPECT_EQ(parentOf([&] { dialogs.input(text, text, text); }), &window);
    EXPECT_EQ(parentOf([&] { dialogs.about(text, text, text); }), &window);
    EXPECT_EQ(parentOf([&] { dialogs.fileToSave(text, QStringLiteral("a.txt"), text); }), &window);
    EXPECT_EQ(parentOf([&] { dialogs.fileToOpen(text, text); }), &window);
}

TEST_F(BoxParentTest, TheQuestionBeforeAFileIsReplacedBelongsToTheViewThatSaves) {
    window.show();
    QDialog view(&window);
    view.show();
    QApplication::setActiveWindow(&view);
    folder.write("taken.txt", "1");
    const QString taken = QString::fromStdString((folder.data() / "taken.txt").string());
    const QWidget* fileBox = nullptr;
    const QWidget* question = nullptr;
    QTimer::singleShot(0, qApp, [&] {
        auto* box = qobject_cast<QFileDialog*>(QApplication::activeModalWidget());
        ASSERT_NE(box, nullptr);
        fileBox = box->parentWidget();
        QTimer::singleShot(0, qApp, [&question, box] {
            auto* asked = qobject_cast<QMessageBox*>(QApplication::activeModalWidget());
            ASSERT_NE(asked, nullptr);
            question = asked->parentWidget();
            QTimer::singleShot(0, box, &QDialog::reject);  // it is there again then
            asked->reject();
        });
        box->selectFile(taken);
        static_cast<QDialog*>(box)->accept();
    });
    EXPECT_EQ(dialogs.fileToSave(QStringLiteral("Title"), taken, QStringLiteral("All (*)")), QString());
    EXPECT_EQ(fileBox, &view);
    EXPECT_EQ(question, &view);
}

TEST_F(BoxParentTest, ABoxOfAnEditorBelongsToTheEditor) {
    window.show();
    QDialog editor(&window);
    editor.setModal(true);
    editor.show();
    EXPECT_EQ(parentOf([&] { dialogs.confirm(QString(), QString()); }), &editor);
    EXPECT_EQ(parentOf([&] { dialogs.confirm(QString(), QString()); }), &editor) << "the second one, too";
}

TEST_F(BoxParentTest, TheSecondBoxOfAViewBelongsToTheView) {
    window.show();
    QDialog view(&window);
    view.show();
    QApplication::setActiveWindow(&view);
    ASSERT_EQ(QApplication::activeWindow(), &view);
    EXPECT_EQ(parentOf([&] { dialogs.confirm(QString(), QString()); }), &view);
    QApplication::setActiveWindow(nullptr);
    EXPECT_EQ(parentOf([&] { dialogs.confirm(QString(), QString()); }), &view) << "just after the first was closed";
    view.hide();
    EXPECT_EQ(parentOf([&] { dialogs.confirm(QString(), QString()); }), &window) << "the view is gone";
}

TEST_F(BoxParentTest, ABoxBeforeTheWindowIsShownBelongsToNone) {
    EXPECT_EQ(parentOf([&] { dialogs.confirm(QString(), QString()); }), nullptr);
}

TEST_F(BoxParentTest, TheSmallPrintStandsUnderTheTextOfABoxWithAWayOut) {
    QTimer::singleShot(0, qApp, [] {
        auto* box = qobject_cast<QMessageBox*>(QApplication::activeModalWidget());
        ASSERT_NE(box, nullptr);
        EXPECT_EQ(box->informativeText(), QStringLiteral("why"));
        EXPECT_EQ(box->icon(), QMessageBox::Warning);
        ASSERT_EQ(box->buttons().size(), 2);
        box->buttons().at(box->buttons().front()->text() == QStringLiteral("stop it") ? 0 : 1)->click();
    });
    EXPECT_TRUE(dialogs.messageOrStop(QString(), QString(), QStringLiteral("why"), QStringLiteral("stop it"),
                                      Dialogs::Icon::Exclamation));
}

}  // namespace
}  // namespace kdx::test
