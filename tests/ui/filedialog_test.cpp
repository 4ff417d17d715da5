#include "support/sourcefolder.h"
#include "ui/qtdialogs.h"

#include <gtest/gtest.h>

#include <QApplication>
#include <QFileDialog>
#include <QLineEdit>
#include <QMessageBox>
#include <QPushButton>
#include <QTemporaryDir>
#include <QTimer>

#include <functional>

#include "settings/captions.h"
#include "settings/datafolder.h"

namespace kdx {
namespace {

/// The real box for a file's name, met by a user who types and then presses something.
class FileDialogTest : public ::testing::Test {
protected:
    FileDialogTest() { captions.load("deutsch", "RDS"); }

    QString answer(const std::function<void(QFileDialog& box)>& user) {
        QTimer::singleShot(0, qApp, [this, user] {
            auto* box = qobject_cast<QFileDialog*>(QApplication::activeModalWidget());
            ASSERT_NE(box, nullptr);
            met = true;
            user(*box);
        });
        return dialogs.fileToSave(QStringLiteral("Auf Sendung"), preset, QStringLiteral("Gruppen (*.txt)"));
    }
    static void press(const QFileDialog& box, const QString& caption) {
        for (QPushButton* found : box.findChildren<QPushButton*>()) {
            if (found->text() == caption) return found->click();
        }
        FAIL() << "no button " << caption.toStdString();
    }

    QTemporaryDir folder;
    QString preset = folder.filePath(QStringLiteral("groups.txt"));
    DataFolder data{test::sourceFolder()};
    Captions captions{data};
    QtDialogs dialogs{captions};
    bool met = false;
};

TEST_F(FileDialogTest, ProposesANameAndGivesTheOneThatWasTyped) {
    EXPECT_EQ(answer([](QFileDialog& box) {
                  EXPECT_EQ(box.windowTitle(), QStringLiteral("Auf Sendung"));
                  EXPECT_EQ(box.findChild<QLineEdit*>()->text(), QStringLiteral("groups.txt"));
                  EXPECT_EQ(box.nameFilters(), QStringList{QStringLiteral("Gruppen (*.txt)")});
                  press(box, QStringLiteral("&Sichern"));
              }),
              preset);
    EXPECT_EQ(answer([](QFileDialog& box) {
                  box.findChild<QLineEdit*>()->setText(QStringLiteral("others.txt"));
                  press(box, QStringLiteral("&Sichern"));
              }),
              folder.filePath(QStringLiteral("others.txt")));
    EXPECT_TRUE(met);
}

TEST_F(FileDialogTest, GivesNothingWhenCancelled) {
    EXPECT_EQ(answer([](QFileDialog& box) { press(box, QStringLiteral("Abbrechen")); }), QString());
    EXPECT_TRUE(met);
}

TEST_F(FileDialogTest, AsksBeforeAFileIsReplaced) {
    QFile file(preset);
    ASSERT_TRUE(file.open(QIODevice::WriteOnly));
    file.close();
    bool asked = false;
    EXPECT_EQ(answer([&asked](QFileDialog& box) {
                  QTimer::singleShot(0, qApp, [&asked, &box] {
                      auto* question = qobject_cast<QMessageBox*>(QApplication::activeModalWidget());
                      ASSERT_NE(question, nullptr);
                      asked = true;
                      QTimer::singleShot(0, &box, &QFileDialog::reject);  // it is there again then
                      question->reject();
                  });
                  press(box, QStringLiteral("&Sichern"));
              }),
              QString());
    EXPECT_TRUE(asked);
}

TEST_F(FileDialogTest, DoesNotOpenOnceTheProgramEnds) {
    QtDialogs ending(captions, [] { return true; });
    EXPECT_EQ(ending.fileToSave(QString(), preset, QString()), QString());
}

}  // namespace
}  // namespace kdx
